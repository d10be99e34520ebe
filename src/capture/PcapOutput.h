// Writes packets to a nanosecond pcap file of link type USER0. Errors do not name the file.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "capture/PcapFile.h"
#include "values/Result.h"

namespace vespscope::capture {

// Does not use libpcap, whose writer leaves an incomplete packet on a full disk: here a file always ends with a whole
// packet, whatever the disk reports.
class PcapOutput {
 public:
  enum class Existing {
    replace,  // writes to the existing file: for pipes and devices
    refuse,   // fails if the file exists; a new file gets its name together with its header, so that a kill leaves no
              // empty one
  };
  // The suffix of such a file's name until it has its header.
  static constexpr const char* unfinished = ".new";

  // Writes the file's header at once; "-" is standard output. A new file is accessible to its owner only, and is
  // removed if its header cannot be written. Fails at once for a named pipe without a reader.
  static Result<PcapOutput> create(const std::string& path, Existing existing = Existing::replace);
  // Writes to an empty file that is open for writing; closes it at the end.
  static Result<PcapOutput> into(int descriptor);

  PcapOutput(PcapOutput&& other) noexcept;
  PcapOutput& operator=(PcapOutput&&) = delete;
  // Writes the buffered packets, as flush() does.
  ~PcapOutput();

  // write() adds a packet, which may stay in the buffer. Each returns the error on failure: the format cannot hold the
  // packet, or the file cannot be written. After a write error the buffered packets are discarded; a later call may
  // succeed again, unless broken().
  [[nodiscard]] std::optional<std::string> write(const PcapPacket& packet);
  [[nodiscard]] std::optional<std::string> flush();

  // The number of packets in the file and in the buffer.
  [[nodiscard]] std::uint64_t packets() const { return packets_; }
  // The file's size with the buffered bytes.
  [[nodiscard]] std::uint64_t size() const { return size_ + waiting_.size(); }
  // Whether the last failure was a system error, not caused by the packet.
  [[nodiscard]] bool unwritable() const { return unwritable_; }
  // Whether an incomplete packet was written and cannot be removed, so that nothing more is written.
  [[nodiscard]] bool broken() const { return broken_; }
  // Whether `path` still names the file: it was not removed, moved or replaced.
  [[nodiscard]] bool isAt(const std::string& path) const;
  // Whether another program has truncated or extended the file.
  [[nodiscard]] bool wasChanged() const;

 private:
  PcapOutput(int descriptor, bool ofOwnFile) : descriptor_(descriptor), ofOwnFile_(ofOwnFile) {}
  std::optional<std::string> begin();
  std::optional<std::string> cutAfter(std::size_t written, int error);

  int descriptor_;
  bool ofOwnFile_;                     // the file was empty before
  std::vector<std::uint8_t> waiting_;  // whole packets; at first also the file's header
  std::uint64_t waitingPackets_ = 0;
  std::uint64_t packets_ = 0;
  std::uint64_t size_ = 0;  // of the file's contents
  bool unwritable_ = false;
  bool broken_ = false;
};

// The part of a file, from its beginning, that reads as whole packets.
struct WholePart {
  std::uint64_t bytes = 0;  // 0 when the header is incomplete
  std::uint64_t packets = 0;
};

// Removes what is not a whole packet from the end of a file that PcapOutput wrote, as a kill or a power failure can
// leave it: an incomplete packet, or zeros up to the end. Returns the file's whole part. A file that is damaged in
// another way or of another kind is not changed, and an error returned. Never blocks, and skips the holes of a sparse
// file.
Result<WholePart> cutToWholePackets(const std::string& path);
Result<WholePart> cutToWholePackets(int descriptor);  // open for reading and writing

}  // namespace vespscope::capture
