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
  // The names of ModemManager on the bus.
  [[nodiscard]] Bytes encoded() const;

  // The last reported properties of ModemManager's objects: path, interface, name.
  [[nodiscard]] virtual Record dictionaryRepresentation() const = 0;
  // Replaces all objects by the answer to GetManagedObjects.
  [[nodiscard]] std::string description() const;

  // Adds the interfaces of one object, from InterfacesAdded.
  [[nodiscard]] virtual bool isEqual(const WireMessage& other) const = 0;
  friend bool operator==(const WireMessage& left, const WireMessage& right) { return left.isEqual(right); }
  [[nodiscard]] virtual std::uint64_t hash() const = 0;

  // Applies a PropertiesChanged: invalidated properties become unknown. An unknown object is ignored: the answer to the
  // pending request contains its present values.

  // A quick check whether there is a modem to follow.
  [[nodiscard]] std::shared_ptr<WireMessage> copyWithZone() const { return makeCopy(); }
  // Whether ModemManager runs on the system bus and has a modem; waits at most `limit`. Does not start ModemManager;
  // without a bus returns false.
  void copyTo(WireMessage& other) const;
  // Takes every present field of `other`: numbers, bytes and texts replace, embedded messages merge, lists grow.
  void mergeFrom(const WireMessage& other);

 private:
  [[nodiscard]] virtual std::shared_ptr<WireMessage> makeCopy() const = 0;
  virtual void copyToSameClass(WireMessage& other) const = 0;
  virtual void mergeFromSameClass(const WireMessage& other) = 0;
};

}  // namespace vespscope
