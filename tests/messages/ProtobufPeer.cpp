#include "ProtobufPeer.h"

#include <algorithm>
#include <fstream>
#include <limits>
#include <vector>

#include <google/protobuf/descriptor.pb.h>
#include <google/protobuf/unknown_field_set.h>
#include <gtest/gtest.h>

#include "registry/MetricRows.h"

namespace vespscope::test {
namespace {

namespace protobuf = google::protobuf;
using Cpp = protobuf::FieldDescriptor;

std::string unnamed(std::int32_t number) { return "(unknown: " + std::to_string(number) + ")"; }

// The unnamed value in an enumeration field, if there is one.
const std::uint64_t* unnamedValue(const protobuf::Message& message, const Cpp& field) {
  static std::uint64_t value;
  const protobuf::UnknownFieldSet& unknown = message.GetReflection()->GetUnknownFields(message);
  for (int index = unknown.field_count(); index-- > 0;) {
    if (unknown.field(index).number() != field.number()) continue;
    value = unknown.field(index).varint();
    return &value;
  }
  return nullptr;
}

Value valueOf(const protobuf::Message& message, const Cpp& field) {
  const protobuf::Reflection& reflection = *message.GetReflection();
  switch (field.type()) {
    case Cpp::TYPE_UINT64:
      return std::uint64_t{reflection.GetUInt64(message, &field)};
    case Cpp::TYPE_UINT32:
      return std::uint32_t{reflection.GetUInt32(message, &field)};
    case Cpp::TYPE_SINT32:
      return std::int32_t{reflection.GetInt32(message, &field)};
    case Cpp::TYPE_BOOL:
      return reflection.GetBool(message, &field);
    case Cpp::TYPE_STRING:
      return reflection.GetString(message, &field);
    case Cpp::TYPE_BYTES: {
      const std::string bytes = reflection.GetString(message, &field);
      return Bytes(bytes.begin(), bytes.end());
    }
    case Cpp::TYPE_ENUM:
      return std::string(reflection.GetEnum(message, &field)->name());
    case Cpp::TYPE_MESSAGE:
      return dictionaryOf(reflection.GetMessage(message, &field));
    default:
      ADD_FAILURE() << field.full_name() << " is of a kind that messages do not have";
      return {};
  }
}

List listOf(const protobuf::Message& message, const Cpp& field) {
  const protobuf::Reflection& reflection = *message.GetReflection();
  List list;
  for (int index = 0; index < reflection.FieldSize(message, &field); ++index) {
    if (field.type() == Cpp::TYPE_UINT32) {
      list.emplace_back(std::uint32_t{reflection.GetRepeatedUInt32(message, &field, index)});
    } else if (field.type() == Cpp::TYPE_SINT32) {
      list.emplace_back(std::int32_t{reflection.GetRepeatedInt32(message, &field, index)});
    } else {
      list.emplace_back(dictionaryOf(reflection.GetRepeatedMessage(message, &field, index)));
    }
  }
  return list;
}

std::vector<const Cpp*> fieldsInTagOrder(const protobuf::Descriptor& descriptor) {
  std::vector<const Cpp*> fields;
  fields.reserve(static_cast<std::size_t>(descriptor.field_count()));
  for (int index = 0; index < descriptor.field_count(); ++index) fields.push_back(descriptor.field(index));
  std::sort(fields.begin(), fields.end(), [](auto* one, auto* other) { return one->number() < other->number(); });
  return fields;
}

std::uint64_t anyNumber(std::mt19937& random) {
  const std::uint64_t wide = std::uint64_t{random()} << 32 | random();
  switch (random() % 5) {
    case 0:
      return random() % 4;
    case 1:
      return std::numeric_limits<std::uint64_t>::max() - random() % 2;
    case 2:
      return std::uint64_t{1} << random() % 64;
    default:
      return wide >> random() % 64;
  }
}

std::string anyBytes(std::mt19937& random) {
  std::string bytes(random() % 10 == 0 ? random() % 400 : random() % 8, '\0');
  for (char& byte : bytes) byte = static_cast<char>(random() % 256);
  return bytes;
}

// Returns any valid UTF-8 text, because protobuf logs other text.
std::string anyText(std::mt19937& random) {
  static const std::vector<std::string> pieces = {"a", "ims", ".", "\xC3\xA9", "\xE2\x82\xAC", std::string(1, '\0')};
  std::string text;
  for (std::size_t count = random() % 6; count > 0; --count) text += pieces[random() % pieces.size()];
  return text;
}

void setRandomly(protobuf::Message& message, const Cpp& field, std::mt19937& random, RandomContent content) {
  const protobuf::Reflection& reflection = *message.GetReflection();
  const std::uint64_t number = anyNumber(random);
  const auto low = static_cast<std::uint32_t>(number);
  switch (field.type()) {
    case Cpp::TYPE_UINT64:
      return reflection.SetUInt64(&message, &field, number);
    case Cpp::TYPE_UINT32:
      return reflection.SetUInt32(&message, &field, low);
    case Cpp::TYPE_SINT32:
      return reflection.SetInt32(&message, &field, static_cast<std::int32_t>(low));
    case Cpp::TYPE_BOOL:
      return reflection.SetBool(&message, &field, (number & 1) != 0);
    case Cpp::TYPE_STRING:
      return reflection.SetString(&message, &field, anyText(random));
    case Cpp::TYPE_BYTES:
      return reflection.SetString(&message, &field, anyBytes(random));
    case Cpp::TYPE_ENUM: {
      const protobuf::EnumDescriptor& values = *field.enum_type();
      const auto value = static_cast<std::int32_t>(low);
      const bool named = values.FindValueByNumber(value) != nullptr;
      if (content.unnamedEnumerationValues && !named && random() % 4 == 0) {
        // A number without a name, which protobuf stores among the unknown fields.
        reflection.MutableUnknownFields(&message)->AddVarint(field.number(),
                                                             static_cast<std::uint64_t>(std::int64_t{value}));
        return;
      }
      const auto index = static_cast<int>(random() % static_cast<unsigned>(values.value_count()));
      return reflection.SetEnumValue(&message, &field, values.value(index)->number());
    }
    default:
      return fillRandomly(*reflection.MutableMessage(&message, &field), random, content);
  }
}

void addRandomly(protobuf::Message& message, const Cpp& field, std::mt19937& random, RandomContent content) {
  const protobuf::Reflection& reflection = *message.GetReflection();
  const auto low = static_cast<std::uint32_t>(anyNumber(random));
  if (field.type() == Cpp::TYPE_UINT32) {
    reflection.AddUInt32(&message, &field, low);
  } else if (field.type() == Cpp::TYPE_SINT32) {
    reflection.AddInt32(&message, &field, static_cast<std::int32_t>(low));
  } else {
    fillRandomly(*reflection.AddMessage(&message, &field), random, content);
  }
}

}  // namespace

ProtobufPeer::ProtobufPeer() {
  std::ifstream input(VESPSCOPE_SCHEMA_DESCRIPTORS, std::ios::binary);
  protobuf::FileDescriptorSet files;
  EXPECT_TRUE(files.ParseFromIstream(&input)) << VESPSCOPE_SCHEMA_DESCRIPTORS;
  // A file may precede the files that it imports.
  for (int round = 0; round < files.file_size(); ++round) {
    for (const protobuf::FileDescriptorProto& file : files.file()) {
      const bool ready = std::all_of(file.dependency().begin(), file.dependency().end(),
                                     [this](const std::string& name) { return this->file(name) != nullptr; });
      if (!ready || this->file(file.name()) != nullptr) continue;
      EXPECT_NE(pool_.BuildFile(file), nullptr) << file.name();
    }
  }
}

const protobuf::FileDescriptor* ProtobufPeer::file(const std::string& name) const { return pool_.FindFileByName(name); }

const protobuf::Descriptor* ProtobufPeer::descriptor(std::string_view messageClass) const {
  return pool_.FindMessageTypeByName("vespscope." + std::string(messageClass));
}

std::unique_ptr<protobuf::Message> ProtobufPeer::make(std::string_view messageClass) {
  return std::unique_ptr<protobuf::Message>(factory_.GetPrototype(descriptor(messageClass))->New());
}

bool isNeverRead(const Cpp& field) {
  return std::any_of(metricRows.begin(), metricRows.end(),
                     [&field](const MetricRow& row) { return row.tag == field.number(); });
}

Record dictionaryOf(const protobuf::Message& message) {
  Record record;
  for (const Cpp* field : fieldsInTagOrder(*message.GetDescriptor())) {
    if (isNeverRead(*field)) continue;
    if (field->is_repeated()) {
      List list = listOf(message, *field);
      if (!list.empty()) record.append(Key(field->name()), std::move(list));
    } else if (message.GetReflection()->HasField(message, field)) {
      record.append(Key(field->name()), valueOf(message, *field));
    } else if (const std::uint64_t* value = unnamedValue(message, *field)) {
      record.append(Key(field->name()), unnamed(static_cast<std::int32_t>(*value)));
    }
  }
  return record;
}

void fillRandomly(protobuf::Message& message, std::mt19937& random, RandomContent content) {
  const unsigned density = random() % 4;  // of four fields
  for (const Cpp* field : fieldsInTagOrder(*message.GetDescriptor())) {
    if (isNeverRead(*field)) continue;
    if (field->is_repeated()) {
      const std::size_t count = random() % 4 == 0 ? random() % 5 : 0;
      for (std::size_t index = 0; index < count; ++index) addRandomly(message, *field, random, content);
    } else if (random() % 4 <= density) {
      setRandomly(message, *field, random, content);
    }
  }
}

}  // namespace vespscope::test
