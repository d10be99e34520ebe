#include "shell/EventRate.h"

namespace vespscope {
namespace {

constexpr std::chrono::seconds window{5};
constexpr std::chrono::milliseconds spacing{250};  // keeps the number of samples small, however often update() is
                                                   // called

}  // namespace

double EventRate::update(Clock::time_point now, std::uint64_t events) {
  while (!samples_.empty() && now - samples_.front().time > window) samples_.pop_front();
  double rate = 0;
  if (!samples_.empty() && now > samples_.front().time) {
    const std::chrono::duration<double> elapsed = now - samples_.front().time;
    rate = static_cast<double>(events - samples_.front().events) / elapsed.count();
  }
  if (samples_.empty() || now - samples_.back().time >= spacing) samples_.push_back({now, events});
  return rate;
}

}  // namespace vespscope
