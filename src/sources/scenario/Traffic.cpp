#include "sources/scenario/Traffic.h"

namespace vespscope::sources::scenario {
namespace {

Time milliseconds(double seconds) { return Time(static_cast<std::int64_t>(seconds * 1000)); }

}  // namespace

// The first session begins soon, so that a new user sees a connection; later ones are random.
Traffic::Traffic(std::uint64_t seed) : random_(hashOf(seed, 20)) {
  data_.from = milliseconds(random_.uniform(3, 4));
  data_.to = data_.from + milliseconds(random_.uniform(11, 13));
  voice_.from = milliseconds(random_.uniform(160, 260));
  voice_.to = voice_.from + milliseconds(random_.uniform(20, 50));
}

void Traffic::entered(Technology technology, Time now) {
  using namespace std::chrono_literals;
  if (technology == Technology::umts && now < 90s && !calledInGsm_) {
    data_ = {now + 5s, now + milliseconds(random_.uniform(12, 14))};
  }
  // A call soon after the first change to GSM shows its dedicated mode.
  if (technology == Technology::gsm && !calledInGsm_) {
    calledInGsm_ = true;
    voice_.from = now + milliseconds(random_.uniform(5, 6));
    voice_.to = voice_.from + milliseconds(random_.uniform(9, 10));
    data_ = {now + 45s, now + 60s};
  }
}

void Traffic::tick(Time now) {
  if (now >= data_.to) {
    data_.from = now + milliseconds(4 + random_.exponential(22));
    data_.to = data_.from + milliseconds(4 + random_.exponential(24));
    dataTerminated_ = random_.chance(0.3);
  }
  if (now >= voice_.to) {
    voice_.from = now + milliseconds(90 + random_.exponential(200));
    voice_.to = voice_.from + milliseconds(15 + random_.exponential(35));
    voiceTerminated_ = random_.chance(0.5);
  }
  if (now >= burst_.to) {
    burst_.from = now + milliseconds(0.2 + random_.exponential(1.5));
    burst_.to = burst_.from + milliseconds(1 + random_.exponential(4));
  }
  demand_.data = data_.covers(now);
  demand_.burst = demand_.data && burst_.covers(now);
  demand_.voice = voice_.covers(now);
  demand_.mobileTerminated = demand_.voice ? voiceTerminated_ : dataTerminated_;
}

}  // namespace vespscope::sources::scenario
