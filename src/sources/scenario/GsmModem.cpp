#include "sources/scenario/GsmModem.h"

#include <algorithm>

#include "sources/scenario/Decibel.h"

namespace vespscope::sources::scenario {
namespace {

using namespace std::chrono_literals;

constexpr Time callPeriod = 480ms;  // one SACCH multiframe, TS 45.008 8.4
constexpr Time idlePeriod = 942ms;  // paging blocks every four multiframes of 51, TS 45.002 6.5
constexpr Time callNeighbours = 960ms;
constexpr Time idleNeighbours = 2826ms;
constexpr Time signallingFor = 500ms;  // after the end of a registration or call

constexpr double reselectHysteresis = 6;  // dB, CELL_RESELECT_HYSTERESIS 3, TS 45.008 6.6.2
constexpr double handoverMargin = 5;      // dB
constexpr double umtsAbove = -99;         // dBm RSCP and dB Ec/No at which the phone changes to UMTS
constexpr double umtsQuality = -13;

// Traffic channels are reused more densely than the measured BCCH, which costs them about 9 dB.
std::uint32_t qualityFor(double carrierToInterference, Random& random) {
  const double steps = (28 - carrierToInterference) / 2.6 + 0.9 * random.normal();
  return static_cast<std::uint32_t>(std::clamp(rounded(steps), 0, 7));
}

}  // namespace

void GsmModem::takeCell(Context& context, const Cell& cell) {
  serving_.cell = cell;
  candidate_.reset();
  candidateBetter_.reset();
  reports_.servingCell(cell, dedicated_);
  if (!dedicated_) {
    reports_.idleConfiguration(cell);
    reports_.gprsConfiguration(cell);
  }
  nas_.camped(context, cell);
}

void GsmModem::setDedicated(Context& context, bool dedicated) {
  dedicated_ = dedicated;
  stateSince_ = context.now;
  latestActivity_ = context.now;
  transmit_ = 33;
  reports_.servingCell(serving_.cell, dedicated);
  measurement_.start(context.now, dedicated ? callPeriod : idlePeriod);
  if (!dedicated) {
    reports_.idleConfiguration(serving_.cell);
    reports_.gprsConfiguration(serving_.cell);
  }
}

void GsmModem::enter(Context& context, bool connected) {
  context.lookAround();
  const std::vector<GsmLevel> levels = context.propagation.gsm(context.random);
  if (!levels.empty()) serving_ = levels.front();
  dedicated_ = connected;
  stateSince_ = context.now;
  latestActivity_ = context.now;
  transmit_ = 33;
  umtsBetter_.reset();
  takeCell(context, serving_.cell);
  measurement_.start(context.now, 300ms);
  neighbours_.start(context.now, 700ms);
}

std::optional<Departure> GsmModem::tick(Context& context) {
  const bool wanted = context.demand.voice || context.demand.signalling;
  if (wanted) latestActivity_ = context.now;
  if (!dedicated_ && wanted && context.now - stateSince_ > 400ms) setDedicated(context, true);
  if (dedicated_) {
    if (context.now - stateSince_ > 600ms) nas_.connectionReady(context);
    if (context.now - latestActivity_ > signallingFor) setDedicated(context, false);
  }
  const bool due = measurement_.expired(context.now);
  const bool neighboursDue = neighbours_.expired(context.now);
  if (!due && !neighboursDue) return std::nullopt;
  const Findings findings = measure(context);
  if (due) {
    if (dedicated_) {
      reportCall(context);
    } else {
      reports_.idleLevel(serving_, antenna_);
    }
    measurement_.start(context.now, dedicated_ ? callPeriod : idlePeriod);
  }
  if (neighboursDue) {
    reports_.neighbours(findings.own, findings.umts, findings.lte);
    neighbours_.start(context.now, dedicated_ ? callNeighbours : idleNeighbours);
  }
  considerCell(context, findings);
  const bool umts =
      !findings.umts.empty() && findings.umts.front().rscp > umtsAbove && findings.umts.front().ecno > umtsQuality;
  if (umtsBetter_.holds(umts && !dedicated_, context.now, 4s)) {
    measurement_.stop();
    neighbours_.stop();
    return Departure{Technology::umts, false};
  }
  return std::nullopt;
}

GsmModem::Findings GsmModem::measure(Context& context) {
  context.lookAround();
  ++round_;
  const Cell cell = serving_.cell;
  Findings findings;
  findings.own = context.propagation.gsm(context.random);
  serving_ = GsmLevel{};
  serving_.cell = cell;
  const auto self =
      std::find_if(findings.own.begin(), findings.own.end(), [&](const GsmLevel& level) { return level.cell == cell; });
  if (self != findings.own.end()) {
    serving_ = *self;
    findings.own.erase(self);
  }
  if (context.random.chance(0.1)) antenna_ = 1 - antenna_;
  // The six strongest carriers whose BSIC is read, TS 45.008 6.6.1 and 8.4.1.
  const auto unread = [&](const GsmLevel& level) { return level.rxlev < -108 || level.carrierToInterference < 3; };
  std::erase_if(findings.own, unread);
  if (findings.own.size() > 6) findings.own.resize(6);
  for (const LayerIndex layer : umtsLayers) {
    std::vector<UmtsLevel> levels = context.propagation.umts(layer, context.now, context.random);
    std::erase_if(levels, [](const UmtsLevel& level) { return level.rscp < -113 || level.ecno < -18; });
    if (levels.size() > 2) levels.resize(2);
    findings.umts.insert(findings.umts.end(), levels.begin(), levels.end());
  }
  std::sort(findings.umts.begin(), findings.umts.end(),
            [](const UmtsLevel& a, const UmtsLevel& b) { return a.rscp > b.rscp; });
  for (const LayerIndex layer : {lte1800, lte800}) {
    std::vector<LteLevel> levels = context.propagation.lte(layer, context.now, context.random);
    std::erase_if(levels, [](const LteLevel& level) { return level.rsrp < -122 || level.rsrq < -18; });
    if (levels.size() > 2) levels.resize(2);
    findings.lte.insert(findings.lte.end(), levels.begin(), levels.end());
  }
  return findings;
}

// The network controls the phone's power so that the mast receives about -80 dBm, in steps of 2 dB.
void GsmModem::reportCall(Context& context) {
  GsmCallLevel call;
  call.cell = serving_.cell;
  call.rxlev = serving_.rxlev;
  call.rxqual = qualityFor(serving_.carrierToInterference, context.random);
  call.antenna = antenna_;
  const double pathLoss = layers[gsm900].pilotPower - serving_.rxlev;
  const int wanted = std::clamp(rounded((pathLoss - 80) / 2) * 2 + 1, 5, 33);
  for (int block = 0; block < 4; ++block) {
    transmit_ += std::clamp(wanted - transmit_, -2, 2);
    call.transmit.push_back(transmit_);
  }
  reports_.callLevel(call);
}

void GsmModem::considerCell(Context& context, const Findings& findings) {
  std::optional<Cell> better;
  const double margin = dedicated_ ? handoverMargin : reselectHysteresis;
  if (!findings.own.empty() && findings.own.front().rxlev > serving_.rxlev + margin) better = findings.own.front().cell;
  if (better != candidate_) candidateBetter_.reset();
  candidate_ = better;
  if (!candidateBetter_.holds(better.has_value(), context.now, dedicated_ ? 900ms : 3000ms)) return;
  takeCell(context, *better);
}

}  // namespace vespscope::sources::scenario
