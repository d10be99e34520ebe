#include "Peer.h"

#include <algorithm>
#include <set>

#include "registry/MetricRows.h"

namespace vespscope::fuzz {
namespace {

namespace protobuf = google::protobuf;
using Bytes = std::span<const std::uint8_t>;
using Field = protobuf::FieldDescriptor;
using test::ProtobufPeer;

ProtobufPeer& peer() {
  static ProtobufPeer instance;
  return instance;
}

// The expected result of reading a piece of input, before either implementation has read it.
enum class Outlook {
  agree,      // up to its end
  bothFail,   // at this place, whatever follows
  different,  // the rules differ
};

struct Varint {
  Outlook outlook;
  std::uint64_t value = 0;
  std::size_t size = 0;
};

Varint takeVarint(Bytes& bytes) {
  Varint varint{Outlook::agree};
  while (varint.size < bytes.size()) {
    const std::uint8_t byte = bytes[varint.size];
    if (varint.size == 9 && byte > 1) return {Outlook::different};
    varint.value |= std::uint64_t{byte & 0x7FU} << (7 * varint.size);
    ++varint.size;
    if (byte < 0x80) {
      bytes = bytes.subspan(varint.size);
      return varint;
    }
  }
  return {Outlook::bothFail};
}

Outlook outlookOf(const protobuf::Descriptor& message, Bytes bytes);

bool isMetricTag(std::uint64_t number) {
  return std::any_of(metricRows.begin(), metricRows.end(), [=](const MetricRow& row) { return row.tag == number; });
}

bool isContent(const Field& field) { return field.type() == Field::TYPE_STRING || field.type() == Field::TYPE_BYTES; }

Outlook outlookOfNumbers(Bytes bytes) {
  while (!bytes.empty()) {
    if (const Varint number = takeVarint(bytes); number.outlook != Outlook::agree) return number.outlook;
  }
  return Outlook::agree;
}

// The outlook for a field's value; `known` is null for a field that neither implementation knows.
Outlook takeValue(const Field* known, std::uint64_t wireType, Bytes& bytes) {
  const bool delimited = known != nullptr && (isContent(*known) || known->message_type() != nullptr);
  const bool packed = known != nullptr && known->is_repeated() && !delimited && wireType == 2;
  if (known != nullptr && !packed && wireType != (delimited ? 2U : 0U)) return Outlook::different;
  if (wireType == 3 || wireType == 4) return Outlook::different;
  if (wireType > 5) return Outlook::bothFail;
  if (wireType == 0) return takeVarint(bytes).outlook;
  std::uint64_t size = wireType == 1 ? 8 : 4;
  if (wireType == 2) {
    const Varint length = takeVarint(bytes);
    if (length.outlook != Outlook::agree) return length.outlook;
    size = length.value;
  }
  if (size > bytes.size()) return Outlook::bothFail;
  const Bytes value = bytes.first(static_cast<std::size_t>(size));
  bytes = bytes.subspan(value.size());
  if (packed) return outlookOfNumbers(value);
  if (known != nullptr && known->message_type() != nullptr) return outlookOf(*known->message_type(), value);
  return Outlook::agree;
}

Outlook outlookOf(const protobuf::Descriptor& message, Bytes bytes) {
  std::set<int> given;
  while (!bytes.empty()) {
    const Varint key = takeVarint(bytes);
    if (key.outlook != Outlook::agree) return key.outlook;
    const std::uint64_t number = key.value >> 3;
    if (key.size > 5 || number == 0 || number > 0xFFFF) return Outlook::different;
    if (isMetricTag(number)) return Outlook::different;
    const Field* known = message.FindFieldByNumber(static_cast<int>(number));
    const bool once = known != nullptr && !known->is_repeated() && (known->message_type() || known->enum_type());
    if (once && !given.insert(static_cast<int>(number)).second) return Outlook::different;
    if (const Outlook value = takeValue(known, key.value & 7, bytes); value != Outlook::agree) return value;
  }
  return Outlook::agree;
}

}  // namespace

std::unique_ptr<protobuf::Message> readByPeer(std::string_view messageClass, Bytes bytes) {
  auto message = peer().make(messageClass);
  if (!message->ParseFromArray(bytes.data(), static_cast<int>(bytes.size()))) return nullptr;
  return message;
}

bool rulesAgree(std::string_view messageClass, Bytes bytes) {
  return outlookOf(*peer().descriptor(messageClass), bytes) != Outlook::different;
}

}  // namespace vespscope::fuzz
