// A pcap or pcapng file of link type USER0: packets as libpcap reads them. Reasons do not name the file.
#pragma once

#include <chrono>
#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string>

#include "values/Result.h"

struct pcap;

namespace vespscope::capture {

// libpcap refuses longer packets on reading, before it takes memory for them.
inline constexpr std::size_t maximumPacketLength = 262'144;

struct PcapPacket {
  std::span<const std::uint8_t> bytes;  // good until the next packet is read
  std::chrono::nanoseconds time{0};     // since 1970-01-01 00:00 UTC
};

namespace detail {
struct PcapCloser {
  void operator()(pcap* handle) const;
};
}  // namespace detail

class PcapInput {
 public:
  // "-" is standard input.
  static Result<PcapInput> open(const std::string& path);
  // The next packet; empty at the end.
  Result<std::optional<PcapPacket>> next();

 private:
  explicit PcapInput(std::unique_ptr<pcap, detail::PcapCloser> handle) : handle_(std::move(handle)) {}
  std::unique_ptr<pcap, detail::PcapCloser> handle_;
};

}  // namespace vespscope::capture
