#include "tools/vespctl/Output.h"

#include <cerrno>
#include <cstdio>
#include <string>
#include <system_error>

namespace vespscope::tools {
namespace {

Problem problem() { return "standard output: " + std::generic_category().message(errno); }

}  // namespace

Problem writeLine(std::string_view text) {
  if (std::fwrite(text.data(), 1, text.size(), stdout) != text.size() || std::fputc('\n', stdout) == EOF) {
    return problem();
  }
  return std::nullopt;
}

Problem flushOutput() {
  if (std::fflush(stdout) != 0) return problem();
  return std::nullopt;
}

}  // namespace vespscope::tools
