// The description of a packet connection in session messages: its name, its address, its name servers.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "sources/nas/Octets.h"
#include "values/Value.h"

namespace vespscope::sources::nas {

// "internet.mnc001.mcc262.gprs" of an access point name in labels (3GPP TS 23.003 9.1); empty when it is damaged or
// contains anything but letters, digits, hyphens and underscores.
[[nodiscard]] std::optional<std::string> accessPointNameOf(Span labels);

// The name servers in protocol configuration options (3GPP TS 24.008 10.5.6.3), 4 or 16 octets each, in order.
[[nodiscard]] std::vector<Bytes> nameServersOf(Span options);

enum class AddressKind { ipv4, ipv6, dual };

struct PacketAddress {
  AddressKind kind = AddressKind::ipv4;
  // 4 octets of IPv4, the interface identifier (8) or the whole address (16) of IPv6; IPv4 first if there are both.
  // Empty when the network assigns the address in another way.
  Bytes octets;
  bool operator==(const PacketAddress&) const = default;
};
// Reads a PDN address (3GPP TS 24.301 9.9.4.9).
[[nodiscard]] std::optional<PacketAddress> pdnAddressOf(Span bytes);
// Reads a packet data protocol address (3GPP TS 24.008 10.5.6.4).
[[nodiscard]] std::optional<PacketAddress> pdpAddressOf(Span bytes);

}  // namespace vespscope::sources::nas
