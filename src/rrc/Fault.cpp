#include "rrc/Fault.h"

#include <array>

namespace vespscope::rrc {

std::string_view textOf(FaultKind kind) {
  static constexpr std::array<std::string_view, faultKindCount> texts = {
      "the message ends inside a value", "a value is outside its declared range",    "a length has more than 14 bits",
      "values are nested too deep",      "the message has more than 262,144 values",
  };
  return texts[static_cast<std::size_t>(kind)];
}

}  // namespace vespscope::rrc
