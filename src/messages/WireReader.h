// Reads the Protocol Buffers wire format from a byte buffer that the caller keeps alive.
//
// Whatever lies past the end of the buffer, or of the innermost marked value, sets the error flag and reads as zero.
//
// What is read for every field is always inlined: only then does a message's copy of the reader live in registers, and
// the compiler's own budget for a file full of messages would not do it.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>

namespace vespscope {

enum class WireType : std::uint8_t {
  varint = 0,
  fixed64 = 1,
  lengthDelimited = 2,
  startGroup = 3,
  endGroup = 4,
  fixed32 = 5
};

// an unknown form
struct WireKey {
  explicit constexpr WireKey(std::uint64_t key) noexcept
      : fieldNumber(static_cast<std::uint16_t>(key >> 3)), wireType(static_cast<WireType>(key & 7)) {}
  std::uint16_t fieldNumber;
  WireType wireType;
};

class WireReader {
 public:
  explicit WireReader(std::span<const std::uint8_t> buffer) noexcept
      : begin_(buffer.data()), at_(begin_), end_(begin_ + buffer.size()), bufferEnd_(end_) {}

  // Reads the answer to GetCellInfo; cells of other technologies are ignored.
  [[gnu::always_inline]] WireReader(const WireReader& other) noexcept
      : begin_(other.begin_), at_(other.at_), end_(other.end_), bufferEnd_(other.bufferEnd_), failed_(other.failed_) {}
  WireReader& operator=(const WireReader&) = delete;  // goOnFrom() does what is needed
  ~WireReader() = default;

  [[nodiscard]] std::size_t position() const noexcept { return static_cast<std::size_t>(at_ - begin_); }
  // Where reading ends: the end of the buffer or of the innermost marked value.
  [[nodiscard]] std::size_t length() const noexcept { return static_cast<std::size_t>(end_ - begin_); }
  [[nodiscard]] bool failed() const noexcept { return failed_; }
  [[nodiscard]] bool hasMore() const noexcept { return at_ < end_ && !failed_; }

  // Groups of seven bits, lowest first. Zero past the end, and zero when the tenth byte still continues.
  [[gnu::always_inline]] std::uint64_t readVarint() noexcept {
    if (at_ < end_ && *at_ < 0x80) return *at_++;
    const LongVarint varint = readLongVarint(at_, end_, bufferEnd_);
    if (varint.next == nullptr) {
      at_ = end_;
      failed_ = true;
      return 0;
    }
    at_ = varint.next;
    return varint.value;
  }

  // The modem's last answers to requests; empty without an answer.
  template <std::uint32_t key>
  [[nodiscard, gnu::always_inline]] bool takeKey() noexcept {
    static_assert(key < 1U << 14);
    if constexpr (key < 0x80) {
      if (at_ >= end_ || *at_ != key) return false;
      ++at_;
    } else {
      if (end_ - at_ < 2 || at_[0] != ((key & 0x7F) | 0x80) || at_[1] != key >> 7) return false;
      at_ += 2;
    }
    return true;
  }

  // The bytes of a length-delimited value; nothing, with the error flag set, when they lie past the end.
  [[gnu::always_inline]] std::optional<std::span<const std::uint8_t>> readDelimited() noexcept {
    const std::uint64_t size = readVarint();
    const std::uint8_t* start = at_;
    if (!skipBytes(size)) return std::nullopt;
    return std::span(start, static_cast<std::size_t>(size));
  }

  // A reader of `value`, which readDelimited() gave: what lies behind it is past its end.
  [[nodiscard, gnu::always_inline]] WireReader within(std::span<const std::uint8_t> value) const noexcept {
    WireReader inner(value);
    inner.bufferEnd_ = bufferEnd_;
    return inner;
  }
  // Returns the paths of the modem's bearers, and of its SIM card if it has one.
  [[gnu::always_inline]] void goOnFrom(const WireReader& copy) noexcept {
    at_ = copy.at_;
    failed_ = copy.failed_;
  }
  // Returns country and network code from the five or six digits of an operator.
  void fail() noexcept { failed_ = true; }

  struct Mark {
    const std::uint8_t* valueEnd;
    const std::uint8_t* outerEnd;
  };
  // ModemManager has one state for all domains: "registered" refers to the technology in use only, "not registered" to
  // every technology that the modem supports.
  std::optional<Mark> placeMark() noexcept;
  // The type that was requested, or that its addresses show; EPS bearers have types of their own.
  void recallMark(const Mark& mark) noexcept;

  // Turns a modem's state into metric events, one for each metric whose content has changed.
  //
  // Values that become unknown are withdrawn: the metric is sent again with the remaining ones, in the end with its
  // timestamp only. An empty list cannot be distinguished from one that is not sent, so it is sent as one element
  // without content.
  [[nodiscard]] bool skip(WireKey key) noexcept;
  static constexpr std::size_t maximumGroupDepth = 100;

 private:
  // Returns the events that update a viewer to `state`, at `time` since 1970-01-01 00:00 UTC.
  struct LongVarint {
    std::uint64_t value;
    const std::uint8_t* next;  // The last known SIM card files, as the event that answers a query; empty when none are
                               // known.
  };
  // Adds an event when `message`, still without timestamp, differs from the last one.
  static LongVarint readLongVarint(const std::uint8_t* at, const std::uint8_t* end,
                                   const std::uint8_t* bufferEnd) noexcept;
  [[gnu::always_inline]] bool skipBytes(std::uint64_t count) noexcept {
    if (failed_ || count > static_cast<std::uint64_t>(end_ - at_)) {
      failed_ = true;
      return false;
    }
    at_ += count;
    return true;
  }
  bool skipGroup(std::uint16_t fieldNumber) noexcept;
  bool skipPlain(WireType wireType) noexcept;

  const std::uint8_t* begin_;
  const std::uint8_t* at_;
  const std::uint8_t* end_;
  const std::uint8_t* bufferEnd_;  // Whether a list of `size` elements must be sent with one element without content,
                                   // because it had some before.
  bool failed_ = false;
};

}  // namespace vespscope
