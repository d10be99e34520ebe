// The output of vespctl compared with protobuf's decoding by the same schema.
#include <fstream>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include <google/protobuf/descriptor.h>
#include <google/protobuf/descriptor.pb.h>
#include <google/protobuf/dynamic_message.h>
#include <google/protobuf/unknown_field_set.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include "Program.h"
#include "support/ScriptedRun.h"

namespace vespscope::test {
namespace {

namespace pb = google::protobuf;
using Json = nlohmann::ordered_json;

std::string hexadecimal(const std::string& bytes) {
  std::string text;
  for (const char byte : bytes) {
    constexpr const char* digits = "0123456789abcdef";
    text += digits[static_cast<unsigned char>(byte) >> 4];
    text += digits[byte & 15];
  }
  return text;
}

Json toJson(const pb::Message& message);

// The value of a field, or of its element `index` if that is not negative.
Json toJson(const pb::Message& message, const pb::FieldDescriptor& field, int index) {
  const pb::Reflection& in = *message.GetReflection();
  const bool many = index >= 0;
  switch (field.cpp_type()) {
    case pb::FieldDescriptor::CPPTYPE_INT32:
      return many ? in.GetRepeatedInt32(message, &field, index) : in.GetInt32(message, &field);
    case pb::FieldDescriptor::CPPTYPE_UINT32:
      return many ? in.GetRepeatedUInt32(message, &field, index) : in.GetUInt32(message, &field);
    case pb::FieldDescriptor::CPPTYPE_UINT64:
      return in.GetUInt64(message, &field);
    case pb::FieldDescriptor::CPPTYPE_BOOL:
      return in.GetBool(message, &field);
    case pb::FieldDescriptor::CPPTYPE_ENUM:
      return in.GetEnum(message, &field)->name();
    case pb::FieldDescriptor::CPPTYPE_STRING: {
      const std::string text = in.GetString(message, &field);
      return field.type() == pb::FieldDescriptor::TYPE_BYTES ? hexadecimal(text) : text;
    }
    case pb::FieldDescriptor::CPPTYPE_MESSAGE:
      return toJson(many ? in.GetRepeatedMessage(message, &field, index) : in.GetMessage(message, &field));
    default:
      ADD_FAILURE() << field.full_name() << " is of a kind that no metric has";
      return nullptr;
  }
}

// An enumeration's number without a name, which protobuf stores separately.
std::optional<std::string> unnamed(const pb::Message& message, const pb::FieldDescriptor& field) {
  const pb::UnknownFieldSet& aside = message.GetReflection()->GetUnknownFields(message);
  for (int index = 0; index < aside.field_count(); ++index) {
    if (aside.field(index).number() != field.number()) continue;
    return "(unknown: " + std::to_string(static_cast<std::int32_t>(aside.field(index).varint())) + ")";
  }
  return std::nullopt;
}

Json toJson(const pb::Message& message) {
  const pb::Reflection& in = *message.GetReflection();
  Json record = Json::object();
  for (int position = 0; position < message.GetDescriptor()->field_count(); ++position) {
    const pb::FieldDescriptor& field = *message.GetDescriptor()->field(position);
    // The number of the SIM card files metric, which is never stored in any message, on purpose.
    if (field.number() == 19) continue;
    if (field.is_repeated()) {
      Json list = Json::array();
      for (int index = 0; index < in.FieldSize(message, &field); ++index) {
        list.push_back(toJson(message, field, index));
      }
      if (!list.empty()) record[field.name()] = std::move(list);
    } else if (in.HasField(message, &field)) {
      record[field.name()] = toJson(message, field, -1);
    } else if (const auto text = unnamed(message, field)) {
      record[field.name()] = *text;
    }
  }
  return record;
}

TEST(VespctlDecode, AgreesWithProtobufOnEveryMetric) {
  pb::FileDescriptorSet schema;
  std::ifstream file(VESPSCOPE_SCHEMA, std::ios::binary);
  ASSERT_TRUE(schema.ParseFromIstream(&file));
  pb::DescriptorPool pool;
  for (const pb::FileDescriptorProto& part : schema.file()) ASSERT_NE(pool.BuildFile(part), nullptr) << part.name();
  pb::DynamicMessageFactory factory;

  const std::vector<MetricEvent> events = scriptedRun();
  ASSERT_EQ(events.size(), 29U);
  const std::vector<std::string> lines = linesOf(vespctl({"decode", "-"}, captureOf(events)).output);
  ASSERT_EQ(lines.size(), events.size());
  for (std::size_t index = 0; index < events.size(); ++index) {
    const Json packet = Json::parse(lines[index]);
    const std::string name = packet["message"];
    const pb::Descriptor* descriptor = pool.FindMessageTypeByName("vespscope." + name);
    ASSERT_NE(descriptor, nullptr) << name;
    const std::unique_ptr<pb::Message> message(factory.GetPrototype(descriptor)->New());
    ASSERT_TRUE(message->ParseFromArray(events[index].payload.data(), static_cast<int>(events[index].payload.size())));
    EXPECT_EQ(packet["ok"], true);
    // Text that is not UTF-8 is written with replacement characters.
    EXPECT_EQ(packet["record"].dump(), toJson(*message).dump(-1, ' ', false, Json::error_handler_t::replace)) << name;
    EXPECT_FALSE(packet["record"].empty()) << name;
  }
}

}  // namespace
}  // namespace vespscope::test
