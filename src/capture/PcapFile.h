// A pcap or pcapng file of link type USER0 through libpcap: packets in, packets out. Reasons do not name the file.
#pragma once

#include <chrono>
#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string>

#include "values/Result.h"

struct pcap;
struct pcap_dumper;

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
  void operator()(pcap_dumper* dumper) const;
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

class PcapOutput {
 public:
  // Writes the file's header at once; "-" is standard output. An existing file is replaced.
  static Result<PcapOutput> create(const std::string& path);
  // Each gives the reason when it fails.
  [[nodiscard]] std::optional<std::string> write(const PcapPacket& packet);
  [[nodiscard]] std::optional<std::string> flush();

 private:
  PcapOutput(std::unique_ptr<pcap, detail::PcapCloser> handle, std::unique_ptr<pcap_dumper, detail::PcapCloser> dumper)
      : handle_(std::move(handle)), dumper_(std::move(dumper)) {}
  std::unique_ptr<pcap, detail::PcapCloser> handle_;
  std::unique_ptr<pcap_dumper, detail::PcapCloser> dumper_;
};

}  // namespace vespscope::capture
