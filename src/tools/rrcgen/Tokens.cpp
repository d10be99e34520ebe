#include "rrcgen/Tokens.h"

#include <array>

namespace vespscope::rrcgen {
namespace {

bool isDigit(char letter) { return letter >= '0' && letter <= '9'; }
bool isLetter(char letter) { return (letter >= 'a' && letter <= 'z') || (letter >= 'A' && letter <= 'Z'); }

// Returns the length of the word at the beginning of `text`: it may contain single hyphens, but not end in one.
std::size_t wordLength(std::string_view text) {
  std::size_t length = 0;
  const auto alphanumeric = [&](std::size_t at) {
    return at < text.size() && (isLetter(text[at]) || isDigit(text[at]));
  };
  while (alphanumeric(length) || (length < text.size() && text[length] == '-' && alphanumeric(length + 1))) ++length;
  return length;
}

std::size_t symbolLength(std::string_view text) {
  static constexpr std::array<std::string_view, 5> symbols = {"::=", "...", "..", "[[", "]]"};
  for (const std::string_view symbol : symbols) {
    if (text.starts_with(symbol)) return symbol.size();
  }
  return std::string_view("{}(),;|").find(text[0]) != std::string_view::npos ? 1 : 0;
}

}  // namespace

Result<std::vector<Token>> tokensOf(const std::string& name, std::string_view text) {
  std::vector<Token> tokens;
  int line = 1;
  while (!text.empty()) {
    const char letter = text[0];
    std::size_t length = 0;
    if (letter == '\n') ++line;
    if (letter == '\n' || letter == ' ' || letter == '\t' || letter == '\r') {
      length = 1;
    } else if (text.starts_with("--")) {
      length = std::min(text.find('\n'), text.size());
    } else if (isLetter(letter)) {
      length = wordLength(text);
      tokens.push_back({Token::Kind::word, std::string(text.substr(0, length)), line});
    } else if (isDigit(letter) || (letter == '-' && text.size() > 1 && isDigit(text[1]))) {
      length = 1;
      while (length < text.size() && isDigit(text[length])) ++length;
      tokens.push_back({Token::Kind::number, std::string(text.substr(0, length)), line});
    } else if (letter == '\'') {
      const std::size_t close = text.find('\'', 1);
      if (close == std::string_view::npos || close + 1 == text.size()) {
        return Failure{name + ":" + std::to_string(line) + ": string without an end"};
      }
      tokens.push_back({Token::Kind::string, std::string(text.substr(1, close - 1)), line});
      length = close + 2;  // includes the letter for binary or hexadecimal
    } else if (const std::size_t symbol = symbolLength(text); symbol > 0) {
      length = symbol;
      tokens.push_back({Token::Kind::symbol, std::string(text.substr(0, length)), line});
    } else {
      return Failure{name + ":" + std::to_string(line) + ": unexpected character '" + letter + "'"};
    }
    text.remove_prefix(length);
  }
  tokens.push_back({Token::Kind::end, "end of file", line});
  return tokens;
}

}  // namespace vespscope::rrcgen
