#include "shell/SimChoice.h"

#include <algorithm>
#include <utility>

#include "messages/DataBearers.h"

namespace vespscope {
namespace {

constexpr std::int32_t noCard = 0;

// The metric's place in the table of metrics; the table's size when it is not registered.
std::size_t placeOf(std::int64_t metricID) {
  const auto found = std::find_if(metricRows.begin(), metricRows.end(),
                                  [metricID](const MetricRow& row) { return row.identifier() == metricID; });
  return static_cast<std::size_t>(found - metricRows.begin());
}

std::int64_t numberIn(const Record& event, std::string_view key) {
  const Value* value = event.find(key);
  return value == nullptr ? 0 : value->asInteger().value_or(0);
}

bool hasBearers(std::int64_t metricID, const Record& event) {
  const Value* payload = event.find("kKeyPayload");
  const Bytes* bytes = payload == nullptr ? nullptr : payload->asBytes();
  return bytes != nullptr && reportsDataBearers(metricID, *bytes);
}

}  // namespace

SimChoice::SimChoice(Output output, std::optional<std::int32_t> wanted,
                     std::function<std::optional<std::int32_t>()> preferred)
    : output_(std::move(output)), preferred_(std::move(preferred)), shown_(wanted), decided_(wanted.has_value()) {
  latest_[noCard];
}

void SimChoice::take(Event event, Clock::time_point arrival) {
  const std::int64_t metricID = numberIn(*event, "kKeyMetricID");
  const auto card = static_cast<std::int32_t>(numberIn(*event, "kKeyProfileID"));
  const auto known = latest_.find(card);
  if (known == latest_.end() && latest_.size() > mostCards) return;
  Latest& latest = known == latest_.end() ? latest_[card] : known->second;
  if (const std::size_t place = placeOf(metricID); place < latest.size()) latest[place] = {event, ++taken_, arrival};
  if (card != noCard && !shown_) choose(card);
  if (card != noCard && !decided_ && hasBearers(metricID, *event)) {
    decided_ = true;
    if (card != shown_) return show(card);
  }
  if (card == noCard || card == shown_) output_.pass(std::move(event));
}

void SimChoice::choose(std::int32_t card) {
  shown_ = preferred_ ? preferred_() : std::nullopt;
  decided_ = shown_.has_value();
  if (!shown_) shown_ = card;
}

void SimChoice::show(std::int32_t card) {
  decided_ = true;
  if (shown_ == card) return;
  shown_ = card;
  output_.forget();
  std::vector<const Held*> again;
  for (const std::int32_t each : {noCard, card}) {
    const auto found = latest_.find(each);
    if (found == latest_.end()) continue;
    for (const Held& held : found->second) {
      if (held.event) again.push_back(&held);
    }
  }
  std::sort(again.begin(), again.end(), [](const Held* one, const Held* other) { return one->number < other->number; });
  for (const Held* held : again) output_.pass(held->event);
}

void SimChoice::showNext() {
  const std::vector<std::int32_t> cards = seen();
  if (cards.empty()) return;
  const auto next = std::upper_bound(cards.begin(), cards.end(), shown_.value_or(noCard));
  show(next == cards.end() ? cards.front() : *next);
}

std::vector<std::int32_t> SimChoice::seen() const {
  std::vector<std::int32_t> cards;
  for (const auto& [card, latest] : latest_) {
    if (card != noCard) cards.push_back(card);
  }
  return cards;
}

std::optional<SimChoice::Clock::time_point> SimChoice::arrivalOf(std::int64_t metricID) const {
  const std::size_t place = placeOf(metricID);
  if (place == metricRows.size()) return std::nullopt;
  const Held* newest = nullptr;
  for (const std::int32_t card : {noCard, shown_.value_or(noCard)}) {
    const auto found = latest_.find(card);
    if (found == latest_.end() || !found->second[place].event) continue;
    const Held& held = found->second[place];
    if (newest == nullptr || held.number > newest->number) newest = &held;
  }
  return newest == nullptr ? std::nullopt : std::optional(newest->arrival);
}

}  // namespace vespscope
