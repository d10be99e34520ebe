#include "messagegen/Schema.h"

#include <algorithm>
#include <charconv>
#include <stdexcept>

#include "messagegen/Tokens.h"

namespace vespscope::messagegen {
namespace {

// Unwinds the parser; never leaves this file.
struct SyntaxError : std::runtime_error {
  using std::runtime_error::runtime_error;
};

class Parser {
 public:
  explicit Parser(const std::vector<Token>& tokens) : tokens_(tokens) {}

  SchemaFile file(std::string_view stem) {
    SchemaFile file;
    file.stem = stem;
    expectWord("syntax");
    expect("=");
    if (take(Token::Kind::text, "a syntax name").text != "proto2") fail("only proto2 is understood");
    expect(";");
    while (current().kind != Token::Kind::end) {
      const Token& token = current();
      if (takeIf("package")) {
        take(Token::Kind::word, "a package name");
        expect(";");
      } else if (takeIf("import")) {
        file.imports.push_back(take(Token::Kind::text, "a file name").text);
        expect(";");
      } else if (takeIf("enum")) {
        file.enumerations.push_back(enumeration(token.comment));
      } else if (takeIf("message")) {
        file.messages.push_back(message(token));
      } else {
        failOn("a declaration");
      }
    }
    return file;
  }

 private:
  Enumeration enumeration(const std::string& comment) {
    Enumeration result;
    result.comment = comment;
    result.name = take(Token::Kind::word, "a name").text;
    expect("{");
    while (!takeIf("}")) {
      EnumerationValue value;
      value.name = take(Token::Kind::word, "a value's name").text;
      expect("=");
      value.number = number<std::int32_t>();
      expect(";");
      const bool taken = std::any_of(result.values.begin(), result.values.end(), [&value](const auto& other) {
        return other.number == value.number || other.name == value.name;
      });
      if (taken) fail(value.name + " is declared twice");
      result.values.push_back(std::move(value));
    }
    if (result.values.empty()) fail("an enumeration without values");
    return result;
  }

  MessageType message(const Token& start) {
    MessageType result;
    result.comment = start.comment;
    result.line = start.line;
    result.name = take(Token::Kind::word, "a name").text;
    expect("{");
    while (!takeIf("}")) {
      const Token& token = current();
      if (takeIf("enum")) {
        result.enumerations.push_back(enumeration(token.comment));
      } else {
        result.fields.push_back(field());
      }
    }
    return result;
  }

  Field field() {
    Field result;
    result.line = current().line;
    result.repeated = takeIf("repeated");
    if (!result.repeated && !takeIf("optional")) failOn("optional or repeated");
    result.type = take(Token::Kind::word, "a type").text;
    result.name = take(Token::Kind::word, "a name").text;
    expect("=");
    result.number = number<std::uint32_t>();
    if (takeIf("[")) {
      expectWord("packed");
      expect("=");
      result.packed = takeIf("true");
      if (!result.packed) failOn("true");
      expect("]");
    }
    expect(";");
    return result;
  }

  template <class Number>
  Number number() {
    const Token& token = take(Token::Kind::number, "a number");
    Number value = 0;
    const char* end = token.text.data() + token.text.size();
    const auto [position, error] = std::from_chars(token.text.data(), end, value);
    if (error != std::errc{} || position != end) fail("'" + token.text + "' is no number of this kind", token.line);
    return value;
  }

  [[nodiscard]] const Token& current() const { return tokens_[position_]; }
  const Token& take(Token::Kind kind, const std::string& wanted) {
    if (current().kind != kind) failOn(wanted);
    return tokens_[position_++];
  }
  bool takeIf(std::string_view text) {
    if (current().kind == Token::Kind::text || current().text != text) return false;
    ++position_;
    return true;
  }
  void expect(std::string_view text) {
    if (!takeIf(text)) failOn("'" + std::string(text) + "'");
  }
  void expectWord(std::string_view text) {
    if (!takeIf(text)) failOn(std::string(text));
  }
  [[noreturn]] void failOn(const std::string& wanted) const {
    fail("expected " + wanted + " before '" + current().text + "'", current().line);
  }
  [[noreturn]] void fail(const std::string& what) const { fail(what, tokens_[position_ - 1].line); }
  [[noreturn]] static void fail(const std::string& what, std::size_t line) {
    throw SyntaxError(std::to_string(line) + ": " + what);
  }

  const std::vector<Token>& tokens_;
  std::size_t position_ = 0;
};

}  // namespace

Result<SchemaFile> parseSchema(std::string_view stem, std::string_view text) {
  const std::string fileName = std::string(stem) + ".proto:";
  const auto tokens = tokenize(text);
  if (!tokens) return Failure{fileName + tokens.reason()};
  try {
    return Parser(*tokens).file(stem);
  } catch (const SyntaxError& error) {
    return Failure{fileName + error.what()};
  }
}

}  // namespace vespscope::messagegen
