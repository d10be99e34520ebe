#include "BusMessages.h"

#include <sys/socket.h>
#include <unistd.h>

#include <array>

namespace vespscope::fuzz {
namespace {

using namespace std::string_view_literals;

constexpr auto clientGreeting = "\0AUTH EXTERNAL\r\nDATA\r\nNEGOTIATE_UNIX_FD\r\nBEGIN\r\n"sv;
constexpr auto serverGreeting = "DATA\r\nOK 0123456789abcdef0123456789abcdef\r\nAGREE_UNIX_FD\r\n"sv;

// Writes a message in D-Bus's little-endian form (D-Bus specification, "Message Protocol").
class Writer {
 public:
  void align(std::size_t boundary) {
    while (bytes_.size() % boundary != 0) bytes_.push_back(0);
  }
  void byte(std::uint8_t value) { bytes_.push_back(value); }
  void number(std::uint64_t value, std::size_t size) {
    align(size);
    for (std::size_t index = 0; index < size; ++index) byte(static_cast<std::uint8_t>(value >> (8 * index)));
  }
  void raw(std::span<const std::uint8_t> bytes) { bytes_.insert(bytes_.end(), bytes.begin(), bytes.end()); }
  void text(std::string_view value) {
    number(value.size(), 4);
    for (const char letter : value) byte(static_cast<std::uint8_t>(letter));
    byte(0);
  }
  void signature(std::string_view value) {
    byte(static_cast<std::uint8_t>(value.size()));
    for (const char letter : value) byte(static_cast<std::uint8_t>(letter));
    byte(0);
  }
  // Writes content preceded by its length in bytes.
  template <class Content>
  void counted(std::size_t boundary, Content content) {
    number(0, 4);
    const std::size_t length = bytes_.size() - 4;
    align(boundary);
    const std::size_t begin = bytes_.size();
    content();
    const std::size_t size = bytes_.size() - begin;
    for (std::size_t index = 0; index < 4; ++index) {
      bytes_[length + index] = static_cast<std::uint8_t>(size >> (8 * index));
    }
  }
  [[nodiscard]] const Bytes& bytes() const { return bytes_; }

