// The schema loaded into another implementation of Protocol Buffers, with which the messages are compared.
#pragma once

#include <memory>
#include <random>
#include <string>
#include <string_view>

#include <google/protobuf/descriptor.h>
#include <google/protobuf/dynamic_message.h>

#include "values/Value.h"

namespace vespscope::test {

class ProtobufPeer {
 public:
  ProtobufPeer();

  // The file `name` of the schema, such as "lte.proto".
  [[nodiscard]] const google::protobuf::FileDescriptor* file(const std::string& name) const;
  [[nodiscard]] const google::protobuf::Descriptor* descriptor(std::string_view messageClass) const;
  [[nodiscard]] std::unique_ptr<google::protobuf::Message> make(std::string_view messageClass);

 private:
  google::protobuf::DescriptorPool pool_;
  google::protobuf::DynamicMessageFactory factory_;
};

// The dictionary that our message must have for the content of `message`. Numbers of closed enumerations without a
// name, which protobuf stores among the unknown fields, count as values of their fields.
[[nodiscard]] Record dictionaryOf(const google::protobuf::Message& message);

struct RandomContent {
  bool unnamedEnumerationValues = false;
};
// Sets a random choice of fields to random values, including boundary values.
void fillRandomly(google::protobuf::Message& message, std::mt19937& random, RandomContent content);

// Returns true for a field whose number is a metric tag, which our readers never store.
[[nodiscard]] bool isNeverRead(const google::protobuf::FieldDescriptor& field);

}  // namespace vespscope::test
