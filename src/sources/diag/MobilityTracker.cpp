#include "sources/diag/MobilityTracker.h"

#include <memory>

#include "messages/common/RegStatus.h"
#include "messages/mobility/KCellularGmmContext.h"
#include "messages/mobility/KCellularMmCommonInfo.h"
#include "messages/mobility/KCellularMmContext.h"
#include "registry/MetricRows.h"

namespace vespscope::sources::diag {
namespace {

using nas::Domain;
using nas::EpsMobilityKind;
using nas::MobilityKind;
using CircuitUpdate = KCellularMmContext::UpdateStatus;
using PacketUpdate = KCellularGmmContext::UpdateStatus;
using Procedure = KCellularGmmContext::RegProc;
using Failure = MmProcFailureCause;

// An update status is logged in the coding of the SIM card's files (3GPP TS 51.011 10.3.17 and 10.3.33).
enum LoggedUpdateStatus : std::uint8_t { updated = 0, notUpdated = 1, roamingNotAllowed = 2 };

std::int32_t attachProcedure(std::uint8_t type) {
  constexpr std::uint8_t combined = 3;
  return type == combined ? Procedure::KNAS_MM_REG_PROC_COMBINED_ATTACH : Procedure::KNAS_MM_REG_PROC_ATTACH;
}

std::int32_t updateProcedure(std::uint8_t type) {
  constexpr std::uint8_t combined = 1;
  constexpr std::uint8_t combinedWithAttach = 2;
  return type == combined || type == combinedWithAttach ? Procedure::KNAS_MM_REG_PROC_COMBINED_RAU
                                                        : Procedure::KNAS_MM_REG_PROC_ROUTING_AREA_UPDATE;
}

// Whether the result of an accept includes the circuit domain (3GPP TS 24.008 10.5.5.1, 10.5.5.17).
bool isCombined(const nas::MobilityMessage& accept) {
  if (accept.domain != Domain::packet || !accept.type) return false;
  if (accept.kind == MobilityKind::attachAccept) return *accept.type == 3;
  return *accept.type == 1 || *accept.type == 5;
}

// The same for EPS (3GPP TS 24.301 9.9.3.10, 9.9.3.13).
bool isCombined(const nas::EpsMobilityMessage& accept) {
  if (!accept.type) return false;
  if (accept.kind == EpsMobilityKind::attachAccept) return *accept.type == 2;
  return accept.kind == EpsMobilityKind::updateAccept && (*accept.type == 1 || *accept.type == 5);
}

bool isAccept(const nas::EpsMobilityMessage& message) {
  return message.kind == EpsMobilityKind::attachAccept || message.kind == EpsMobilityKind::updateAccept;
}

}  // namespace

void MobilityTracker::takeCircuit(const MobilityStateRecord& record, EventList& out) {
  circuit_.update.reset();
  if (record.updateStatus == updated) circuit_.update = CircuitUpdate::STATUS_UPDATED;
  if (record.updateStatus == notUpdated) circuit_.update = CircuitUpdate::STATUS_NOT_UPDATED;
  if (record.updateStatus == roamingNotAllowed) circuit_.update = CircuitUpdate::STATUS_ROAMING_NOT_ALLOWED;
  report(Domain::circuit, out);
}

void MobilityTracker::takePacket(const MobilityStateRecord& record, EventList& out) {
  packet_.update.reset();
  if (record.updateStatus == updated) packet_.update = PacketUpdate::GPRS_STATUS_UPDATED;
  if (record.updateStatus == notUpdated) packet_.update = PacketUpdate::GPRS_STATUS_NOT_UPDATED;
  if (record.updateStatus == roamingNotAllowed) packet_.update = PacketUpdate::GPRS_STATUS_ROAMING_NOT_ALLOWED;
  report(Domain::packet, out);
}

void MobilityTracker::take(const GmmRegistrationRecord& record, EventList& out) {
  packet_.location.reset();
  packet_.routingAreaCode.reset();
  if (record.area) {
    packet_.location = record.area->location;
    packet_.routingAreaCode = record.area->rac;
  }
  report(Domain::packet, out);
}

void MobilityTracker::take(const nas::MobilityMessage& message, EventList& out) {
  Registration& domain = message.domain == Domain::packet ? packet_ : circuit_;
  switch (message.kind) {
    case MobilityKind::attachRequest:
    case MobilityKind::updateRequest:
      begin(message, domain);
      break;
    case MobilityKind::attachAccept:
    case MobilityKind::updateAccept:
      accept(message);
      break;
    case MobilityKind::attachReject:
    case MobilityKind::updateReject:
      domain.registration = RegStatus::KREG_STATUS_REGISTRATION_FAILURE;
      reject(message, domain);
      break;
    case MobilityKind::serviceRequest:
      if (message.domain == Domain::packet) domain.procedure = Procedure::KNAS_MM_REG_PROC_SERVICE_REQ;
      break;
    case MobilityKind::serviceAccept:
      endProcedure(domain);
      break;
    case MobilityKind::serviceReject:
      reject(message, domain);
      break;
    case MobilityKind::detach:
      domain.registration = RegStatus::KREG_STATUS_SERVICE_DETACHED;
      endProcedure(domain);
      break;
    case MobilityKind::newIdentity:
      if (message.locationArea) domain.location = message.locationArea;
      if (message.routingAreaCode) domain.routingAreaCode = message.routingAreaCode;
      if (message.temporaryIdentity) domain.temporaryIdentity = message.temporaryIdentity;
      break;
    case MobilityKind::authenticationReject:
      domain.failureCause = Failure::KNAS_MM_PROC_FAILURE_CAUSE_NW_AUTH_REJ;
      endProcedure(domain);
      break;
  }
  report(message.domain, out);
}

void MobilityTracker::take(const nas::EpsMobilityMessage& message, EventList& out) {
  if (!isAccept(message)) return;
  equivalents_ = message.equivalentPlmns;
  if (isCombined(message)) acceptCombined(message.locationArea, message.tmsi);
  report(out);
}

void MobilityTracker::begin(const nas::MobilityMessage& request, Registration& domain) {
  domain.registration = RegStatus::KREG_STATUS_REGISTRATION_IN_PROGRESS;
  if (request.domain == Domain::circuit) return;
  domain.procedure =
      request.kind == MobilityKind::attachRequest ? attachProcedure(*request.type) : updateProcedure(*request.type);
}

void MobilityTracker::accept(const nas::MobilityMessage& message) {
  equivalents_ = message.equivalentPlmns;
  const bool packet = message.domain == Domain::packet;
  Registration& domain = packet ? packet_ : circuit_;
  domain.registration = RegStatus::KREG_STATUS_NORMAL_SERVICE;
  domain.update = packet ? std::int32_t{PacketUpdate::GPRS_STATUS_UPDATED} : CircuitUpdate::STATUS_UPDATED;
  domain.failureCause = Failure::KNAS_MM_PROC_FAILURE_CAUSE_NONE;
  domain.rejectCause = message.cause.value_or(0);
  if (message.locationArea) domain.location = message.locationArea;
  if (message.temporaryIdentity) domain.temporaryIdentity = message.temporaryIdentity;
  if (!packet) {
    domain.combined = false;
    return;
  }
  domain.routingAreaCode = message.routingAreaCode;
  domain.updateTimerSeconds = message.updateTimerSeconds;
  domain.procedure = Procedure::KNAS_MM_REG_PROC_PROC_NONE;
  if (isCombined(message)) acceptCombined(message.locationArea, message.tmsi);
}

void MobilityTracker::acceptCombined(const std::optional<nas::LocationArea>& location,
                                     std::optional<std::uint32_t> tmsi) {
  circuit_.registration = RegStatus::KREG_STATUS_NORMAL_SERVICE;
  circuit_.update = CircuitUpdate::STATUS_UPDATED;
  circuit_.failureCause = Failure::KNAS_MM_PROC_FAILURE_CAUSE_NONE;
  circuit_.rejectCause = 0;
  circuit_.combined = true;
  if (location) circuit_.location = location;
  if (tmsi) circuit_.temporaryIdentity = tmsi;
}

void MobilityTracker::reject(const nas::MobilityMessage& message, Registration& domain) {
  domain.failureCause = Failure::KNAS_MM_PROC_FAILURE_CAUSE_REJECTED_BY_NW;
  domain.rejectCause = *message.cause;
  endProcedure(domain);
}

// The circuit domain's metric has no procedure.
void MobilityTracker::endProcedure(Registration& domain) {
  if (domain.procedure) domain.procedure = Procedure::KNAS_MM_REG_PROC_PROC_NONE;
}

void MobilityTracker::endConnection(EventList& out) {
  for (Registration* domain : {&circuit_, &packet_}) {
    endProcedure(*domain);
    // Whether the phone is registered after a procedure that was cut off is not known.
    if (domain->registration == RegStatus::KREG_STATUS_REGISTRATION_IN_PROGRESS) domain->registration.reset();
  }
  report(out);
}

void MobilityTracker::report(Domain domain, EventList& out) {
  if (domain == Domain::circuit && circuit_ == reportedCircuit_ && circuitReportedAt_.isOld(out.time())) {
    reportCircuit(out);
  }
  if (domain == Domain::packet && packet_ == reportedPacket_ && packetReportedAt_.isOld(out.time())) reportPacket(out);
  report(out);
}

void MobilityTracker::report(EventList& out) {
  if (circuit_ != reportedCircuit_) reportCircuit(out);
  if (packet_ != reportedPacket_) reportPacket(out);
  if (equivalents_ == reportedEquivalents_) return;
  reportedEquivalents_ = equivalents_;
  KCellularMmCommonInfo message;
  for (const nas::Plmn& each : equivalents_) {
    auto plmn = std::make_shared<Plmn>();
    plmn->setEncodedPlmn(each.octets());
    message.addEplmnList(std::move(plmn));
  }
  out.add(metricIdentifier("K_CELLULAR_MM_INFO"), message);
}

void MobilityTracker::reportCircuit(EventList& out) {
  reportedCircuit_ = circuit_;
  circuitReportedAt_.note(out.time());
  KCellularMmContext message;
  if (circuit_.registration) message.setRegStatus(*circuit_.registration);
  if (circuit_.update) message.setUpdateStatus(*circuit_.update);
  if (circuit_.location) {
    auto area = std::make_shared<KCellularLocationAreaId>();
    area->setEncodedPlmn(circuit_.location->plmn.octets());
    area->setLac(circuit_.location->lac);
    message.setLai(std::move(area));
  }
  if (circuit_.temporaryIdentity) message.setTmsi(*circuit_.temporaryIdentity);
  if (circuit_.failureCause) message.setProcFailureCause(*circuit_.failureCause);
  if (circuit_.rejectCause) message.setRejectCause(*circuit_.rejectCause);
  if (circuit_.combined) message.setIsCombinedProc(*circuit_.combined);
  out.add(metricIdentifier("K_CELLULAR_MM_CTXT"), message);
}

void MobilityTracker::reportPacket(EventList& out) {
  reportedPacket_ = packet_;
  packetReportedAt_.note(out.time());
  KCellularGmmContext message;
  if (packet_.registration) message.setRegStatus(*packet_.registration);
  if (packet_.update) message.setUpdateStatus(*packet_.update);
  if (packet_.location) {
    auto area = std::make_shared<RoutingAreaId>();
    area->setEncodedPlmn(packet_.location->plmn.octets());
    area->setLac(packet_.location->lac);
    if (packet_.routingAreaCode) area->setRac(*packet_.routingAreaCode);
    message.setRai(std::move(area));
  }
  if (packet_.temporaryIdentity) message.setPTmsi(*packet_.temporaryIdentity);
  if (packet_.updateTimerSeconds) message.setT3312DurS(*packet_.updateTimerSeconds);
  if (packet_.failureCause) message.setProcFailureCause(*packet_.failureCause);
  if (packet_.rejectCause) message.setRejectCause(*packet_.rejectCause);
  if (packet_.procedure) message.setRegProc(*packet_.procedure);
  out.add(metricIdentifier("K_CELLULAR_GMM_CTXT"), message);
}

}  // namespace vespscope::sources::diag
