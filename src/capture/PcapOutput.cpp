#include "capture/PcapOutput.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstring>
#include <limits>
#include <span>
#include <utility>

namespace vespscope::capture {
namespace {

// Magic number of nanosecond pcap, version 2.4, no time zone, no accuracy, longest packet 262144, link type 147.
constexpr std::array<std::uint8_t, 24> fileHeader = {0x4D, 0x3C, 0xB2, 0xA1, 2, 0, 4, 0, 0,   0, 0, 0,
                                                     0,    0,    0,    0,    0, 0, 4, 0, 147, 0, 0, 0};
static_assert(maximumPacketLength == std::size_t{4} << 16);

constexpr std::size_t packetHeaderSize = 16;  // seconds, nanoseconds, stored bytes, original bytes
constexpr std::size_t keptLengthOffset = 8;
constexpr std::size_t blockSize = 262'144;  // buffered bytes that are written without flush()
constexpr mode_t ownerOnly = 0600;

std::string unwritten(int error) { return "cannot be written: " + std::string(std::strerror(error)); }

void append(std::vector<std::uint8_t>& bytes, std::uint32_t number) {
  for (int shift = 0; shift < 32; shift += 8) bytes.push_back(static_cast<std::uint8_t>(number >> shift));
}

std::size_t keptLength(std::span<const std::uint8_t> packetHeader) {
  std::size_t length = 0;
  for (std::size_t index = 0; index < 4; ++index) {
    length |= std::size_t{packetHeader[keptLengthOffset + index]} << (8 * index);
  }
  return length;
}

int openFile(const std::string& path, PcapOutput::Existing existing) {
  if (path == "-") return ::fcntl(STDOUT_FILENO, F_DUPFD_CLOEXEC, 0);
  constexpr int manner = O_WRONLY | O_CREAT | O_CLOEXEC;
  if (existing == PcapOutput::Existing::replace) {
    // Without O_NONBLOCK, opening a pipe would wait for its reader; writing to it then blocks as usual.
    const int opened = ::open(path.c_str(), manner | O_TRUNC | O_NONBLOCK | O_NOCTTY, ownerOnly);
    if (opened >= 0) ::fcntl(opened, F_SETFL, ::fcntl(opened, F_GETFL) & ~O_NONBLOCK);
    return opened;
  }
  if (::access(path.c_str(), F_OK) == 0) {
    errno = EEXIST;
    return -1;
  }
  const std::string hidden = path + PcapOutput::unfinished;
  ::unlink(hidden.c_str());
  return ::open(hidden.c_str(), manner | O_EXCL, ownerOnly);
}

void removeFile(const std::string& path) {
  struct stat file {};
  if (::stat(path.c_str(), &file) == 0 && S_ISREG(file.st_mode)) ::unlink(path.c_str());
}

// A file's bytes at any offset, read in blocks.
class Blocks {
 public:
  explicit Blocks(int descriptor) : descriptor_(descriptor) {}

  // Reads exactly `bytes.size()` bytes at `offset`, at most a block; returns false when there are fewer.
  bool read(std::uint64_t offset, std::span<std::uint8_t> bytes) {
    if (offset < begin_ || offset + bytes.size() > begin_ + length_) {
      begin_ = offset;
      const ssize_t count = ::pread(descriptor_, block_.data(), block_.size(), static_cast<off_t>(offset));
      length_ = count < 0 ? 0 : static_cast<std::size_t>(count);
    }
    if (length_ < bytes.size()) return false;
    std::copy_n(block_.begin() + static_cast<std::ptrdiff_t>(offset - begin_), bytes.size(), bytes.begin());
    return true;
  }
  // Whether the file has only zeros from `offset` on. Holes are not read.
  bool onlyZerosFrom(std::uint64_t offset) {
    while (true) {
      const off_t data = ::lseek(descriptor_, static_cast<off_t>(offset), SEEK_DATA);
      if (data < 0) return errno == ENXIO;
      const ssize_t count = ::pread(descriptor_, block_.data(), block_.size(), data);
      if (count <= 0) return count == 0;
      length_ = 0;
      const auto end = block_.begin() + count;
      if (std::any_of(block_.begin(), end, [](std::uint8_t byte) { return byte != 0; })) return false;
      offset = static_cast<std::uint64_t>(data + count);
    }
  }

