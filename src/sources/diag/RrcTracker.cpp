#include "sources/diag/RrcTracker.h"

#include <array>
#include <limits>

#include "messages/lte/LteRrcState.h"
#include "registry/MetricRows.h"

namespace vespscope::sources::diag {
namespace {

using State = LteRrcState;
using Cause = KCellularLteRrcState::Cause;

std::int32_t stateAfter(RrcEvent event) {
  switch (event) {
    case RrcEvent::connectionRequest:
    case RrcEvent::reestablishmentRequest:
      return State::KLTE_RRC_STATE_ATMPT_CONNECTION;
    case RrcEvent::connectionReject:
    case RrcEvent::connectionRelease:
    case RrcEvent::reestablishmentReject:
      return State::KLTE_RRC_STATE_IDLE;
    case RrcEvent::mobilityFromEutra:
      return State::KLTE_RRC_STATE_ATMPT_OUTBND_MOBILITY;
    case RrcEvent::connectionSetupComplete:
    case RrcEvent::reestablishmentComplete:
    case RrcEvent::reconfigurationComplete:
    case RrcEvent::dedicatedMessage:
      break;
  }
  return State::KLTE_RRC_STATE_CONNECTED;
}

// The values of the cause field in the order of 3GPP TS 36.331 6.2.2; the metric has no names for later ones.
template <std::size_t count>
std::optional<std::int32_t> causeNamed(const std::array<std::int32_t, count>& names, std::optional<unsigned> value) {
  if (!value || *value >= count) return std::nullopt;
  return names[*value];
}

std::optional<std::int32_t> causeOf(const RrcMeaning& meaning) {
  constexpr std::array<std::int32_t, 6> establishment = {
      Cause::KLTE_RRC_CAUSE_EST_EMERGENCY, Cause::KLTE_RRC_CAUSE_EST_HIGH_PRIO_ACC,
      Cause::KLTE_RRC_CAUSE_EST_MT_ACC,    Cause::KLTE_RRC_CAUSE_EST_MO_SIGNAL,
      Cause::KLTE_RRC_CAUSE_EST_MO_DATA,   Cause::KLTE_RRC_CAUSE_EST_DELAY_TOL_ACC};
  constexpr std::array<std::int32_t, 3> reestablishment = {Cause::KLTE_RRC_CAUSE_REEST_RECFG_FAIL,
                                                           Cause::KLTE_RRC_CAUSE_REEST_HO_FAIL,
                                                           Cause::KLTE_RRC_CAUSE_REEST_OTHER_FAIL};
  constexpr std::array<std::int32_t, 3> release = {Cause::KLTE_RRC_CAUSE_REL_LOAD_BAL_TAU_REQD,
                                                   Cause::KLTE_RRC_CAUSE_REL_OTHER,
                                                   Cause::KLTE_RRC_CAUSE_REL_CSFB_HIGH_PRIO};
  switch (meaning.event) {
    case RrcEvent::connectionRequest:
      return causeNamed(establishment, meaning.cause);
    case RrcEvent::reestablishmentRequest:
      return causeNamed(reestablishment, meaning.cause);
    case RrcEvent::connectionRelease:
      return causeNamed(release, meaning.cause);
    case RrcEvent::connectionReject:
      return Cause::KLTE_RRC_CAUSE_EST_FAIL_REJ;
    case RrcEvent::reestablishmentReject:
      return Cause::KLTE_RRC_CAUSE_REL_CONN_FAIL_REEST_REJ;
    case RrcEvent::connectionSetupComplete:
    case RrcEvent::reestablishmentComplete:
    case RrcEvent::mobilityFromEutra:
    case RrcEvent::reconfigurationComplete:
    case RrcEvent::dedicatedMessage:
      break;
  }
  return std::nullopt;
}

}  // namespace

bool RrcTracker::isIdle() const { return state_ == State::KLTE_RRC_STATE_IDLE; }

bool RrcTracker::isConnected() const { return state_ == State::KLTE_RRC_STATE_CONNECTED; }

// Whether the message only confirms a connection and opens none. A message of the phone may be logged up to 100 ms
// after the release. In a log that begins within a connection, any message of the connection confirms it.
bool RrcTracker::confirmsOnly(RrcEvent event, std::chrono::nanoseconds time) const {
  constexpr std::chrono::nanoseconds latest = std::chrono::milliseconds(100);
  if (event == RrcEvent::dedicatedMessage) return state_.has_value();
  if (event != RrcEvent::reconfigurationComplete) return false;
  // Without a connection in LTE, the message completes a handover from another technology.
  const bool elsewhere = state_ == State::KLTE_RRC_STATE_IDLE || state_ == State::KLTE_RRC_STATE_ATMPT_OUTBND_MOBILITY;
  return state_ && (!elsewhere || time - since_ <= latest);
}

bool RrcTracker::take(const RrcMeaning& meaning, EventList& out) {
  if (confirmsOnly(meaning.event, out.time())) {
    if (isConnected()) confirm(out);
    return false;
  }
  const std::int32_t state = stateAfter(meaning.event);
  // A second attempt or release is reported again.
  if (state_ == state && state == State::KLTE_RRC_STATE_CONNECTED) {
    confirm(out);
    return false;
  }
  message_ = {};
  message_.setState(state);
  if (state_) {
    message_.setPrevState(*state_);
    const auto duration = std::chrono::duration_cast<std::chrono::milliseconds>(out.time() - since_).count();
    if (duration >= 0 && duration <= std::numeric_limits<std::uint32_t>::max()) {
      message_.setPrevStateDurMs(static_cast<std::uint32_t>(duration));
    }
  }
  if (const auto cause = causeOf(meaning)) message_.setCause(*cause);
  report(out);
  state_ = state;
  since_ = out.time();
  return state == State::KLTE_RRC_STATE_IDLE || meaning.event == RrcEvent::reestablishmentRequest;
}

void RrcTracker::takePaging(EventList& out) {
  if (isIdle()) confirm(out);
}

void RrcTracker::confirm(EventList& out) {
  if (reportedAt_.isOld(out.time())) report(out);
}

void RrcTracker::report(EventList& out) {
  out.add(metricIdentifier("K_LTE_RRC_STATE"), message_);
  reportedAt_.note(out.time());
}

}  // namespace vespscope::sources::diag
