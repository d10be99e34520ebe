// What happens to a freshly stored report after it has been logged: lists to the holders, codes to display units.
#pragma once

#include <array>
#include <string_view>
#include <variant>

#include "metrics/Measurements.h"
#include "metrics/MetricValidator.h"
#include "values/Value.h"

namespace vespscope {

// of a dedicated bearer: its default bearer
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
// Empty for other messages, for an invalid bearer identity, and for one whose mandatory part is truncated.
struct FillTemplate {
  RecordField field;
};
// One of the lists that make up a list of tracking areas: the number of areas, and their coding.
struct WriteOutIntegers {
  std::string_view key;
};
// Networks, areas and temporary identities as coded in NAS messages.
struct WriteOutRecord {
  std::string_view key;
};
struct WriteOutRecordList {
  std::string_view key;
};
// All areas of a list (3GPP TS 24.301 9.9.3.33), in order; empty when the list is damaged.
struct Halve {
  std::string_view key;
};

using Step =
    std::variant<NoStep, ReplaceList, FillTemplate, WriteOutIntegers, WriteOutRecord, WriteOutRecordList, Halve>;
// The GUTI of an EPS mobile identity (3GPP TS 24.301 9.9.3.12); empty for other types.
using Steps = std::array<Step, 3>;

// The TMSI or P-TMSI of a mobile identity (3GPP TS 24.008 10.5.1.4); empty for other types.
void postProcess(MetricValidator& validator, Record& report, const Steps& steps);

// Replaces the "timestamp" entry (milliseconds) by its text; an absent report is a programming error.
void writeOutTimestamp(const MetricValidator& validator, std::optional<Record>& report);

}  // namespace vespscope
