#include "rrc/Decoder.h"

#include <algorithm>
#include <bit>

namespace vespscope::rrc {

bool Decoder::fail(FaultKind kind) {
  fault_ = {kind, bits_.position()};
  return false;
}

inline bool Decoder::readIndex(std::uint64_t count, std::uint64_t& index) {
  index = 0;
  if (count < 2) return true;
  const std::size_t begin = bits_.position();
  if (!readBits(static_cast<unsigned>(std::bit_width(count - 1)), index)) return false;
  if (index < count) return true;
  bits_.setPosition(begin);
  return fail(FaultKind::outOfRange);
}

bool Decoder::readLength(std::uint64_t& length) {
  std::uint64_t isLong = 0;
  if (!readBits(1, isLong)) return false;
  if (isLong == 0) return readBits(7, length);
  std::uint64_t isFragmented = 0;
  if (!readBits(1, isFragmented)) return false;
  return isFragmented == 0 ? readBits(14, length) : fail(FaultKind::fragmented);
}

bool Decoder::readSmallNumber(std::uint64_t& number) {
  std::uint64_t isLarge = 0;
  if (!readBits(1, isLarge)) return false;
  if (isLarge == 0) return readBits(6, number);
  std::uint64_t length = 0;
  if (!readLength(length)) return false;
  if (length > 4) return fail(FaultKind::outOfRange);
  return readBits(static_cast<unsigned>(8 * length), number);
}

bool Decoder::readSize(const Type& type, std::uint64_t& size) {
  std::uint64_t isExtended = 0;
  if (type.extensible != 0 && !readBits(1, isExtended)) return false;
  const Range& range = grammar::ranges[type.range];
  constexpr std::int64_t tooLargeToCount = 65536;
  if (isExtended != 0 || range.upper >= tooLargeToCount) {
    if (!readLength(size)) return false;
    return isExtended != 0 || static_cast<std::int64_t>(size) >= range.lower || fail(FaultKind::outOfRange);
  }
  if (!readIndex(static_cast<std::uint64_t>(range.upper - range.lower) + 1, size)) return false;
  size += static_cast<std::uint64_t>(range.lower);
  return true;
}

template <class Content>
bool Decoder::readOpenType(Content content) {
  std::uint64_t length = 0;
  if (!readLength(length)) return false;
  if (8 * length > bits_.left()) return fail(FaultKind::truncated);
  const std::size_t outer = bits_.limit();
  const std::size_t end = bits_.position() + 8 * length;
  bits_.setLimit(end);
  if (!content()) return false;
  bits_.setPosition(end);
  bits_.setLimit(outer);
  return true;
}

bool Decoder::grow() {
  if (count_ >= mostNodes) return fail(FaultKind::tooManyValues);
  constexpr std::size_t atFirst = 512;
  nodes_.resize(std::max(atFirst, 2 * nodes_.size()));
  return true;
}

bool Decoder::readUnknown() {
  if (!makeRoom()) return false;
  Node& node = nodes_[count_++];
  node = Node();
  node.bit = static_cast<std::uint32_t>(bits_.position());
  node.bits = static_cast<std::uint32_t>(bits_.left());
  node.end = static_cast<std::uint32_t>(count_);
  return true;
}

inline bool Decoder::readInteger(const Type& type, std::int64_t& value) {
  const Range& range = grammar::ranges[type.range];
  std::uint64_t isExtended = 0;
  if (type.extensible != 0 && !readBits(1, isExtended)) return false;
  if (isExtended != 0) return readUnbounded({Range::unboundedBelow, Range::unbounded}, value);
  if (range.lower == Range::unboundedBelow || range.upper == Range::unbounded) return readUnbounded(range, value);
  std::uint64_t offset = 0;
  if (!readIndex(static_cast<std::uint64_t>(range.upper - range.lower) + 1, offset)) return false;
  value = range.lower + static_cast<std::int64_t>(offset);
  return true;
}

inline bool Decoder::readEnumerated(const Type& type, std::int64_t& value) {
  std::uint64_t isExtended = 0;
  std::uint64_t index = 0;
  if (type.extensible != 0 && !readBits(1, isExtended)) return false;
  if (isExtended == 0) {
    if (!readIndex(type.count, index)) return false;
  } else {
    if (!readSmallNumber(index)) return false;
    index += type.count;
  }
  value = static_cast<std::int64_t>(index);
  return true;
}

inline bool Decoder::readContent(const Type& type, std::size_t index) {
  std::int64_t value = 0;
  bool read = true;
  switch (type.kind()) {
    case Kind::unknown:
    case Kind::null:
      break;
    case Kind::boolean: {
      std::uint64_t bit = 0;
      read = readBits(1, bit);
      value = static_cast<std::int64_t>(bit);
      break;
    }
    case Kind::integer:
      read = readInteger(type, value);
      break;
    case Kind::enumerated:
      read = readEnumerated(type, value);
      break;
    case Kind::bitString:
      return readBitString(type, index);
    case Kind::octetString:
      return readOctetString(type, index);
    case Kind::list:
      read = readList(type, value);
      break;
    case Kind::sequence:
      return readSequence(type);
    case Kind::choice:
      read = readChoice(type, value);
      break;
  }
  nodes_[index].value = value;
  return read;
}

bool Decoder::readValue(TypeId id, NameId name) {
  if (level_ == mostLevels) return fail(FaultKind::tooDeep);
  if (!makeRoom()) return false;
  const Type& type = grammar::types[id];
  const std::size_t index = count_++;
  const std::size_t begin = bits_.position();
  Node& node = nodes_[index];
  node.type = id;
  node.name = name;
  node.kind = type.kind();
  node.unreadable = false;
  node.bit = static_cast<std::uint32_t>(begin);
  node.value = 0;
  ++level_;
  if (!readContent(type, index)) return false;
  --level_;
  Node& done = nodes_[index];
  done.end = static_cast<std::uint32_t>(count_);
  if (done.kind != Kind::bitString && done.kind != Kind::octetString) {
    done.bits = static_cast<std::uint32_t>(bits_.position() - begin);
  }
  return true;
}

// With its length in bytes in front: an offset from the lower bound, or a number with its sign.
bool Decoder::readUnbounded(const Range& range, std::int64_t& value) {
  std::uint64_t length = 0;
  if (!readLength(length)) return false;
  constexpr std::uint64_t mostBytes = 7;
  if (length == 0 || length > mostBytes) return fail(FaultKind::outOfRange);
  const auto count = static_cast<unsigned>(8 * length);
  std::uint64_t bits = 0;
  if (!readBits(count, bits)) return false;
  if (range.lower == Range::unboundedBelow) {
    const unsigned unused = 64 - count;
    value = static_cast<std::int64_t>(bits << unused) >> unused;
  } else {
    value = range.lower + static_cast<std::int64_t>(bits);
  }
  return value <= range.upper || fail(FaultKind::outOfRange);
}

bool Decoder::readBitString(const Type& type, std::size_t index) {
  std::uint64_t size = 0;
  if (!readSize(type, size)) return false;
  nodes_[index].bit = static_cast<std::uint32_t>(bits_.position());
  nodes_[index].bits = static_cast<std::uint32_t>(size);
  return bits_.skip(size) || fail(FaultKind::truncated);
}

bool Decoder::readOctetString(const Type& type, std::size_t index) {
  std::uint64_t size = 0;
  if (!readSize(type, size)) return false;
  if (8 * size > bits_.left()) return fail(FaultKind::truncated);
  const std::size_t begin = bits_.position();
  const std::size_t end = begin + 8 * size;
  nodes_[index].bit = static_cast<std::uint32_t>(begin);
  nodes_[index].bits = static_cast<std::uint32_t>(8 * size);
  if (type.first != 0) {
    // What the string holds is a message of its own: when it cannot be read, the rest of this one can.
    const std::size_t outer = bits_.limit();
    const unsigned level = level_;
    bits_.setLimit(end);
    if (!readValue(static_cast<TypeId>(type.first), noName)) {
      if (fault_.kind == FaultKind::tooManyValues || fault_.kind == FaultKind::tooDeep) return false;
      count_ = index + 1;
      nodes_[index].unreadable = true;
      level_ = level;
    }
    bits_.setLimit(outer);
  }
  bits_.setPosition(end);
  return true;
}

bool Decoder::readList(const Type& type, std::int64_t& count) {
  std::uint64_t size = 0;
  if (!readSize(type, size)) return false;
  count = static_cast<std::int64_t>(size);
  for (; size > 0; --size) {
    if (!readValue(static_cast<TypeId>(type.first), noName)) return false;
  }
  return true;
}

bool Decoder::readSequence(const Type& type) {
  std::uint64_t isExtended = 0;
  if (type.extensible != 0 && !readBits(1, isExtended)) return false;
  const std::size_t optionals = bits_.position();
  if (!bits_.skip(type.range)) return fail(FaultKind::truncated);
  return readFields(type, optionals) && (isExtended == 0 || readAdditions(type));
}

// The fields before the extension marker; the bits at `optionals` say which of the optional ones are there.
bool Decoder::readFields(const Type& type, std::size_t optionals) {
  for (std::size_t index = 0; index < type.count; ++index) {
    const Field& field = grammar::fields[type.first + index];
    if (field.optional() && bits_.peek(optionals++, 1) == 0) continue;
    if (!readValue(field.type(), field.name)) return false;
  }
  return true;
}

bool Decoder::readAdditions(const Type& type) {
  std::uint64_t count = 0;
  if (!readSmallNumber(count)) return false;
  ++count;
  const std::size_t present = bits_.position();
  if (!bits_.skip(count)) return fail(FaultKind::truncated);
  for (std::uint64_t addition = 0; addition < count; ++addition) {
    if (bits_.peek(present + addition, 1) == 0) continue;
    if (!readOpenType([&] { return readAddition(type, addition); })) return false;
  }
  return true;
}

bool Decoder::readAddition(const Type& type, std::uint64_t addition) {
  if (addition >= type.extra) return readUnknown();
  const Field& field = grammar::fields[type.first + type.count + addition];
  return field.name == noName ? readSequence(grammar::types[field.type()]) : readValue(field.type(), field.name);
}

bool Decoder::readChoice(const Type& type, std::int64_t& chosen) {
  std::uint64_t isExtended = 0;
  std::uint64_t index = 0;
  if (type.extensible != 0 && !readBits(1, isExtended)) return false;
  if (isExtended == 0) {
    if (!readIndex(type.count, index)) return false;
    chosen = static_cast<std::int64_t>(index);
    const Field& field = grammar::fields[type.first + index];
    return readValue(field.type(), field.name);
  }
  if (!readSmallNumber(index)) return false;
  chosen = static_cast<std::int64_t>(type.count + index);
  return readOpenType([&] { return readAddition(type, index); });
}

}  // namespace vespscope::rrc
