#include "rrc/Message.h"

#include <algorithm>
#include <charconv>

#include "rrc/BitReader.h"
#include "rrc/Decoder.h"

namespace vespscope::rrc {

std::optional<Fault> Message::read(Pdu pdu, std::span<const std::uint8_t> bytes) {
  pdu_ = pdu;
  bytes_ = bytes;
  Decoder decoder(bytes, nodes_);
  if (decoder.read(static_cast<TypeId>(pdu))) {
    count_ = decoder.count();
    return std::nullopt;
  }
  count_ = 0;
  return decoder.fault();
}

View Message::body() const { return either(root()["message"], root()).chosen(); }

View Message::content() const { return either(body()["criticalExtensions"], body()).chosen(); }

std::optional<int> numberIn(std::string_view name) {
  if (name.starts_with("spare")) return std::nullopt;
  std::size_t digits = 0;
  while (digits < name.size() && (name[digits] < '0' || name[digits] > '9')) ++digits;
  if (digits == name.size()) return std::nullopt;
  const std::size_t begin = digits > 0 && name[digits - 1] == '-' ? digits - 1 : digits;
  int number = 0;
  std::from_chars(name.data() + begin, name.data() + name.size(), number);
  return number;
}

std::string_view View::item() const {
  const Type& type = grammar::types[node().type];
  const auto index = static_cast<std::uint64_t>(node().value);
  if (type.kind() != Kind::enumerated || index >= std::uint64_t{type.count} + type.extra) return {};
  return nameOf(grammar::items[type.first + index]);
}

std::optional<int> View::itemNumber() const { return numberIn(item()); }

View View::extension(const Path& path) const {
  static constexpr NameId deeper = findName("nonCriticalExtension").value();
  View level = *this;
  View found = level[path];
  while (!found && (level = level.child(deeper))) found = level[path];
  return found;
}

std::optional<std::uint64_t> View::number() const {
  constexpr std::uint32_t most = 57;
  if (message_ == nullptr || node().bits > most) return std::nullopt;
  return BitReader(message_->bytes()).peek(node().bit, node().bits);
}

std::vector<std::uint8_t> View::bytes() const {
  std::vector<std::uint8_t> bytes;
  if (message_ == nullptr) return bytes;
  const BitReader reader(message_->bytes());
  bytes.reserve((node().bits + 7) / 8);
  for (std::uint32_t done = 0; done < node().bits; done += 8) {
    const unsigned count = std::min(8U, node().bits - done);
    bytes.push_back(static_cast<std::uint8_t>(reader.peek(node().bit + done, count) << (8 - count)));
  }
  return bytes;
}

}  // namespace vespscope::rrc
