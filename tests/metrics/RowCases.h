// One literal payload for each handled metric, the decoder's lines for it and its stored value.
#pragma once

#include <cstdint>
#include <optional>
#include <ostream>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "metrics/MetricValidator.h"
#include "values/Text.h"

namespace vespscope::test {

struct ListCase {
  const char* name;
  std::string (*actual)(const MetricValidator&);
  const char* elements;  // their texts one after the other; '@' means the report's time
};

struct RowCase {
  const char* message;
  std::int64_t identifier;
  const char* payload;  // in hexadecimal; the timestamp is 1700000000000 in each
  const char* literal;  // begins the log line
  const char* report;   // the log line's dictionary after its timestamp
  std::vector<std::string> furtherLines;
  std::optional<Record> MetricValidator::*stored;
  const char* storedReport;  // the stored dictionary after its timestamp
  std::vector<ListCase> lists;
};

// The name of a row's instance of a parameterised test.
inline std::string nameOfRow(const ::testing::TestParamInfo<RowCase>& info) { return info.param.message; }
inline void PrintTo(const RowCase& row, std::ostream* out) { *out << row.message; }

// The time of every payload, in UTC.
inline const std::string reportTime = "2023-11-14 22:13:20 UTC";

inline std::string textOf(const Record& record) { return toText(record); }
inline std::string textOf(const RecordList& list) {
  std::string text;
  for (const Record& record : list) text += toText(record);
  return text;
}

[[nodiscard]] const std::vector<RowCase>& rowCases();
// The lines that the decoder prints for the payload.
[[nodiscard]] std::string identifierLineOf(const RowCase& row);
[[nodiscard]] std::vector<std::string> linesOf(const RowCase& row);

[[nodiscard]] Bytes bytesOf(std::string_view hexadecimal);
// Returns `text` with the report's time for each '@'.
[[nodiscard]] std::string withTime(std::string text);

}  // namespace vespscope::test
