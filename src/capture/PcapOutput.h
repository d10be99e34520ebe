// Packets into a nanosecond pcap file of link type USER0. Reasons do not name the file.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "capture/PcapFile.h"
#include "values/Result.h"

namespace vespscope::capture {

// Written without libpcap, whose writer leaves part of a packet behind on a full disk: here a file always ends with a
// whole packet, whatever becomes of the disk.
class PcapOutput {
 public:
  enum class Existing {
    replace,  // writes into what is there: for pipes and devices
    refuse,   // and the new file appears under its name only with its header, so that a kill leaves none that is empty
  };
  // What such a file is called until it has its header: its name and this.
  static constexpr const char* unfinished = ".new";

  // Writes the file's header at once; "-" is standard output. A new file is open to its owner alone; one whose header
  // does not fit is removed. A named pipe without a reader is refused at once.
  static Result<PcapOutput> create(const std::string& path, Existing existing = Existing::replace);
  // Writes into an empty file that is open for writing, and closes it at the end.
  static Result<PcapOutput> into(int descriptor);

  PcapOutput(PcapOutput&& other) noexcept;
  PcapOutput& operator=(PcapOutput&&) = delete;
  // Writes what waits, as flush() does.
  ~PcapOutput();

  // Adds a packet, which may wait in memory. Each gives the reason when it fails: a packet that the format cannot hold,
  // or a file that cannot be written. After the latter what had not reached the file is forgotten; a later call may
  // succeed again, unless broken().
  [[nodiscard]] std::optional<std::string> write(const PcapPacket& packet);
  [[nodiscard]] std::optional<std::string> flush();

  // The packets in the file and those that wait.
  [[nodiscard]] std::uint64_t packets() const { return packets_; }
  // Bytes of the file, with those that wait.
  [[nodiscard]] std::uint64_t size() const { return size_ + waiting_.size(); }
  // The last call that failed was refused by the system, not for what the packet is.
  [[nodiscard]] bool unwritable() const { return unwritable_; }
  // A part of a packet was written and cannot be taken back, so nothing more is written.
  [[nodiscard]] bool broken() const { return broken_; }
  // The file is still what is found at `path`: neither removed nor moved nor replaced.
  [[nodiscard]] bool isAt(const std::string& path) const;
  // Another program has cut the file or added to it.
  [[nodiscard]] bool wasChanged() const;

 private:
  PcapOutput(int descriptor, bool ofOwnFile) : descriptor_(descriptor), ofOwnFile_(ofOwnFile) {}
  std::optional<std::string> begin();
  std::optional<std::string> cutAfter(std::size_t written, int error);

  int descriptor_;
  bool ofOwnFile_;                     // nothing was in the file before
  std::vector<std::uint8_t> waiting_;  // whole packets; at first the file's header
  std::uint64_t waitingPackets_ = 0;
  std::uint64_t packets_ = 0;
  std::uint64_t size_ = 0;  // of what is in the file
  bool unwritable_ = false;
  bool broken_ = false;
};

// What of a file reads as whole packets, from its beginning.
struct WholePart {
  std::uint64_t bytes = 0;  // 0 when not even the header is whole
  std::uint64_t packets = 0;
};

// Cuts off what is no whole packet at the end of a file that PcapOutput wrote, as a kill or a power failure can leave
// it: a part of a packet, or zeros up to the end. Returns the file's whole part. A file that is damaged in another way
// or of another kind is left alone, with a reason. Never waits, and passes over the holes of a sparse file.
Result<WholePart> cutToWholePackets(const std::string& path);
Result<WholePart> cutToWholePackets(int descriptor);  // open for reading and writing

}  // namespace vespscope::capture
