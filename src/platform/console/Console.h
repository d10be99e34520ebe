// The only way in which a program writes to its user: error lines, help and progress. File names, texts from a remote
// manager and other outside bytes reach a terminal only through here, as printable lines of UTF-8 without control
// characters.
#pragma once

#include <string_view>

namespace vespscope::console {

// Writes one line to standard error; a newline inside it is made visible.
void error(std::string_view line);

// Writes a text of several lines, each ending in a newline, to standard error or standard output. Other control
// characters are made visible.
void errorText(std::string_view text);
void outputText(std::string_view text);

// Whether standard error is a terminal, so that progress can be shown.
[[nodiscard]] bool errorIsTerminal();
// Shows a line on standard error's terminal in place of the one shown before, cut to the terminal's width; an empty
// line removes it.
void showProgress(std::string_view line);

}  // namespace vespscope::console
