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

}  // namespace fields

template <class Self>
std::shared_ptr<Self> Message<Self>::initWithData(std::span<const std::uint8_t> data, bool* decoded) {
  auto message = std::make_shared<Self>();
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
  while (reader.hasMore()) {
    const WireKey key(reader.readVarint());
    if (reader.failed() || key.wireType == WireType::endGroup) break;
    if (takeMetricTag(reader, key.fieldNumber, Self::className)) continue;
    bool success = true;
    const bool known = fields::findIf<Self>([&](const auto& field) {
      if (field.number != key.fieldNumber) return false;
      success = fields::read(field, self(), self()._has, reader, key.wireType);
      return true;
    });
    if (!known) success = reader.skip(key);
    if (!success) return false;
  }
  return !reader.failed();
}

template <class Self>
void Message<Self>::writeTo(WireWriter& writer) const {
  fields::forEach<Self>([&](const auto& field) { fields::write(field, self(), self()._has, writer); });
}

template <class Self>
Record Message<Self>::dictionaryRepresentation() const {
  Record record;
  fields::forEach<Self>([&](const auto& field) { fields::addTo(record, field, self(), self()._has); });
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
