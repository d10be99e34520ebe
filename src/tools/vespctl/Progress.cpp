#include "tools/vespctl/Progress.h"

#include <array>
#include <cmath>
#include <cstdio>

#include "platform/console/Console.h"

namespace vespscope::tools {
namespace {

constexpr std::chrono::milliseconds interval{200};
constexpr double megabyte = 1e6;

// A number with one decimal.
std::string decimal(double number) {
  std::array<char, 64> text{};
  std::snprintf(text.data(), text.size(), "%.1f", number);
  return text.data();
}

std::string timeText(double seconds) {
  const auto whole = static_cast<std::uint64_t>(std::llround(seconds));
  if (whole < 60) return std::to_string(whole) + " s";
  if (whole < 3600) return std::to_string(whole / 60) + " min " + std::to_string(whole % 60) + " s";
  return std::to_string(whole / 3600) + " h " + std::to_string(whole % 3600 / 60) + " min";
}

}  // namespace

std::string progressText(const sources::InputProgress& input, std::uint64_t events, std::chrono::milliseconds elapsed) {
  std::string count = std::to_string(events) + " events";
  if (input.read == 0) return count;
  const auto read = static_cast<double>(input.read);
  const auto total = static_cast<double>(input.total);
  const double seconds = std::chrono::duration<double>(elapsed).count();
  std::string text = decimal(read / megabyte);
  if (input.total != 0) text += " of " + decimal(total / megabyte);
  text += " MB";
  if (seconds <= 0) return text + ", " + count;
  text += ", " + decimal(read / megabyte / seconds) + " MB/s";
  if (input.total > input.read) text += ", " + timeText((total - read) * seconds / read) + " left";
  return text + ", " + count;
}

Progress::Progress() : onTerminal_(console::errorIsTerminal()) {}
Progress::~Progress() { clear(); }

void Progress::say(const std::string& line) {
  if (!onTerminal_) return;
  clear();
  console::error(line);
}

bool Progress::due() {
  if (!onTerminal_) return false;
  const auto now = std::chrono::steady_clock::now();
  if (now < next_) return false;
  next_ = now + interval;
  return true;
}

void Progress::show(const std::string& line) {
  if (!onTerminal_) return;
  console::showProgress(line);
  shown_ = true;
}

std::chrono::milliseconds Progress::elapsed() const {
  return std::chrono::duration_cast<std::chrono::milliseconds>(std::chrono::steady_clock::now() - begin_);
}

void Progress::clear() {
  if (shown_) console::showProgress("");
  shown_ = false;
}

}  // namespace vespscope::tools
