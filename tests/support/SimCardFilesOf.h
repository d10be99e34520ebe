// Requests a source's SIM card files and waits for the result.
#pragma once

#include <future>
#include <optional>
#include <utility>

#include "sources/playback/Source.h"

namespace vespscope::test {

inline std::optional<MetricEvent> simCardFilesOf(sources::Source& source) {
  std::promise<std::optional<MetricEvent>> found;
  source.findSimCardFiles([&found](std::optional<MetricEvent> files) { found.set_value(std::move(files)); });
  return found.get_future().get();
}

}  // namespace vespscope::test
