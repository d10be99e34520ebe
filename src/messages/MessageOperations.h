// The operations of every message class, written once over its field table. Included only where a class's operations
// are compiled.
#pragma once

#include <memory>
#include <tuple>
#include <typeinfo>

#include "messages/FieldOperations.h"
#include "messages/Message.h"
#include "messages/MetricTags.h"
#include "messages/WireReader.h"
#include "messages/WireWriter.h"

namespace vespscope {
namespace fields {

template <class Self>
inline constexpr auto table = Self::template fieldTable<Self>();

// Calls `visitor` with every field of `Self`, in tag order.
template <class Self, class Visitor>
void forEach(Visitor&& visitor) {
  std::apply([&visitor](const auto&... field) { (visitor(field), ...); }, table<Self>);
}

// Calls `visitor` with the fields of `Self`, in tag order, until it returns true; false when it never does.
template <class Self, class Visitor>
bool findIf(Visitor&& visitor) {
  return std::apply([&visitor](const auto&... field) { return (visitor(field) || ...); }, table<Self>);
}

// Reads the field at `index` of the table if its key, as writers write it, comes next; every element of a list. False
// when the read has to end.
template <class Self, std::size_t index, class Presence>
[[gnu::always_inline]] inline bool readIfNext(Self& message, Presence& presence, WireReader& reader) {
  constexpr const auto& field = std::get<index>(table<Self>);
  // The registry comes before the known fields: a field whose number is a metric tag is not read here.
  if constexpr (!isMetricTag(field.number)) {
    constexpr std::uint32_t key = std::uint32_t{field.number} << 3 | static_cast<std::uint32_t>(field.wireType);
    if constexpr (field.isList) {
      while (reader.takeKey<key>()) {
        if (!read(field, message, presence, reader, field.wireType)) return false;
      }
    } else if (reader.takeKey<key>()) {
      return read(field, message, presence, reader, field.wireType);
    }
  }
  return true;
}

// Reads the fields that come in tag order, which is how they are written: each key is then predicted by the one before
// it, which a jump by number never is. Stops at the first key that comes otherwise. False when the read has to end.
template <class Self, class Presence>
[[gnu::always_inline]] inline bool readInOrder(Self& message, Presence& presence, WireReader& reader) {
  return [&]<std::size_t... index>(std::index_sequence<index...>) __attribute__((always_inline)) {
    return (readIfNext<Self, index>(message, presence, reader) && ...);
  }
  (std::make_index_sequence<std::tuple_size_v<decltype(Self::template fieldTable<Self>())>>());
}

}  // namespace fields

template <class Self>
std::shared_ptr<Self> Message<Self>::initWithData(std::span<const std::uint8_t> data, bool* decoded) {
  auto message = makeCached<Self>();
  WireReader reader(data);
  const bool success = message->readFrom(reader);
  if (decoded != nullptr) *decoded = success;
  return success ? message : std::make_shared<Self>();
}

template <class Self>
std::string_view Message<Self>::messageClass() const noexcept {
  return Self::className;
}

template <class Self>
bool Message<Self>::readFrom(WireReader& reader) {
  // Copies that nobody else can see stay in registers.
  WireReader in = reader;
  auto has = self()._has;
  bool success = true;
  while (in.hasMore()) {
    success = fields::readInOrder(self(), has, in);
    if (!success || !in.hasMore()) break;
    self()._has = has;
    reader.goOnFrom(in);
    const Step step = readAny(reader);
    in.goOnFrom(reader);
    has = self()._has;
    success = step != Step::failure;
    if (step != Step::next) break;
  }
  self()._has = has;
  reader.goOnFrom(in);
  return success && !in.failed();
}

template <class Self>
typename Message<Self>::Step Message<Self>::readAny(WireReader& reader) {
  const WireKey key(reader.readVarint());
  if (reader.failed() || key.wireType == WireType::endGroup) return Step::end;
  if (takeMetricTag(reader, key.fieldNumber, Self::className)) return Step::next;
  bool success = true;
  const bool known = fields::findIf<Self>([&](const auto& field) {
    if (field.number != key.fieldNumber) return false;
    success = fields::read(field, self(), self()._has, reader, key.wireType);
    return true;
  });
  if (!known) success = reader.skip(key);
  return success ? Step::next : Step::failure;
}

template <class Self>
void Message<Self>::writeTo(WireWriter& writer) const {
  fields::forEach<Self>([&](const auto& field) { fields::write(field, self(), self()._has, writer); });
}

template <class Self>
Record Message<Self>::dictionaryRepresentation() const {
  Record record;
  std::size_t count = self()._has.count();
  fields::forEach<Self>([&](const auto& field) { count += fields::isThere(field, self()); });
  record.reserve(count);
  fields::forEach<Self>([&](const auto& field)
                            __attribute__((always_inline)) { fields::addTo(record, field, self(), self()._has); });
  return record;
}

template <class Self>
bool Message<Self>::isEqual(const WireMessage& other) const {
  if (typeid(*this) != typeid(other)) return false;
  const Self& same = static_cast<const Self&>(other);
  return !fields::findIf<Self>(
      [&](const auto& field) { return !fields::equal(field, self(), self()._has, same, same._has); });
}

template <class Self>
std::uint64_t Message<Self>::hash() const {
  std::uint64_t result = 0;
  fields::forEach<Self>([&](const auto& field) { result ^= fields::hash(field, self(), self()._has); });
  return result;
}

template <class Self>
std::shared_ptr<Self> Message<Self>::copyWithZone() const {
  auto other = std::make_shared<Self>();
  fields::forEach<Self>([&](const auto& field) { fields::copy(field, self(), self()._has, *other, other->_has); });
  return other;
}

template <class Self>
void Message<Self>::copyTo(Self& other) const {
  fields::forEach<Self>([&](const auto& field) { fields::share(field, self(), self()._has, other, other._has); });
}

template <class Self>
void Message<Self>::mergeFrom(const Self& other) {
  fields::forEach<Self>([&](const auto& field) { fields::merge(field, other, other._has, self(), self()._has); });
}

template <class Self>
std::shared_ptr<WireMessage> Message<Self>::makeCopy() const {
  return copyWithZone();
}

template <class Self>
void Message<Self>::copyToSameClass(WireMessage& other) const {
  copyTo(static_cast<Self&>(other));
}

template <class Self>
void Message<Self>::mergeFromSameClass(const WireMessage& other) {
  mergeFrom(static_cast<const Self&>(other));
}

}  // namespace vespscope
