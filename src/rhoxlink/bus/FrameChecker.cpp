#include "rhoxlink/bus/FrameChecker.h"

#include <algorithm>
#include <string>
#include <utility>

namespace vespscope::bus {
namespace {

// A D-Bus message's header: endianness, type, flags, version, bytes of the body, serial, bytes of the fields.
constexpr std::size_t headerSize = 16;
constexpr std::size_t typeAt = 1;
constexpr std::size_t versionAt = 3;
constexpr std::size_t bodySizeAt = 4;
constexpr std::size_t fieldsSizeAt = 12;
constexpr std::uint8_t methodCall = 1;
constexpr std::uint8_t lastType = 4;  // signal
constexpr std::uint8_t protocolVersion = 1;
constexpr std::size_t alignment = 8;  // of the body

std::size_t numberAt(std::span<const std::uint8_t> header, std::size_t offset) {
  std::uint32_t number = 0;
  for (std::size_t index = 0; index < sizeof number; ++index) {
    const std::size_t place = header[0] == 'l' ? offset + sizeof number - 1 - index : offset + index;
    number = number << 8 | header[place];
  }
  return number;
}

std::string limitText(std::size_t limit) { return "the limit is " + std::to_string(limit) + " bytes"; }

}  // namespace

bool MemoryBudget::take(std::size_t size) {
  std::size_t taken = taken_;
  do {
    if (size > limit_ - std::min(taken, limit_)) return false;
  } while (!taken_.compare_exchange_weak(taken, taken + size));
  return true;
}

Result<std::size_t> FrameChecker::admit(std::span<const std::uint8_t> bytes, bool authenticated) {
  if (!authenticated_ && authenticated) {
    authenticated_ = true;
    waited_ = {};
  }
  return authenticated_ ? admitMessages(bytes) : admitLine(bytes);
}

Result<std::size_t> FrameChecker::admitLine(std::span<const std::uint8_t> bytes) {
  const auto end = std::find(bytes.begin(), bytes.end(), '\n');
  const auto size = static_cast<std::size_t>(end - bytes.begin()) + (end == bytes.end() ? 0 : 1);
  authenticationBytes_ += size;
  if (authenticationBytes_ > limits_.authentication) {
    return Failure{"the peer's authentication is too long: " + limitText(limits_.authentication)};
  }
  return size;
}

Result<std::size_t> FrameChecker::admitMessages(std::span<const std::uint8_t> bytes) {
  std::size_t admitted = 0;
  while (admitted < bytes.size()) {
    if (remaining_ == 0) {
      begun_ = true;
      const auto header = bytes.subspan(admitted);
      if (header.size() < headerSize) break;
      const Result<std::size_t> size = sizeOf(header);
      if (!size) return Failure{size.reason()};
      waitsForRoom_ = budget_ && *size > limits_.unbudgeted && !budget_->take(*size);
      if (waitsForRoom_) break;
      if (budget_ && *size > limits_.unbudgeted) taken_ = *size;
      remaining_ = *size;
    }
    const std::size_t next = std::min(remaining_, bytes.size() - admitted);
    admitted += next;
    remaining_ -= next;
    if (remaining_ == 0) finishMessage();
  }
  return admitted;
}

Result<std::size_t> FrameChecker::sizeOf(std::span<const std::uint8_t> header) const {
  if ((header[0] != 'l' && header[0] != 'B') || header[typeAt] == 0 || header[typeAt] > lastType ||
      header[versionAt] != protocolVersion) {
    return Failure{std::string("the peer sent bytes that are not a D-Bus message")};
  }
  if (header[typeAt] == methodCall && !limits_.calls) {
    return Failure{std::string("the peer calls methods, which only a client does")};
  }
  const std::size_t fields = numberAt(header, fieldsSizeAt);
  if (fields > limits_.fields) {
    return Failure{"the header of the peer's message has " + std::to_string(fields) +
                   " bytes of fields: " + limitText(limits_.fields)};
  }
  const std::size_t size = headerSize + (fields + alignment - 1) / alignment * alignment + numberAt(header, bodySizeAt);
  if (size > limits_.message) {
    return Failure{"the peer's message has " + std::to_string(size) + " bytes: " + limitText(limits_.message)};
  }
  return size;
}

void FrameChecker::finishMessage() {
  if (taken_ != 0) budget_->giveBack(std::exchange(taken_, 0));
  begun_ = false;
  waited_ = {};
}

Result<bool> FrameChecker::waited(std::chrono::milliseconds duration) {
  if (!unfinished()) return true;
  waited_ += duration;
  const auto limit = authenticated_ ? limits_.messageTime : limits_.authenticationTime;
  if (waited_ <= limit) return true;
  return Failure{std::string(authenticated_ ? "the peer did not finish a message within "
                                            : "the peer did not authenticate within ") +
                 std::to_string(limit.count()) + " ms"};
}

}  // namespace vespscope::bus
