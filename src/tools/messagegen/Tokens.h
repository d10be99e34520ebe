// Splits a schema file into words, numbers, texts and punctuation, each with the comment above it.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "values/Result.h"

namespace vespscope::messagegen {

struct Token {
  enum class Kind { word, number, text, punctuation, end };
  Kind kind = Kind::end;
  std::string text;
  std::string comment;  // of the lines directly above, joined by blanks
  std::size_t line = 0;
};

// Returns the tokens of `text`, the last of kind end, or an error as "12: …".
[[nodiscard]] Result<std::vector<Token>> tokenize(std::string_view text);

}  // namespace vespscope::messagegen
