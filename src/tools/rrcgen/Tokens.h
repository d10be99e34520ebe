// Splits ASN.1 text (ITU-T X.680) into words, numbers, strings and symbols, without comments.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "values/Result.h"

namespace vespscope::rrcgen {

struct Token {
  enum class Kind { word, number, string, symbol, end };
  Kind kind = Kind::end;
  std::string text;  // of a number with its sign, of a string without its quotes
  int line = 0;      // from 1
};

// Returns the tokens of `text`, the last of kind `end`, or an error with `name` and line.
[[nodiscard]] Result<std::vector<Token>> tokensOf(const std::string& name, std::string_view text);

}  // namespace vespscope::rrcgen
