// Writes system log lines from a side thread, so that a stuck log daemon never stalls who logs.
#pragma once

#include <atomic>
#include <condition_variable>
#include <cstdint>
#include <deque>
#include <mutex>
#include <string>
#include <thread>

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
  // line and counts it.
  void enqueue(std::string line, bool terminalOwned);

  // Waits until everything queued so far is written, at most for a second.
  void flush();

  [[nodiscard]] std::uint64_t dropped() const { return dropped_; }

 private:
  struct Line {
    std::string text;
    bool terminalOwned;
  };
  void run();
  static void write(const std::deque<Line>& lines);
  static bool writeOut(const std::string& text);

  static constexpr std::size_t capacity = 8192;    // lines that wait, beside as many that are being written
  static constexpr std::size_t blockSize = 16384;  // bytes that standard error gets at once

  std::mutex mutex_;
  std::condition_variable changed_;
  std::deque<Line> lines_;
  bool writing_ = false;
  bool stopping_ = false;
  std::atomic<std::uint64_t> dropped_ = 0;
  std::thread thread_;
};

}  // namespace vespscope::log
