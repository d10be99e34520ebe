// The 29 metrics that the decoder handles: identifier, message, where it is stored, and what its report goes through.
#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string_view>

#include "metrics/MetricValidator.h"
#include "metrics/PostProcessing.h"
#include "values/Value.h"

namespace vespscope {

// A payload as its message's dictionary.
struct DecodedPayload {
  Record record;    // empty when the payload did not decode
  bool ok = false;  // false when the payload was missing or did not decode
};

struct EventRow {
  std::int64_t identifier;
  std::string_view message;  // the message class
  DecodedPayload (*decode)(const Bytes* payload);
  std::optional<Record> MetricValidator::*stored;
  std::string_view literal;  // opens the log line, with its trailing blank
  Steps steps = {};
};

// In ascending order of identifiers.
[[nodiscard]] std::span<const EventRow> eventRows();

// The row of `identifier`; null for a metric that is not handled.
[[nodiscard]] const EventRow* findEventRow(std::int64_t identifier);

}  // namespace vespscope
