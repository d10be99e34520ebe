// Words, numbers, texts and punctuation of a schema file, with the comment that stands above each.
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

// The tokens of `text`, closed by one of kind end, or a fault as "12: …".
[[nodiscard]] Result<std::vector<Token>> tokenize(std::string_view text);

}  // namespace vespscope::messagegen
