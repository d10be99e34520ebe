// Asks a source for its SIM card files and waits for what it finds.
#pragma once

#include <future>
#include <optional>
#include <utility>

#include "manager/Source.h"

namespace vespscope::test {

inline std::optional<manager::MetricEvent> simCardFilesOf(manager::Source& source) {
  std::promise<std::optional<manager::MetricEvent>> found;
  source.findSimCardFiles([&found](std::optional<manager::MetricEvent> files) { found.set_value(std::move(files)); });
  return found.get_future().get();
}

}  // namespace vespscope::test
