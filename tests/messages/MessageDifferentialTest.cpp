// Thousands of random messages of every class, compared with another implementation of Protocol Buffers.
#include <filesystem>
#include <fstream>
#include <iterator>
#include <random>
#include <set>
#include <string>

#include <google/protobuf/stubs/logging.h>
#include <google/protobuf/unknown_field_set.h>
#include <gtest/gtest.h>

#include "ProtobufPeer.h"
#include "messages/MessageClasses.h"
#include "messages/MessageTesting.h"
#include "platform/log/Log.h"

namespace vespscope::test {
namespace {

namespace protobuf = google::protobuf;

// Compares the kinds of numbers as well, which equality of values does not.
bool sameKinds(const Value& one, const Value& other) {
  if (one.data().index() != other.data().index()) return false;
  if (const List* list = one.asList()) {
    return std::equal(list->begin(), list->end(), other.asList()->begin(), other.asList()->end(), sameKinds);
  }
  if (const Record* record = one.asRecord()) {
    return std::equal(record->begin(), record->end(), other.asRecord()->begin(), other.asRecord()->end(),
                      [](const Entry& left, const Entry& right) {
                        return left.key == right.key && sameKinds(left.value, right.value);
                      });
  }
  return true;
}

Bytes bytesOf(const protobuf::Message& message) {
  const std::string text = message.SerializeAsString();
  return {text.begin(), text.end()};
}

bool parse(protobuf::Message& message, const Bytes& bytes) {
  return message.ParseFromArray(bytes.data(), static_cast<int>(bytes.size()));
}

class MessageDifferential : public testing::TestWithParam<std::string_view> {
 protected:
  static constexpr int rounds = 2000;

  [[nodiscard]] std::shared_ptr<WireMessage> ours() const {
    for (const MessageClass& messageClass : messageClasses()) {
      if (messageClass.name == GetParam()) return messageClass.make();
    }
    return nullptr;
  }
  [[nodiscard]] std::unique_ptr<protobuf::Message> theirs() { return peer_.make(GetParam()); }

  [[nodiscard]] std::shared_ptr<WireMessage> read(const Bytes& bytes) {
    auto message = ours();
    WireReader reader(bytes);
    EXPECT_TRUE(message->readFrom(reader));
    EXPECT_EQ(reader.position(), bytes.size());
    return message;
  }

  static void expectSameContent(const WireMessage& ours, const protobuf::Message& theirs) {
    const Value shown = ours.dictionaryRepresentation();
    const Value expected = dictionaryOf(theirs);
    ASSERT_TRUE(shown == expected && sameKinds(shown, expected)) << toText(shown) << "\n" << toText(expected);
  }

