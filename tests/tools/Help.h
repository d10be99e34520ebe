// Reads the lists in the programs' help.
#pragma once

#include <regex>
#include <set>
#include <string>

#include "Program.h"

namespace vespscope::test {

// The first word of each row of a help's list of options, as "--name".
inline std::set<std::string> optionsOf(const std::string& help) {
  std::set<std::string> options;
  const std::regex row("^  (-[a-z],)?(--[a-z][a-z-]*).*");
  for (const std::string& line : linesOf(help)) {
    if (std::smatch found; std::regex_match(line, found, row)) options.insert(found[2]);
  }
  return options;
}

}  // namespace vespscope::test
