// Values as JSON: numbers as numbers, bytes as lower-case hexadecimal text, absent as null, keys in record order.
#pragma once

#include <optional>
#include <string>

#include <nlohmann/json_fwd.hpp>

#include "values/Value.h"

namespace vespscope::tools {

using Json = nlohmann::ordered_json;

[[nodiscard]] Json toJson(const Value& value);
[[nodiscard]] Json toJson(const Record& record);
[[nodiscard]] Json toJson(const RecordList& list);
[[nodiscard]] Json toJson(const std::optional<Record>& record);

// Appends the JSON text of a record, on one line, to `out`: the same as write(toJson(record)), without the intermediate
// JSON values.
void appendJson(std::string& out, const Record& record);

// Returns the JSON text, on one line unless `indentation` is positive; bytes that are not UTF-8 become U+FFFD.
[[nodiscard]] std::string write(const Json& json, int indentation = -1);

}  // namespace vespscope::tools
