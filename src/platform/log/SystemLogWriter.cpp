#include "platform/log/SystemLogWriter.h"

#include <syslog.h>
#include <unistd.h>

#include <chrono>
#include <utility>

namespace vespscope::log {
namespace {

// How long a line may wait to be written together with others, and how many queued lines end the wait.
constexpr std::chrono::milliseconds patience{5};
constexpr std::size_t enough = 1024;

}  // namespace

SystemLogWriter::SystemLogWriter() : thread_([this] { run(); }) {}

SystemLogWriter::~SystemLogWriter() {
  {
    const std::lock_guard lock(mutex_);
    stopping_ = true;
  }
  changed_.notify_all();
  thread_.join();
}

void SystemLogWriter::Lines::add(std::string_view line, bool terminalOwned) {
  text += line;
  lines.push_back({text.size(), terminalOwned});
  text += '\n';
}

bool SystemLogWriter::daemonPresent() { return ::access("/dev/log", F_OK) == 0; }

void SystemLogWriter::enqueue(std::string_view line, bool terminalOwned) {
  bool tell = false;
  {
    const std::lock_guard lock(mutex_);
    const bool tooLong = !waiting_.lines.empty() && waiting_.text.size() + line.size() > byteCapacity;
    if (waiting_.lines.size() >= capacity || tooLong) {
      ++dropped_;
      ++untold_;
      return;
    }
    waiting_.add(line, terminalOwned);
    // Otherwise the writer has been notified already.
    tell = waiting_.lines.size() == 1 || waiting_.lines.size() == enough;
  }
  if (tell) changed_.notify_all();
}

void SystemLogWriter::flush() {
  std::unique_lock lock(mutex_);
  hurried_ = true;
  changed_.notify_all();
  changed_.wait_for(lock, std::chrono::seconds(1), [this] { return waiting_.lines.empty() && !writing_; });
}

void SystemLogWriter::run() {
  std::unique_lock lock(mutex_);
  Lines taken;
  while (true) {
    changed_.wait(lock, [this] { return stopping_ || !waiting_.lines.empty(); });
    // Waking the writer for every line would cost more than writing them.
    changed_.wait_for(lock, patience, [this] { return stopping_ || hurried_ || waiting_.lines.size() >= enough; });
    if (waiting_.lines.empty()) return;
    std::swap(taken, waiting_);
    if (const std::uint64_t count = std::exchange(untold_, 0); count != 0) {
      taken.add("the system log did not keep up: " + std::to_string(count) + " lines are left out here",
                taken.lines.back().terminalOwned);
    }
    writing_ = true;
    lock.unlock();
    write(taken);
    lock.lock();
    writing_ = false;
    if (!waiting_.lines.empty()) continue;
    hurried_ = false;
    changed_.notify_all();
  }
}

void SystemLogWriter::write(Lines& taken) {
  if (daemonPresent()) {
    writeToDaemon(taken);
  } else {
    writeToStandardError(taken);
  }
  taken.lines.clear();
  taken.text.clear();
  if (taken.text.capacity() > keptSize) taken = {};
}

void SystemLogWriter::writeToDaemon(Lines& taken) {
  std::size_t begin = 0;
  for (const Lines::Line& line : taken.lines) {
    taken.text[line.end] = '\0';
    ::syslog(LOG_INFO | LOG_USER, "%s", taken.text.data() + begin);
    begin = line.end + 1;
  }
}

void SystemLogWriter::writeToStandardError(const Lines& taken) {
  const bool terminal = ::isatty(STDERR_FILENO) != 0;
  std::size_t begin = 0;  // of the next write
  std::size_t next = 0;   // the next line
  for (const Lines::Line& line : taken.lines) {
    const std::string_view before(taken.text.data() + begin, next - begin);
    next = line.end + 1;
    if (!line.terminalOwned || !terminal) continue;
    if (!writeOut(before)) return;
    begin = next;
  }
  writeOut(std::string_view(taken.text).substr(begin));
}

// Returns false when standard error is closed; there is no place left to report that.
bool SystemLogWriter::writeOut(std::string_view text) {
  while (!text.empty()) {
    const ssize_t written = ::write(STDERR_FILENO, text.data(), text.size());
    if (written <= 0) return false;
    text.remove_prefix(static_cast<std::size_t>(written));
  }
  return true;
}

}  // namespace vespscope::log
