// A text for a terminal: headings, and items below them wrapped to 80 columns.
#pragma once

#include <string>
#include <string_view>

namespace vespscope::tools {

// The words with blanks at which a line never ends.
[[nodiscard]] std::string unbroken(std::string words);

class Paragraphs {
 public:
  // A line, wrapped without an indentation.
  void line(std::string_view words);
  // Begins a part; nothing is written for a part without items.
  void heading(std::string_view words);
  // Indented, its further lines deeper.
  void item(std::string_view words);
  // An item that is copied as a whole, such as a command: never wrapped.
  void verbatim(std::string_view words);

  // Each line ends in a newline.
  [[nodiscard]] const std::string& text() const { return text_; }

 private:
  void begin();
  void wrap(std::string_view words, std::size_t first, std::size_t others);

  std::string text_;
  std::string heading_;  // of the part that has no item yet
};

}  // namespace vespscope::tools
