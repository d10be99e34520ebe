#include "sources/scenario/NasContext.h"

#include <algorithm>

#include "sources/scenario/SimCard.h"

namespace vespscope::sources::scenario {
namespace {

using namespace std::chrono_literals;

// The metrics' procedures.
constexpr std::uint32_t epsNone = 0;
constexpr std::uint32_t epsCombinedAttach = 2;
constexpr std::uint32_t epsCombinedUpdate = 5;
constexpr std::uint32_t gprsCombinedUpdate = 3;
constexpr std::uint32_t gprsNone = 10;

Bytes ipv6(std::uint32_t subnet, std::uint32_t host) {
  // Within 2001:db8::/32, the prefix for documentation (RFC 3849).
  Bytes address = {0x20, 0x01, 0x0D, 0xB8, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0};
  for (std::size_t i = 0; i < 4; ++i) {
    address[4 + i] = static_cast<std::uint8_t>(subnet >> (24U - 8U * i));
    address[12 + i] = static_cast<std::uint8_t>(host >> (24U - 8U * i));
  }
  return address;
}

// The bearers that the network provides in this technology; the voice service exists in LTE only.
std::vector<Bearer> bearersIn(Technology technology, std::uint32_t subnet) {
  const bool lte = technology == Technology::lte;
  Bearer internet;
  internet.contextId = 1;
  internet.nsapi = 5;
  internet.accessPoint = "internet";
  internet.dualStack = true;
  internet.lte = lte;
  // 100.64.0.0/10 is shared address space behind an operator's address translation (RFC 6598).
  internet.address = {100, static_cast<std::uint8_t>(64 + subnet % 64), static_cast<std::uint8_t>(subnet >> 8U & 0xFFU),
                      static_cast<std::uint8_t>(1 + subnet % 250)};
  const Bytes six = ipv6(subnet, 1);
  internet.address.insert(internet.address.end(), six.begin(), six.end());
  internet.primaryDns = {192, 0, 2, 53};  // RFC 5737
  internet.secondaryDns = {198, 51, 100, 53};
  if (!lte) return {internet};
  Bearer ims;
  ims.contextId = 2;
  ims.nsapi = 6;
  ims.accessPoint = "ims";
  ims.lte = true;
  ims.address = ipv6(subnet + 1, 1);
  ims.primaryDns = ipv6(0xFFFF0000U, 0x53);
  ims.secondaryDns = ipv6(0xFFFF0000U, 0x153);
  return {internet, ims};
}

}  // namespace

NasContext::NasContext(NasReports& reports, std::uint64_t seed) : reports_(reports), random_(hashOf(seed, 40)) {
  registration_.mmeGroup = 0x8000U + static_cast<std::uint32_t>(random_.between(1, 200));
  registration_.mmeCode = static_cast<std::uint32_t>(random_.between(1, 60));
}

void NasContext::camped(Context& context, const Cell& cell) {
  technology_ = layers[cell.layer].technology;
  const std::uint32_t location = context.map.locationAreaCode(cell);
  const std::uint32_t routing = context.map.routingAreaCode(cell);
  const Procedure before = procedure_;
  if (technology_ == Technology::lte) {
    currentTac_ = context.map.trackingAreaCode(cell);
    const std::vector<std::uint32_t>& known = registration_.trackingAreas;
    const bool inside = std::find(known.begin(), known.end(), currentTac_) != known.end();
    procedure_ = !attached_ ? Procedure::attach : inside ? Procedure::none : Procedure::trackingAreaUpdate;
  } else {
    const bool inside =
        registration_.gprsUpdated && location == registration_.locationArea && routing == registration_.routingArea;
    procedure_ = inside ? Procedure::none : Procedure::routingAreaUpdate;
    currentTac_ = 0;
  }
  if (procedure_ != Procedure::none) {
    registration_.locationArea = location;
    registration_.routingArea = routing;
  }
  if (procedure_ != before) answer_.stop();
}

void NasContext::report() const {
  if (technology_ == Technology::lte) {
    reports_.eps(registration_);
  } else {
    reports_.gprs(registration_);
    reports_.circuit(registration_);
  }
}

void NasContext::connectionReady(Context& context) {
  if (procedure_ == Procedure::none || answer_.running()) return;
  answer_.start(context.now, Time(random_.between(300, 900)));
  if (technology_ == Technology::lte) {
    registration_.epsInProgress = true;
    registration_.epsUpdated = false;
    registration_.epsProcedure = procedure_ == Procedure::attach ? epsCombinedAttach : epsCombinedUpdate;
  } else {
    registration_.gprsInProgress = true;
    registration_.gprsUpdated = false;
    registration_.circuitUpdated = false;
    registration_.combined = true;
    registration_.gprsProcedure = gprsCombinedUpdate;
  }
  report();
}

// Identities begin with the bits of TS 23.003 2.4 and 2.8.2 that distinguish them.
void NasContext::newIdentities(Random& random, Technology technology) {
  const auto value = static_cast<std::uint32_t>(random.next() >> 34U);
  registration_.tmsi = static_cast<std::uint32_t>(random.next() >> 34U) | 0x10000000U;
  if (technology == Technology::lte) {
    registration_.mTmsi = value | 0xC0000000U;
  } else {
    registration_.pTmsi = value | 0xC0000000U;
  }
}

void NasContext::complete(Context& context) {
  const bool attach = procedure_ == Procedure::attach;
  procedure_ = Procedure::none;
  newIdentities(random_, technology_);
  registration_.circuitUpdated = true;
  registration_.combined = true;
  if (technology_ == Technology::lte) {
    attached_ = true;
    registration_.epsInProgress = false;
    registration_.epsUpdated = true;
    registration_.epsProcedure = epsNone;
    registration_.gprsUpdated = false;  // an entry into UMTS or GSM needs an update
    registration_.trackingAreas = {currentTac_};
    if (attach) reports_.common(testImsi());
    report();
    reports_.circuit(registration_);
  } else {
    registration_.gprsInProgress = false;
    registration_.gprsUpdated = true;
    registration_.gprsProcedure = gprsNone;
    registration_.trackingAreas.clear();  // a return to LTE needs an update
    report();
  }
  bearersFor_ = technology_;
  bearers_.start(context.now, Time(random_.between(80, 400)));
}

void NasContext::tick(Context& context) {
  if (answer_.expired(context.now)) complete(context);
  if (bearers_.expired(context.now)) reports_.bearers(bearersIn(bearersFor_, registration_.mmeGroup * 16));
}

}  // namespace vespscope::sources::scenario
