#include "sources/scenario/UmtsModem.h"

#include <algorithm>

#include "sources/scenario/Decibel.h"

namespace vespscope::sources::scenario {
namespace {

using namespace std::chrono_literals;

constexpr Time dedicatedPeriod = 480ms;
constexpr Time sharedPeriod = 640ms;
constexpr Time pagingPeriod = 1280ms;
constexpr Time pagingCycle = 640ms;  // DRX cycle length coefficient 6, TS 25.331 10.3.3.49
constexpr Time dedicatedFor = 4s;    // without traffic
constexpr Time sharedFor = 5s;
constexpr Time pagingFor = 18s;
constexpr Time signallingFor = 700ms;  // after the end of a registration

constexpr double bestCellOffset = 2;  // dB, event 1D
constexpr double idleHysteresis = 4;  // dB
constexpr double leave2100Below = -102;
constexpr double enter900Above = -104;
constexpr double enter2100Above = -92;
constexpr double lteAbove = -109;       // dBm at which the phone changes to LTE
constexpr double lostBelow = -107;      // dBm at which GSM is preferred
constexpr double gsmAbove = -97;        // dBm
constexpr double gsmSearchBelow = -98;  // dBm RSCP below which GSM is measured

UmtsEstablishment establishmentOf(const Demand& demand) {
  if (demand.voice) {
    return demand.mobileTerminated ? UmtsEstablishment::terminatingConversational
                                   : UmtsEstablishment::originatingConversational;
  }
  if (demand.data) {
    return demand.mobileTerminated ? UmtsEstablishment::terminatingInteractive
                                   : UmtsEstablishment::originatingInteractive;
  }
  return UmtsEstablishment::registration;
}

std::optional<UmtsLevel> strongest(Context& context) {
  context.lookAround();
  std::optional<UmtsLevel> best;
  for (const LayerIndex layer : umtsLayers) {
    const std::vector<UmtsLevel> levels = context.propagation.umts(layer, context.now, context.random);
    if (levels.empty()) continue;
    if (!best || (best->rscp < leave2100Below && levels.front().rscp > best->rscp)) best = levels.front();
  }
  return best;
}

}  // namespace

void UmtsModem::change(Context& context, UmtsRrc state) {
  state_ = state;
  stateSince_ = context.now;
  reports_.rrc(state, establishment_, release_);
  measurement_.start(context.now, 60ms);
}

void UmtsModem::takeCell(Context& context, const Cell& cell) {
  serving_.level.cell = cell;
  candidate_.reset();
  candidateBetter_.reset();
  context.lookAround();
  for (const UmtsLevel& level : context.propagation.umts(cell.layer, context.now, context.random)) {
    if (level.cell == cell) serving_.level = level;
  }
  reports_.servingCell(cell);
  reports_.selection(serving_.level);
  nas_.camped(context, cell);
}

void UmtsModem::enter(Context& context, bool connected) {
  lteBetter_.reset();
  lost_.reset();
  redirected_.reset();
  establishment_.reset();
  release_.reset();
  latestActivity_ = context.now;
  const std::optional<UmtsLevel> best = strongest(context);
  if (best) serving_.level = *best;
  dualCarrier_ = false;
  if (connected && context.demand.voice) establishment_ = establishmentOf(context.demand);
  change(context, connected ? UmtsRrc::cellDch : UmtsRrc::idle);
  takeCell(context, serving_.level.cell);
  reports_.configuration(pagingCycle, dualCarrier_);
}

std::optional<Departure> UmtsModem::leave(Context& context, Technology to, bool connected) {
  if (state_ != UmtsRrc::idle) release_ = UmtsRelease::cellChanged;
  change(context, UmtsRrc::inactive);
  stateEnds_.stop();
  measurement_.stop();
  return Departure{to, connected};
}

void UmtsModem::release(Context& context, UmtsRelease cause) {
  release_ = cause;
  change(context, UmtsRrc::releasing);
  stateEnds_.start(context.now, Time(context.random.between(80, 200)));
}

std::optional<Departure> UmtsModem::tick(Context& context) {
  switch (state_) {
    case UmtsRrc::inactive:
      return std::nullopt;
    case UmtsRrc::establishing:
      if (!stateEnds_.expired(context.now)) return std::nullopt;
      if (serving_.level.rscp < -112 && context.random.chance(0.5)) {
        release_ = UmtsRelease::establishmentFailed;
        change(context, UmtsRrc::idle);
        return std::nullopt;
      }
      change(context, UmtsRrc::cellDch);
      latestActivity_ = context.now;
      return std::nullopt;
    case UmtsRrc::releasing:
      if (!stateEnds_.expired(context.now)) return std::nullopt;
      if (redirected_) {
        change(context, UmtsRrc::inactive);
        measurement_.stop();
        return Departure{*redirected_, false};
      }
      change(context, UmtsRrc::idle);
      return std::nullopt;
    case UmtsRrc::idle:
    case UmtsRrc::uraPch:
    case UmtsRrc::cellPch:
      tickIdle(context);
      break;
    case UmtsRrc::cellFach:
    case UmtsRrc::cellDch:
      tickConnected(context);
      break;
  }
  if (!measurement_.expired(context.now)) return std::nullopt;
  const Findings findings = measure(context);
  report(context, findings);
  considerCell(context, findings);
  measurement_.start(context.now, dedicated() ? dedicatedPeriod : paging() ? pagingPeriod : sharedPeriod);
  return considerDeparture(context, findings);
}

void UmtsModem::tickIdle(Context& context) {
  if (context.demand.any() && context.now - stateSince_ > 300ms) {
    if (state_ == UmtsRrc::idle) {
      release_.reset();
      establishment_ = establishmentOf(context.demand);
      change(context, UmtsRrc::establishing);
      stateEnds_.start(context.now, Time(context.random.between(280, 650)));
    } else {
      change(context, UmtsRrc::cellFach);  // by a cell update
      latestActivity_ = context.now;
    }
    return;
  }
  if (state_ != UmtsRrc::idle && context.now - stateSince_ > pagingFor) release(context, UmtsRelease::inactive);
}

void UmtsModem::tickConnected(Context& context) {
  const Demand& demand = context.demand;
  if (demand.any()) latestActivity_ = context.now;
  nas_.connectionReady(context);
  const Time quiet = context.now - latestActivity_;
  if (!dedicated()) {
    if ((demand.data || demand.voice) && context.now - stateSince_ > 250ms) {
      change(context, UmtsRrc::cellDch);
    } else if (std::min(quiet, context.now - stateSince_) > sharedFor) {
      change(context, context.random.chance(0.7) ? UmtsRrc::uraPch : UmtsRrc::cellPch);
    }
    return;
  }
  const bool forData = establishment_ == UmtsEstablishment::originatingInteractive ||
                       establishment_ == UmtsEstablishment::terminatingInteractive;
  if (!forData && quiet > signallingFor) {
    release(context, UmtsRelease::normal);
  } else if (quiet > dedicatedFor) {
    change(context, UmtsRrc::cellFach);
  }
  // Two carriers at once while there is much to receive and the band has them.
  const bool dual = dedicated() && demand.burst && serving_.level.cell.layer == umts2100;
  if (dual != dualCarrier_ && (dual || !dedicated() || !demand.data)) {
    dualCarrier_ = dual;
    reports_.configuration(pagingCycle, dual);
  }
}

UmtsModem::Findings UmtsModem::measure(Context& context) {
  context.lookAround();
  ++round_;
  const Cell cell = serving_.level.cell;
  Findings findings;
  findings.own = context.propagation.umts(cell.layer, context.now, context.random);
  serving_.level = UmtsLevel{};
  serving_.level.cell = cell;
  const auto self = std::find_if(findings.own.begin(), findings.own.end(),
                                 [&](const UmtsLevel& level) { return level.cell == cell; });
  if (self != findings.own.end()) {
    serving_.level = *self;
    findings.own.erase(self);
  }
  serving_.imbalance = 0.97 * serving_.imbalance + 0.5 * context.random.normal();
  const auto keepHeard = [](std::vector<UmtsLevel>& levels, std::size_t most) {
    // TS 25.133 8.1.2.2: a cell is detected with CPICH Ec/Io above -20 dB.
    std::erase_if(levels, [](const UmtsLevel& level) { return level.rscp < -115 || level.ecno < -20; });
    if (levels.size() > most) levels.resize(most);
  };
  keepHeard(findings.own, 6);
  findings.other = context.propagation.umts(cell.layer == umts2100 ? umts900 : umts2100, context.now, context.random);
  keepHeard(findings.other, 2);
  if (serving_.level.rscp < gsmSearchBelow) {
    findings.gsm = context.propagation.gsm(context.random);
    std::erase_if(findings.gsm, [](const GsmLevel& level) { return level.rxlev < -104; });
    if (findings.gsm.size() > 6) findings.gsm.resize(6);
  }
  for (const LayerIndex layer : {lte1800, lte800}) {
    std::vector<LteLevel> levels = context.propagation.lte(layer, context.now, context.random);
    std::erase_if(levels, [](const LteLevel& level) { return level.rsrp < -124 || level.rsrq < -19; });
    if (levels.size() > 2) levels.resize(2);
    findings.lte.insert(findings.lte.end(), levels.begin(), levels.end());
  }
  return findings;
}

void UmtsModem::report(Context& context, const Findings& findings) {
  reports_.servingLevel(serving_, state_ != UmtsRrc::idle);
  if (dedicated() && round_ % 2 == 0) reportTransmitPower(context);
  if (!dedicated() || round_ % 2 == 1) {
    std::vector<UmtsLevel> umts = findings.own;
    umts.insert(umts.end(), findings.other.begin(), findings.other.end());
    reports_.neighbours(umts, findings.gsm, findings.lte);
  }
}

// The initial DPCCH power of TS 25.331 8.5.3, from which the inner loop deviates by a few dB only.
void UmtsModem::reportTransmitPower(Context& context) {
  const auto limited = [](double power) { return std::clamp(rounded(power), -50, 24); };
  const bool busy = context.demand.data || context.demand.voice;
  const double dataOffset = context.demand.burst ? 11 : busy ? 7 : 3;
  std::vector<UmtsTransmit> powers;
  for (int subframe = 0; subframe < 3; ++subframe) {
    const double control = -96 - serving_.level.rscp + context.random.normal();
    powers.push_back({limited(control), limited(control + dataOffset), subframe});
  }
  reports_.transmitPower(powers);
}

void UmtsModem::considerCell(Context& context, const Findings& findings) {
  const UmtsLevel& own = serving_.level;
  std::optional<Cell> better;
  const double margin = dedicated() ? bestCellOffset : idleHysteresis;
  if (!findings.own.empty() && findings.own.front().rscp > own.rscp + margin) better = findings.own.front().cell;
  if (!better && !findings.other.empty()) {
    const UmtsLevel& other = findings.other.front();
    const bool fits = own.cell.layer == umts2100 ? own.rscp < leave2100Below && other.rscp > enter900Above
                                                 : other.rscp > enter2100Above;
    if (fits) better = other.cell;
  }
  if (better != candidate_) candidateBetter_.reset();
  candidate_ = better;
  if (candidateBetter_.holds(better.has_value(), context.now, dedicated() ? 400ms : 1000ms)) {
    takeCell(context, *better);
  }
}

std::optional<Departure> UmtsModem::considerDeparture(Context& context, const Findings& findings) {
  const Demand& demand = context.demand;
  const bool lte = std::any_of(findings.lte.begin(), findings.lte.end(),
                               [](const LteLevel& level) { return level.rsrp > lteAbove; });
  const bool mayLeave = !demand.voice && !nas_.wantsSignalling();
  if (lteBetter_.holds(lte && mayLeave, context.now, 1500ms)) {
    lteBetter_.reset();
    if (paging()) return leave(context, Technology::lte, false);
    if (dedicated() && demand.data && context.random.chance(0.4)) return leave(context, Technology::lte, true);
    redirected_ = Technology::lte;
    release(context, UmtsRelease::normal);
    return std::nullopt;
  }
  const auto usable = [](const UmtsLevel& level) { return level.rscp > lostBelow; };
  const bool umts = usable(serving_.level) || std::any_of(findings.other.begin(), findings.other.end(), usable);
  const bool gsm = !findings.gsm.empty() && findings.gsm.front().rxlev > gsmAbove;
  if (lost_.holds(!umts && gsm, context.now, 1s)) return leave(context, Technology::gsm, dedicated() && demand.voice);
  return std::nullopt;
}

}  // namespace vespscope::sources::scenario
