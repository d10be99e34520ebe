// Turns on the one mutant whose number the environment's MUTANT is; every other expression is as written.
#pragma once

#include <cstdlib>

namespace mutation {

inline int active() {
  static const int number = [] {
    const char* text = std::getenv("MUTANT");
    return text == nullptr ? 0 : std::atoi(text);
  }();
  return number;
}

constexpr bool on(int number) { return !__builtin_is_constant_evaluated() && active() == number; }

}  // namespace mutation