 private:
  Bytes bytes_;
};

constexpr std::array members = {"PerformCommand"sv, "EventsOn"sv, "EventsOff"sv,    "Event"sv,
                                "Introspect"sv,     "GetAll"sv,   "NameAcquired"sv, "Ping"sv};
constexpr std::array interfaces = {"org.vespscope.BasebandManager1"sv, "org.freedesktop.DBus.Introspectable"sv,
                                   "org.freedesktop.DBus.Properties"sv, "org.freedesktop.DBus.Peer"sv};
constexpr std::array paths = {"/org/vespscope/BasebandManager1"sv, "/"sv, "/org/vespscope"sv};
constexpr std::array signatures = {"sa{sv}"sv, ""sv, "sta{sv}"sv, "isa{sv}"sv, "s"sv, "ssssa{sv}"sv, "aav"sv};
constexpr std::array words = {"AddConfiguration"sv, "ClearConfiguration"sv,
                              "QueryMetric"sv,      "Status"sv,
                              "Metric"sv,           "Trigger"sv,
                              "kKeyAppID"sv,        "kKeyPayload"sv,
                              "kKeyPayloadType"sv,  "kKeyTriggerRef"sv,
                              "kKeyTriggerType"sv,  "kKeyTriggerID"sv,
                              "kKeyProfileID"sv,    "kKeyMetricID"sv,
                              "kKeyClientName"sv,   "live"sv};

std::string_view wordOf(Input& input) {
  const std::uint8_t choice = input.byte();
  if (choice < 2 * words.size()) return words[choice % words.size()];
  const auto piece = input.bytes(choice % 32);
  return {reinterpret_cast<const char*>(piece.data()), piece.size()};
}

std::uint64_t numberOf(Input& input) {
  constexpr std::array<std::uint64_t, 8> usual = {0, 1, 2, 3, 9999, 0x7F0013, 0x3C4E04, ~std::uint64_t{0}};
  const std::uint8_t choice = input.byte();
  if (choice < 128) return usual[choice % usual.size()];
  return std::uint64_t{input.word()} << (choice % 48);
}

void writeVariant(Writer& out, Input& input, int depth);

void writeEntries(Writer& out, Input& input, int depth) {
  out.counted(8, [&] {
    for (int count = input.byte() % 10; count > 0; --count) {
      out.align(8);
      out.text(wordOf(input));
      writeVariant(out, input, depth);
    }
  });
}

void writeVariant(Writer& out, Input& input, int depth) {
  constexpr std::array kinds = {"b"sv, "x"sv, "t"sv, "d"sv, "s"sv,  "ay"sv,
                                "g"sv, "i"sv, "u"sv, "v"sv, "av"sv, "a{sv}"sv};
  std::size_t kind = input.byte() % kinds.size();
  if (depth > 80 && kind > 8) kind = 0;
  out.signature(kinds[kind]);
  switch (kind) {
    case 0:
      return out.number(numberOf(input) & 1, 4);
    case 1:
    case 2:
    case 3:
      return out.number(numberOf(input), 8);
    case 4:
      return out.text(wordOf(input));
    case 5: {
      const auto data = input.piece();
      return out.counted(1, [&] { out.raw(data); });
    }
    case 6:
      return out.signature("");
    case 7:
    case 8:
      return out.number(numberOf(input), 4);
    case 9:
      return writeVariant(out, input, depth + 1);
    case 10:
      return out.counted(1, [&] {
        for (int count = input.byte() % 6; count > 0; --count) writeVariant(out, input, depth + 1);
      });
    default:
      return writeEntries(out, input, depth + 1);
  }
}

// A body that matches its signature.
Bytes bodyOf(std::string_view signature, Input& input) {
  Writer out;
  if (signature.starts_with("i")) {
    out.number(numberOf(input), 4);
    signature.remove_prefix(1);
  }
  for (; signature.starts_with("s"); signature.remove_prefix(1)) out.text(wordOf(input));
  if (signature.starts_with("t")) out.number(numberOf(input), 8);
  if (signature.ends_with("a{sv}")) writeEntries(out, input, 0);
  return out.bytes();
}

void appendMessage(Bytes& conversation, Side side, std::uint32_t serial, Input& input) {
  const std::uint8_t choice = input.byte();
  const bool right = choice < 192;  // the body matches its signature
  const std::uint8_t shape = input.byte();
  // Calls for a server; signals and replies for a client.
  const auto type = static_cast<std::uint8_t>(side == Side::client ? (choice % 16 == 15 ? 1 + shape % 5 : 1)
                                                                   : (choice % 4 == 3 ? 2 + shape % 2 : 4));
  std::string_view signature = signatures[shape % signatures.size()];
  std::string_view member = members[(shape >> 3) % members.size()];
  if (shape % 4 == 0) {
    member = side == Side::client ? members[0] : members[3];
    signature = side == Side::client ? signatures[0] : type == 4 ? signatures[2] : signatures[3];
  }
  const Bytes made = right ? bodyOf(signature, input) : Bytes();
  const std::span<const std::uint8_t> body = right ? std::span<const std::uint8_t>(made) : input.piece();
  Writer out;
  out.byte('l');
  out.byte(type);
  out.byte(choice & 1);
  out.byte(1);
  out.number(body.size(), 4);
  out.number(serial, 4);
  out.counted(8, [&] {
    const auto field = [&out](std::uint8_t code, std::string_view kind, auto content) {
      out.align(8);
      out.byte(code);
      out.signature(kind);
      content();
    };
    if (type == 1 || type == 4) {
      field(1, "o", [&] { out.text(paths[choice >= 250 ? choice % paths.size() : 0]); });
      field(2, "s", [&] { out.text(interfaces[choice >= 240 ? choice % interfaces.size() : 0]); });
      field(3, "s", [&] { out.text(member); });
    } else {
      field(5, "u", [&] { out.number(1 + shape % 4, 4); });
      if (type == 3) field(4, "s", [&] { out.text("org.freedesktop.DBus.Error.Failed"); });
    }
    if (!signature.empty()) field(8, "g", [&] { out.signature(signature); });
  });
  out.align(8);
  out.raw(body);
  conversation.insert(conversation.end(), out.bytes().begin(), out.bytes().end());
}

}  // namespace

Bytes conversationOf(Side side, Input input) {
  const std::uint8_t manner = input.byte();
  const std::string_view greeting = side == Side::client ? clientGreeting : serverGreeting;
  Bytes conversation;
  if (manner % 8 != 7) conversation.assign(greeting.begin(), greeting.end());
  for (std::uint32_t serial = 1; manner % 8 < 5 && !input.empty() && serial < 200; ++serial) {
    appendMessage(conversation, side, serial, input);
  }
  const auto rest = input.rest();
  conversation.insert(conversation.end(), rest.begin(), rest.end());
  return conversation;
}

Connection::Connection() {
  std::array<int, 2> ends{};
  require(::socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0, ends.data()) == 0, "no sockets");
  ours_ = ends[0];
  theirs_ = ends[1];
}

Connection::~Connection() { ::close(theirs_); }

void Connection::send(std::span<const std::uint8_t> bytes) const {
  static_cast<void>(::send(theirs_, bytes.data(), bytes.size(), MSG_NOSIGNAL));
}

void Connection::drain() const {
  std::array<char, 65'536> sink;
  while (::recv(theirs_, sink.data(), sink.size(), 0) > 0) {
  }
}

}  // namespace vespscope::fuzz
