#include "shell/SimSwitch.h"

#include <algorithm>
#include <utility>

#include "client/RhoxWrapper.h"
#include "metrics/MetricValidator.h"
#include "platform/dispatch/MainLoop.h"
#include "platform/dispatch/SerialQueue.h"
#include "rhoxlink/Rhoxlink.h"

namespace vespscope {
namespace {

std::optional<std::int32_t> cardOfTheSource() {
  return rhox::client::connectionStatus(RhoxWrapper::sharedInstance()->manager()).simCard;
}

}  // namespace

std::shared_ptr<SimSwitch> SimSwitch::create(std::optional<std::int32_t> wanted) {
  return std::shared_ptr<SimSwitch>(new SimSwitch(wanted));
}

SimSwitch::SimSwitch(std::optional<std::int32_t> wanted)
    : choice_({[this] { callSoon(&SimSwitch::forget_); }, [this](SimChoice::Event event) { pass_(std::move(event)); }},
              wanted, &cardOfTheSource) {
  onForget([] { MetricValidator::shared()->forget(); });
}

void SimSwitch::install() { RhoxWrapper::setMetricGate(shared_from_this()); }

void SimSwitch::take(std::shared_ptr<const Record> dictionary, const Pass& pass) {
  perform([&](SimChoice& choice) {
    if (!pass_) pass_ = pass;
    choice.take(std::move(dictionary), SimChoice::Clock::now());
  });
}

void SimSwitch::showNext() {
  const auto queue = RhoxWrapper::sharedInstance()->queue();
  if (!queue) return;
  queue->async([self = shared_from_this()] { self->perform([](SimChoice& choice) { choice.showNext(); }); });
}

template <class Change>
void SimSwitch::perform(const Change& change) {
  const std::lock_guard lock(mutex_);
  const std::optional<std::int32_t> before = choice_.shown();
  change(choice_);
  if (before && choice_.shown() != before) callSoon(&SimSwitch::shown_);
}

void SimSwitch::callSoon(std::vector<std::function<void()>> SimSwitch::*listeners) {
  dispatch::MainLoop::main().async([self = shared_from_this(), listeners] {
    for (const auto& listener : (*self).*listeners) listener();
  });
}

application::SimCards SimSwitch::cards() const {
  const std::lock_guard lock(mutex_);
  application::SimCards cards{choice_.shown(), choice_.seen()};
  std::erase(cards.others, cards.shown.value_or(0));
  return cards;
}

std::optional<SimChoice::Clock::time_point> SimSwitch::arrivalOf(std::int64_t metricID) const {
  const std::lock_guard lock(mutex_);
  return choice_.arrivalOf(metricID);
}

}  // namespace vespscope
