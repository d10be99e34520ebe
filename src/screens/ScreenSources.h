// Which stored values of the decoder each second-level screen shows, one row per screen key.
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

#include "values/Value.h"

namespace vespscope {

class MetricValidator;

struct ScreenSource {
  std::string_view key;
  std::optional<std::int64_t> metric = {};  // the metric whose latest report the screen shows; empty: no report fills
                                            // its list
  // A screen of one section: the record it shows, null while there is none.
  const Record* (*record)(const MetricValidator&) = nullptr;
  // Otherwise a list screen: a section for each record.
  const RecordList& (*list)(const MetricValidator&) = nullptr;
  // The prefix of the number in a list screen's headers; empty: no headers.
  std::string_view headerPrefix = {};
};

// Returns the source of the screen whose key is exactly `key`, or null.
[[nodiscard]] const ScreenSource* screenSource(std::string_view key);

}  // namespace vespscope
