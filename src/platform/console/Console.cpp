#include "platform/console/Console.h"

#include <sys/ioctl.h>
#include <unistd.h>

#include <cerrno>
#include <string>

#include "values/Text.h"

namespace vespscope::console {
namespace {

// Errors are ignored: when this output is closed or full, they cannot be reported anywhere.
void write(int descriptor, std::string_view text) {
  while (!text.empty()) {
    const ssize_t written = ::write(descriptor, text.data(), text.size());
    if (written < 0 && errno == EINTR) continue;
    if (written <= 0) return;
    text.remove_prefix(static_cast<std::size_t>(written));
  }
}

void writeLines(int descriptor, std::string_view text) {
  std::string lines;
  while (!text.empty()) {
    const std::size_t end = text.find('\n');
    appendPrintable(lines, text.substr(0, end));
    lines += '\n';
    text.remove_prefix(end == std::string_view::npos ? text.size() : end + 1);
  }
  write(descriptor, lines);
}

std::size_t terminalWidth() {
  constexpr std::size_t usual = 80;
  winsize size{};
  return ::ioctl(STDERR_FILENO, TIOCGWINSZ, &size) == 0 && size.ws_col > 0 ? size.ws_col : usual;
}

// At most `length` bytes of printable UTF-8, without a part of a character.
std::string_view cutTo(std::size_t length, std::string_view text) {
  if (text.size() <= length) return text;
  while (length > 0 && (static_cast<unsigned char>(text[length]) & 0xC0) == 0x80) --length;
  return text.substr(0, length);
}

}  // namespace

void error(std::string_view line) { write(STDERR_FILENO, printable(line) + "\n"); }
void errorText(std::string_view text) { writeLines(STDERR_FILENO, text); }
void outputText(std::string_view text) { writeLines(STDOUT_FILENO, text); }

bool errorIsTerminal() { return ::isatty(STDERR_FILENO) != 0; }

void showProgress(std::string_view line) {
  const std::string text = printable(line);
  write(STDERR_FILENO, "\r" + std::string(cutTo(terminalWidth() - 1, text)) + "\x1b[K");
}

}  // namespace vespscope::console
