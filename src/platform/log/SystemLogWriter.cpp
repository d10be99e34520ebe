#include "platform/log/SystemLogWriter.h"

#include <syslog.h>
#include <unistd.h>

#include <chrono>

namespace vespscope::log {

SystemLogWriter::SystemLogWriter() : thread_([this] { run(); }) {}

SystemLogWriter::~SystemLogWriter() {
  {
    const std::lock_guard lock(mutex_);
    stopping_ = true;
  }
  changed_.notify_all();
  thread_.join();
}

bool SystemLogWriter::daemonPresent() { return ::access("/dev/log", F_OK) == 0; }

void SystemLogWriter::enqueue(std::string line, bool terminalOwned) {
  {
    const std::lock_guard lock(mutex_);
    if (lines_.size() >= capacity) {
      ++dropped_;
      return;
    }
    lines_.push_back({std::move(line), terminalOwned});
  }
  changed_.notify_all();
}

void SystemLogWriter::flush() {
  std::unique_lock lock(mutex_);
  changed_.wait_for(lock, std::chrono::seconds(1), [this] { return lines_.empty() && !writing_; });
}

void SystemLogWriter::run() {
  std::unique_lock lock(mutex_);
  while (true) {
    changed_.wait(lock, [this] { return stopping_ || !lines_.empty(); });
    if (lines_.empty()) return;
    const Line line = std::move(lines_.front());
    lines_.pop_front();
    writing_ = true;
    lock.unlock();
    write(line);
    lock.lock();
    writing_ = false;
    if (lines_.empty()) changed_.notify_all();
  }
}

void SystemLogWriter::write(const Line& line) {
  if (daemonPresent()) {
    ::syslog(LOG_INFO | LOG_USER, "%s", line.text.c_str());
    return;
  }
  if (line.terminalOwned && ::isatty(STDERR_FILENO) != 0) return;
  const std::string text = line.text + '\n';
  std::size_t done = 0;
  while (done < text.size()) {
    const ssize_t written = ::write(STDERR_FILENO, text.data() + done, text.size() - done);
    if (written <= 0) return;  // nowhere is left to tell that standard error is gone
    done += static_cast<std::size_t>(written);
  }
}

}  // namespace vespscope::log
