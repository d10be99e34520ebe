#include "sources/scenario/LteModem.h"

#include <algorithm>

#include "sources/scenario/Decibel.h"

namespace vespscope::sources::scenario {
namespace {

using namespace std::chrono_literals;

constexpr Time connectedPeriod = 320ms;
constexpr Time idlePeriod = 1280ms;  // paging cycle rf128, TS 36.331 6.3.2
constexpr Time inactivity = 10s;     // after which the network releases a connection

constexpr int neighboursEvery = 3;         // rounds of measurements of a connection
constexpr double handoverOffset = 3;       // dB, event A3
constexpr double weakBelow = -106;         // dBm, event A2: other frequencies are measured in gaps
constexpr double betterLayer = -101;       // dBm at which the phone changes to a layer of higher priority
constexpr double lostBelow = -117;         // dBm at which UMTS is preferred
constexpr double umtsUsable = -106;        // dBm RSCP
constexpr double reestablishAbove = -119;  // dBm

// A neighbour is detected above this level and this ratio to all others (dBm, dB); TS 36.133 8.1.2.2.1 requires -6 dB,
// a receiver that cancels the stronger cells does better.
constexpr double heardAbove = -125;
constexpr double heardRatio = -12;

void keepHeard(std::vector<LteLevel>& levels, std::size_t most) {
  std::erase_if(levels, [](const LteLevel& level) { return level.rsrp < heardAbove || level.sinr < heardRatio; });
  if (levels.size() > most) levels.resize(most);
}

// Srxlev of TS 36.304 5.2.3.2 (dB).
double excess(const LteLevel& level) { return level.rsrp - 2 * selectionOf(level.cell.layer).rxLevelMinimum; }

LteCause establishmentCause(const Demand& demand) {
  if (!demand.voice && !demand.data) return LteCause::mobileOriginatedSignalling;
  return demand.mobileTerminated ? LteCause::mobileTerminatedAccess : LteCause::mobileOriginatedData;
}

std::optional<Cell> strongest(Context& context) {
  context.lookAround();
  std::optional<LteLevel> best;
  for (const LayerIndex layer : lteLayers) {
    const std::vector<LteLevel> levels = context.propagation.lte(layer, context.now, context.random);
    if (levels.empty()) continue;
    // The layer of higher priority is chosen while it is good enough.
    const LteLevel& first = levels.front();
    if (!best || (best->rsrp < betterLayer - 4 && first.rsrp > best->rsrp)) best = first;
  }
  if (!best) return std::nullopt;
  return best->cell;
}

}  // namespace

void LteModem::change(Context& context, LteRrc state, LteCause cause) {
  reports_.rrc({state, state_, context.now - stateSince_, cause});
  const bool wasConnected = connected();
  state_ = state;
  stateSince_ = context.now;
  if (connected() != wasConnected) window_.clear();  // the measurement period changes
}

void LteModem::takeCell(Context& context, const Cell& cell) {
  cell_ = cell;
  candidate_.reset();
  candidateBetter_.reset();
  outOfSync_.reset();
  window_.clear();
  reports_.servingCell(cell_);
  reports_.selection(cell_);
  reports_.carriers(cell_, {});
  nas_.camped(context, cell_);
}

void LteModem::enter(Context& context, bool connected) {
  lost_.reset();
  leaving_ = false;
  const std::optional<Cell> best = strongest(context);
  cell_ = best.value_or(cell_);
  if (connected) {
    change(context, LteRrc::inbound, LteCause::notApplicable);
    stateEnds_.start(context.now, Time(context.random.between(60, 180)));
  } else {
    change(context, LteRrc::idle, LteCause::notApplicable);
    takeCell(context, cell_);
    measurement_.start(context.now, 120ms);
  }
}

std::optional<Departure> LteModem::leave(Context& context, LteCause cause, bool connected) {
  change(context, LteRrc::none, cause);
  measurement_.stop();
  stateEnds_.stop();
  handover_.stop();
  return Departure{Technology::umts, connected};
}

std::optional<Departure> LteModem::tick(Context& context) {
  switch (state_) {
    case LteRrc::none:
      break;
    case LteRrc::idle:
      if (leaving_) return leave(context, LteCause::notApplicable, false);
      tickIdle(context);
      break;
    case LteRrc::attempting:
      tickAttempt(context);
      break;
    case LteRrc::connected:
      return tickConnected(context);
    case LteRrc::ending:
      if (stateEnds_.expired(context.now)) {
        change(context, LteRrc::idle, LteCause::releaseOther);
        measurement_.start(context.now, 400ms);
      }
      break;
    case LteRrc::outbound:
      if (stateEnds_.expired(context.now)) return leave(context, LteCause::releaseMobilityFromLte, true);
      break;
    case LteRrc::inbound:
      if (stateEnds_.expired(context.now)) {
        becomeConnected(context, LteCause::mobilityToLte);
        takeCell(context, cell_);
      }
      break;
  }
  return std::nullopt;
}

void LteModem::tickIdle(Context& context) {
  if (measurement_.expired(context.now)) {
    const Findings findings = measure(context);
    report(context, findings);
    considerReselection(context, findings);
    leaving_ = lost_.holds(lostTo(findings), context.now, 1s);
    measurement_.start(context.now, idlePeriod);
    return;
  }
  const bool settled = context.now - stateSince_ > 300ms;
  if (settled && context.demand.any()) {
    attemptCause_ = establishmentCause(context.demand);
    change(context, LteRrc::attempting, attemptCause_);
    stateEnds_.start(context.now, Time(context.random.between(45, 110)));
  }
}

void LteModem::tickAttempt(Context& context) {
  if (!stateEnds_.expired(context.now)) return;
  const bool again = attemptCause_ == LteCause::reestablishmentHandoverFailure ||
                     attemptCause_ == LteCause::reestablishmentRadioLinkFailure;
  if (again) {
    const std::optional<Cell> best = strongest(context);
    for (const LteLevel& level : context.propagation.lte(best.value_or(cell_).layer, context.now, context.random)) {
      if (level.cell != best || level.rsrp < reestablishAbove) continue;
      becomeConnected(context, attemptCause_);
      if (*best != cell_) takeCell(context, *best);
      return;
    }
    // T311 is 3 s in this network.
    if (context.now - stateSince_ < 3s) {
      stateEnds_.start(context.now, 200ms);
      return;
    }
    change(context, LteRrc::idle, LteCause::releaseNoReestablishment);
    measurement_.start(context.now, 200ms);
    return;
  }
  const double answered = std::clamp((serving_.level.rsrp + 130) / 12, 0.1, 0.995);
  if (context.random.chance(answered)) {
    becomeConnected(context, attemptCause_);
    return;
  }
  change(context, LteRrc::idle, LteCause::noResponse);
  measurement_.start(context.now, 200ms);
}

void LteModem::becomeConnected(Context& context, LteCause cause) {
  change(context, LteRrc::connected, cause);
  latestActivity_ = context.now;
  outOfSync_.reset();
  handoverTarget_.reset();
  handoverToUmts_ = context.random.chance(0.6);
  measurement_.start(context.now, 60ms);
  drxUpdate_.start(context.now, Time(context.random.between(30, 90)));
}

void LteModem::release(Context& context, LteCause cause) {
  aggregation_.drop(cell_);
  handover_.stop();
  handoverTarget_.reset();
  drxUpdate_.stop();
  change(context, LteRrc::ending, cause);
  reports_.drx({}, false, state_, 1);
  stateEnds_.start(context.now, 60ms);  // TS 36.331 5.3.8.3
}

// Voice gets a short cycle for its packets every 20 ms, data the network's default.
void LteModem::updateDrx(Context& context) {
  voice_ = context.demand.voice;
  callId_ = voice_ ? std::to_string(context.random.between(100000, 999999)) : std::string();
  const LteDrx data{10, 200, 8, 320, 40, 2, layers[cell_.layer].resourceBlocks == 100 ? 4U : 3U};
  const LteDrx voice{4, 6, 4, 40, 20, 1, data.transmissionMode};
  reports_.drx(voice_ ? voice : data, true, state_, 1 + aggregation_.activated());
}

std::optional<Departure> LteModem::tickConnected(Context& context) {
  if (context.demand.any()) latestActivity_ = context.now;
  if (drxUpdate_.expired(context.now)) updateDrx(context);
  if (voice_ != context.demand.voice && !drxUpdate_.running()) drxUpdate_.start(context.now, 40ms);
  nas_.connectionReady(context);
  if (handover_.expired(context.now)) {
    executeHandover(context);
    return std::nullopt;
  }
  if (measurement_.expired(context.now)) {
    const Findings findings = measure(context);
    aggregation_.measure(context, cell_, serving_.imbalance);
    report(context, findings);
    considerHandover(context, findings);
    measurement_.start(context.now, connectedPeriod);
    if (lost_.holds(lostTo(findings), context.now, 640ms)) {
      if (handoverToUmts_ || context.demand.voice) {
        aggregation_.drop(cell_);
        change(context, LteRrc::outbound, LteCause::notApplicable);
        stateEnds_.start(context.now, Time(context.random.between(250, 700)));
        return std::nullopt;
      }
      if (context.random.chance(0.3)) {  // released with redirection
        leaving_ = true;
        release(context, LteCause::releaseOther);
        return std::nullopt;
      }
    }
    considerLinkFailure(context);
    if (!connected()) return std::nullopt;
  }
  if (context.now - latestActivity_ > inactivity) release(context, LteCause::releaseOther);
  return std::nullopt;
}

LteModem::Findings LteModem::measure(Context& context) {
  context.lookAround();
  ++round_;
  Findings findings;
  findings.own = context.propagation.lte(cell_.layer, context.now, context.random);
  serving_.level = LteLevel{};
  serving_.level.cell = cell_;
  const auto self = std::find_if(findings.own.begin(), findings.own.end(),
                                 [this](const LteLevel& level) { return level.cell == cell_; });
  if (self != findings.own.end()) {
    serving_.level = *self;
    findings.own.erase(self);
  }
  serving_.imbalance = 0.97 * serving_.imbalance + 0.5 * context.random.normal();
  window_.push_back(serving_);
  if (window_.size() > levelWindow) window_.pop_front();

  const bool idle = !connected();
  const LteSelection& selection = selectionOf(cell_.layer);
  if (idle && excess(serving_.level) > 2.0 * selection.intraSearch) findings.own.clear();
  keepHeard(findings.own, 6);
  const bool weak = idle ? excess(serving_.level) <= 2.0 * selection.nonIntraSearch : serving_.level.rsrp < weakBelow;
  const bool lookHigher = round_ % 5 == 0;
  for (const LayerIndex layer : lteLayers) {
    const bool wanted = weak || (lookHigher && layers[layer].priority > layers[cell_.layer].priority);
    if (layer == cell_.layer || !wanted) continue;
    std::vector<LteLevel> levels = context.propagation.lte(layer, context.now, context.random);
    keepHeard(levels, 3);
    findings.other.insert(findings.other.end(), levels.begin(), levels.end());
  }
  if (weak) {
    for (const LayerIndex layer : umtsLayers) {
      std::vector<UmtsLevel> levels = context.propagation.umts(layer, context.now, context.random);
      std::erase_if(levels, [](const UmtsLevel& level) { return level.rscp < -115 || level.ecno < -18; });
      if (levels.size() > 2) levels.resize(2);
      findings.umts.insert(findings.umts.end(), levels.begin(), levels.end());
    }
    findings.gsm = context.propagation.gsm(context.random);
    std::erase_if(findings.gsm, [](const GsmLevel& level) { return level.rxlev < -104; });
    if (findings.gsm.size() > 4) findings.gsm.resize(4);
  }
  return findings;
}

void LteModem::report(Context& context, const Findings& findings) {
  std::vector<LteServing> serving{serving_};
  for (const Secondary& each : aggregation_.secondaries()) {
    if (each.state == SecondaryState::activated) serving.push_back(each.serving);
  }
  reports_.servingLevel(serving_, connected());
  reports_.levels(serving, {window_.begin(), window_.end()}, connected() ? connectedPeriod : idlePeriod,
                  connected() ? callId_ : std::string());
  if (connected() && round_ % neighboursEvery == 0) reportTransmitPower(context);
  if (!connected() || round_ % neighboursEvery == 1) reportNeighbours(findings);
  if ((!findings.umts.empty() || !findings.gsm.empty()) && (!connected() || round_ % neighboursEvery == 2)) {
    reports_.otherNeighbours(findings.umts, findings.gsm);
  }
}

void LteModem::reportNeighbours(const Findings& findings) {
  std::vector<LteLevel> neighbours = findings.own;
  neighbours.insert(neighbours.end(), findings.other.begin(), findings.other.end());
  reports_.lteNeighbours(neighbours);
}

// Uplink power control of TS 36.213 5.1.1.1 and 5.1.2.1.
void LteModem::reportTransmitPower(Context& context) {
  const double pathLoss = layers[cell_.layer].pilotPower - serving_.level.rsrp;
  const auto limited = [](double power) { return std::clamp(rounded(power), -40, 23); };
  std::vector<LteTransmit> powers;
  const bool busy = context.demand.data || context.demand.voice;
  const int grants = busy ? static_cast<int>(context.random.between(2, 4)) : 1;
  int subframe = static_cast<int>(context.random.between(0, 2));
  for (int i = 0; i < grants; ++i) {
    const double blocks = context.demand.burst ? 24 : context.demand.voice ? 2 : 6;
    const double pusch = decibels(blocks) - 85 + 0.8 * pathLoss + context.random.normal();
    const double pucch = -114 + pathLoss + context.random.normal();
    powers.push_back({limited(pucch), limited(pusch), subframe});
    subframe = std::min(9, subframe + static_cast<int>(context.random.between(1, 2)));
  }
  reports_.transmitPower(powers);
}

bool LteModem::lostTo(const Findings& findings) const {
  const auto strong = [](const LteLevel& level) { return level.rsrp > lostBelow; };
  if (strong(serving_.level) || std::any_of(findings.other.begin(), findings.other.end(), strong)) return false;
  return std::any_of(findings.umts.begin(), findings.umts.end(),
                     [](const UmtsLevel& level) { return level.rscp > umtsUsable; });
}

// Cell reselection of TS 36.304 5.2.4.5 and 5.2.4.6.
void LteModem::considerReselection(Context& context, const Findings& findings) {
  const LteSelection& own = selectionOf(cell_.layer);
  std::optional<Cell> better;
  if (!findings.own.empty() && findings.own.front().rsrp > serving_.level.rsrp + own.hysteresis) {
    better = findings.own.front().cell;
  }
  for (const LteLevel& level : findings.other) {
    const LteSelection& other = selectionOf(level.cell.layer);
    const bool higher = layers[level.cell.layer].priority > layers[cell_.layer].priority;
    const bool fits = higher ? excess(level) > 2.0 * other.high
                             : excess(serving_.level) < 2.0 * own.servingLow && excess(level) > 2.0 * other.low;
    if (fits && !better) better = level.cell;
  }
  if (better != candidate_) candidateBetter_.reset();
  candidate_ = better;
  if (candidateBetter_.holds(better.has_value(), context.now, 1s)) takeCell(context, *better);
}

// Events A3 within the layer, A5 to another one, TS 36.331 5.5.4.
void LteModem::considerHandover(Context& context, const Findings& findings) {
  if (handover_.running()) return;
  std::optional<Cell> better;
  if (!findings.own.empty() && findings.own.front().rsrp > serving_.level.rsrp + handoverOffset) {
    better = findings.own.front().cell;
  }
  for (const LteLevel& level : findings.other) {
    const bool higher = layers[level.cell.layer].priority > layers[cell_.layer].priority;
    const bool fits =
        higher ? level.rsrp > betterLayer : serving_.level.rsrp < weakBelow - 4 && level.rsrp > serving_.level.rsrp + 5;
    if (fits && !better) better = level.cell;
  }
  if (better != candidate_) candidateBetter_.reset();
  candidate_ = better;
  if (!candidateBetter_.holds(better.has_value(), context.now, connectedPeriod)) return;
  if (round_ % neighboursEvery != 1) reportNeighbours(findings);
  handoverTarget_ = better;
  handover_.start(context.now, Time(context.random.between(70, 190)));
}

void LteModem::executeHandover(Context& context) {
  aggregation_.drop(cell_);
  const Cell target = *handoverTarget_;
  handoverTarget_.reset();
  if (context.random.chance(0.03)) {
    attemptCause_ = LteCause::reestablishmentHandoverFailure;
    change(context, LteRrc::attempting, attemptCause_);
    stateEnds_.start(context.now, Time(context.random.between(90, 200)));
    return;
  }
  takeCell(context, target);
  measurement_.start(context.now, 100ms);
  drxUpdate_.start(context.now, 30ms);
}

// Out of sync for T310, 1 s here, TS 36.331 5.3.11.
void LteModem::considerLinkFailure(Context& context) {
  const bool bad = serving_.level.sinr < -7 || serving_.level.rsrp < -126;
  if (!outOfSync_.holds(bad, context.now, 1s)) return;
  aggregation_.drop(cell_);
  handover_.stop();
  attemptCause_ = LteCause::reestablishmentRadioLinkFailure;
  change(context, LteRrc::attempting, attemptCause_);
  stateEnds_.start(context.now, 150ms);
}

}  // namespace vespscope::sources::scenario
