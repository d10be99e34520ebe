// Bounds a TOML text before a TOML library reads it: the library's recursion and memory follow what the text says.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace vespscope::manager {

struct TomlBounds {
  std::size_t size = std::size_t{64} << 10;  // bytes of the whole text
  std::size_t keyLength = 256;               // bytes of a key or a table's name as written, all its parts together
  std::size_t keyParts = 8;                  // a.b.c has three
  std::size_t nesting = 8;                   // of arrays and inline tables
};

// The first violation with its line, or nothing. Takes time linear in the text's size. A text without a violation makes
// a tree at most keyParts * (nesting + 2) + nesting deep. Also reports what makes the end of strings and comments
// uncertain: a string without an end, and a control character other than tab and line end.
[[nodiscard]] std::optional<std::string> violationOf(std::string_view toml, const TomlBounds& bounds = {});

}  // namespace vespscope::manager
