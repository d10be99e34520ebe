// The entries of a message class's field table: number, schema name and storage of each field, in tag order.
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

// How a number is written and shown.
enum class NumberKind { uint64, uint32, int32, sint32, boolean, enumeration };

// An optional number with a presence bit. `names` is for enumerations.
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

// Bytes or a text, absent when null.
template <class Owner, class Content>
struct ContentField {
  static constexpr WireType wireType = WireType::lengthDelimited;
  static constexpr bool isList = false;
  std::uint16_t number;
  std::string_view name;
  std::shared_ptr<const Content> Owner::*member;
};

// An embedded message, absent when null.
template <class Owner, class Embedded>
struct MessageField {
  static constexpr WireType wireType = WireType::lengthDelimited;
  static constexpr bool isList = false;
  std::uint16_t number;
  std::string_view name;
  std::shared_ptr<Embedded> Owner::*member;
};

// A repeated embedded message.
template <class Owner, class Element>
struct MessageListField {
  static constexpr WireType wireType = WireType::lengthDelimited;
  static constexpr bool isList = true;
  std::uint16_t number;
  std::string_view name;
  MessageList<Element> Owner::*member;
};

// A repeated number, written packed.
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