 private:
  const int descriptor_;
  std::vector<std::uint8_t> block_ = std::vector<std::uint8_t>(65'536);
  std::uint64_t begin_ = 0;
  std::size_t length_ = 0;
};

bool isRegular(int descriptor) {
  struct stat file {};
  return ::fstat(descriptor, &file) == 0 && S_ISREG(file.st_mode);
}

}  // namespace

Result<PcapOutput> PcapOutput::create(const std::string& path, Existing existing) {
  const int descriptor = openFile(path, existing);
  if (descriptor < 0) return Failure{"cannot be created: " + std::string(std::strerror(errno))};
  const std::string opened = existing == Existing::refuse ? path + unfinished : path;
  PcapOutput output(descriptor, path != "-" && isRegular(descriptor));
  std::optional<std::string> reason = output.begin();
  if (!reason && opened != path && ::rename(opened.c_str(), path.c_str()) != 0) reason = unwritten(errno);
  if (!reason) return output;
  if (path != "-") removeFile(opened);
  return Failure{*std::move(reason)};
}

Result<PcapOutput> PcapOutput::into(int descriptor) {
  PcapOutput output(descriptor, isRegular(descriptor));
  if (auto reason = output.begin()) return Failure{*std::move(reason)};
  return output;
}

std::optional<std::string> PcapOutput::begin() {
  waiting_.assign(fileHeader.begin(), fileHeader.end());
  return flush();
}

PcapOutput::PcapOutput(PcapOutput&& other) noexcept
    : descriptor_(std::exchange(other.descriptor_, -1)),
      ofOwnFile_(other.ofOwnFile_),
      waiting_(std::move(other.waiting_)),
      waitingPackets_(other.waitingPackets_),
      packets_(other.packets_),
      size_(other.size_),
      unwritable_(other.unwritable_),
      broken_(other.broken_) {}

PcapOutput::~PcapOutput() {
  if (descriptor_ < 0) return;
  static_cast<void>(flush());
  ::close(descriptor_);
}

std::optional<std::string> PcapOutput::write(const PcapPacket& packet) {
  unwritable_ = false;
  if (packet.bytes.size() > maximumPacketLength) {
    return std::to_string(packet.bytes.size()) + " bytes where at most " + std::to_string(maximumPacketLength) + " fit";
  }
  // The file stores seconds since 1970 as 32 bits, unsigned.
  const auto seconds = std::chrono::floor<std::chrono::seconds>(packet.time);
  if (seconds.count() < 0 || seconds.count() > std::numeric_limits<std::uint32_t>::max()) return "time out of range";
  const auto length = static_cast<std::uint32_t>(packet.bytes.size());
  append(waiting_, static_cast<std::uint32_t>(seconds.count()));
  append(waiting_, static_cast<std::uint32_t>((packet.time - seconds).count()));
  append(waiting_, length);
  append(waiting_, length);
  waiting_.insert(waiting_.end(), packet.bytes.begin(), packet.bytes.end());
  ++waitingPackets_;
  ++packets_;
  return waiting_.size() < blockSize ? std::nullopt : flush();
}

std::optional<std::string> PcapOutput::flush() {
  unwritable_ = false;
  if (broken_) return cutAfter(0, EIO);
  if (!waiting_.empty() && wasChanged()) {
    // Further packets at the old offset would follow a hole.
    broken_ = true;
    static_cast<void>(cutAfter(0, EIO));
    return "has been changed by another program";
  }
  std::size_t written = 0;
  while (written < waiting_.size()) {
    const ssize_t count = ::write(descriptor_, waiting_.data() + written, waiting_.size() - written);
    if (count < 0 && errno == EINTR) continue;
    if (count <= 0) return cutAfter(written, count < 0 ? errno : EIO);
    written += static_cast<std::size_t>(count);
  }
  size_ += written;
  waiting_.clear();
  waitingPackets_ = 0;
  return std::nullopt;
}

// Only the first `written` buffered bytes have reached the file: removes an incomplete packet at its end.
std::optional<std::string> PcapOutput::cutAfter(std::size_t written, int error) {
  std::size_t whole = 0;
  std::uint64_t wholePackets = 0;
  while (written - whole >= packetHeaderSize && waitingPackets_ != 0) {
    const std::size_t size = packetHeaderSize + keptLength(std::span(waiting_).subspan(whole, packetHeaderSize));
    if (written - whole < size) break;
    whole += size;
    ++wholePackets;
  }
  if (const auto part = static_cast<off_t>(written - whole); part != 0) {
    // If standard output is appended to a file, the beginning of the file is not ours.
    const off_t end = ::lseek(descriptor_, -part, SEEK_CUR);
    broken_ = end < 0 || ::ftruncate(descriptor_, end) != 0;
  }
  size_ += whole;
  packets_ -= waitingPackets_ - wholePackets;
  waiting_.clear();
  waitingPackets_ = 0;
  unwritable_ = true;
  return unwritten(error);
}

bool PcapOutput::isAt(const std::string& path) const {
  struct stat open {};
  struct stat found {};
  return ::fstat(descriptor_, &open) == 0 && ::lstat(path.c_str(), &found) == 0 && open.st_dev == found.st_dev &&
         open.st_ino == found.st_ino;
}

bool PcapOutput::wasChanged() const {
  struct stat file {};
  return ofOwnFile_ && ::fstat(descriptor_, &file) == 0 && static_cast<std::uint64_t>(file.st_size) != size_;
}

Result<WholePart> cutToWholePackets(int descriptor) {
  struct stat file {};
  if (::fstat(descriptor, &file) != 0 || !S_ISREG(file.st_mode)) return Failure{std::string("not a regular file")};
  const auto size = static_cast<std::uint64_t>(file.st_size);
  if (size < fileHeader.size()) return WholePart{};
  Blocks blocks(descriptor);
  std::array<std::uint8_t, fileHeader.size()> header{};
  if (!blocks.read(0, header) || header != fileHeader) {
    if (blocks.onlyZerosFrom(0)) return WholePart{};
    return Failure{std::string("not a recording of this program")};
  }
  WholePart whole{.bytes = fileHeader.size(), .packets = 0};
  std::array<std::uint8_t, packetHeaderSize> packet{};
  while (size - whole.bytes >= packetHeaderSize && blocks.read(whole.bytes, packet)) {
    const std::size_t length = keptLength(packet);
    // An event has at least its identifier, so no packet is empty.
    if (length == 0 && blocks.onlyZerosFrom(whole.bytes)) break;
    if (length == 0 || length > maximumPacketLength) return Failure{"damaged at byte " + std::to_string(whole.bytes)};
    if (size - whole.bytes - packetHeaderSize < length) break;
    whole.bytes += packetHeaderSize + length;
    ++whole.packets;
  }
  if (whole.bytes < size && ::ftruncate(descriptor, static_cast<off_t>(whole.bytes)) != 0) {
    return Failure{unwritten(errno)};
  }
  return whole;
}

Result<WholePart> cutToWholePackets(const std::string& path) {
  const int descriptor = ::open(path.c_str(), O_RDWR | O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY);
  if (descriptor < 0) return Failure{"cannot be opened: " + std::string(std::strerror(errno))};
  auto whole = cutToWholePackets(descriptor);
  ::close(descriptor);
  return whole;
}

}  // namespace vespscope::capture
