// A message class with its operations, all of them worked out from the class's field table.
//
// The definitions lie in MessageOperations.h and are compiled once per class, so including a message stays cheap.
#pragma once

#include <cstdint>
#include <memory>
#include <span>
#include <string_view>

#include "messages/FieldTable.h"
#include "messages/WireMessage.h"

namespace vespscope {

template <class Self>
class Message : public WireMessage {
 public:
  // The message that `data` encodes, or an empty one with `decoded` set to false when `data` cannot be decoded.
  [[nodiscard]] static std::shared_ptr<Self> initWithData(std::span<const std::uint8_t> data, bool* decoded = nullptr);

  [[nodiscard]] std::string_view messageClass() const noexcept final;
  [[nodiscard]] bool readFrom(WireReader& reader) final;
  void writeTo(WireWriter& writer) const final;
  [[nodiscard]] Record dictionaryRepresentation() const final;
  [[nodiscard]] bool isEqual(const WireMessage& other) const final;
  [[nodiscard]] std::uint64_t hash() const final;

  [[nodiscard]] std::shared_ptr<Self> copyWithZone() const;
  void copyTo(Self& other) const;
  void mergeFrom(const Self& other);

 private:
  // Only `Self` may derive from this.
  friend Self;
  Message() = default;

  enum class Step { next, end, failure };
  // Reads one key and its value, whatever they are.
  Step readAny(WireReader& reader);

  [[nodiscard]] std::shared_ptr<WireMessage> makeCopy() const final;
  void copyToSameClass(WireMessage& other) const final;
  void mergeFromSameClass(const WireMessage& other) final;

  [[nodiscard]] Self& self() noexcept { return static_cast<Self&>(*this); }
  [[nodiscard]] const Self& self() const noexcept { return static_cast<const Self&>(*this); }
};

}  // namespace vespscope
