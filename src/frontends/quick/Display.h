// Checks whether a display named by the environment opens, without the toolkit, which aborts if none does.
#pragma once

#include <memory>
#include <string>

namespace vespscope::quick {

struct DisplayCheck {
  bool opens = false;
  std::string reason;  // why not, in one sentence for the user
  // Keeps an X display open until the toolkit has opened it too: a server whose only client disconnects restarts and
  // refuses connections meanwhile.
  std::shared_ptr<void> connection;
  bool named = false;  // whether the environment names a display at all
};

// Tries the same displays as the toolkit: the platforms that QT_QPA_PLATFORM lists, or the displays of WAYLAND_DISPLAY
// and DISPLAY. A platform that needs neither counts as a display that opens.
[[nodiscard]] DisplayCheck checkDisplay();

}  // namespace vespscope::quick
