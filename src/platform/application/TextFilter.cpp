#include "platform/application/TextFilter.h"

#include <algorithm>
#include <cwctype>
#include <utility>

#include "values/Text.h"
#include "values/Utf8.h"

namespace vespscope::application {

TextFilter::TextFilter(std::string text) : text_(std::move(text)), wanted_(caseFolded(text_)) {}

bool TextFilter::passes(std::string_view text) const {
  return wanted_.empty() || caseFolded(text).find(wanted_) != std::string::npos;
}

std::string caseFolded(std::string_view text) {
  if (isPlain(text)) {
    std::string folded(text);
    std::transform(folded.begin(), folded.end(), folded.begin(), [](char character) {
      return character >= 'A' && character <= 'Z' ? static_cast<char>(character - 'A' + 'a') : character;
    });
    return folded;
  }
  std::string folded;
  const std::string clean = printable(text);
  for (std::string_view left = clean; !left.empty();) {
    const CodePoint point = codePointAt(left);
    left.remove_prefix(point.length);
    appendCodePoint(folded, static_cast<char32_t>(std::towlower(static_cast<wint_t>(point.value))));
  }
  return folded;
}

}  // namespace vespscope::application
