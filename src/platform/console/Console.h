// What a program writes to the person who runs it: error lines, help and progress. File names, texts of a remote
// manager and other outside bytes reach a terminal only through here, as printable lines of UTF-8 without control
// characters.
#pragma once

#include <string_view>

namespace vespscope::console {

// Writes one line to standard error; a line end inside it becomes visible too.
void error(std::string_view line);

// Writes a text of several lines, each ending in a newline, to standard error or standard output. Only newlines are
// taken as they are.
void errorText(std::string_view text);
void outputText(std::string_view text);

// Whether standard error is a terminal, where progress is worth showing.
[[nodiscard]] bool errorIsTerminal();
// Shows a line on the terminal of standard error, over the one shown before and cut to the terminal's width; an empty
// line removes it.
void showProgress(std::string_view line);

}  // namespace vespscope::console
