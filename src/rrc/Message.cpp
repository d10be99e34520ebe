#include "rrc/Message.h"

#include <algorithm>
#include <charconv>

#include "rrc/BitReader.h"
#include "rrc/Decoder.h"

namespace vespscope::rrc {

std::optional<Fault> Message::read(Pdu pdu, std::span<const std::uint8_t> bytes) {
  pdu_ = pdu;
  nodes_.clear();
  bytes_ = bytes;
  Decoder decoder(bytes, nodes_);
  if (decoder.read(static_cast<TypeId>(pdu))) return std::nullopt;
  nodes_.clear();
  return decoder.fault();
}

View Message::root() const {
  if (nodes_.empty()) return {};
  return {this, 0, nodes_[0].end};
}

View Message::body() const { return either(root()["message"], root()).chosen(); }

View Message::content() const { return either(body()["criticalExtensions"], body()).chosen(); }

std::optional<int> numberIn(std::string_view name) {
  if (name.starts_with("spare")) return std::nullopt;
  const std::size_t digits = name.find_first_of("0123456789");
  if (digits == std::string_view::npos) return std::nullopt;
  const std::size_t begin = digits > 0 && name[digits - 1] == '-' ? digits - 1 : digits;
  int number = 0;
  std::from_chars(name.data() + begin, name.data() + name.size(), number);
  return number;
}

const Node& View::node() const {
  static constexpr Node absent{};
  return message_ == nullptr ? absent : message_->nodes()[index_];
}

Kind View::kind() const { return grammar.types[node().type].kind(); }
std::string_view View::name() const { return nameOf(node().name); }
std::int64_t View::value() const { return node().value; }
bool View::unreadable() const { return node().unreadable; }
std::size_t View::bit() const { return node().bit; }
std::size_t View::bits() const { return node().bits; }

std::string_view View::item() const {
  const Type& type = grammar.types[node().type];
  const auto index = static_cast<std::uint64_t>(node().value);
  if (type.kind() != Kind::enumerated || index >= std::uint64_t{type.count} + type.extra) return {};
  return nameOf(grammar.items[type.first + index]);
}

std::optional<int> View::itemNumber() const { return numberIn(item()); }
NameId View::id() const { return node().name; }

View View::chosen() const {
  View view = *this;
  while (view.kind() == Kind::choice) view = view.first();
  return view;
}

View View::first() const {
  if (message_ == nullptr || index_ + 1 == node().end) return {};
  return {message_, index_ + 1, node().end};
}

View View::next() const {
  if (message_ == nullptr || node().end == limit_) return {};
  return {message_, node().end, limit_};
}

View View::child(NameId name) const {
  if (message_ == nullptr) return {};
  if (kind() == Kind::octetString) return first().child(name);
  const std::span<const Node> nodes = message_->nodes();
  const std::uint32_t end = nodes[index_].end;
  for (std::uint32_t index = index_ + 1; index < end; index = nodes[index].end) {
    if (nodes[index].name == name) return {message_, index, end};
  }
  return {};
}

View View::operator[](const Path& path) const {
  View view = *this;
  for (const NameId name : path) view = view.child(name);
  return view;
}

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
