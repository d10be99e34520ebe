#include "tools/vespctl/Progress.h"

#include <unistd.h>

#include <cinttypes>
#include <cstdio>

namespace vespscope::tools {
namespace {

constexpr std::chrono::milliseconds interval{200};

}  // namespace

Progress::Progress() : onTerminal_(::isatty(STDERR_FILENO) != 0) {}
Progress::~Progress() { clear(); }

void Progress::say(const std::string& line) {
  if (!onTerminal_) return;
  clear();
  std::fprintf(stderr, "%s\n", line.c_str());
}

void Progress::show(std::uint64_t events) {
  if (!onTerminal_) return;
  const auto now = std::chrono::steady_clock::now();
  if (now < next_) return;
  next_ = now + interval;
  std::fprintf(stderr, "\r%" PRIu64 " events", events);
  shown_ = true;
}

void Progress::clear() {
  if (shown_) std::fputs("\r\x1b[K", stderr);
  shown_ = false;
}

}  // namespace vespscope::tools
