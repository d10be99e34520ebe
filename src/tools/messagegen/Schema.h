// The declarations of schema files, as far as the message generator understands proto2.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "values/Result.h"

namespace vespscope::messagegen {

struct EnumerationValue {
  std::string name;
  std::int32_t number = 0;
};

struct Enumeration {
  std::string name;
  std::string comment;  // the sentence above the declaration
  std::vector<EnumerationValue> values;
};

struct Field {
  bool repeated = false;
  bool packed = false;
  std::string type;
  std::string name;
  std::uint32_t number = 0;
  std::size_t line = 0;
};

struct MessageType {
  std::string name;
  std::string comment;
  std::vector<Enumeration> enumerations;
  std::vector<Field> fields;
  std::size_t line = 0;
};

struct SchemaFile {
  std::string stem;  // "lte" for lte.proto: also the folder of its headers
  std::vector<std::string> imports;
  std::vector<Enumeration> enumerations;
  std::vector<MessageType> messages;
};

// The declarations in `text`, or the first fault as "lte.proto:12: …". Understood are syntax, package, import,
// enum, message with nested enums, optional and repeated fields, and `packed`.
[[nodiscard]] Result<SchemaFile> parseSchema(std::string_view stem, std::string_view text);

}  // namespace vespscope::messagegen
