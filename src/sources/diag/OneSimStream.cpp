#include "sources/diag/OneSimStream.h"

#include <utility>

#include "messages/WireReader.h"
#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "registry/MetricRows.h"

namespace vespscope::sources {
namespace {

bool hasBearers(const MetricEvent& event) {
  if (event.metricID != metricIdentifier("K_CELLULAR_ACTIVE_BEARER")) return false;
  KCellularActivatedBearerContexts message;
  WireReader reader(event.payload);
  return message.readFrom(reader) && message.bearerContextsCount() > 0;
}

}  // namespace

OneSimStream::OneSimStream(std::unique_ptr<EventStream> all, std::optional<std::int32_t> sim)
    : all_(std::move(all)), sim_(sim) {
  if (all_->canRewind()) lookAhead();
}

// Examines only the beginning of the log, so that a long one starts at once.
void OneSimStream::lookAhead() {
  constexpr int mostEvents = 50'000;
  std::optional<std::int32_t> first;
  std::optional<std::int32_t> withBearers;
  for (int count = 0; count < mostEvents; ++count) {
    const auto event = all_->next();
    if (!event) break;
    if (event->profileID == 0) continue;
    if (!first) first = event->profileID;
    several_ = several_ || event->profileID != *first;
    if (!withBearers && hasBearers(*event)) withBearers = event->profileID;
    if (several_ && withBearers) break;
  }
  all_->rewind();
  if (!sim_) sim_ = withBearers ? withBearers : first;
}

std::string OneSimStream::label() const {
  if (!several_ || !sim_) return all_->label();
  return all_->label() + " (SIM " + std::to_string(*sim_) + ", another is in the log)";
}

std::optional<MetricEvent> OneSimStream::next() {
  while (auto event = all_->next()) {
    if (event->profileID == 0) return event;
    if (!sim_) sim_ = event->profileID;
    if (event->profileID == sim_) return event;
  }
  return std::nullopt;
}

}  // namespace vespscope::sources
