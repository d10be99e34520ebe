// What reading a command line is for every program: options to run with, or a text to print and an exit status.
#pragma once

#include <optional>
#include <string>

namespace CLI {
class App;
}

namespace vespscope {

inline constexpr int usageStatus = 2;  // the exit status after invalid arguments

// What a program prints instead of running, and how it exits.
struct Ending {
  std::string text;
  int status = 0;  // 0: the text goes to standard output; else it is one line for standard error

  // Prints the text, and returns the status.
  int print() const;
};

template <class Options>
struct CommandLine {
  std::optional<Options> options;  // to run with; else:
  Ending ending;
};

// The ending that reports why the program does not accept its arguments.
[[nodiscard]] Ending refusal(const CLI::App& app, const std::string& why);

// Reads the arguments into the variables of the program's options. Returns an ending if they ask for help or for the
// version, or are invalid.
[[nodiscard]] std::optional<Ending> parseArguments(CLI::App& app, int argc, const char* const* argv);

}  // namespace vespscope
