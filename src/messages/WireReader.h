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

// A key: three bits of wire type below the field number, which is taken modulo 65536.
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

  // Part by part: a copy of the whole at once, which the compiler would make of a default one, would wait until the
  // parts, stored just before, have reached the cache.
  // NOLINTNEXTLINE(modernize-use-equals-default)
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

  // Steps over the key `key`, encoded as short as it can be, if it comes next; at most two bytes.
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
  // Goes to where `copy`, a copy of this reader with the same marks, has come to.
  [[gnu::always_inline]] void goOnFrom(const WireReader& copy) noexcept {
    at_ = copy.at_;
    failed_ = copy.failed_;
  }
  // Sets the error flag, as after a failure of a reader within.
  void fail() noexcept { failed_ = true; }

  struct Mark {
    const std::uint8_t* valueEnd;
    const std::uint8_t* outerEnd;
  };
  // Reads a length and makes the end of that value the end of reading; nothing, with the error flag set, when the
  // value reaches past the end.
  std::optional<Mark> placeMark() noexcept;
  // Goes to the end of the marked value and takes back the end of reading that was before.
  void recallMark(const Mark& mark) noexcept;

  // Skips the value of a field that nobody knows. False for a wire type that does not exist, for a group without its
  // matching end or nested more than maximumGroupDepth deep, and for a value that reaches past the end.
  [[nodiscard]] bool skip(WireKey key) noexcept;
  static constexpr std::size_t maximumGroupDepth = 100;

 private:
  // Small enough to come back in two registers.
  struct LongVarint {
    std::uint64_t value;
    const std::uint8_t* next;  // null after a failure
  };
  // Takes and gives plain values, so that a reader on the stack can live in registers.
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
  const std::uint8_t* bufferEnd_;  // as far as memory may be looked at, though not taken
  bool failed_ = false;
};

}  // namespace vespscope
