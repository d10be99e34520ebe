// What a program finds out about its terminal without curses: the streams, the size that the environment asks for, and
// which control sequences the type knows.
#pragma once

#include <cstdio>
#include <memory>
#include <optional>
#include <string>

namespace vespscope::terminal {

struct CloseFile {
  void operator()(std::FILE* file) const { std::fclose(file); }
};
using File = std::unique_ptr<std::FILE, CloseFile>;

// Returns a stream of the standard descriptor if that is a terminal, else of the controlling terminal; null when there
// is neither. `mode` is that of fopen.
[[nodiscard]] File terminalFile(int standard, const char* mode);

// The maximum number of columns and lines: the memory of a frame grows with its size.
inline constexpr int mostCells = 1000;

// Returns why the environment's variable is not a terminal size; empty when it is one or is not set.
[[nodiscard]] std::optional<std::string> sizeObstacle(const char* variable);

// Whether the terminal ignores those of xterm's control sequences that it does not support; other terminals print them.
[[nodiscard]] bool ignoresUnknownSequences();

}  // namespace vespscope::terminal
