#include "rhoxlink/bus/GuardedInput.h"

#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstring>
#include <string>
#include <utility>

namespace vespscope::bus {
namespace {

using namespace std::chrono_literals;

constexpr std::size_t bufferSize = 32 * 1024;
// A wait for the peer is counted in steps, so that a pause of this process is not attributed to the peer.
constexpr std::chrono::milliseconds longestStep = 1s;
constexpr std::chrono::milliseconds roomPause = 10ms;  // between two checks of the budget

bool setNonBlocking(int descriptor) {
  const int flags = ::fcntl(descriptor, F_GETFL);
  return flags >= 0 && ::fcntl(descriptor, F_SETFL, flags | O_NONBLOCK) == 0;
}

}  // namespace

GuardedInput::GuardedInput(int input, int reading, int writing, const WireLimits& limits,
                           std::shared_ptr<MemoryBudget> budget)
    : input_(input),
      reading_(reading),
      writing_(writing),
      checker_(limits, std::move(budget)),
      buffer_(bufferSize),
      lastWait_(Clock::now()) {}

Result<std::unique_ptr<GuardedInput>> GuardedInput::open(int input, const WireLimits& limits,
                                                         std::shared_ptr<MemoryBudget> budget) {
  std::array<int, 2> ends{-1, -1};
  if (!setNonBlocking(input) || ::pipe2(ends.data(), O_CLOEXEC | O_NONBLOCK) != 0) {
    const int error = errno;
    if (input >= 0) ::close(input);
    return Failure{std::strerror(error) + std::string()};
  }
  return std::unique_ptr<GuardedInput>(new GuardedInput(input, ends[0], ends[1], limits, std::move(budget)));
}

GuardedInput::~GuardedInput() {
  for (const int descriptor : {input_, reading_, writing_}) {
    if (descriptor >= 0) ::close(descriptor);
  }
}

int GuardedInput::takeOutput() { return std::exchange(reading_, -1); }

Result<bool> GuardedInput::pump(bool authenticated) {
  while (true) {
    if (passOn()) return true;
    if (writing_ < 0) return false;
    if (begin_ < end_) {
      const Result<std::size_t> count =
          checker_.admit(std::span(buffer_).subspan(begin_, end_ - begin_), authenticated);
      if (!count) return Failure{count.reason()};
      admitted_ = begin_ + *count;
      if (admitted_ > begin_) continue;
      if (checker_.waitsForRoom()) return false;
    }
    if (std::exchange(drained_, false) || !fill()) return waited();
  }
}

bool GuardedInput::passOn() {
  if (begin_ == admitted_) {
    if (!ended_ || writing_ < 0) return false;
    // An incomplete message is discarded.
    ::close(std::exchange(writing_, -1));
    return true;
  }
  const ssize_t count = ::write(writing_, buffer_.data() + begin_, admitted_ - begin_);
  if (count <= 0) return false;
  begin_ += static_cast<std::size_t>(count);
  return true;
}

bool GuardedInput::fill() {
  if (ended_) return false;
  if (begin_ > 0) {
    std::copy(buffer_.begin() + static_cast<std::ptrdiff_t>(begin_),
              buffer_.begin() + static_cast<std::ptrdiff_t>(end_), buffer_.begin());
    end_ -= begin_;
    begin_ = admitted_ = 0;
  }
  ssize_t count = 0;
  do {
    count = ::read(input_, buffer_.data() + end_, buffer_.size() - end_);
  } while (count < 0 && errno == EINTR);
  if (count < 0 && (errno == EAGAIN || errno == EWOULDBLOCK)) return false;
  ended_ = count <= 0;
  if (count > 0) end_ += static_cast<std::size_t>(count);
  drained_ = count > 0 && end_ < buffer_.size();
  return true;
}

Result<bool> GuardedInput::waited() {
  if (!checker_.unfinished()) {
    waiting_ = false;
    return false;
  }
  const Clock::time_point now = Clock::now();
  if (!std::exchange(waiting_, true)) {
    lastWait_ = now;
    return false;
  }
  const auto step = std::min(std::chrono::duration_cast<std::chrono::milliseconds>(now - lastWait_), longestStep);
  if (step < 1ms) return false;
  lastWait_ = now;
  if (const Result<bool> patient = checker_.waited(step); !patient) return Failure{patient.reason()};
  return false;
}

std::chrono::microseconds GuardedInput::timeout() const {
  if (checker_.waitsForRoom()) return roomPause;
  return checker_.unfinished() && !ended_ ? std::chrono::microseconds(longestStep) : -1us;
}

}  // namespace vespscope::bus
