#include "sources/modemmanager/Reports.h"

#include <algorithm>
#include <memory>

#include "messages/common/RegStatus.h"
#include "messages/lte/KCellularEmmContext.h"
#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "messages/mobility/KCellularGmmContext.h"
#include "messages/mobility/KCellularMmCommonInfo.h"
#include "messages/mobility/KCellularMmContext.h"
#include "registry/MetricRows.h"

namespace vespscope::sources::modemmanager {
namespace {

std::optional<std::int32_t> statusOf(Registration registration) {
  switch (registration) {
    case Registration::home:
    case Registration::roaming:
    case Registration::homeCsfbNotPreferred:
    case Registration::roamingCsfbNotPreferred:
      return RegStatus::KREG_STATUS_NORMAL_SERVICE;
    case Registration::homeSmsOnly:
    case Registration::roamingSmsOnly:
      return RegStatus::KREG_STATUS_REGISTERED_SMS_ONLY;
    case Registration::idle:
      return RegStatus::KREG_STATUS_AT_NOT_REGISTERED;
    case Registration::searching:
      return RegStatus::KREG_STATUS_REGISTRATION_IN_PROGRESS;
    case Registration::denied:
      return RegStatus::KREG_STATUS_REGISTRATION_FAILURE;
    case Registration::emergencyOnly:
      return RegStatus::KREG_STATUS_EMERGENCY_SERVICE;
    case Registration::unknown:
    case Registration::attachedRlos:
      break;
  }
  return std::nullopt;
}

// ModemManager has one state for all domains: "registered" refers to the technology in use only, "not registered" to
// every technology that the modem supports.
bool concerns(const ModemState& state, Technology technology) {
  if (state.technology != Technology::none) {
    return (technology == Technology::lte) == (state.technology == Technology::lte);
  }
  const Registration registration = state.registration.value_or(Registration::unknown);
  const bool nowhere = registration == Registration::idle || registration == Registration::searching ||
                       registration == Registration::denied;
  return nowhere && (technology == Technology::lte ? state.mayUseLte : state.mayUseGsmOrUmts);
}

bool registered(const ModemState& state) {
  return state.registration && statusOf(*state.registration) == RegStatus::KREG_STATUS_NORMAL_SERVICE;
}

using PdpType = BearerContext::PdpType;

// The type that was requested, or that its addresses show; EPS bearers have types of their own.
std::optional<std::int32_t> typeOf(const Bearer& bearer, bool lte) {
  constexpr std::uint32_t ipv4 = 1;
  constexpr std::uint32_t ipv6 = 2;
  constexpr std::uint32_t both = 4;
  std::uint32_t families = 0;
  if (!bearer.ipv4.empty() && !bearer.ipv6.empty()) {
    families = both;
  } else if (!bearer.ipv4.empty() || !bearer.ipv6.empty()) {
    families = bearer.ipv4.empty() ? ipv6 : ipv4;
  } else {
    families = bearer.families.value_or(0);
  }
  if (families == ipv4) return lte ? PdpType::PDP_TYPE_IPv4_PDN : PdpType::PDP_TYPE_IPv4;
  if (families == ipv6) return lte ? PdpType::PDP_TYPE_IPv6_PDN : PdpType::PDP_TYPE_IPv6;
  if (families == both) return lte ? PdpType::PDP_TYPE_IPv4v6_PDN : PdpType::PDP_TYPE_IPv4v6;
  return std::nullopt;
}

std::int32_t typeOfServer(const Bytes& address) {
  return address.size() == 4 ? PdpType::PDP_TYPE_IPv4 : PdpType::PDP_TYPE_IPv6;
}

std::shared_ptr<BearerContext> contextOf(const Bearer& bearer, bool lte) {
  auto context = std::make_shared<BearerContext>();
  if (bearer.contextId) context->setCid(*bearer.contextId);
  if (bearer.accessPoint) context->setApn(*bearer.accessPoint);
  if (const auto type = typeOf(bearer, lte)) context->setPdpType(*type);
  Bytes address = bearer.ipv4;
  address.insert(address.end(), bearer.ipv6.begin(), bearer.ipv6.end());
  if (!address.empty()) context->setPdpAddr(std::move(address));
  if (!bearer.dns.empty()) {
    context->setPrimaryDnsType(typeOfServer(bearer.dns[0]));
    context->setPrimaryDnsAddr(bearer.dns[0]);
  }
  if (bearer.dns.size() > 1) {
    context->setSecondaryDnsType(typeOfServer(bearer.dns[1]));
    context->setSecondaryDnsAddr(bearer.dns[1]);
  }
  return context;
}

}  // namespace

std::vector<MetricEvent> Reports::update(const ModemState& state, std::chrono::nanoseconds time) {
  time_ = time;
  tellRegistration(state);
  tellServingCell(state);
  tellSignal(state);
  tellNeighbours(state);
  tellBearers(state);
  tellSim(state);
  return std::exchange(events_, {});
}

void Reports::tellRegistration(const ModemState& state) {
  const std::optional<std::int32_t> status = statusOf(state.registration.value_or(Registration::unknown));
  KCellularEmmContext eps;
  if (concerns(state, Technology::lte)) {
    if (status) eps.setRegStatus(*status);
    if (state.epsMode) eps.setUeOpMode(static_cast<std::int32_t>(*state.epsMode) - 1);
  }
  tell(metricIdentifier("K_LTE_EMM_CTXT"), eps);

  KCellularMmContext circuit;
  KCellularGmmContext packet;
  if (concerns(state, Technology::umts)) {
    if (status) circuit.setRegStatus(*status);
    if (state.packetAttached) {
      packet.setRegStatus(*state.packetAttached ? RegStatus::KREG_STATUS_NORMAL_SERVICE
                                                : RegStatus::KREG_STATUS_SERVICE_DETACHED);
    }
    if (registered(state) && state.network) {
      auto location = std::make_shared<KCellularLocationAreaId>();
      location->setEncodedPlmn(state.network->octets());
      if (state.lac) location->setLac(*state.lac);
      circuit.setLai(std::move(location));
    }
    if (state.packetAttached == true && state.network) {
      auto routing = std::make_shared<RoutingAreaId>();
      routing->setEncodedPlmn(state.network->octets());
      if (state.lac) routing->setLac(*state.lac);
      packet.setRai(std::move(routing));
    }
  }
  tell(metricIdentifier("K_CELLULAR_MM_CTXT"), circuit);
  tell(metricIdentifier("K_CELLULAR_GMM_CTXT"), packet);
}

void Reports::tellBearers(const ModemState& state) {
  KCellularActivatedBearerContexts message;
  if (state.bearersKnown) message.setBearerContextCount(static_cast<std::uint32_t>(state.bearers.size()));
  for (const Bearer& bearer : state.bearers) {
    message.addBearerContexts(contextOf(bearer, state.technology == Technology::lte));
  }
  if (emptied(ListName::bearers, state.bearers.size())) message.addBearerContexts(std::make_shared<BearerContext>());
  tell(metricIdentifier("K_CELLULAR_ACTIVE_BEARER"), message);
}

void Reports::tellSim(const ModemState& state) {
  KCellularMmCommonInfo common;
  if (state.sim.imsi) common.setImsi(encodedImsi(*state.sim.imsi));
  tell(metricIdentifier("K_CELLULAR_MM_INFO"), common);

  files_ = cardFiles(state.sim);
  KCellularSimCardFiles message = simCardFilesMessage(files_);
  if (emptied(ListName::files, files_.size())) message.addEfList(std::make_shared<ElementaryFile>());
  tell(metricIdentifier("K_SIM_FILE_INFO"), message);
}

std::optional<MetricEvent> Reports::simCardFiles(std::chrono::nanoseconds time) const {
  if (files_.empty()) return std::nullopt;
  KCellularSimCardFiles message = simCardFilesMessage(files_);
  return stampedEvent(metricIdentifier("K_SIM_FILE_INFO"), message, time);
}

}  // namespace vespscope::sources::modemmanager
