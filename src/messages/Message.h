// Delivers outside the lock: the manager requests the label and the SIM card's files while it holds locks of its own.
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
  // poll() ignores a negative descriptor
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
  // The live source: ModemManager's reports of a modem, followed on the system bus while the source runs.
  //
  // Waits for a missing bus, ModemManager or modem. Values of a lost modem are withdrawn: a viewer that showed a
  // registered modem then shows only the time of the loss.
  friend Self;
  Message() = default;

  enum class Step { next, end, failure };
  // The modem and its state, or what the source waits for.
  Step readAny(WireReader& reader);

  [[nodiscard]] std::shared_ptr<WireMessage> makeCopy() const final;
  void copyToSameClass(WireMessage& other) const final;
  void mergeFromSameClass(const WireMessage& other) final;

  [[nodiscard]] Self& self() noexcept { return static_cast<Self&>(*this); }
  [[nodiscard]] const Self& self() const noexcept { return static_cast<const Self&>(*this); }
};

}  // namespace vespscope
