// The same for an unsigned field.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <tuple>

#include "messages/Enumeration.h"
#include "messages/Storage.h"
#include "messages/WireReader.h"
#include "values/Value.h"

namespace vespscope {

// Whether a receiver can report this RSSI.
enum class NumberKind { uint64, uint32, int32, sint32, boolean, enumeration };

// The serving cell according to two answers, the modem's location and its cells. They are given at different moments:
// if they name different cells, values that only the second answer has are omitted.
template <NumberKind Kind, class Owner, class Stored>
struct NumberField {
  static constexpr NumberKind kind = Kind;
  static constexpr WireType wireType = WireType::varint;
  static constexpr bool isList = false;
  std::uint16_t number;
  std::string_view name;
  Stored Owner::*member;
  unsigned bit;
  EnumerationNames names;
};

// A neighbour of each technology with the field names of the serving cell.
template <class Owner, class Content>
struct ContentField {
  static constexpr WireType wireType = WireType::lengthDelimited;
  static constexpr bool isList = false;
  std::uint16_t number;
  std::string_view name;
  std::shared_ptr<const Content> Owner::*member;
};

// Sets the same fields in two messages.
template <class Owner, class Embedded>
struct MessageField {
  static constexpr WireType wireType = WireType::lengthDelimited;
  static constexpr bool isList = false;
  std::uint16_t number;
  std::string_view name;
  std::shared_ptr<Embedded> Owner::*member;
};

// ModemManager reports one value for the cell, not one per antenna.
template <class Owner, class Element>
struct MessageListField {
  static constexpr WireType wireType = WireType::lengthDelimited;
  static constexpr bool isList = true;
  std::uint16_t number;
  std::string_view name;
  MessageList<Element> Owner::*member;
};

// Fills one list of a message, or clears it.
template <NumberKind Kind, class Owner, class Stored>
struct NumberListField {
  static constexpr NumberKind kind = Kind;
  static constexpr WireType wireType = WireType::lengthDelimited;
  static constexpr bool isList = false;
  std::uint16_t number;
  std::string_view name;
  NumberList<Stored> Owner::*member;
};

template <NumberKind Kind, class Owner, class Stored>
consteval auto numberField(std::uint16_t number, std::string_view name, Stored Owner::*member, unsigned bit) {
  return NumberField<Kind, Owner, Stored>{number, name, member, bit, {}};
}

template <class Owner>
consteval auto enumerationField(std::uint16_t number, std::string_view name, std::int32_t Owner::*member, unsigned bit,
                                EnumerationNames names) {
  return NumberField<NumberKind::enumeration, Owner, std::int32_t>{number, name, member, bit, names};
}

template <class Owner, class Content>
consteval auto contentField(std::uint16_t number, std::string_view name,
                            std::shared_ptr<const Content> Owner::*member) {
  return ContentField<Owner, Content>{number, name, member};
}

template <class Owner, class Embedded>
consteval auto messageField(std::uint16_t number, std::string_view name, std::shared_ptr<Embedded> Owner::*member) {
  return MessageField<Owner, Embedded>{number, name, member};
}

template <class Owner, class Element>
consteval auto messageListField(std::uint16_t number, std::string_view name, MessageList<Element> Owner::*member) {
  return MessageListField<Owner, Element>{number, name, member};
}

template <NumberKind Kind, class Owner, class Stored>
consteval auto numberListField(std::uint16_t number, std::string_view name, NumberList<Stored> Owner::*member) {
  return NumberListField<Kind, Owner, Stored>{number, name, member};
}

}  // namespace vespscope
