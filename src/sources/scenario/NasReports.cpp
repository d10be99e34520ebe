#include "sources/scenario/NasReports.h"

#include <memory>
#include <utility>

#include "messages/common/RegStatus.h"
#include "messages/lte/KCellularEmmContext.h"
#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "messages/mobility/KCellularGmmContext.h"
#include "messages/mobility/KCellularMmCommonInfo.h"
#include "messages/mobility/KCellularMmContext.h"
#include "registry/MetricRows.h"

namespace vespscope::sources::scenario {
namespace {

constexpr std::uint32_t periodicUpdateSeconds = 3240;    // 54 minutes, the default of T3412 and T3312
constexpr std::uint32_t periodicLocationSeconds = 3600;  // T3212

Bytes ownPlmn() { return operatorPlmn().octets(); }

std::int32_t statusOf(bool inProgress, bool updated) {
  if (inProgress) return RegStatus::KREG_STATUS_REGISTRATION_IN_PROGRESS;
  return updated ? RegStatus::KREG_STATUS_NORMAL_SERVICE : RegStatus::KREG_STATUS_AT_NOT_REGISTERED;
}

std::shared_ptr<BearerContext> contextOf(const Bearer& bearer) {
  using Type = BearerContext::PdpType;
  auto context = std::make_shared<BearerContext>();
  context->setCid(bearer.contextId);
  context->setNsapi(bearer.nsapi);
  context->setApn(bearer.accessPoint);
  if (bearer.dualStack) {
    context->setPdpType(bearer.lte ? Type::PDP_TYPE_IPv4v6_PDN : Type::PDP_TYPE_IPv4v6);
  } else {
    context->setPdpType(bearer.lte ? Type::PDP_TYPE_IPv6_PDN : Type::PDP_TYPE_IPv6);
  }
  context->setPdpAddr(bearer.address);
  const std::int32_t dns = bearer.primaryDns.size() == 4 ? Type::PDP_TYPE_IPv4 : Type::PDP_TYPE_IPv6;
  context->setPrimaryDnsType(dns);
  context->setPrimaryDnsAddr(bearer.primaryDns);
  context->setSecondaryDnsType(dns);
  context->setSecondaryDnsAddr(bearer.secondaryDns);
  context->setIsAddrIratMobile(bearer.accessPoint == "internet");  // keeps its address in other technologies
  return context;
}

}  // namespace

void NasReports::common(const Bytes& imsi) {
  KCellularMmCommonInfo message;
  message.setImsi(imsi);
  auto equivalent = std::make_shared<Plmn>();
  equivalent->setEncodedPlmn(
      radio::Plmn::fromNumbers(mobileCountryCode, mobileNetworkCode + 1, networkCodeDigits)->octets());
  message.addEplmnList(std::move(equivalent));
  outbox_.send(metricIdentifier("K_CELLULAR_MM_INFO"), message);
}

void NasReports::eps(const Registration& registration) {
  KCellularEmmContext message;
  message.setRegStatus(statusOf(registration.epsInProgress, registration.epsUpdated));
  message.setUpdateStatus(registration.epsUpdated ? KCellularEmmContext::UpdateStatus::EPS_STATUS_UPDATED
                                                  : KCellularEmmContext::UpdateStatus::EPS_STATUS_NOT_UPDATED);
  message.setUeOpMode(KCellularEmmContext::UeOpMode::EPS_UE_OP_MODE_CSPS_MODE_1);
  for (const std::uint32_t code : registration.trackingAreas) {
    auto area = std::make_shared<KCellularTrackingAreaId>();
    area->setEncodedPlmn(ownPlmn());
    area->setTac(code);
    message.addTaiList(std::move(area));
  }
  if (registration.mTmsi != 0) {
    auto guti = std::make_shared<Guti>();
    guti->setMmegi(registration.mmeGroup);
    guti->setMmec(registration.mmeCode);
    guti->setMTmsi(registration.mTmsi);
    message.setGuti(std::move(guti));
  }
  message.setRejectCause(KCellularEmmContext::RejectCause::EMM_CAUSE_NO_CAUSE);
  message.setRegProc(static_cast<std::int32_t>(registration.epsProcedure));
  if (registration.epsUpdated) {
    message.setT3412DurS(periodicUpdateSeconds);
    message.setIsImsVoiceSupported(true);
    message.setIsEmergBearerSupported(true);
  }
  outbox_.send(metricIdentifier("K_LTE_EMM_CTXT"), message);
}

void NasReports::gprs(const Registration& registration) {
  KCellularGmmContext message;
  message.setRegStatus(statusOf(registration.gprsInProgress, registration.gprsUpdated));
  message.setUpdateStatus(registration.gprsUpdated ? KCellularGmmContext::UpdateStatus::GPRS_STATUS_UPDATED
                                                   : KCellularGmmContext::UpdateStatus::GPRS_STATUS_NOT_UPDATED);
  auto area = std::make_shared<RoutingAreaId>();
  area->setEncodedPlmn(ownPlmn());
  area->setLac(registration.locationArea);
  area->setRac(registration.routingArea);
  message.setRai(std::move(area));
  if (registration.pTmsi != 0) message.setPTmsi(registration.pTmsi);
  if (registration.gprsUpdated) message.setT3312DurS(periodicUpdateSeconds);
  message.setProcFailureCause(MmProcFailureCause::KNAS_MM_PROC_FAILURE_CAUSE_NONE);
  message.setRejectCause(MmRejectCause::KNAS_MM_REJ_CAUSE_NONE);
  message.setRegProc(static_cast<std::int32_t>(registration.gprsProcedure));
  outbox_.send(metricIdentifier("K_CELLULAR_GMM_CTXT"), message);
}

void NasReports::circuit(const Registration& registration) {
  KCellularMmContext message;
  const bool inProgress = registration.gprsInProgress || registration.epsInProgress;
  message.setRegStatus(statusOf(inProgress, registration.circuitUpdated));
  message.setUpdateStatus(registration.circuitUpdated ? KCellularMmContext::UpdateStatus::STATUS_UPDATED
                                                      : KCellularMmContext::UpdateStatus::STATUS_NOT_UPDATED);
  auto area = std::make_shared<KCellularLocationAreaId>();
  area->setEncodedPlmn(ownPlmn());
  area->setLac(registration.locationArea);
  message.setLai(std::move(area));
  if (registration.tmsi != 0) message.setTmsi(registration.tmsi);
  message.setT3212DurS(periodicLocationSeconds);
  message.setProcFailureCause(MmProcFailureCause::KNAS_MM_PROC_FAILURE_CAUSE_NONE);
  message.setRejectCause(MmRejectCause::KNAS_MM_REJ_CAUSE_NONE);
  message.setIsCombinedProc(registration.combined);
  outbox_.send(metricIdentifier("K_CELLULAR_MM_CTXT"), message);
}

void NasReports::bearers(const std::vector<Bearer>& bearers) {
  KCellularActivatedBearerContexts message;
  message.setBearerContextCount(static_cast<std::uint32_t>(bearers.size()));
  for (const Bearer& each : bearers) message.addBearerContexts(contextOf(each));
  outbox_.send(metricIdentifier("K_CELLULAR_ACTIVE_BEARER"), message);
}

void NasReports::cardFiles(const std::vector<CardFile>& files) {
  KCellularSimCardFiles message = simCardFilesMessage(files);
  outbox_.send(metricIdentifier("K_SIM_FILE_INFO"), message);
}

MetricEvent cardFilesEvent(const std::vector<CardFile>& files, std::chrono::nanoseconds time) {
  KCellularSimCardFiles message = simCardFilesMessage(files);
  return stampedEvent(metricIdentifier("K_SIM_FILE_INFO"), message, time);
}

}  // namespace vespscope::sources::scenario
