// Whether a display opens that the environment names, found out without the toolkit, which aborts where none does.
#pragma once

#include <memory>
#include <string>

namespace vespscope::quick {

struct DisplayCheck {
  bool opens = false;
  std::string reason;  // why not, one sentence for the user
  // Keeps an X display open until the toolkit has opened it too: a server that loses its only client starts anew, and
  // refuses connections meanwhile.
  std::shared_ptr<void> connection;
  bool named = false;  // whether the environment names a display at all
};

// Tries what the toolkit would try: the platforms that QT_QPA_PLATFORM lists, or the displays of WAYLAND_DISPLAY and
// DISPLAY. A platform that needs neither counts as a display that opens.
[[nodiscard]] DisplayCheck checkDisplay();

}  // namespace vespscope::quick
