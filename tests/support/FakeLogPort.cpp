#include "support/FakeLogPort.h"

#include <arpa/inet.h>
#include <fcntl.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <array>
#include <cstdio>
#include <cstdlib>

namespace vespscope::test {
namespace {

constexpr std::uint8_t configure = 0x73;
// The number of codes for each equipment; those not listed have none.
constexpr std::uint32_t codeCountOf(std::size_t equipment) {
  return equipment == 4 || equipment == 5 || equipment == 7 || equipment == 11 ? 0x900 : 0;
}

std::uint16_t checksumOf(const Bytes& bytes) {
  std::uint16_t crc = 0xFFFF;
  for (const std::uint8_t byte : bytes) {
    crc = static_cast<std::uint16_t>(crc ^ byte);
    for (int bit = 0; bit < 8; ++bit) {
      crc = static_cast<std::uint16_t>((crc & 1U) != 0 ? (crc >> 1U) ^ 0x8408U : crc >> 1U);
    }
  }
  return static_cast<std::uint16_t>(~crc);
}

std::uint32_t u32(const Bytes& bytes, std::size_t offset) {
  std::uint32_t number = 0;
  for (std::size_t i = 4; i > 0; --i) number = number << 8U | bytes.at(offset + i - 1);
  return number;
}

void put32(Bytes& bytes, std::uint32_t number) {
  for (int i = 0; i < 4; ++i) bytes.push_back(static_cast<std::uint8_t>(number >> (8 * i)));
}

void sendAll(int descriptor, const Bytes& bytes) {
  std::size_t sent = 0;
  while (sent < bytes.size()) {
    pollfd ready{descriptor, POLLOUT, 0};
    if (::poll(&ready, 1, 5000) <= 0) return;
    const ssize_t count = ::write(descriptor, bytes.data() + sent, bytes.size() - sent);
    if (count <= 0) return;
    sent += static_cast<std::size_t>(count);
  }
}

void sendFrame(int descriptor, Bytes content) {
  const std::uint16_t crc = checksumOf(content);
  content.push_back(static_cast<std::uint8_t>(crc & 0xFF));
  content.push_back(static_cast<std::uint8_t>(crc >> 8U));
  Bytes frame;
  for (const std::uint8_t byte : content) {
    if (byte == 0x7D || byte == 0x7E) frame.push_back(0x7D);
    frame.push_back(byte == 0x7D ? 0x5D : byte == 0x7E ? 0x5E : byte);
  }
  frame.push_back(0x7E);
  sendAll(descriptor, frame);
}

}  // namespace

FakeLogPort::FakeLogPort(Line line, Manner manner, Bytes log) : line_(line), manner_(manner), log_(std::move(log)) {
  if (line_ == Line::terminal) {
    terminal_ = ::posix_openpt(O_RDWR | O_NOCTTY | O_NONBLOCK);
    if (terminal_ < 0 || ::grantpt(terminal_) != 0 || ::unlockpt(terminal_) != 0) std::abort();
    name_ = ::ptsname(terminal_);
  } else {
    listening_ = ::socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t length = sizeof address;
    if (::bind(listening_, reinterpret_cast<sockaddr*>(&address), length) != 0 || ::listen(listening_, 4) != 0 ||
        ::getsockname(listening_, reinterpret_cast<sockaddr*>(&address), &length) != 0) {
      std::abort();
    }
    name_ = "tcp:127.0.0.1:" + std::to_string(ntohs(address.sin_port));
  }
  thread_ = std::thread([this] { run(); });
}

FakeLogPort::~FakeLogPort() {
  stopping_ = true;
  thread_.join();
  if (listening_ >= 0) ::close(listening_);
  if (terminal_ >= 0) ::close(terminal_);
}

std::vector<std::string> FakeLogPort::commands() const {
  const std::lock_guard lock(mutex_);
  return commands_;
}

void FakeLogPort::unplug() { unplugging_ = true; }

void FakeLogPort::run() {
  while (!stopping_) {
    if (line_ == Line::terminal) {
      serve(terminal_);
      if (!unplugging_.exchange(false)) continue;
      // The other end sees a hang-up, and the path is removed.
      ::close(terminal_);
      terminal_ = -1;
      return;
    }
    pollfd ready{listening_, POLLIN, 0};
    if (::poll(&ready, 1, 10) <= 0) continue;
    const int descriptor = ::accept(listening_, nullptr, nullptr);
    serve(descriptor);
    unplugging_ = false;
    ::close(descriptor);
  }
}

void FakeLogPort::serve(int descriptor) {
  frame_.clear();
  escaped_ = false;
  equipmentsOn_ = 0;
  if (manner_ == Manner::already) sendAll(descriptor, log_);
  while (!stopping_ && !unplugging_) {
    pollfd ready{descriptor, POLLIN, 0};
    if (::poll(&ready, 1, 10) <= 0) continue;
    std::array<std::uint8_t, 256> buffer{};
    const ssize_t count = ::read(descriptor, buffer.data(), buffer.size());
    if (count <= 0) {
      if (line_ == Line::tcp) return;
      // No program has the terminal open.
      ::usleep(1000);
      continue;
    }
    if (manner_ == Manner::nonsense) sendAll(descriptor, Bytes{'A', 'T', '\r', '\n', 0x7E, 'E', 'R', 'R'});
    for (ssize_t i = 0; i < count; ++i) take(buffer.at(static_cast<std::size_t>(i)), descriptor);
  }
}

void FakeLogPort::take(std::uint8_t byte, int descriptor) {
  if (byte == 0x7E) {
    if (!frame_.empty()) takeCommand(frame_, descriptor);
    frame_.clear();
    escaped_ = false;
  } else if (byte == 0x7D) {
    escaped_ = true;
  } else {
    frame_.push_back(escaped_ ? static_cast<std::uint8_t>(byte ^ 0x20U) : byte);
    escaped_ = false;
  }
}

void FakeLogPort::takeCommand(const Bytes& frame, int descriptor) {
  if (frame.size() < 10) return note("bad: too short");
  const Bytes content(frame.begin(), frame.end() - 2);
  if (checksumOf(content) != (frame[frame.size() - 2] | frame[frame.size() - 1] << 8U)) return note("bad: checksum");
  if (content[0] != configure || content[1] != 0 || content[2] != 0 || content[3] != 0) return note("bad: head");
  const std::uint32_t operation = u32(content, 4);
  Bytes answer = {configure, 0, 0, 0};
  put32(answer, operation);
  put32(answer, 0);
  bool allOn = false;
  if (operation == 0 && content.size() == 8) {
    note("off");
  } else if (operation == 1 && content.size() == 8) {
    note("counts");
    for (std::size_t equipment = 0; equipment < 16; ++equipment) put32(answer, codeCountOf(equipment));
  } else if (operation == 3 && content.size() >= 16) {
    const std::uint32_t equipment = u32(content, 8);
    const std::uint32_t count = u32(content, 12);
    if (count != codeCountOf(equipment) || content.size() != 16 + (count + 7) / 8) return note("bad: mask");
    std::string words = "on " + std::to_string(equipment) + ":";
    for (std::uint32_t code = 0; code < count; ++code) {
      if ((content[16 + code / 8] >> (code % 8) & 1U) == 0) continue;
      std::array<char, 8> text{};
      std::snprintf(text.data(), text.size(), " %X%03X", equipment, code);
      words += text.data();
    }
    note(words);
    answer.insert(answer.end(), content.begin() + 8, content.end());
    allOn = ++equipmentsOn_ == 4;
  } else {
    return note("bad: operation");
  }
  if (manner_ == Manner::refusing) {
    answer = content;
    answer.insert(answer.begin(), 0x13);
  }
  if (manner_ == Manner::proper || manner_ == Manner::refusing) sendFrame(descriptor, answer);
  if (manner_ == Manner::proper && allOn) sendAll(descriptor, log_);
}

void FakeLogPort::note(std::string command) {
  const std::lock_guard lock(mutex_);
  commands_.push_back(std::move(command));
}

}  // namespace vespscope::test
