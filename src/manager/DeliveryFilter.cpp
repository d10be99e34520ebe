#include "manager/DeliveryFilter.h"

#include <algorithm>

#include "manager/Payload.h"

namespace vespscope::manager {

void DeliveryFilter::setConfiguration(std::shared_ptr<const Configuration> configuration) {
  configuration_ = std::move(configuration);
  if (!configuration_) slots_.clear();
  for (auto& [key, slot] : slots_) slot.waiting.reset();
  waiting_ = 0;
}

void DeliveryFilter::offer(const SharedEvent& event, Clock::time_point now, std::vector<SharedEvent>& due) {
  if (!configuration_) return;
  releaseUntil(event->time, due);
  const MetricRule* rule = configuration_->ruleFor(event->metricID);
  if (rule == nullptr) return;
  const Key key{event->metricID, event->profileID};
  if (slots_.size() >= slotLimit && !slots_.contains(key)) return due.push_back(event);
  Slot& slot = slots_[key];
  if (slot.last == event || slot.waiting == event) return;
  if (rule->period.count() != 0) return offerPeriodic(slot, event, rule->period, now, due);
  if (rule->onChange() && slot.last && sameButForTimestamp(slot.last->payload, event->payload)) return;
  slot.last = event;
  due.push_back(event);
}

void DeliveryFilter::offerPeriodic(Slot& slot, const SharedEvent& event, std::chrono::nanoseconds period,
                                   Clock::time_point now, std::vector<SharedEvent>& due) {
  // An event more than a period before the previous one belongs to another stretch of time, as when a recording starts
  // again.
  const bool outside = event->time >= slot.periodEnd || event->time < slot.periodEnd - 2 * period;
  if (!slot.last || outside) {
    if (slot.waiting) release(slot, period, due);
    slot.last = event;
    slot.periodEnd = event->time + period;
    due.push_back(event);
    return;
  }
  if (!slot.waiting) ++waiting_;
  slot.waiting = event;
  slot.due = now + (slot.periodEnd - event->time);
}

void DeliveryFilter::release(Slot& slot, std::chrono::nanoseconds period, std::vector<SharedEvent>& due) {
  slot.last = std::move(slot.waiting);
  slot.waiting.reset();
  --waiting_;
  slot.periodEnd += period;
  due.push_back(slot.last);
}

void DeliveryFilter::releaseUntil(std::chrono::nanoseconds time, std::vector<SharedEvent>& due) {
  if (waiting_ == 0) return;
  std::vector<std::pair<std::chrono::nanoseconds, Slot*>> ended;
  for (auto& [key, slot] : slots_) {
    if (slot.waiting && slot.periodEnd <= time) ended.emplace_back(slot.periodEnd, &slot);
  }
  std::sort(ended.begin(), ended.end());
  for (const auto& [end, slot] : ended) release(*slot, configuration_->ruleFor(slot->waiting->metricID)->period, due);
}

void DeliveryFilter::collect(Clock::time_point now, std::vector<SharedEvent>& due) {
  if (waiting_ == 0) return;
  std::vector<std::pair<Clock::time_point, Slot*>> ended;
  for (auto& [key, slot] : slots_) {
    if (slot.waiting && slot.due <= now) ended.emplace_back(slot.due, &slot);
  }
  std::sort(ended.begin(), ended.end());
  for (const auto& [end, slot] : ended) release(*slot, configuration_->ruleFor(slot->waiting->metricID)->period, due);
}

std::optional<DeliveryFilter::Clock::time_point> DeliveryFilter::nextDue() const {
  std::optional<Clock::time_point> next;
  if (waiting_ == 0) return next;
  for (const auto& [key, slot] : slots_) {
    if (slot.waiting && (!next || slot.due < *next)) next = slot.due;
  }
  return next;
}

}  // namespace vespscope::manager
