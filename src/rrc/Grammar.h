// The tables that the reader interprets: every type, field, range and name of the RRC messages.
//
// `rrcgen` writes them from the ASN.1 definitions of 3GPP TS 36.331 and TS 38.331 into tables/.
#pragma once

#include <cstdint>
#include <limits>
#include <string_view>

namespace vespscope::rrc {

using TypeId = std::uint16_t;
using NameId = std::uint16_t;

// The name of what has none: elements of lists, groups of extension additions.
inline constexpr NameId noName = 0;

enum class Kind : std::uint8_t {
  unknown,  // content of a later release, read by its length
  null,
  boolean,
  integer,
  enumerated,
  bitString,
  octetString,
  list,  // SEQUENCE OF
  sequence,
  choice,
};

struct Type {
  std::uint8_t kindNumber;  // of Kind
  std::uint8_t extensible;  // 1 when an extension marker is there
  std::uint16_t count;      // fields, alternatives or items before the extension marker
  std::uint16_t extra;      // known ones behind it; a group of fields counts once
  std::uint16_t
      range;  // integer: its values; strings and lists: their sizes; sequence: how many of `count` are optional
  std::uint32_t first;  // compounds: their first field; enumerated: its first item; list: the type of an element;
                        // octet string: the type of its content, or 0

  [[nodiscard]] constexpr Kind kind() const { return static_cast<Kind>(kindNumber); }
};

// A field of a sequence or an alternative of a choice. A group of extension additions is a field without a name whose
// type is a sequence.
struct Field {
  NameId name;
  std::uint16_t typeAndOptional;  // the optional mark is the highest bit

  static constexpr std::uint16_t optionalMark = 0x8000;
  [[nodiscard]] constexpr TypeId type() const { return typeAndOptional & (optionalMark - 1); }
  [[nodiscard]] constexpr bool optional() const { return (typeAndOptional & optionalMark) != 0; }
};

// Inclusive.
struct Range {
  std::int64_t lower;
  std::int64_t upper;

  static constexpr std::int64_t unbounded = std::numeric_limits<std::int64_t>::max();
  static constexpr std::int64_t unboundedBelow = std::numeric_limits<std::int64_t>::min();
};

// The tables of the messages in Pdu.h.
namespace grammar {

extern const Type types[];
extern const Field fields[];
extern const NameId items[];  // the names of enumerated values
extern const Range ranges[];

}  // namespace grammar

}  // namespace vespscope::rrc
