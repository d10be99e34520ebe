#include "manager/TomlBounds.h"

namespace vespscope::manager {
namespace {

class Scan {
 public:
  Scan(std::string_view toml, const TomlBounds& bounds) : text_(toml), bounds_(bounds) {}

  std::optional<std::string> run() {
    while (!problem_ && position_ < text_.size()) step();
    return problem_;
  }

 private:
  void step() {
    const char letter = text_[position_];
    if (letter == '"' || letter == '\'') return skipString(letter);
    if (letter == '#') return skipComment();
    if (isForbidden(position_)) return fail("a control character");
    ++position_;
    switch (letter) {
      case '\n':
        ++line_;
        // Inside brackets a line end separates values; the statement continues after it.
        if (depth_ == 0) inValue_ = false;
        return beginKey();
      case '.':
        if (++parts_ > bounds_.keyParts) fail("a key has more than " + std::to_string(bounds_.keyParts) + " parts");
        return;
      case '=':
        checkLength();
        if (depth_ == 0) inValue_ = true;
        return beginKey();
      case '[':
      case '{':
        // A table's name is in its own brackets, which hold nothing else.
        if (depth_ == 0 && !inValue_) return beginKey();
        if (++depth_ > bounds_.nesting)
          fail("values are nested more than " + std::to_string(bounds_.nesting) + " deep");
        return beginKey();
      case ']':
      case '}':
        if (depth_ > 0) {
          --depth_;
        } else {
          checkLength();
        }
        return beginKey();
      case ',':
        return beginKey();
      default:
        return;
    }
  }

  void skipString(char quote) {
    const std::string three(3, quote);
    const bool lines = text_.substr(position_).starts_with(three);
    position_ += lines ? 3 : 1;
    const std::size_t begin = line_;
    for (; position_ < text_.size(); ++position_) {
      const char letter = text_[position_];
      if (letter == '\n' && !lines) break;
      if (letter == '\n') ++line_;
      if (isForbidden(position_)) return fail("a control character");
      if (letter == '\\' && quote == '"') {
        // An escaped character never ends a string; a line end is examined separately.
        if (position_ + 1 < text_.size() && (text_[position_ + 1] == '"' || text_[position_ + 1] == '\\')) ++position_;
      } else if (letter == quote && !lines) {
        ++position_;
        return;
      } else if (letter == quote && text_.substr(position_).starts_with(three)) {
        position_ += 3;
        // One or two quotes more belong to the string.
        for (int more = 0; more < 2 && position_ < text_.size() && text_[position_] == quote; ++more) ++position_;
        return;
      }
    }
    line_ = begin;
    fail("a string has no end");
  }

  void skipComment() {
    for (; position_ < text_.size() && text_[position_] != '\n'; ++position_) {
      if (isForbidden(position_)) return fail("a control character");
    }
  }

  // Control characters except tab and the line ends LF and CR LF: TOML allows them only as escapes.
  [[nodiscard]] bool isForbidden(std::size_t position) const {
    const auto letter = static_cast<unsigned char>(text_[position]);
    if (letter == '\r') return position + 1 == text_.size() || text_[position + 1] != '\n';
    return (letter < 0x20 && letter != '\t' && letter != '\n') || letter == 0x7F;
  }

  void beginKey() {
    parts_ = 1;
    keyBegin_ = position_;
  }
  void checkLength() {
    if (position_ - 1 - keyBegin_ > bounds_.keyLength) {
      fail("a key is longer than " + std::to_string(bounds_.keyLength) + " bytes");
    }
  }
  void fail(const std::string& reason) {
    if (!problem_) problem_ = "line " + std::to_string(line_) + ": " + reason;
  }

  const std::string_view text_;
  const TomlBounds& bounds_;
  std::size_t position_ = 0;
  std::size_t line_ = 1;
  std::size_t depth_ = 0;     // open arrays and inline tables
  bool inValue_ = false;      // after the statement's "="
  std::size_t parts_ = 1;     // of the current key
  std::size_t keyBegin_ = 0;  // where the current key begins
  std::optional<std::string> problem_;
};

}  // namespace

std::optional<std::string> violationOf(std::string_view toml, const TomlBounds& bounds) {
  if (toml.size() > bounds.size) return "the configuration is longer than " + std::to_string(bounds.size) + " bytes";
  return Scan(toml, bounds).run();
}

}  // namespace vespscope::manager
