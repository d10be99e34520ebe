// Bounds a TOML text before the TOML library reads it, because the library's recursion and memory depend on the text.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace vespscope::manager {

struct TomlBounds {
  std::size_t size = std::size_t{64} << 10;  // bytes of the whole text
  std::size_t keyLength = 256;               // bytes of a key or a table's name as written, with all its parts
  std::size_t keyParts = 8;                  // a.b.c has three
  std::size_t nesting = 8;                   // of arrays and inline tables
};

// Returns the first violation with its line; empty if there is none. Takes time linear in the text's size. A text
// without a violation makes a tree at most keyParts * (nesting + 2) + nesting deep. Also reports whatever makes the end
// of strings and comments ambiguous: an unterminated string, and a control character other than tab and line end.
[[nodiscard]] std::optional<std::string> violationOf(std::string_view toml, const TomlBounds& bounds = {});

}  // namespace vespscope::manager
