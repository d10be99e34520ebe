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
  bool first = false;
  {
    const std::lock_guard lock(mutex_);
    if (lines_.size() >= capacity) {
      ++dropped_;
      return;
    }
    first = lines_.empty();
    lines_.push_back({std::move(line), terminalOwned});
  }
  if (first) changed_.notify_all();  // else the writer has been told already
}

void SystemLogWriter::flush() {
  std::unique_lock lock(mutex_);
  changed_.wait_for(lock, std::chrono::seconds(1), [this] { return lines_.empty() && !writing_; });
}

void SystemLogWriter::run() {
  std::unique_lock lock(mutex_);
  std::deque<Line> taken;
  while (true) {
    changed_.wait(lock, [this] { return stopping_ || !lines_.empty(); });
    if (lines_.empty()) return;
    taken.swap(lines_);
    writing_ = true;
    lock.unlock();
    write(taken);
    taken.clear();
    lock.lock();
    writing_ = false;
    if (lines_.empty()) changed_.notify_all();
  }
}

void SystemLogWriter::write(const std::deque<Line>& lines) {
  if (daemonPresent()) {
    for (const Line& line : lines) ::syslog(LOG_INFO | LOG_USER, "%s", line.text.c_str());
    return;
  }
  const bool terminal = ::isatty(STDERR_FILENO) != 0;
  std::string text;
  for (const Line& line : lines) {
    if (line.terminalOwned && terminal) continue;
    text += line.text;
    text += '\n';
    if (text.size() < blockSize) continue;
    if (!writeOut(text)) return;
    text.clear();
  }
  writeOut(text);
}

// False when standard error is gone; nowhere is left to tell that.
bool SystemLogWriter::writeOut(const std::string& text) {
  std::size_t done = 0;
  while (done < text.size()) {
    const ssize_t written = ::write(STDERR_FILENO, text.data() + done, text.size() - done);
    if (written <= 0) return false;
    done += static_cast<std::size_t>(written);
  }
  return true;
}

}  // namespace vespscope::log
