#include "frontends/terminal/EmptyState.h"

#include "platform/application/StatusText.h"

namespace vespscope::terminal {

EmptyState emptyStateOf(const ScreenModel& screen, const application::Status* status, bool utf8) {
  if (screen.rowCount() != 0) {
    const std::string& filter = screen.filter();
    return {"No row contains " + (utf8 ? "“" + filter + "”" : '"' + filter + '"'), "Press esc to clear the filter."};
  }
  return {"Waiting for Update", application::waitingText(status, screen.table().sections.empty())};
}

}  // namespace vespscope::terminal
