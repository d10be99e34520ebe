#include "capture/PcapFile.h"

#include <pcap/pcap.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <limits>

namespace vespscope::capture {
namespace {

constexpr int linkType = DLT_USER0;
constexpr long nanosecondsPerSecond = 1'000'000'000;

std::string systemReason(int error) { return std::strerror(error); }

struct StreamCloser {
  void operator()(std::FILE* stream) const { std::fclose(stream); }
};
using Stream = std::unique_ptr<std::FILE, StreamCloser>;

// A stream of the program's own for `path`, "-" being standard input: closing it leaves that open.
Stream openStream(const std::string& path) {
  if (path != "-") return Stream(std::fopen(path.c_str(), "rb"));
  const int copy = ::dup(STDIN_FILENO);
  if (copy < 0) return nullptr;
  Stream stream(::fdopen(copy, "rb"));
  if (!stream) ::close(copy);
  return stream;
}

std::string linkTypeReason(int found) {
  const char* name = pcap_datalink_val_to_name(found);
  return "link type " + std::to_string(found) + " (" + (name != nullptr ? name : "unknown") +
         ") where 147 (USER0) is needed";
}

}  // namespace

void detail::PcapCloser::operator()(pcap* handle) const { pcap_close(handle); }

Result<PcapInput> PcapInput::open(const std::string& path) {
  Stream stream = openStream(path);
  if (!stream) return Failure{"cannot be opened: " + systemReason(errno)};
  std::array<char, PCAP_ERRBUF_SIZE> error{};
  pcap_t* handle = pcap_fopen_offline_with_tstamp_precision(stream.get(), PCAP_TSTAMP_PRECISION_NANO, error.data());
  if (handle == nullptr) return Failure{"not a capture: " + std::string(error.data())};
  static_cast<void>(stream.release());  // closed with the handle
  PcapInput input{std::unique_ptr<pcap, detail::PcapCloser>(handle)};
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
      return Failure{std::string(pcap_geterr(handle_.get()))};
  }
  if (header->caplen != header->len) {
    return Failure{"cut to " + std::to_string(header->caplen) + " of " + std::to_string(header->len) + " bytes"};
  }
  // libpcap hands out the file's 32 bits of seconds with a sign; they have none.
  std::int64_t seconds = header->ts.tv_sec;
  if (seconds < 0 && seconds >= std::numeric_limits<std::int32_t>::min()) seconds += std::int64_t{1} << 32;
  constexpr auto lastSecond = std::numeric_limits<std::chrono::nanoseconds::rep>::max() / nanosecondsPerSecond - 5;
  // With nanosecond precision the field named for microseconds holds nanoseconds, of which libpcap takes any number.
  const bool within = header->ts.tv_usec >= 0 && header->ts.tv_usec < nanosecondsPerSecond;
  if (seconds < 0 || seconds > lastSecond || !within) return Failure{std::string("time out of range")};
  const auto time = std::chrono::seconds(seconds) + std::chrono::nanoseconds(header->ts.tv_usec);
  return std::optional<PcapPacket>(PcapPacket{{bytes, header->caplen}, time});
}

}  // namespace vespscope::capture
