// The declarations of schema files, in the subset of proto2 that the message generator supports.
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

// Returns the declarations in `text`, or the first error as "lte.proto:12: …". Supports syntax, package, import, enum,
// message with nested enums, optional and repeated fields, and `packed`.
[[nodiscard]] Result<SchemaFile> parseSchema(std::string_view stem, std::string_view text);

}  // namespace vespscope::messagegen
