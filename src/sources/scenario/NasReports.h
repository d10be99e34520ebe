// Converts the phone's registrations, bearers and card files into metric events.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "sources/report/SimCardFiles.h"
#include "sources/scenario/Outbox.h"
#include "sources/scenario/RadioMap.h"
#include "values/Value.h"

namespace vespscope::sources::scenario {

// The agreement between phone and network.
struct Registration {
  bool epsInProgress = false;
  bool epsUpdated = false;
  std::uint32_t epsProcedure = 0;  // number of the metric's procedure
  std::uint32_t mmeGroup = 0;      // 16 bits, TS 23.003 2.8.1
  std::uint32_t mmeCode = 0;       // 8 bits
  std::uint32_t mTmsi = 0;
  std::vector<std::uint32_t> trackingAreas;
  std::uint32_t gprsProcedure = 10;  // number of the metric's procedure; 10: none
  bool gprsInProgress = false;
  bool gprsUpdated = false;
  bool circuitUpdated = false;
  bool combined = false;  // circuit-switched registration made together with the packet-switched one
  std::uint32_t locationArea = 0;
  std::uint32_t routingArea = 0;
  std::uint32_t tmsi = 0;
  std::uint32_t pTmsi = 0;
};

// A packet data connection.
struct Bearer {
  std::uint32_t contextId = 0;
  std::uint32_t nsapi = 0;  // 5..15, TS 24.008 10.5.6.2; on LTE the EPS bearer identity
  std::string accessPoint;
  bool dualStack = false;  // IPv4v6, else IPv6
  bool lte = false;
  Bytes address;
  Bytes primaryDns;
  Bytes secondaryDns;
};

class NasReports {
 public:
  explicit NasReports(Outbox& outbox) : outbox_(outbox) {}

  void common(const Bytes& imsi);
  void eps(const Registration& registration);
  void gprs(const Registration& registration);
  void circuit(const Registration& registration);
  void bearers(const std::vector<Bearer>& bearers);
  void cardFiles(const std::vector<CardFile>& files);

 private:
  Outbox& outbox_;
};

// The card files as the payload of one event, at a moment since 1970.
[[nodiscard]] MetricEvent cardFilesEvent(const std::vector<CardFile>& files, std::chrono::nanoseconds time);

}  // namespace vespscope::sources::scenario
