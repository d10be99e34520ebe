#include "sources/scenario/CarrierAggregation.h"

#include <algorithm>

namespace vespscope::sources::scenario {
namespace {

using namespace std::chrono_literals;

constexpr std::size_t most = 2;
constexpr double addAbove = -110;         // dBm, event A4
constexpr double removeBelow = -116;      // dBm, event A2
constexpr Time addAfter = 600ms;          // of data
constexpr Time removeAfter = 4s;          // without data
constexpr Time deactivateAfter = 1280ms;  // sCellDeactivationTimer rf128, TS 36.331 6.3.2
constexpr int reportEvery = 3;            // rounds

LteLevel levelOf(const Cell& cell, Context& context) {
  for (const LteLevel& level : context.propagation.lte(cell.layer, context.now, context.random)) {
    if (level.cell == cell) return level;
  }
  LteLevel unheard;
  unheard.cell = cell;
  return unheard;
}

}  // namespace

std::uint32_t CarrierAggregation::activated() const {
  return static_cast<std::uint32_t>(std::count_if(secondaries_.begin(), secondaries_.end(), [](const Secondary& each) {
    return each.state == SecondaryState::activated;
  }));
}

bool CarrierAggregation::removeUnfit(Time now) {
  const bool noData = now - latestData_ > removeAfter;
  const auto unfit = [noData](const Secondary& each) { return noData || each.serving.level.rsrp < removeBelow; };
  std::copy_if(secondaries_.begin(), secondaries_.end(), std::back_inserter(removed_), unfit);
  return std::erase_if(secondaries_, unfit) > 0;
}

// Secondary cells are on the primary's mast and have the same direction.
bool CarrierAggregation::add(Context& context, const Cell& primary, double imbalance) {
  if (secondaries_.size() == most || (secondaries_.size() == 1 && !context.demand.burst)) return false;
  for (const LayerIndex layer : lteLayers) {
    const bool used = layer == primary.layer ||
                      std::any_of(secondaries_.begin(), secondaries_.end(),
                                  [layer](const Secondary& each) { return each.serving.level.cell.layer == layer; });
    if (used || !context.map.hosts(primary.site, layer)) continue;
    const LteLevel level = levelOf({layer, primary.sector, primary.site}, context);
    if (level.rsrp < addAbove) continue;
    const bool firstIsFree = secondaries_.empty() || secondaries_.front().index != 0;
    const Secondary secondary{firstIsFree ? 0U : 1U, SecondaryState::configured, {level, imbalance}};
    secondaries_.insert(firstIsFree ? secondaries_.begin() : secondaries_.end(), secondary);
    return true;
  }
  return false;
}

bool CarrierAggregation::activate(const Context& context) {
  bool changed = false;
  for (Secondary& each : secondaries_) {
    const SecondaryState before = each.state;
    if (context.demand.burst) each.state = SecondaryState::activated;
    if (context.now - latestBurst_ > deactivateAfter) each.state = SecondaryState::configured;
    changed |= each.state != before;
  }
  return changed;
}

void CarrierAggregation::measure(Context& context, const Cell& primary, double imbalance) {
  if (context.demand.data) latestData_ = context.now;
  if (context.demand.burst) latestBurst_ = context.now;
  for (Secondary& each : secondaries_) each.serving = {levelOf(each.serving.level.cell, context), imbalance};
  bool configured = removeUnfit(context.now);
  // Cells added in the previous round are activated first, by a separate MAC control element.
  const bool switched = activate(context);
  const bool wanted = data_.holds(context.demand.data, context.now, addAfter);
  if (wanted && !configured && !switched) configured = add(context, primary, imbalance);
  ++round_;
  if (configured) reports_.carriers(primary, secondaries_);
  if (configured || switched) {
    std::vector<Secondary> all = secondaries_;
    for (Secondary& each : removed_) each.state = SecondaryState::removed;
    all.insert(all.end(), removed_.begin(), removed_.end());
    std::sort(all.begin(), all.end(), [](const Secondary& a, const Secondary& b) { return a.index < b.index; });
    reports_.aggregation(all);
    removed_.clear();
  } else if (!secondaries_.empty() && round_ % reportEvery == 0) {
    reports_.aggregation(secondaries_);
  }
}

void CarrierAggregation::drop(const Cell& primary) {
  data_.reset();
  if (secondaries_.empty()) return;
  for (Secondary& each : secondaries_) each.state = SecondaryState::removed;
  reports_.aggregation(secondaries_);
  secondaries_.clear();
  reports_.carriers(primary, secondaries_);
}

}  // namespace vespscope::sources::scenario
