#include "rrc/lte/Plmn.h"

namespace vespscope::rrc::lte {
namespace {

std::uint16_t numberOf(const View& digits) {
  unsigned number = 0;
  for (const View digit : digits) number = number * 10 + static_cast<unsigned>(digit.value());
  return static_cast<std::uint16_t>(number);
}

}  // namespace

std::optional<Plmn> plmnOf(const View& identity, const std::optional<Plmn>& before) {
  const View country = identity["mcc"];
  const View network = identity["mnc"];
  if (!network || (!country && !before)) return std::nullopt;
  return Plmn{country ? numberOf(country) : before->countryCode, numberOf(network),
              static_cast<std::uint8_t>(network.value())};
}

}  // namespace vespscope::rrc::lte
