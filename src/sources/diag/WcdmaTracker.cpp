#include "sources/diag/WcdmaTracker.h"

#include <array>

#include "messages/common/SystemBand.h"
#include "messages/umts/KCellularWcdmaCellInfo.h"
#include "messages/umts/KCellularWcdmaRrcConnectionState.h"
#include "radio/CellIdentity.h"
#include "radio/Channel.h"
#include "registry/MetricRows.h"

namespace vespscope::sources::diag {
namespace {

using State = KCellularWcdmaRrcConnectionState::State;
using Release = KCellularWcdmaRrcConnectionState::ReleaseCause;

// Empty for a band that the metric has no name for.
std::optional<std::int32_t> bandNamed(std::uint32_t number) {
  constexpr std::array<std::int32_t, 9> first = {
      SystemBand::SYS_BAND_WCDMA_I_IMT_2000, SystemBand::SYS_BAND_WCDMA_II_PCS_1900,
      SystemBand::SYS_BAND_WCDMA_III_1700,   SystemBand::SYS_BAND_WCDMA_IV_1700,
      SystemBand::SYS_BAND_WCDMA_V_850,      SystemBand::SYS_BAND_WCDMA_VI_800,
      SystemBand::SYS_BAND_WCDMA_VII_2600,   SystemBand::SYS_BAND_WCDMA_VIII_900,
      SystemBand::SYS_BAND_WCDMA_IX_1700};
  if (number >= 1 && number <= first.size()) return first[number - 1];
  if (number == 11) return SystemBand::SYS_BAND_WCDMA_XI_1500;
  if (number == 19) return SystemBand::SYS_BAND_WCDMA_XIX_850;
  return std::nullopt;
}

// EstablishmentCause has the metric's numbers; values after the last named one are spare.
std::optional<std::int32_t> establishmentCauseOf(std::optional<unsigned> cause) {
  constexpr unsigned lastNamed = 22;
  if (!cause || *cause > lastNamed) return std::nullopt;
  return static_cast<std::int32_t>(*cause);
}

std::optional<std::int32_t> releaseCauseOf(std::optional<unsigned> cause) {
  constexpr unsigned normalEvent = 0;
  if (!cause) return std::nullopt;
  return *cause == normalEvent ? Release::KRRC_REL_NORMAL_EVENT : Release::KRRC_REL_OTHER_CAUSE;
}

std::optional<std::int32_t> rejectionCauseOf(const WcdmaRrcMeaning& meaning) {
  constexpr unsigned congestion = 0;
  if (meaning.redirected) return Release::KRRC_REL_CONN_REJECT_REDIRECTION;
  if (!meaning.cause) return std::nullopt;
  return *meaning.cause == congestion ? Release::KRRC_REL_CONN_REJECT_CONGESTION
                                      : Release::KRRC_REL_CONN_REJECT_UNSPECIFIED;
}

std::optional<std::int32_t> connectedStateOf(std::optional<unsigned> indicator) {
  if (indicator == 0U) return State::KWCDMA_RRC_CONN_STATE_CELL_DCH;
  if (indicator == 1U) return State::KWCDMA_RRC_CONN_STATE_CELL_FACH;
  return std::nullopt;
}

}  // namespace

void WcdmaTracker::describe(const WcdmaCellRecord& record, EventList& out) {
  KCellularWcdmaCellInfo message;
  if (record.plmn) {
    message.setMcc(record.plmn->mcc());
    message.setMnc(record.plmn->mnc());
    message.setNumMncDigits(record.plmn->mncDigits());
  }
  message.setLac(record.locationAreaCode);
  if (const auto cell = radio::UtraCellIdentity::fromNumber(record.cellIdentity)) message.setCellId(cell->number());
  if (const auto channel = radio::Uarfcn::fromNumber(record.downlinkUarfcn, radio::Direction::downlink)) {
    if (const auto band = bandNamed(channel->band())) message.setWcdmaBand(*band);
  }
  message.setDlUarfcn(record.downlinkUarfcn);
  message.setPsc(record.primaryScramblingCode);
  out.add(metricIdentifier("K_UMTS_SCELL_INFO"), message);
}

bool WcdmaTracker::take(const WcdmaRrcMeaning& meaning, EventList& out) {
  switch (meaning.event) {
    case WcdmaRrcEvent::connectionRequest:
      granted_.reset();
      report({State::KWCDMA_RRC_CONN_STATE_ESTABLISH, establishmentCauseOf(meaning.cause), std::nullopt}, out);
      return false;
    case WcdmaRrcEvent::connectionSetup:
      granted_ = connectedStateOf(meaning.state);
      return false;
    case WcdmaRrcEvent::connectionSetupComplete:
      if (granted_) report({*granted_, std::nullopt, std::nullopt}, out);
      return false;
    case WcdmaRrcEvent::connectionReject:
      report({State::KWCDMA_RRC_CONN_STATE_IDLE, std::nullopt, rejectionCauseOf(meaning)}, out);
      return true;
    case WcdmaRrcEvent::connectionRelease:
      report({State::KWCDMA_RRC_CONN_STATE_RELEASE, std::nullopt, releaseCauseOf(meaning.cause)}, out);
      return true;
    case WcdmaRrcEvent::connectionReleaseComplete: {
      const bool told = reported_ && (reported_->state == State::KWCDMA_RRC_CONN_STATE_RELEASE ||
                                      reported_->state == State::KWCDMA_RRC_CONN_STATE_IDLE);
      report({State::KWCDMA_RRC_CONN_STATE_IDLE, std::nullopt, told ? reported_->releaseCause : std::nullopt}, out);
      return true;
    }
    case WcdmaRrcEvent::signallingReleaseIndication:
      report({State::KWCDMA_RRC_CONN_STATE_SCRI_SENT, std::nullopt, std::nullopt}, out);
      return false;
    case WcdmaRrcEvent::cellUpdate:
      // The phone sends this message in CELL_FACH (3GPP TS 25.331 8.3.1.2).
      report({State::KWCDMA_RRC_CONN_STATE_CELL_FACH, std::nullopt, std::nullopt}, out);
      return false;
    case WcdmaRrcEvent::radioLinkFailure:
      report({State::KWCDMA_RRC_CONN_STATE_RADIO_LINK_FAILURE, std::nullopt, std::nullopt}, out);
      return false;
    case WcdmaRrcEvent::dedicatedChannelMessage:
      report({State::KWCDMA_RRC_CONN_STATE_CELL_DCH, std::nullopt, std::nullopt}, out);
      return false;
    case WcdmaRrcEvent::directTransfer:
      confirm(out);
      return false;
  }
  return false;
}

void WcdmaTracker::confirm(EventList& out) {
  const bool connected = reported_ && (reported_->state == State::KWCDMA_RRC_CONN_STATE_CELL_DCH ||
                                       reported_->state == State::KWCDMA_RRC_CONN_STATE_CELL_FACH);
  if (connected) report(Connection(*reported_), out);
}

// A repeated message is not reported again, unless the last report is old.
void WcdmaTracker::report(const Connection& connection, EventList& out) {
  if (reported_ == connection && !reportedAt_.isOld(out.time())) return;
  reported_ = connection;
  reportedAt_.note(out.time());
  KCellularWcdmaRrcConnectionState message;
  message.setState(connection.state);
  if (connection.establishmentCause) message.setEstablishmentCause(*connection.establishmentCause);
  if (connection.releaseCause) message.setReleaseCause(*connection.releaseCause);
  out.add(metricIdentifier("K_UMTS_RRC_STATE"), message);
}

}  // namespace vespscope::sources::diag
