// What happens to a freshly stored report after it has been logged: lists to the holders, codes to display units.
#pragma once

#include <array>
#include <string_view>
#include <variant>

#include "metrics/Measurements.h"
#include "metrics/MetricValidator.h"
#include "values/Value.h"

namespace vespscope {

// Names one field of the decoder's holders.
using ListField = RecordList& (*)(MetricValidator&);
using RecordField = Record& (*)(MetricValidator&);

struct NoStep {};
// The report's list `key` replaces the holder's, its codes converted and every element given the report's "timestamp"
// and, when `shared` names one, that entry too. A list that is missing or holds anything but records is skipped.
struct ReplaceList {
  std::string_view key;
  ListField field;
  Measured measured = Measured::nothing;
  std::string_view shared = {};
};
// Every key that the holder's record still has takes the report's value, or leaves when the report has none.
struct FillTemplate {
  RecordField field;
};
// A list of integers becomes its one-line text, which is also a log line of its own.
struct WriteOutIntegers {
  std::string_view key;
};
// A record, or a list of records, becomes its one-line text.
struct WriteOutRecord {
  std::string_view key;
};
struct WriteOutRecordList {
  std::string_view key;
};
// A 32-bit integer is halved.
struct Halve {
  std::string_view key;
};

using Step =
    std::variant<NoStep, ReplaceList, FillTemplate, WriteOutIntegers, WriteOutRecord, WriteOutRecordList, Halve>;
// No metric needs more than three.
using Steps = std::array<Step, 3>;

// Carries out the steps on `report`, the dictionary just stored in `validator`.
void postProcess(MetricValidator& validator, Record& report, const Steps& steps);

// Replaces the "timestamp" entry (milliseconds) by its text; an absent report is a programming error.
void writeOutTimestamp(const MetricValidator& validator, std::optional<Record>& report);

}  // namespace vespscope
