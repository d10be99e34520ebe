// Whether a source's events come from a modem, a recording or a model.
#pragma once

#include <string_view>

namespace vespscope {

enum class SourceKind { unknown, live, recorded, simulated };

// The word of a kind on the bus.
[[nodiscard]] constexpr std::string_view wordOf(SourceKind kind) {
  switch (kind) {
    case SourceKind::live:
      return "live";
    case SourceKind::recorded:
      return "recorded";
    case SourceKind::simulated:
      return "simulated";
    case SourceKind::unknown:
      break;
  }
  return "unknown";
}

// The kind of a word; `unknown` for any other word.
[[nodiscard]] constexpr SourceKind sourceKindOf(std::string_view word) {
  for (const SourceKind kind : {SourceKind::live, SourceKind::recorded, SourceKind::simulated}) {
    if (word == wordOf(kind)) return kind;
  }
  return SourceKind::unknown;
}

}  // namespace vespscope
