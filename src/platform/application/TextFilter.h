// The filter of a list: passes texts that contain what the user typed, in any case.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace vespscope::application {

class TextFilter {
 public:
  // The maximum number of characters that a user can type; frontends ignore further ones.
  static constexpr std::size_t longestText = 200;

  TextFilter() = default;
  explicit TextFilter(std::string text);

  // The text as typed; an empty filter passes every text.
  [[nodiscard]] const std::string& text() const { return text_; }
  [[nodiscard]] bool empty() const { return text_.empty(); }
  [[nodiscard]] bool passes(std::string_view text) const;

 private:
  std::string text_;
  std::string wanted_;  // case folded
};

// Returns the text made printable and in lower case.
[[nodiscard]] std::string caseFolded(std::string_view text);

}  // namespace vespscope::application
