// Writes system log lines from a side thread, so that a stuck log daemon never stalls who logs.
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

  // True when a log daemon's socket exists; without one, lines go to standard error.
  [[nodiscard]] static bool daemonPresent();

  // Queues one line; `terminalOwned` keeps it off a standard error that is the terminal. A full queue drops the
  // line and counts it, and a line in the log tells where that was.
  void enqueue(std::string_view line, bool terminalOwned);

  // Waits until everything queued so far is written, at most for a second.
  void flush();

  [[nodiscard]] std::uint64_t dropped() const { return dropped_; }

 private:
  // Lines one behind the other, so that a line costs no memory of its own.
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

  // Lines that wait, beside as many that are being written, and bytes of them; one line is taken whatever its size.
  static constexpr std::size_t capacity = 8192;
  static constexpr std::size_t byteCapacity = std::size_t{8} << 20;
  static constexpr std::size_t keptSize = std::size_t{1} << 18;  // bytes of room that are kept for the next lines

  std::mutex mutex_;
  std::condition_variable changed_;
  Lines waiting_;
  std::uint64_t untold_ = 0;  // lines that were dropped behind those that wait
  bool writing_ = false;
  bool hurried_ = false;  // somebody waits until all is written
  bool stopping_ = false;
  std::atomic<std::uint64_t> dropped_ = 0;
  std::thread thread_;
};

}  // namespace vespscope::log
