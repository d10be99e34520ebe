// The generator's input: the declarations of all schema files with every type resolved and every name formed.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "messagegen/Schema.h"

namespace vespscope::messagegen {

// How a field is stored and which accessors it has.
enum class Shape { number, enumeration, content, message, messageList, numberList };

struct FieldModel {
  Shape shape = Shape::number;
  std::string key;       // the schema name
  std::string property;  // the accessor's name
  std::string item;      // the name of one element of a repeated field
  std::uint32_t number = 0;
  std::string kind;    // of a number: uint64, uint32, int32, sint32, boolean
  std::string stored;  // the C++ type of a number or of bytes, the class of a message, or an enumeration's scope
  unsigned bit = 0;    // for a number
};

struct MessageModel {
  const MessageType* declaration = nullptr;
  std::vector<FieldModel> fields;     // in tag order
  std::vector<std::string> includes;  // headers of the types it uses, sorted
  unsigned presenceWidth = 8;         // bits of the presence word
};

struct FileModel {
  const SchemaFile* file = nullptr;
  std::vector<MessageModel> messages;
};

// Returns the models of `files`, or the first error as "lte.proto:12: …". `files` must outlive the result.
[[nodiscard]] Result<std::vector<FileModel>> buildModel(const std::vector<SchemaFile>& files);

// "prev_state_dur_ms" becomes "prevStateDurMs", "QRxLevMin" "qRxLevMin": split at underscores, the first letter
// lowered, each later piece capitalised.
[[nodiscard]] std::string propertyName(const std::string& key);
[[nodiscard]] std::string capitalized(std::string name);

}  // namespace vespscope::messagegen
