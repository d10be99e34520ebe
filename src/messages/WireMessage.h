// The base of every metric message: what can be done with one without knowing its class.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

#include "values/Value.h"

namespace vespscope {

class WireReader;
class WireWriter;

class WireMessage {
 public:
  WireMessage() = default;
  // A copy says whether embedded messages are shared (copyTo) or not (copyWithZone).
  WireMessage(const WireMessage&) = delete;
  WireMessage& operator=(const WireMessage&) = delete;
  WireMessage(WireMessage&&) noexcept = default;
  WireMessage& operator=(WireMessage&&) noexcept = default;
  virtual ~WireMessage() = default;

  // The name of the message's own class.
  [[nodiscard]] virtual std::string_view messageClass() const noexcept = 0;

  // Sets the fields that the reader holds, up to its end; true on success. After a failure the fields read so far
  // stay set, so discard the message.
  [[nodiscard]] virtual bool readFrom(WireReader& reader) = 0;
  // Writes the fields that are present in ascending order of their numbers.
  virtual void writeTo(WireWriter& writer) const = 0;
  // What writeTo() writes.
  [[nodiscard]] Bytes encoded() const;

  // The fields that are present, in ascending order of their numbers, under their schema names; enumerations as the
  // names of their values.
  [[nodiscard]] virtual Record dictionaryRepresentation() const = 0;
  // The class, the object's identity and its dictionary, on one line.
  [[nodiscard]] std::string description() const;

  // True for a message of exactly the same class whose present fields are the same and equal. A list that was emptied
  // differs from one that was never there.
  [[nodiscard]] virtual bool isEqual(const WireMessage& other) const = 0;
  friend bool operator==(const WireMessage& left, const WireMessage& right) { return left.isEqual(right); }
  [[nodiscard]] virtual std::uint64_t hash() const = 0;

  // The operations below take any message; one of another class is a programming error.

  // A copy that shares nothing with this message.
  [[nodiscard]] std::shared_ptr<WireMessage> copyWithZone() const { return makeCopy(); }
  // Copies every present field into `other`, which then shares this message's embedded messages.
  void copyTo(WireMessage& other) const;
  // Takes every present field of `other`: numbers, bytes and texts replace, embedded messages merge, lists grow.
  void mergeFrom(const WireMessage& other);

 private:
  [[nodiscard]] virtual std::shared_ptr<WireMessage> makeCopy() const = 0;
  virtual void copyToSameClass(WireMessage& other) const = 0;
  virtual void mergeFromSameClass(const WireMessage& other) = 0;
};

}  // namespace vespscope
