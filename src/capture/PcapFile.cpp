#include "capture/PcapFile.h"

#include <pcap/pcap.h>

#include <array>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <limits>
#include <string_view>

#include <stdio.h>

#include "platform/files/FormatHint.h"

namespace vespscope::capture {
namespace {

constexpr int linkType = DLT_USER0;
constexpr long nanosecondsPerSecond = 1'000'000'000;

constexpr std::size_t blockSize = 65'536;  // bytes read at once

struct StreamCloser {
  void operator()(std::FILE* stream) const { std::fclose(stream); }
};
using Stream = std::unique_ptr<std::FILE, StreamCloser>;
using SharedFile = std::shared_ptr<files::UnpackedFile>;

ssize_t readFile(void* cookie, char* bytes, std::size_t size) {
  const auto count = (*static_cast<SharedFile*>(cookie))->read({reinterpret_cast<std::uint8_t*>(bytes), size});
  if (count) return static_cast<ssize_t>(*count);
  errno = EIO;
  return -1;
}

int closeFile(void* cookie) {
  delete static_cast<SharedFile*>(cookie);
  return 0;
}

// Wraps `file` in the stream that libpcap reads.
Stream streamOf(const SharedFile& file) {
  auto cookie = std::make_unique<SharedFile>(file);
  Stream stream(::fopencookie(cookie.get(), "rb", {readFile, nullptr, nullptr, closeFile}));
  if (!stream) return stream;
  static_cast<void>(cookie.release());  // deleted with the stream
  std::setvbuf(stream.get(), nullptr, _IOFBF, blockSize);
  return stream;
}

std::string linkTypeReason(int found) {
  const char* name = pcap_datalink_val_to_name(found);
  return "link type " + std::to_string(found) + " (" + (name != nullptr ? name : "unknown") +
         ") where 147 (USER0) is needed";
}

}  // namespace

void detail::PcapCloser::operator()(pcap* handle) const { pcap_close(handle); }

Result<PcapInput> PcapInput::open(const std::string& path,
                                  std::shared_ptr<const dispatch::WakeDescriptor> interruption) {
  auto opened = files::UnpackedFile::open(path, std::move(interruption));
  if (!opened) return Failure{opened.reason()};
  const SharedFile file = std::move(*opened);
  Stream stream = streamOf(file);
  if (!stream) return Failure{std::string("cannot be opened: ") + std::strerror(errno)};
  std::array<char, PCAP_ERRBUF_SIZE> error{};
  pcap_t* handle = pcap_fopen_offline_with_tstamp_precision(stream.get(), PCAP_TSTAMP_PRECISION_NANO, error.data());
  if (file->failure()) return Failure{*file->failure()};
  if (handle == nullptr && file->position() == 0) return Failure{std::string("is empty")};
  if (handle == nullptr) {
    // libpcap knows best about a damaged file of its own kind.
    const bool unknown = std::string_view(error.data()) == "unknown file format";
    const std::string_view hint = unknown ? files::formatHintOf(path) : std::string_view();
    return Failure{"not a capture: " + (hint.empty() ? std::string(error.data()) : std::string(hint))};
  }
  static_cast<void>(stream.release());  // closed with the handle
  PcapInput input{file, std::unique_ptr<pcap, detail::PcapCloser>(handle)};
  if (const int found = pcap_datalink(handle); found != linkType) return Failure{linkTypeReason(found)};
  return input;
}

Result<std::optional<PcapPacket>> PcapInput::next() {
  pcap_pkthdr* header = nullptr;
  const u_char* bytes = nullptr;
  switch (pcap_next_ex(handle_.get(), &header, &bytes)) {
    case 1:
      break;
    case PCAP_ERROR_BREAK:
      return std::optional<PcapPacket>{};
    default:
      if (file_->failure()) return Failure{*file_->failure()};
      return Failure{std::string(pcap_geterr(handle_.get()))};
  }
  // An event has at least its identifier. After a power failure a file may end in zeros, which read as empty packets.
  if (header->caplen == 0)
    return Failure{
        std::string("a packet without bytes: the recording is damaged here, for example by a power failure")};
  if (header->caplen != header->len) {
    return Failure{"cut to " + std::to_string(header->caplen) + " of " + std::to_string(header->len) + " bytes"};
  }
  // libpcap returns the file's 32 bits of seconds as signed; they are unsigned.
  std::int64_t seconds = header->ts.tv_sec;
  if (seconds < 0 && seconds >= std::numeric_limits<std::int32_t>::min()) seconds += std::int64_t{1} << 32;
  constexpr auto lastSecond = std::numeric_limits<std::chrono::nanoseconds::rep>::max() / nanosecondsPerSecond - 5;
  // With nanosecond precision the microseconds field holds nanoseconds, which libpcap does not check.
  const bool within = header->ts.tv_usec >= 0 && header->ts.tv_usec < nanosecondsPerSecond;
  if (seconds < 0 || seconds > lastSecond || !within) return Failure{std::string("time out of range")};
  const auto time = std::chrono::seconds(seconds) + std::chrono::nanoseconds(header->ts.tv_usec);
  return std::optional<PcapPacket>(PcapPacket{{bytes, header->caplen}, time});
}

}  // namespace vespscope::capture
