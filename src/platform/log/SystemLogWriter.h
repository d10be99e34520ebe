// Writes system log lines from a separate thread, so that a stuck log daemon never blocks the logging threads.
#pragma once

#include <atomic>
#include <condition_variable>
#include <cstdint>
#include <mutex>
#include <string>
#include <string_view>
#include <thread>
#include <vector>

namespace vespscope::log {

class SystemLogWriter {
 public:
  SystemLogWriter();
  SystemLogWriter(const SystemLogWriter&) = delete;
  SystemLogWriter& operator=(const SystemLogWriter&) = delete;
  ~SystemLogWriter();

  // Whether a log daemon's socket exists; without one, lines go to standard error.
  [[nodiscard]] static bool daemonPresent();

  // Queues one line; `terminalOwned` keeps it off a standard error that is the terminal. If the queue is full, the line
  // is dropped and counted, and a line in the log marks the place.
  void enqueue(std::string_view line, bool terminalOwned);

  // Waits until everything queued so far is written, at most one second.
  void flush();

  [[nodiscard]] std::uint64_t dropped() const { return dropped_; }

 private:
  // Lines stored one after the other, so that a line needs no allocation of its own.
  struct Lines {
    struct Line {
      std::size_t end = 0;  // in `text`, before the newline
      bool terminalOwned = false;
    };
    void add(std::string_view line, bool terminalOwned);

    std::string text;
    std::vector<Line> lines;
  };
  void run();
  static void write(Lines& taken);
  static void writeToDaemon(Lines& taken);
  static void writeToStandardError(const Lines& taken);
  static bool writeOut(std::string_view text);

  // Bounds in lines and in bytes for the waiting lines; as many more may be being written. A single line is accepted
  // whatever its size.
  static constexpr std::size_t capacity = 8192;
  static constexpr std::size_t byteCapacity = std::size_t{8} << 20;
  static constexpr std::size_t keptSize = std::size_t{1} << 18;  // bytes of memory kept for the next lines

  std::mutex mutex_;
  std::condition_variable changed_;
  Lines waiting_;
  std::uint64_t untold_ = 0;  // lines dropped after the waiting ones and not yet reported
  bool writing_ = false;
  bool hurried_ = false;  // a flush() is waiting
  bool stopping_ = false;
  std::atomic<std::uint64_t> dropped_ = 0;
  std::thread thread_;
};

}  // namespace vespscope::log
