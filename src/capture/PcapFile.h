// A pcap or pcapng file of link type USER0: packets as libpcap reads them. Errors do not name the file.
#pragma once

#include <chrono>
#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string>

#include "platform/files/UnpackedFile.h"
#include "values/Result.h"

struct pcap;

namespace vespscope::capture {

// libpcap rejects longer packets before it allocates memory for them.
inline constexpr std::size_t maximumPacketLength = 262'144;

struct PcapPacket {
  std::span<const std::uint8_t> bytes;  // valid until the next packet is read
  std::chrono::nanoseconds time{0};     // since 1970-01-01 00:00 UTC
};

namespace detail {
struct PcapCloser {
  void operator()(pcap* handle) const;
};
}  // namespace detail

class PcapInput {
 public:
  // Opens a file as files::UnpackedFile does: "-" is standard input. Blocks only for the header of a pipe.
  static Result<PcapInput> open(const std::string& path,
                                std::shared_ptr<const dispatch::WakeDescriptor> interruption = nullptr);
  // The next packet; empty at the end.
  Result<std::optional<PcapPacket>> next();

  // Whether reading ended because of the interruption.
  [[nodiscard]] bool interrupted() const { return file_->interrupted(); }
  // The number of bytes read so far, including those still in memory.
  [[nodiscard]] std::uint64_t position() const { return file_->position(); }

 private:
  PcapInput(std::shared_ptr<files::UnpackedFile> file, std::unique_ptr<pcap, detail::PcapCloser> handle)
      : file_(std::move(file)), handle_(std::move(handle)) {}
  std::shared_ptr<files::UnpackedFile> file_;  // read by the handle
  std::unique_ptr<pcap, detail::PcapCloser> handle_;
};

}  // namespace vespscope::capture
