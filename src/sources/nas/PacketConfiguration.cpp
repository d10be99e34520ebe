#include "sources/nas/PacketConfiguration.h"

#include <algorithm>
#include <utility>

namespace vespscope::sources::nas {
namespace {

constexpr std::size_t ipv4Length = 4;
constexpr std::size_t interfaceLength = 8;
constexpr std::size_t ipv6Length = 16;

Bytes bytesOf(Span span) { return {span.begin(), span.end()}; }

bool isZero(Span bytes) {
  return std::all_of(bytes.begin(), bytes.end(), [](std::uint8_t octet) { return octet == 0; });
}

// Some networks send the same server in two forms.
void appendServer(Span address, std::vector<Bytes>& servers) {
  if (isZero(address)) return;
  Bytes server = bytesOf(address);
  if (std::find(servers.begin(), servers.end(), server) == servers.end()) servers.push_back(std::move(server));
}

bool belongsInName(std::uint8_t octet) {
  return (octet >= 'a' && octet <= 'z') || (octet >= 'A' && octet <= 'Z') || (octet >= '0' && octet <= '9') ||
         octet == '-' || octet == '_';
}

// Appends the primary and secondary server of an IP control protocol packet from the network (RFC 1332, RFC 1877).
void appendControlProtocolServers(Span packet, std::vector<Bytes>& servers) {
  constexpr std::size_t head = 4;
  constexpr std::uint8_t acknowledged = 2;
  constexpr std::uint8_t corrected = 3;
  constexpr std::uint8_t primary = 129;
  constexpr std::uint8_t secondary = 131;
  if (packet.size() < head || (packet[0] != acknowledged && packet[0] != corrected)) return;
  Octets octets(packet.subspan(head));
  while (const auto option = octets.octet()) {
    const auto length = octets.octet();
    if (!length || *length < 2) return;
    const auto value = octets.value(*length - 2U);
    if (!value) return;
    const bool isServer = *option == primary || *option == secondary;
    if (isServer && value->size() == ipv4Length) appendServer(*value, servers);
  }
}

}  // namespace

std::optional<std::string> accessPointNameOf(Span labels) {
  std::string name;
  Octets octets(labels);
  while (octets.left() > 0) {
    const auto label = octets.lengthValue();
    if (!label || label->empty() || !std::all_of(label->begin(), label->end(), belongsInName)) return std::nullopt;
    if (!name.empty()) name += '.';
    name.append(label->begin(), label->end());
  }
  if (name.empty()) return std::nullopt;
  return name;
}

std::vector<Bytes> nameServersOf(Span options) {
  constexpr std::uint16_t controlProtocol = 0x8021;
  constexpr std::uint16_t ipv6Server = 0x0003;
  constexpr std::uint16_t ipv4Server = 0x000D;
  std::vector<Bytes> servers;
  Octets octets(options);
  if (!octets.octet()) return servers;  // the configuration protocol
  while (const auto identifier = octets.value(2)) {
    const auto content = octets.lengthValue();
    if (!content) break;
    const std::uint16_t kind = number16(*identifier);
    if (kind == controlProtocol) appendControlProtocolServers(*content, servers);
    const std::size_t wanted = kind == ipv4Server ? ipv4Length : kind == ipv6Server ? ipv6Length : 0;
    if (wanted != 0 && content->size() == wanted) appendServer(*content, servers);
  }
  return servers;
}

std::optional<PacketAddress> pdnAddressOf(Span bytes) {
  if (bytes.empty()) return std::nullopt;
  const Span address = bytes.subspan(1);
  switch (bytes[0] & 7U) {
    case 1:
      if (address.size() < ipv4Length) return std::nullopt;
      return PacketAddress{AddressKind::ipv4, bytesOf(address.first(ipv4Length))};
    case 2:
      if (address.size() < interfaceLength) return std::nullopt;
      return PacketAddress{AddressKind::ipv6, bytesOf(address.first(interfaceLength))};
    case 3: {
      if (address.size() < interfaceLength + ipv4Length) return std::nullopt;
      PacketAddress both{AddressKind::dual, bytesOf(address.subspan(interfaceLength, ipv4Length))};
      both.octets.insert(both.octets.end(), address.begin(), address.begin() + interfaceLength);
      return both;
    }
    default:
      return std::nullopt;
  }
}

std::optional<PacketAddress> pdpAddressOf(Span bytes) {
  constexpr std::uint8_t internetProtocol = 1;
  constexpr std::uint8_t ipv4 = 0x21;
  constexpr std::uint8_t ipv6 = 0x57;
  constexpr std::uint8_t dual = 0x8D;
  if (bytes.size() < 2 || (bytes[0] & 0xFU) != internetProtocol) return std::nullopt;
  const Span address = bytes.subspan(2);
  const auto whole = [&](AddressKind kind, std::size_t length) -> std::optional<PacketAddress> {
    if (!address.empty() && address.size() != length) return std::nullopt;
    return PacketAddress{kind, bytesOf(address)};
  };
  switch (bytes[1]) {
    case ipv4:
      return whole(AddressKind::ipv4, ipv4Length);
    case ipv6:
      return whole(AddressKind::ipv6, ipv6Length);
    case dual:
      return whole(AddressKind::dual, ipv4Length + ipv6Length);
    default:
      return std::nullopt;
  }
}

}  // namespace vespscope::sources::nas
