// The operations of messages on one field, written once per shape of field. `presence` is the presence word of the
// message that holds the field.
#pragma once

#include <algorithm>
#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string_view>
#include <utility>

#include "messages/ContentHash.h"
#include "messages/FieldTable.h"
#include "messages/NumberKinds.h"
#include "messages/WireReader.h"
#include "messages/WireWriter.h"
#include "values/Key.h"
#include "values/Value.h"

namespace vespscope::fields {

// True for a field without a presence bit that has something to show.
template <NumberKind Kind, class Owner, class Stored>
constexpr bool isThere(const NumberField<Kind, Owner, Stored>& /*field*/, const Owner& /*owner*/) {
  return false;
}
template <class Field, class Owner>
bool isThere(const Field& field, const Owner& owner) {
  if constexpr (requires { (owner.*field.member).size(); }) {
    return (owner.*field.member).size() != 0;
  } else {
    return owner.*field.member != nullptr;
  }
}

// Optional numbers.

template <NumberKind Kind, class Owner, class Stored, class Presence>
[[gnu::always_inline]] inline bool read(const NumberField<Kind, Owner, Stored>& field, Owner& owner, Presence& presence,
                                        WireReader& reader, WireType) {
  presence.set(field.bit);
  owner.*field.member = fromVarint<Kind>(reader.readVarint());
  return true;
}

template <NumberKind Kind, class Owner, class Stored, class Presence>
void write(const NumberField<Kind, Owner, Stored>& field, const Owner& owner, const Presence& presence,
           WireWriter& writer) {
  if (presence.test(field.bit)) writeNumber<Kind>(writer, owner.*field.member, field.number);
}

template <NumberKind Kind, class Owner, class Stored, class Presence>
void addTo(Record& record, const NumberField<Kind, Owner, Stored>& field, const Owner& owner,
           const Presence& presence) {
  if (!presence.test(field.bit)) return;
  if constexpr (Kind == NumberKind::enumeration) {
    record.append(Key::ofStatic(field.name), enumerationValue(field.names, owner.*field.member));
  } else {
    record.append(Key::ofStatic(field.name), owner.*field.member);
  }
}

template <NumberKind Kind, class Owner, class Stored, class Presence>
bool equal(const NumberField<Kind, Owner, Stored>& field, const Owner& one, const Presence& onePresence,
           const Owner& other, const Presence& otherPresence) {
  const bool present = onePresence.test(field.bit);
  return present == otherPresence.test(field.bit) && (!present || one.*field.member == other.*field.member);
}

template <NumberKind Kind, class Owner, class Stored, class Presence>
std::uint64_t hash(const NumberField<Kind, Owner, Stored>& field, const Owner& owner, const Presence& presence) {
  return presence.test(field.bit) ? hashOfNumber(owner.*field.member) : 0;
}

template <NumberKind Kind, class Owner, class Stored, class Presence>
void share(const NumberField<Kind, Owner, Stored>& field, const Owner& from, const Presence& fromPresence, Owner& to,
           Presence& toPresence) {
  if (!fromPresence.test(field.bit)) return;
  to.*field.member = from.*field.member;
  toPresence.set(field.bit);
}

template <NumberKind Kind, class Owner, class Stored, class Presence>
void copy(const NumberField<Kind, Owner, Stored>& field, const Owner& from, const Presence& fromPresence, Owner& to,
          Presence& toPresence) {
  share(field, from, fromPresence, to, toPresence);
}

template <NumberKind Kind, class Owner, class Stored, class Presence>
void merge(const NumberField<Kind, Owner, Stored>& field, const Owner& from, const Presence& fromPresence, Owner& to,
           Presence& toPresence) {
  share(field, from, fromPresence, to, toPresence);
}

// Bytes and texts.

template <class Content>
[[gnu::noinline]] void replace(std::shared_ptr<const Content>& content,
                               std::optional<std::span<const std::uint8_t>> bytes) {
  content = bytes ? makeCached<const Content>(bytes->begin(), bytes->end()) : nullptr;
}

template <class Owner, class Content, class Presence>
[[gnu::always_inline]] inline bool read(const ContentField<Owner, Content>& field, Owner& owner, Presence&,
                                        WireReader& reader, WireType) {
  replace(owner.*field.member, reader.readDelimited());
  return true;
}

template <class Owner, class Content, class Presence>
void write(const ContentField<Owner, Content>& field, const Owner& owner, const Presence&, WireWriter& writer) {
  const auto& content = owner.*field.member;
  if (content == nullptr) return;
  if constexpr (std::is_same_v<Content, Bytes>) {
    writer.writeBytes(*content, field.number);
  } else {
    writer.writeString(*content, field.number);
  }
}

template <class Owner, class Content, class Presence>
void addTo(Record& record, const ContentField<Owner, Content>& field, const Owner& owner, const Presence&) {
  if (const auto& content = owner.*field.member) record.append(Key::ofStatic(field.name), content);
}

template <class Owner, class Content, class Presence>
bool equal(const ContentField<Owner, Content>& field, const Owner& one, const Presence&, const Owner& other,
           const Presence&) {
  const auto& left = one.*field.member;
  const auto& right = other.*field.member;
  return left == right || (left != nullptr && right != nullptr && *left == *right);
}

template <class Owner, class Content, class Presence>
std::uint64_t hash(const ContentField<Owner, Content>& field, const Owner& owner, const Presence&) {
  const auto& content = owner.*field.member;
  return content == nullptr ? 0 : contentHash(*content);
}

template <class Owner, class Content, class Presence>
void share(const ContentField<Owner, Content>& field, const Owner& from, const Presence&, Owner& to, Presence&) {
  if (from.*field.member != nullptr) to.*field.member = from.*field.member;
}

template <class Owner, class Content, class Presence>
void copy(const ContentField<Owner, Content>& field, const Owner& from, const Presence&, Owner& to, Presence&) {
  if (const auto& content = from.*field.member) to.*field.member = std::make_shared<const Content>(*content);
}

template <class Owner, class Content, class Presence>
void merge(const ContentField<Owner, Content>& field, const Owner& from, const Presence& fromPresence, Owner& to,
           Presence& toPresence) {
  share(field, from, fromPresence, to, toPresence);
}

// Embedded messages.

// How the read of an embedded message ended; `truncated` sets the outer reader's error flag too.
enum class Ending { success, failure, truncated };

template <class Embedded>
Ending readEmbedded(Embedded& message, WireReader reader) {
  if (message.readFrom(reader)) return Ending::success;
  return reader.failed() ? Ending::truncated : Ending::failure;
}

[[gnu::always_inline]] inline bool goOn(WireReader& reader, Ending ending) {
  if (ending == Ending::truncated) reader.fail();
  return ending == Ending::success;
}

template <class Embedded>
[[gnu::noinline]] Ending readNew(std::shared_ptr<Embedded>& message, const WireReader& reader) {
  message = makeCached<Embedded>();
  return readEmbedded(*message, reader);
}

template <class Owner, class Embedded, class Presence>
[[gnu::always_inline]] inline bool read(const MessageField<Owner, Embedded>& field, Owner& owner, Presence&,
                                        WireReader& reader, WireType) {
  const auto value = reader.readDelimited();
  return value && goOn(reader, readNew(owner.*field.member, reader.within(*value)));
}

template <class Owner, class Embedded, class Presence>
void write(const MessageField<Owner, Embedded>& field, const Owner& owner, const Presence&, WireWriter& writer) {
  if (const auto& message = owner.*field.member) writer.writeMessage(*message, field.number);
}

template <class Owner, class Embedded, class Presence>
void addTo(Record& record, const MessageField<Owner, Embedded>& field, const Owner& owner, const Presence&) {
  if (const auto& message = owner.*field.member) {
    record.append(Key::ofStatic(field.name), message->dictionaryRepresentation());
  }
}

template <class Owner, class Embedded, class Presence>
bool equal(const MessageField<Owner, Embedded>& field, const Owner& one, const Presence&, const Owner& other,
           const Presence&) {
  const auto& left = one.*field.member;
  const auto& right = other.*field.member;
  return left == right || (left != nullptr && right != nullptr && left->isEqual(*right));
}

template <class Owner, class Embedded, class Presence>
std::uint64_t hash(const MessageField<Owner, Embedded>& field, const Owner& owner, const Presence&) {
  const auto& message = owner.*field.member;
  return message == nullptr ? 0 : message->hash();
}

template <class Owner, class Embedded, class Presence>
void share(const MessageField<Owner, Embedded>& field, const Owner& from, const Presence&, Owner& to, Presence&) {
  if (from.*field.member != nullptr) to.*field.member = from.*field.member;
}

template <class Owner, class Embedded, class Presence>
void copy(const MessageField<Owner, Embedded>& field, const Owner& from, const Presence&, Owner& to, Presence&) {
  if (const auto& message = from.*field.member) to.*field.member = message->copyWithZone();
}

template <class Owner, class Embedded, class Presence>
void merge(const MessageField<Owner, Embedded>& field, const Owner& from, const Presence& fromPresence, Owner& to,
           Presence& toPresence) {
  if (to.*field.member == nullptr) {
    share(field, from, fromPresence, to, toPresence);
  } else if (from.*field.member != nullptr) {
    (to.*field.member)->mergeFrom(*(from.*field.member));
  }
}

// Repeated embedded messages.

template <class Element>
[[gnu::noinline]] Ending readNew(MessageList<Element>& list, const WireReader& reader) {
  auto element = makeCached<Element>();
  Element& added = *element;
  list.add(std::move(element));
  return readEmbedded(added, reader);
}

template <class Owner, class Element, class Presence>
[[gnu::always_inline]] inline bool read(const MessageListField<Owner, Element>& field, Owner& owner, Presence&,
                                        WireReader& reader, WireType) {
  const auto value = reader.readDelimited();
  return value && goOn(reader, readNew(owner.*field.member, reader.within(*value)));
}

template <class Owner, class Element, class Presence>
void write(const MessageListField<Owner, Element>& field, const Owner& owner, const Presence&, WireWriter& writer) {
  for (const auto& element : owner.*field.member) writer.writeMessage(*element, field.number);
}

template <class Owner, class Element, class Presence>
void addTo(Record& record, const MessageListField<Owner, Element>& field, const Owner& owner, const Presence&) {
  const auto& elements = owner.*field.member;
  if (elements.size() == 0) return;
  List list;
  list.reserve(elements.size());
  for (const auto& element : elements) list.emplace_back(element->dictionaryRepresentation());
  record.append(Key::ofStatic(field.name), std::move(list));
}

template <class Owner, class Element, class Presence>
bool equal(const MessageListField<Owner, Element>& field, const Owner& one, const Presence&, const Owner& other,
           const Presence&) {
  const auto& left = one.*field.member;
  const auto& right = other.*field.member;
  return left.exists() == right.exists() && std::equal(left.begin(), left.end(), right.begin(), right.end(),
                                                       [](const auto& leftElement, const auto& rightElement) {
                                                         return leftElement->isEqual(*rightElement);
                                                       });
}

template <class Owner, class Element, class Presence>
std::uint64_t hash(const MessageListField<Owner, Element>& field, const Owner& owner, const Presence&) {
  std::uint64_t result = 0;
  for (const auto& element : owner.*field.member) result = addToHash(result, element->hash());
  return result;
}

template <class Owner, class Element, class Presence>
void share(const MessageListField<Owner, Element>& field, const Owner& from, const Presence&, Owner& to, Presence&) {
  if ((from.*field.member).size() == 0 || &from == &to) return;
  (to.*field.member).clear();
  for (const auto& element : from.*field.member) (to.*field.member).add(element);
}

template <class Owner, class Element, class Presence>
void copy(const MessageListField<Owner, Element>& field, const Owner& from, const Presence&, Owner& to, Presence&) {
  for (const auto& element : from.*field.member) (to.*field.member).add(element->copyWithZone());
}

template <class Owner, class Element, class Presence>
void merge(const MessageListField<Owner, Element>& field, const Owner& from, const Presence&, Owner& to, Presence&) {
  const std::size_t count = (from.*field.member).size();
  for (std::size_t index = 0; index < count; ++index) (to.*field.member).add((from.*field.member).at(index));
}

// Repeated numbers.

template <NumberKind Kind, class Stored>
[[gnu::noinline]] Ending readPacked(NumberList<Stored>& numbers, WireReader reader) {
  while (reader.hasMore()) numbers.add(fromVarint<Kind>(reader.readVarint()));
  return reader.failed() ? Ending::truncated : Ending::success;
}

template <NumberKind Kind, class Owner, class Stored, class Presence>
[[gnu::always_inline]] inline bool read(const NumberListField<Kind, Owner, Stored>& field, Owner& owner, Presence&,
                                        WireReader& reader, WireType wireType) {
  auto& numbers = owner.*field.member;
  if (wireType != WireType::lengthDelimited) {
    numbers.add(fromVarint<Kind>(reader.readVarint()));
    return true;
  }
  const auto value = reader.readDelimited();
  return value && goOn(reader, readPacked<Kind>(numbers, reader.within(*value)));
}

template <NumberKind Kind, class Owner, class Stored, class Presence>
void write(const NumberListField<Kind, Owner, Stored>& field, const Owner& owner, const Presence&, WireWriter& writer) {
  const auto& numbers = owner.*field.member;
  if (numbers.size() == 0) return;
  const WireWriter::Mark mark = writer.placeMark(field.number);
  for (const Stored number : numbers.values()) writeNumber<Kind>(writer, number, WireWriter::noField);
  writer.recallMark(mark);
}

template <NumberKind Kind, class Owner, class Stored, class Presence>
void addTo(Record& record, const NumberListField<Kind, Owner, Stored>& field, const Owner& owner, const Presence&) {
  const auto& numbers = (owner.*field.member).values();
  if (!numbers.empty()) record.append(Key::ofStatic(field.name), List(numbers.begin(), numbers.end()));
}

template <NumberKind Kind, class Owner, class Stored, class Presence>
bool equal(const NumberListField<Kind, Owner, Stored>& field, const Owner& one, const Presence&, const Owner& other,
           const Presence&) {
  return (one.*field.member).values() == (other.*field.member).values();
}

template <NumberKind Kind, class Owner, class Stored, class Presence>
std::uint64_t hash(const NumberListField<Kind, Owner, Stored>& field, const Owner& owner, const Presence&) {
  std::uint64_t result = 0;
  for (const Stored number : (owner.*field.member).values()) result = addToHash(result, hashOfNumber(number));
  return result;
}

template <NumberKind Kind, class Owner, class Stored, class Presence>
void share(const NumberListField<Kind, Owner, Stored>& field, const Owner& from, const Presence&, Owner& to,
           Presence&) {
  if ((from.*field.member).size() != 0) to.*field.member = from.*field.member;
}

template <NumberKind Kind, class Owner, class Stored, class Presence>
void copy(const NumberListField<Kind, Owner, Stored>& field, const Owner& from, const Presence& fromPresence, Owner& to,
          Presence& toPresence) {
  share(field, from, fromPresence, to, toPresence);
}

template <NumberKind Kind, class Owner, class Stored, class Presence>
void merge(const NumberListField<Kind, Owner, Stored>& field, const Owner& from, const Presence&, Owner& to,
           Presence&) {
  const std::size_t count = (from.*field.member).size();
  for (std::size_t index = 0; index < count; ++index) (to.*field.member).add((from.*field.member).at(index));
}

}  // namespace vespscope::fields
