// How the network ends a connection, and where the phone goes.
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

#include "rrc/lte/Carriers.h"

namespace vespscope::rrc::lte {

// RedirectedCarrierInfo.
struct Redirection {
  enum class Technology : std::uint8_t { lte, gsm, umtsFdd, umtsTdd, cdma2000, nr, later };
  Technology technology = Technology::later;
  std::vector<std::uint32_t> carriers;  // of LTE, UMTS and NR
  std::optional<GsmCarriers> gsmCarriers;
};

// Priorities for the choice of cells, in place of the broadcast ones; 0..7, and 7 is the highest.
struct DedicatedPriorities {
  struct Carrier {
    std::uint32_t carrier = 0;
    std::uint8_t priority = 0;
  };
  struct Gsm {
    GsmCarriers carriers;
    std::uint8_t priority = 0;
  };
  std::vector<Carrier> lte;
  std::vector<Gsm> gsm;
  std::vector<Carrier> umtsFdd;
  std::vector<Carrier> umtsTdd;
  std::vector<Carrier> nr;
  std::optional<std::uint8_t> validity;  // T320, in minutes; absent: without an end
};

struct Release {
  std::string_view cause;  // "loadBalancingTAUrequired", "other", "cs-FallbackHighPriority-v1020", "rrc-Suspend-v1320"
  std::optional<Redirection> redirection;
  std::optional<DedicatedPriorities> priorities;
};

// Nothing when the message is another.
[[nodiscard]] std::optional<Release> releaseOf(const Message& message);

}  // namespace vespscope::rrc::lte
