#include "frontends/terminal/TerminalEnvironment.h"

#include <fcntl.h>
#include <unistd.h>

#include <cstdlib>
#include <string_view>

#include "values/Text.h"

namespace vespscope::terminal {

File terminalFile(int standard, const char* mode) {
  const int descriptor = ::isatty(standard) != 0 ? ::fcntl(standard, F_DUPFD_CLOEXEC, 3)
                                                 : ::open("/dev/tty", O_RDWR | O_CLOEXEC | O_NOCTTY);
  if (descriptor < 0) return nullptr;
  return File(::fdopen(descriptor, mode));
}

std::optional<std::string> sizeObstacle(const char* variable) {
  const char* text = std::getenv(variable);
  if (text == nullptr) return std::nullopt;
  char* end = nullptr;
  const long number = std::strtol(text, &end, 10);
  if (*end != '\0' || number <= mostCells) return std::nullopt;  // curses ignores anything but a positive number
  return std::string(variable) + " is " + printable(text) + ", and a terminal has at most " +
         std::to_string(mostCells) + " of them";
}

bool ignoresUnknownSequences() {
  const char* name = std::getenv("TERM");
  const std::string_view type = name == nullptr ? "" : name;
  return !type.starts_with("vt") && !type.starts_with("linux");
}

}  // namespace vespscope::terminal
