#include "sources/diag/BearerTracker.h"

#include <memory>

#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "registry/MetricRows.h"

namespace vespscope::sources::diag {
namespace {

using nas::AddressKind;
using nas::EpsSessionKind;
using nas::SessionKind;
using Type = BearerContext::PdpType;

std::int32_t typeOf(AddressKind kind, bool eps) {
  switch (kind) {
    case AddressKind::ipv4:
      return eps ? Type::PDP_TYPE_IPv4_PDN : Type::PDP_TYPE_IPv4;
    case AddressKind::ipv6:
      return eps ? Type::PDP_TYPE_IPv6_PDN : Type::PDP_TYPE_IPv6;
    case AddressKind::dual:
      break;
  }
  return eps ? Type::PDP_TYPE_IPv4v6_PDN : Type::PDP_TYPE_IPv4v6;
}

std::int32_t serverTypeOf(const Bytes& server) {
  constexpr std::size_t ipv4Length = 4;
  return server.size() == ipv4Length ? Type::PDP_TYPE_IPv4 : Type::PDP_TYPE_IPv6;
}

}  // namespace

void BearerTracker::take(const BearerStateRecord& record, EventList& out) {
  // The modem's numbers of the states of 3GPP TS 24.301 6.1.3.2.
  constexpr std::uint8_t inactive = 0;
  constexpr std::uint8_t active = 2;
  if (record.state == active) bearers_[record.bearer].eps = true;
  if (record.state == inactive) remove(record.bearer);
  report(out);
}

void BearerTracker::take(const nas::EpsSessionMessage& message, EventList& out) {
  switch (message.kind) {
    case EpsSessionKind::activateDefault:
      bearers_[message.bearer] = {message.accessPoint, message.address, true, message.nameServers};
      break;
    case EpsSessionKind::activateDedicated:
      links_[message.bearer] = *message.linked;
      bearers_[message.bearer] = {std::nullopt, std::nullopt, true, {}};
      break;
    case EpsSessionKind::modify: {
      const auto bearer = bearers_.find(message.bearer);
      if (bearer != bearers_.end() && !message.nameServers.empty()) bearer->second.nameServers = message.nameServers;
      break;
    }
    case EpsSessionKind::rejected:
    case EpsSessionKind::deactivate:
    case EpsSessionKind::deactivated:
      remove(message.bearer);
      break;
    case EpsSessionKind::accepted:
      break;
  }
  report(out);
}

void BearerTracker::take(const nas::SessionMessage& message, EventList& out) {
  switch (message.kind) {
    case SessionKind::activateRequest:
      requests_[message.transaction] = {*message.accessPointId, message.accessPoint};
      return;
    case SessionKind::activateAccept:
      activate(message);
      break;
    case SessionKind::activateReject:
      requests_.erase(message.transaction);
      return;
    case SessionKind::deactivateRequest:
    case SessionKind::deactivateAccept:
      if (const auto active = activeTransactions_.extract(message.transaction)) remove(active.mapped());
      break;
  }
  report(out);
}

void BearerTracker::clear(EventList& out) {
  bearers_.clear();
  links_.clear();
  requests_.clear();
  activeTransactions_.clear();
  report(out);
}

// An answer to a request that is not in the log names no context.
void BearerTracker::activate(const nas::SessionMessage& accept) {
  const auto request = requests_.extract(accept.transaction);
  if (!request) return;
  const Request& asked = request.mapped();
  activeTransactions_[accept.transaction] = asked.accessPointId;
  bearers_[asked.accessPointId] = {asked.accessPoint, accept.address, false, accept.nameServers};
}

// The dedicated bearers are removed with their default one (3GPP TS 24.301 6.4.4.2).
void BearerTracker::remove(std::uint8_t bearer) {
  bearers_.erase(bearer);
  links_.erase(bearer);
  std::erase_if(links_, [&](const auto& link) {
    if (link.second != bearer) return false;
    bearers_.erase(link.first);
    return true;
  });
}

void BearerTracker::report(EventList& out) {
  if (bearers_ == reported_ && !reportedAt_.isOld(out.time())) return;
  reported_ = bearers_;
  reportedAt_.note(out.time());
  KCellularActivatedBearerContexts message;
  message.setBearerContextCount(static_cast<std::uint32_t>(bearers_.size()));
  for (const auto& [identity, bearer] : bearers_) {
    auto context = std::make_shared<BearerContext>();
    context->setNsapi(identity);
    if (bearer.accessPoint) context->setApn(*bearer.accessPoint);
    if (bearer.address) {
      context->setPdpType(typeOf(bearer.address->kind, bearer.eps));
      if (!bearer.address->octets.empty()) context->setPdpAddr(bearer.address->octets);
    }
    if (!bearer.nameServers.empty()) {
      context->setPrimaryDnsType(serverTypeOf(bearer.nameServers[0]));
      context->setPrimaryDnsAddr(bearer.nameServers[0]);
    }
    if (bearer.nameServers.size() > 1) {
      context->setSecondaryDnsType(serverTypeOf(bearer.nameServers[1]));
      context->setSecondaryDnsAddr(bearer.nameServers[1]);
    }
    message.addBearerContexts(std::move(context));
  }
  out.add(metricIdentifier("K_CELLULAR_ACTIVE_BEARER"), message);
}

}  // namespace vespscope::sources::diag
