#include "sources/diag/EmmTracker.h"

#include <algorithm>
#include <array>
#include <memory>

#include "messages/common/RegStatus.h"
#include "messages/lte/KCellularEmmContext.h"
#include "registry/MetricRows.h"

namespace vespscope::sources::diag {
namespace {

using nas::EpsMobilityKind;
using Mode = KCellularEmmContext::UeOpMode;
using Procedure = KCellularEmmContext::RegProc;
using Update = KCellularEmmContext::UpdateStatus;

// The modem's numbers of the states of 3GPP TS 24.301 5.1.3.2.
enum State : std::uint8_t {
  deregistered = 1,
  registeredInitiated = 2,
  registered = 3,
  updateInitiated = 4,
  serviceRequestInitiated = 5,
};
constexpr std::uint16_t normalService = 0;

std::int32_t attachProcedure(std::uint8_t type) {
  constexpr std::uint8_t combined = 2;
  constexpr std::uint8_t emergency = 6;
  if (type == combined) return Procedure::EMM_PROC_ATTACH_COMB;
  return type == emergency ? Procedure::EMM_PROC_EMERGENCY_ATTACH : Procedure::EMM_PROC_ATTACH;
}

std::int32_t updateProcedure(std::uint8_t type) {
  constexpr std::uint8_t combined = 1;
  constexpr std::uint8_t combinedWithAttach = 2;
  constexpr std::uint8_t periodic = 3;
  if (type == combined || type == combinedWithAttach) return Procedure::EMM_PROC_TAU_COMB;
  return type == periodic ? Procedure::EMM_PROC_PERIODIC_TAU : Procedure::EMM_PROC_TAU;
}

// The phone's mode of operation (3GPP TS 24.301 4.3), as far as a request shows it: a phone for both domains requests
// both at once; its usage setting says which one it prefers.
std::optional<std::int32_t> modeOf(std::int32_t procedure, std::optional<bool> dataCentric) {
  if (!dataCentric) return std::nullopt;
  if (procedure == Procedure::EMM_PROC_ATTACH_COMB || procedure == Procedure::EMM_PROC_TAU_COMB) {
    return *dataCentric ? Mode::EPS_UE_OP_MODE_CSPS_MODE_2 : Mode::EPS_UE_OP_MODE_CSPS_MODE_1;
  }
  if (procedure != Procedure::EMM_PROC_ATTACH) return std::nullopt;
  return *dataCentric ? Mode::EPS_UE_OP_MODE_PS_MODE_2 : Mode::EPS_UE_OP_MODE_PS_MODE_1;
}

// The causes on which a phone sets EU3 ROAMING NOT ALLOWED (3GPP TS 24.301 5.5.1.2.5, 5.5.3.2.5).
bool forbidsRoaming(std::uint8_t cause) {
  constexpr std::array<std::uint8_t, 11> causes = {3, 6, 7, 8, 11, 12, 13, 14, 15, 25, 35};
  return std::find(causes.begin(), causes.end(), cause) != causes.end();
}

}  // namespace

bool EmmTracker::isDeregistered(const EmmStateRecord& record) { return record.state == deregistered; }

void EmmTracker::take(const EmmStateRecord& record, EventList& out) {
  context_.guti = record.guti;
  switch (record.state) {
    case deregistered:
      context_.registration = RegStatus::KREG_STATUS_AT_NOT_REGISTERED;
      context_.procedure = Procedure::EMM_PROC_NO_PROC;
      break;
    case registeredInitiated:
    case updateInitiated:
      context_.registration = RegStatus::KREG_STATUS_REGISTRATION_IN_PROGRESS;
      break;
    case registered:
      context_.registration.reset();
      if (record.substate == normalService) context_.registration = RegStatus::KREG_STATUS_NORMAL_SERVICE;
      context_.procedure = Procedure::EMM_PROC_NO_PROC;
      break;
    case serviceRequestInitiated:
      context_.procedure = Procedure::EMM_PROC_SERV_REQ;
      break;
    default:
      context_.registration.reset();
      context_.procedure.reset();
  }
  report(out);
}

bool EmmTracker::take(const nas::EpsMobilityMessage& message, bool outgoing, EventList& out) {
  bool left = false;
  switch (message.kind) {
    case EpsMobilityKind::attachRequest:
    case EpsMobilityKind::updateRequest:
      begin(message);
      break;
    case EpsMobilityKind::attachAccept:
    case EpsMobilityKind::updateAccept:
      accept(message);
      break;
    case EpsMobilityKind::attachReject:
    case EpsMobilityKind::updateReject:
      reject(message);
      break;
    case EpsMobilityKind::serviceRequest:
      context_.procedure = Procedure::EMM_PROC_SERV_REQ;
      break;
    case EpsMobilityKind::serviceReject:
      context_.rejectCause = *message.cause;
      context_.procedure = Procedure::EMM_PROC_NO_PROC;
      break;
    case EpsMobilityKind::detachRequest:
      detaching_ = endsRegistration(message, outgoing);
      left = detaching_ && outgoing && message.switchOff;
      break;
    case EpsMobilityKind::detachAccept:
      left = detaching_;
      break;
    case EpsMobilityKind::attachComplete:
    case EpsMobilityKind::updateComplete:
      break;
  }
  if (left) leave();
  report(out);
  return left;
}

// The types of 3GPP TS 24.301 9.9.3.7 differ by direction.
bool EmmTracker::endsRegistration(const nas::EpsMobilityMessage& request, bool outgoing) {
  constexpr std::uint8_t phoneDetachesCircuit = 2;
  constexpr std::uint8_t networkDetachesCircuit = 3;
  return request.type != (outgoing ? phoneDetachesCircuit : networkDetachesCircuit);
}

void EmmTracker::leave() {
  detaching_ = false;
  context_.registration = RegStatus::KREG_STATUS_AT_NOT_REGISTERED;
  context_.procedure = Procedure::EMM_PROC_NO_PROC;
}

void EmmTracker::endConnection(EventList& out) {
  // Without its connection a procedure has failed or, if it was a service request, ended; whether the phone is
  // registered after a failed one is unknown.
  if (!context_.procedure || context_.procedure == Procedure::EMM_PROC_NO_PROC) return;
  context_.procedure = Procedure::EMM_PROC_NO_PROC;
  if (context_.registration == RegStatus::KREG_STATUS_REGISTRATION_IN_PROGRESS) context_.registration.reset();
  report(out);
}

void EmmTracker::begin(const nas::EpsMobilityMessage& request) {
  const bool attach = request.kind == EpsMobilityKind::attachRequest;
  context_.procedure = attach ? attachProcedure(*request.type) : updateProcedure(*request.type);
  context_.registration = RegStatus::KREG_STATUS_REGISTRATION_IN_PROGRESS;
  if (const auto mode = modeOf(*context_.procedure, request.dataCentric)) context_.mode = mode;
}

void EmmTracker::accept(const nas::EpsMobilityMessage& message) {
  context_.procedure = Procedure::EMM_PROC_NO_PROC;
  context_.registration = RegStatus::KREG_STATUS_NORMAL_SERVICE;
  context_.update = Update::EPS_STATUS_UPDATED;
  context_.rejectCause = message.cause.value_or(0);
  if (!message.trackingAreas.empty()) context_.areas = message.trackingAreas;
  if (message.guti) context_.guti = message.guti;
  // An update without a timer keeps the previous value (3GPP TS 24.301 5.3.5).
  if (message.updateTimerSeconds || message.kind == EpsMobilityKind::attachAccept) {
    context_.updateTimerSeconds = message.updateTimerSeconds;
  }
  context_.imsVoice = message.imsVoice;
  context_.emergencyBearers = message.emergencyBearers;
}

void EmmTracker::reject(const nas::EpsMobilityMessage& message) {
  context_.registration = RegStatus::KREG_STATUS_REGISTRATION_FAILURE;
  context_.procedure = Procedure::EMM_PROC_NO_PROC;
  context_.rejectCause = *message.cause;
  context_.update.reset();
  if (forbidsRoaming(*message.cause)) {
    // The phone deletes its identity and its areas as well.
    context_.update = Update::EPS_STATUS_ROAMING_NOT_ALLOWED;
    context_.guti.reset();
    context_.areas.clear();
  }
}

void EmmTracker::report(EventList& out) {
  if (context_ == reported_ && !reportedAt_.isOld(out.time())) return;
  reported_ = context_;
  reportedAt_.note(out.time());
  KCellularEmmContext message;
  if (context_.registration) message.setRegStatus(*context_.registration);
  if (context_.update) message.setUpdateStatus(*context_.update);
  if (context_.mode) message.setUeOpMode(*context_.mode);
  for (const nas::TrackingArea& area : context_.areas) {
    auto element = std::make_shared<KCellularTrackingAreaId>();
    element->setEncodedPlmn(area.plmn.octets());
    element->setTac(area.tac);
    message.addTaiList(std::move(element));
  }
  if (context_.guti) {
    auto guti = std::make_shared<Guti>();
    guti->setMmegi(context_.guti->mmeGroup);
    guti->setMmec(context_.guti->mmeCode);
    guti->setMTmsi(context_.guti->mTmsi);
    message.setGuti(std::move(guti));
  }
  if (context_.rejectCause) message.setRejectCause(*context_.rejectCause);
  if (context_.procedure) message.setRegProc(*context_.procedure);
  if (context_.updateTimerSeconds) message.setT3412DurS(*context_.updateTimerSeconds);
  if (context_.imsVoice) message.setIsImsVoiceSupported(*context_.imsVoice);
  if (context_.emergencyBearers) message.setIsEmergBearerSupported(*context_.emergencyBearers);
  out.add(metricIdentifier("K_LTE_EMM_CTXT"), message);
}

}  // namespace vespscope::sources::diag
