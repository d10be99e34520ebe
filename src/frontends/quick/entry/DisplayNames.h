// The displays that the environment names.
#pragma once

#include <string>
#include <vector>

namespace vespscope::quick {

inline constexpr const char* noDisplayNamed = "there is no display: neither WAYLAND_DISPLAY nor DISPLAY is set";

// The variable's value; empty when it is not set.
[[nodiscard]] std::string environmentVariable(const char* name);

// The platforms that the toolkit would try: those that QT_QPA_PLATFORM lists ("xcb", "wayland", …, with their options),
// or those of WAYLAND_DISPLAY and DISPLAY. Empty when the environment names none.
[[nodiscard]] std::vector<std::string> platformsToTry();

}  // namespace vespscope::quick
