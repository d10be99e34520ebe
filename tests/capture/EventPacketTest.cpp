// One packet of a capture has the same meaning for protobuf and for our reader.
#include <fstream>
#include <random>

#include <google/protobuf/descriptor.pb.h>
#include <google/protobuf/dynamic_message.h>
#include <gtest/gtest.h>

#include "capture/EventPacket.h"

namespace vespscope::test {
namespace {

using namespace capture;

namespace pb = google::protobuf;

// The schema in the source tree, as the reference implementation reads it.
class EventPacketSchema : public testing::Test {
 protected:
  void SetUp() override {
    std::ifstream file(VESPSCOPE_PACKET_SCHEMA, std::ios::binary);
    pb::FileDescriptorSet files;
    ASSERT_TRUE(files.ParseFromIstream(&file));
    ASSERT_EQ(files.file_size(), 1);
    const pb::FileDescriptor* schema = pool_.BuildFile(files.file(0));
    ASSERT_NE(schema, nullptr);
    type_ = schema->FindMessageTypeByName("MetricEvent");
    ASSERT_NE(type_, nullptr);
  }

  pb::DescriptorPool pool_;
  pb::DynamicMessageFactory factory_;
  const pb::Descriptor* type_ = nullptr;
};

TEST_F(EventPacketSchema, PacketsMeanTheSameToProtobuf) {
  std::mt19937 random(1);
  for (int round = 0; round < 2'000; ++round) {
    MetricEvent event;
    event.metricID = static_cast<std::int32_t>(random() >> (1 + random() % 31));
    event.profileID = static_cast<std::int32_t>(random());
    event.payload.resize(random() % 300);
    for (std::uint8_t& byte : event.payload) byte = static_cast<std::uint8_t>(random());
    const Bytes packet = packetOf(event);

    const std::unique_ptr<pb::Message> message(factory_.GetPrototype(type_)->New());
    ASSERT_TRUE(message->ParseFromArray(packet.data(), static_cast<int>(packet.size())));
    const auto* fields = message->GetReflection();
    EXPECT_EQ(fields->GetUInt32(*message, type_->FindFieldByName("metric_id")),
              static_cast<std::uint32_t>(event.metricID));
    EXPECT_EQ(fields->GetInt32(*message, type_->FindFieldByName("profile_id")), event.profileID);
    EXPECT_EQ(fields->GetString(*message, type_->FindFieldByName("payload")),
              std::string(event.payload.begin(), event.payload.end()));

    const std::string theirs = message->SerializeAsString();
    const auto back = eventOf({reinterpret_cast<const std::uint8_t*>(theirs.data()), theirs.size()}, event.time);
    ASSERT_TRUE(back) << back.reason();
    EXPECT_EQ(back->metricID, event.metricID);
    EXPECT_EQ(back->profileID, event.profileID);
    EXPECT_EQ(back->payload, event.payload);
  }
}

TEST(EventPacket, TheLastOfRepeatedFieldsCounts) {
  const Bytes packet = {0x08, 0x01, 0x1A, 0x01, 0xAA, 0x08, 0x02, 0x1A, 0x01, 0xBB};
  const auto event = eventOf(packet, {});
  ASSERT_TRUE(event) << event.reason();
  EXPECT_EQ(event->metricID, 2);
  EXPECT_EQ(event->payload, Bytes{0xBB});
}

TEST(EventPacket, AFieldNumberThatIsTheSameOnlyModulo65536IsAnother) {
  // Field 65537, a varint, then metric_id.
  const Bytes packet = {0x88, 0x80, 0x20, 0x05, 0x08, 0x07};
  const auto event = eventOf(packet, {});
  ASSERT_TRUE(event) << event.reason();
  EXPECT_EQ(event->metricID, 7);
}

TEST(EventPacket, RandomBytesNeverDoHarm) {
  std::mt19937 random(2);
  int good = 0;
  for (int round = 0; round < 20'000; ++round) {
    Bytes packet(random() % 24);
    for (std::uint8_t& byte : packet) byte = static_cast<std::uint8_t>(random() % 3 == 0 ? 0x08 : random());
    const auto event = eventOf(packet, {});
    if (event) {
      ++good;
    } else {
      EXPECT_FALSE(event.reason().empty());
    }
  }
  EXPECT_GT(good, 100);
}

}  // namespace
}  // namespace vespscope::test
