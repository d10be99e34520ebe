#include "messagegen/Tokens.h"

#include <utility>

namespace vespscope::messagegen {
namespace {

bool isLetter(char character) {
  return (character >= 'a' && character <= 'z') || (character >= 'A' && character <= 'Z') || character == '_';
}
bool isDigit(char character) { return character >= '0' && character <= '9'; }

class Tokenizer {
 public:
  explicit Tokenizer(std::string_view text) : text_(text) {}

  Result<std::vector<Token>> run() {
    while (position_ < text_.size()) {
      const char character = text_[position_];
      if (character == '\n') {
        endLine();
      } else if (character == ' ' || character == '\t' || character == '\r') {
        ++position_;
      } else if (text_.substr(position_, 2) == "//") {
        takeComment();
      } else if (isLetter(character)) {
        add(Token::Kind::word, takeWhile([](char next) { return isLetter(next) || isDigit(next) || next == '.'; }));
      } else if (isDigit(character) || character == '-') {
        ++position_;
        add(Token::Kind::number, character + takeWhile(isDigit));
      } else if (character == '"') {
        ++position_;
        const std::string text = takeWhile([](char next) { return next != '"' && next != '\n'; });
        if (text_.substr(position_, 1) != "\"") return Failure{fault("a text without its end")};
        ++position_;
        add(Token::Kind::text, text);
      } else if (std::string_view("{}[]=;").find(character) != std::string_view::npos) {
        ++position_;
        add(Token::Kind::punctuation, std::string(1, character));
      } else {
        return Failure{fault(std::string("unexpected character '") + character + "'")};
      }
    }
    add(Token::Kind::end, "end of file");
    return std::move(tokens_);
  }

 private:
  [[nodiscard]] std::string fault(const std::string& what) const { return std::to_string(line_) + ": " + what; }

  template <class Predicate>
  std::string takeWhile(Predicate wanted) {
    const std::size_t start = position_;
    while (position_ < text_.size() && wanted(text_[position_])) ++position_;
    return std::string(text_.substr(start, position_ - start));
  }

  void add(Token::Kind kind, std::string text) {
    tokens_.push_back({kind, std::move(text), std::exchange(comment_, {}), line_});
    lineHasTokens_ = true;
  }

  void endLine() {
    ++position_;
    ++line_;
    // An empty line separates a comment from the next declaration.
    if (!lineHasTokens_ && !lineHasComment_) comment_.clear();
    lineHasTokens_ = false;
    lineHasComment_ = false;
  }

  void takeComment() {
    position_ += 2;
    std::string words = takeWhile([](char next) { return next != '\n'; });
    if (lineHasTokens_) return;  // a comment after a declaration belongs to that declaration
    lineHasComment_ = true;
    if (!words.empty() && words.front() == ' ') words.erase(0, 1);
    if (!comment_.empty()) comment_ += ' ';
    comment_ += words;
  }

  std::string_view text_;
  std::size_t position_ = 0;
  std::size_t line_ = 1;
  bool lineHasTokens_ = false;
  bool lineHasComment_ = false;
  std::string comment_;
  std::vector<Token> tokens_;
};

}  // namespace

Result<std::vector<Token>> tokenize(std::string_view text) { return Tokenizer(text).run(); }

}  // namespace vespscope::messagegen
