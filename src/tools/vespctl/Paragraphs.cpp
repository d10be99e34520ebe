#include "tools/vespctl/Paragraphs.h"

#include <algorithm>

namespace vespscope::tools {
namespace {

constexpr std::size_t width = 80;
constexpr std::size_t indentation = 2;
constexpr char fixedBlank = '\x1F';

}  // namespace

std::string unbroken(std::string words) {
  std::replace(words.begin(), words.end(), ' ', fixedBlank);
  return words;
}

void Paragraphs::line(std::string_view words) { wrap(words, 0, indentation); }
void Paragraphs::heading(std::string_view words) { heading_ = words; }

void Paragraphs::item(std::string_view words) {
  begin();
  wrap(words, indentation, 2 * indentation);
}

void Paragraphs::verbatim(std::string_view words) {
  begin();
  text_.append(indentation, ' ').append(words).append("\n");
}

void Paragraphs::begin() {
  if (heading_.empty()) return;
  text_ += "\n" + heading_ + "\n";
  heading_.clear();
}

void Paragraphs::wrap(std::string_view words, std::size_t first, std::size_t others) {
  std::size_t column = first;
  text_.append(first, ' ');
  bool begun = false;
  while (!words.empty()) {
    const std::string_view word = words.substr(0, words.find(' '));
    words.remove_prefix(std::min(word.size() + 1, words.size()));
    if (begun && column + 1 + word.size() > width) {
      text_.append("\n").append(others, ' ');
      column = others;
    } else if (begun) {
      text_ += ' ';
      ++column;
    }
    for (const char each : word) text_ += each == fixedBlank ? ' ' : each;
    column += word.size();
    begun = true;
  }
  text_ += '\n';
}

}  // namespace vespscope::tools
