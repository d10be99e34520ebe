#include "frontends/terminal/EmptyState.h"

namespace vespscope::terminal {
namespace {

std::string quoted(const std::string& text, bool utf8) { return utf8 ? "“" + text + "”" : '"' + text + '"'; }

}  // namespace

EmptyState emptyStateOf(const ScreenModel& screen, const std::string& name, const application::Status* status,
                        bool utf8) {
  if (screen.rowCount() != 0) {
    return {"No row contains " + quoted(screen.filter(), utf8), "Press esc to clear the filter."};
  }
  const std::string title = "Waiting for Update";
  if (status != nullptr && !status->connected) {
    return {title, "The baseband manager is not connected; the connection is being retried. Values of " +
                       quoted(name, utf8) + " appear here with the first report after that."};
  }
  if (screen.table().sections.empty()) {
    return {title, "The latest report for " + quoted(name, utf8) +
                       " had no entries. They appear here when a report brings some."};
  }
  if (status != nullptr && status->events == 0) {
    return {title, "Connected to the baseband manager, which has not sent any event yet. Values of " +
                       quoted(name, utf8) + " appear here with their first report."};
  }
  return {title, "The modem has not reported any values of " + quoted(name, utf8) +
                     " yet. They appear here with the first report."};
}

}  // namespace vespscope::terminal