  ProtobufPeer peer_;
  std::mt19937 random_{20240229};
};

TEST_P(MessageDifferential, ReadsAndWritesTheSameBytes) {
  for (int round = 0; round < rounds; ++round) {
    const auto theirMessage = theirs();
    fillRandomly(*theirMessage, random_, {});
    const Bytes bytes = bytesOf(*theirMessage);
    const auto message = read(bytes);
    expectSameContent(*message, *theirMessage);
    ASSERT_EQ(message->encoded(), bytes);
    const auto copy = message->copyWithZone();
    ASSERT_TRUE(*copy == *message);
    ASSERT_EQ(copy->hash(), message->hash());
    const auto shared = ours();
    message->copyTo(*shared);
    ASSERT_TRUE(*shared == *message);
  }
}

TEST_P(MessageDifferential, ReadsWhatThePeerTakesForUnknown) {
  for (int round = 0; round < rounds / 4; ++round) {
    const auto theirMessage = theirs();
    fillRandomly(*theirMessage, random_, {.unnamedEnumerationValues = true});
    auto* unknown = theirMessage->GetReflection()->MutableUnknownFields(theirMessage.get());
    unknown->AddVarint(200, random_());
    unknown->AddFixed32(201, static_cast<std::uint32_t>(random_()));
    unknown->AddFixed64(1000, random_());
    unknown->AddLengthDelimited(11787, std::string(random_() % 300, '\x9A'));
    unknown->AddGroup(65535)->AddGroup(7)->AddVarint(19, 1);
    const auto message = read(bytesOf(*theirMessage));
    expectSameContent(*message, *theirMessage);
    const auto theirAgain = theirs();
    ASSERT_TRUE(parse(*theirAgain, message->encoded()));
    expectSameContent(*message, *theirAgain);
  }
}

TEST_P(MessageDifferential, MergesTheSameWay) {
  for (int round = 0; round < rounds / 4; ++round) {
    const auto theirTarget = theirs();
    const auto theirSource = theirs();
    fillRandomly(*theirTarget, random_, {});
    fillRandomly(*theirSource, random_, {});
    const auto target = read(bytesOf(*theirTarget));
    target->mergeFrom(*read(bytesOf(*theirSource)));
    theirTarget->MergeFrom(*theirSource);
    ASSERT_EQ(target->encoded(), bytesOf(*theirTarget));
  }
}

TEST_P(MessageDifferential, FindsTheSamePrefixesTruncated) {
  // Protobuf logs a text truncated inside a character, but accepts it.
  protobuf::SetLogHandler(nullptr);
  for (int round = 0; round < 10; ++round) {
    const auto theirMessage = theirs();
    fillRandomly(*theirMessage, random_, {});
    const Bytes bytes = bytesOf(*theirMessage);
    for (std::size_t size = 0; size < std::min<std::size_t>(bytes.size(), 200); ++size) {
      const Bytes prefix(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(size));
      const auto message = ours();
      WireReader reader(prefix);
      const bool success = message->readFrom(reader);
      ASSERT_EQ(success, parse(*theirs(), prefix)) << size << " of " << bytes.size();
      ASSERT_NE(success, reader.failed());
    }
  }
}

TEST_P(MessageDifferential, SurvivesDamagedAndRandomBytes) {
  log::discardOutputs();
  for (int round = 0; round < rounds / 2; ++round) {
    const auto theirMessage = theirs();
    fillRandomly(*theirMessage, random_, {});
    Bytes bytes = bytesOf(*theirMessage);
    if (bytes.empty() || round % 4 == 0) bytes.resize(random_() % 64);
    for (std::size_t flips = 1 + random_() % 4; flips > 0 && !bytes.empty(); --flips) {
      bytes[random_() % bytes.size()] ^= static_cast<std::uint8_t>(1U << random_() % 8);
    }
    const auto message = ours();
    WireReader reader(bytes);
    const bool success = message->readFrom(reader);
    ASSERT_LE(reader.position(), bytes.size());
    if (!success) continue;
    // The message that was read is a normal one.
    const auto again = read(message->encoded());
    ASSERT_TRUE(*message->copyWithZone() == *message);
    ASSERT_EQ(again->dictionaryRepresentation(), again->copyWithZone()->dictionaryRepresentation());
    ASSERT_FALSE(message->description().empty());
  }
}

std::vector<std::string_view> names() {
  std::vector<std::string_view> result;
  for (const MessageClass& messageClass : messageClasses()) result.push_back(messageClass.name);
  return result;
}

INSTANTIATE_TEST_SUITE_P(Messages, MessageDifferential, testing::ValuesIn(names()),
                         [](const auto& test) { return std::string(test.param); });

// The names of all fields, quoted as in code.
std::set<std::string> quotedFieldNames(const ProtobufPeer& peer) {
  std::set<std::string> names;
  for (const MessageClass& messageClass : messageClasses()) {
    const protobuf::Descriptor* message = peer.descriptor(messageClass.name);
    for (int field = 0; field < message->field_count(); ++field) {
      names.insert('"' + std::string(message->field(field)->name()) + '"');
    }
  }
  return names;
}

TEST(MessageDifferentialSchema, NoFileOfTheMessagesRepeatsAFieldNameButTheGeneratedHeaders) {
  const std::set<std::string> names = quotedFieldNames(ProtobufPeer());
  EXPECT_GT(names.size(), 200U);
  std::size_t files = 0;
  for (const auto& entry : std::filesystem::directory_iterator(VESPSCOPE_SOURCE_DIR "/src/messages")) {
    if (!entry.is_regular_file() || entry.path().extension() == ".txt") continue;
    ++files;
    std::ifstream file(entry.path(), std::ios::binary);
    const std::string text{std::istreambuf_iterator<char>(file), {}};
    for (const std::string& name : names) EXPECT_EQ(text.find(name), std::string::npos) << entry.path() << " " << name;
  }
  EXPECT_GT(files, 10U);
}

TEST(MessageDifferentialSchema, Declares54MessagesWith348FieldsOfWhich31AreEnumerations) {
  ProtobufPeer peer;
  int messages = 0;
  int fields = 0;
  int enumerations = 0;
  for (const char* name : {"lte.proto", "umts.proto", "gsm.proto", "mobility.proto"}) {
    const protobuf::FileDescriptor* file = peer.file(name);
    ASSERT_NE(file, nullptr);
    for (int index = 0; index < file->message_type_count(); ++index) {
      const protobuf::Descriptor* message = file->message_type(index);
      ++messages;
      fields += message->field_count();
      for (int field = 0; field < message->field_count(); ++field) {
        if (message->field(field)->enum_type() != nullptr) ++enumerations;
      }
    }
  }
  EXPECT_EQ(messages, 54);
  EXPECT_EQ(fields, 348);
  EXPECT_EQ(enumerations, 31);
  EXPECT_EQ(messageClasses().size(), 54U);
}

}  // namespace
}  // namespace vespscope::test
