// The accessors and the storage of one field, as C++ text.
#pragma once

#include <string>

#include "messagegen/Model.h"

namespace vespscope::messagegen {

// The declarations inside the class, indented.
[[nodiscard]] std::string accessors(const FieldModel& field);
// The member that holds the field.
[[nodiscard]] std::string storage(const FieldModel& field);
// The field's entry in the field table.
[[nodiscard]] std::string tableEntry(const FieldModel& field);

// Returns `pattern` with every @name@ replaced by the text of that name.
struct Replacement {
  std::string name;
  std::string text;
};
[[nodiscard]] std::string fill(std::string pattern, const std::vector<Replacement>& replacements);

}  // namespace vespscope::messagegen
