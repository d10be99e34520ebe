// Interprets the grammar over the bits of one message and lists the values that it finds.
#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

#include "rrc/BitReader.h"
#include "rrc/Fault.h"
#include "rrc/Grammar.h"
#include "rrc/Message.h"

namespace vespscope::rrc {

class Decoder {
 public:
  // Deeper and longer than messages get: a reconfiguration with one of NR inside has 40 levels.
  static constexpr unsigned mostLevels = 128;
  static constexpr std::size_t mostNodes = 262'144;

  // `nodes` is the memory for the values, and grows as needed.
  Decoder(std::span<const std::uint8_t> bytes, std::vector<Node>& nodes) : bits_(bytes), nodes_(nodes) {}

  // False when the bytes are not a value of the type; the values are then of no use.
  [[nodiscard]] bool read(TypeId type) { return readValue(type, noName); }
  [[nodiscard]] const Fault& fault() const { return fault_; }
  // How many values there are.
  [[nodiscard]] std::size_t count() const { return count_; }

 private:
  // What all of these return: false after a fault.
  bool fail(FaultKind kind);
  // Room for one more value; false when there are too many.
  bool makeRoom() { return count_ < nodes_.size() || grow(); }
  bool grow();
  bool readValue(TypeId id, NameId name);
  bool readContent(const Type& type, std::size_t index);
  bool readInteger(const Type& type, std::int64_t& value);
  bool readUnbounded(const Range& range, std::int64_t& value);
  bool readEnumerated(const Type& type, std::int64_t& value);
  bool readBitString(const Type& type, std::size_t index);
  bool readOctetString(const Type& type, std::size_t index);
  bool readList(const Type& type, std::int64_t& count);
  bool readSequence(const Type& type);
  bool readFields(const Type& type, std::size_t optionals);
  bool readAdditions(const Type& type);
  bool readAddition(const Type& type, std::uint64_t addition);
  bool readChoice(const Type& type, std::int64_t& chosen);
  bool readUnknown();
  bool readBits(unsigned count, std::uint64_t& value) { return bits_.read(count, value) || fail(FaultKind::truncated); }
  // An index below `count` in as few bits as hold it.
  bool readIndex(std::uint64_t count, std::uint64_t& index);
  // A number that is small as a rule: additions to extension marks.
  bool readSmallNumber(std::uint64_t& number);
  bool readLength(std::uint64_t& length);
  // The size of a string or list.
  bool readSize(const Type& type, std::uint64_t& size);
  // Reads with `content`, which sees only what the length in front announces, and goes to the end of that.
  template <class Content>
  bool readOpenType(Content content);

  BitReader bits_;
  std::vector<Node>& nodes_;
  std::size_t count_ = 0;
  Fault fault_;
  unsigned level_ = 0;
};

}  // namespace vespscope::rrc
