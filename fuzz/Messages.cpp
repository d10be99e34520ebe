// The message readers: all classes, every accessor and operation, and the other implementation's reading of the same
// bytes.
#include <memory>

#include <google/protobuf/stubs/logging.h>

#include "Fuzz.h"
#include "Peer.h"
#include "messages/MessageClasses.h"
#include "messages/WireReader.h"
#include "platform/log/Log.h"
#include "values/Text.h"

using namespace vespscope;
using fuzz::require;
using test::dictionaryOf;

namespace {

// Checks the properties of any message that was read.
void checkOperations(const MessageClass& messageClass, const WireMessage& message) {
  fuzz::callAccessors(message);
  const Record dictionary = message.dictionaryRepresentation();
  require(!message.description().empty(), "a message without a description");
  const Bytes written = message.encoded();
  const auto again = messageClass.make();
  WireReader reader(written);
  require(again->readFrom(reader), "what was written cannot be read");
  require(again->encoded() == written, "what was written and read is written differently");
  require(again->dictionaryRepresentation() == dictionary, "what was written reads differently");
  const auto copy = message.copyWithZone();
  require(*copy == message && message == *copy, "a copy differs");
  require(copy->hash() == message.hash(), "a copy has another hash");
  require(copy->encoded() == written, "a copy is written differently");
  const auto shared = messageClass.make();
  message.copyTo(*shared);
  require(*shared == message, "a shared copy differs");
  const auto merged = messageClass.make();
  merged->mergeFrom(message);
  require(merged->encoded() == written, "merged into an empty message it differs");
  merged->mergeFrom(message);
  fuzz::callAccessors(*merged);
  require(message.encoded() == written, "operations changed the message");
}

void compareWithPeer(const MessageClass& messageClass, std::span<const std::uint8_t> bytes, bool read,
                     const WireMessage& message) {
  if (!fuzz::rulesAgree(messageClass.name, bytes)) return;
  const auto theirs = fuzz::readByPeer(messageClass.name, bytes);
  require(read == (theirs != nullptr), read ? "the peer refuses what is read" : "the peer reads what is refused");
  if (!read) return;
  require(Value(message.dictionaryRepresentation()) == Value(dictionaryOf(*theirs)), "the peer reads differently");
  const Bytes written = message.encoded();
  const auto theirsAgain = fuzz::readByPeer(messageClass.name, written);
  require(theirsAgain != nullptr, "the peer refuses what is written");
  require(Value(message.dictionaryRepresentation()) == Value(dictionaryOf(*theirsAgain)),
          "the peer reads what is written differently");
}

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  log::discardOutputs();
  google::protobuf::SetLogHandler(nullptr);  // protobuf logs text that is not UTF-8
  if (size == 0) return 0;
  const MessageClass& messageClass = messageClasses()[data[0] % messageClasses().size()];
  const std::span<const std::uint8_t> bytes(data + 1, size - 1);
  const auto message = messageClass.make();
  WireReader reader(bytes);
  const bool read = message->readFrom(reader);
  require(reader.position() <= bytes.size(), "read past the end");
  // The fields read before a failure remain readable.
  checkOperations(messageClass, *message);
  compareWithPeer(messageClass, bytes, read, *message);
  return 0;
}
