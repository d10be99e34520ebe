#include "rrcgen/Syntax.h"

#include <charconv>

#include "rrcgen/Tokens.h"

namespace vespscope::rrcgen {
namespace {

using rrc::Kind;
using DefinitionPointer = std::shared_ptr<const Definition>;

bool isTypeName(std::string_view word) { return word[0] >= 'A' && word[0] <= 'Z'; }

// A recursive descent parser. The first error is kept, and every later token is the end.
class Parser {
 public:
  Parser(std::string file, std::vector<Token> tokens) : tokens_(std::move(tokens)) { module_.file = std::move(file); }

  Result<Module> parse() {
    module_.name = word();
    for (const char* text : {"DEFINITIONS", "AUTOMATIC", "TAGS", "::=", "BEGIN"}) expect(text);
    if (take("IMPORTS")) parseImports();
    while (!failure_ && !at("END")) parseAssignment();
    expect("END");
    if (failure_) return Failure{*failure_};
    return std::move(module_);
  }

 private:
  [[nodiscard]] const Token& token() const { return tokens_[position_]; }
  [[nodiscard]] bool at(std::string_view text) const {
    return token().kind != Token::Kind::end && token().text == text;
  }
  void fail(const std::string& what) {
    if (!failure_) failure_ = module_.file + ":" + std::to_string(token().line) + ": " + what;
    position_ = tokens_.size() - 1;
  }
  bool take(std::string_view text) {
    if (!at(text)) return false;
    ++position_;
    return true;
  }
  void expect(std::string_view text) {
    if (!take(text)) fail("expected " + std::string(text) + ", found " + token().text);
  }
  std::string word() {
    if (token().kind != Token::Kind::word) {
      fail("expected a name, found " + token().text);
      return {};
    }
    return tokens_[position_++].text;
  }
  std::int64_t integer() {
    std::int64_t value = 0;
    const std::string& text = token().text;
    if (token().kind != Token::Kind::number ||
        std::from_chars(text.data(), text.data() + text.size(), value).ec != std::errc()) {
      fail("expected a number, found " + text);
      return 0;
    }
    ++position_;
    return value;
  }

  void parseImports() {
    std::vector<std::string> symbols;
    while (!failure_ && !take(";")) {
      if (take("FROM")) {
        const std::string from = word();
        for (const std::string& symbol : symbols) module_.imports[symbol] = from;
        symbols.clear();
      } else {
        symbols.push_back(word());
        take(",");
      }
    }
  }

  void parseAssignment() {
    const std::string name = word();
    if (failure_) return;
    if (!isTypeName(name)) {
      expect("INTEGER");
      expect("::=");
      if (!module_.values.emplace(name, integer()).second) fail(name + " is defined twice");
      return;
    }
    TypeAssignment assignment;
    if (take("{")) {
      do assignment.parameters.push_back(word());
      while (take(","));
      expect("}");
    }
    expect("::=");
    assignment.type = parseType();
    if (!module_.types.emplace(name, std::move(assignment)).second) fail(name + " is defined twice");
  }

  DefinitionPointer parseType() {
    auto type = std::make_shared<Definition>();
    type->line = token().line;
    const std::string name = word();
    if (name == "BOOLEAN") {
      type->kind = Kind::boolean;
    } else if (name == "NULL") {
      type->kind = Kind::null;
    } else if (name == "INTEGER") {
      type->kind = Kind::integer;
      parseConstraint(*type);
    } else if (name == "ENUMERATED") {
      type->kind = Kind::enumerated;
      parseItems(*type);
    } else if (name == "BIT" || name == "OCTET") {
      type->kind = name == "BIT" ? Kind::bitString : Kind::octetString;
      expect("STRING");
      parseConstraint(*type);
    } else if (name == "SEQUENCE" || name == "CHOICE") {
      parseCompound(*type, name == "CHOICE" ? Kind::choice : Kind::sequence);
    } else if (!failure_ && isTypeName(name)) {
      type->kind = Kind::unknown;
      type->reference = name;
      if (take("{")) {
        do type->arguments.push_back(parseType());
        while (take(","));
        expect("}");
      }
      parseConstraint(*type);
    } else {
      fail("expected a type, found " + name);
    }
    return type;
  }

  void parseCompound(Definition& type, Kind kind) {
    if (take("{")) {
      type.kind = kind;
      parseMembers(type, "}");
      expect("}");
      return;
    }
    type.kind = Kind::list;
    parseConstraint(type);
    expect("OF");
    type.content = parseType();
  }

  // Parses members up to `close`, which is not consumed.
  void parseMembers(Definition& type, std::string_view close) {
    while (!failure_ && !at(close)) {
      if (take("...")) {
        if (type.extensible) fail("fields behind a second extension marker are not supported");
        type.extensible = true;
      } else if (take("[[")) {
        auto group = std::make_shared<Definition>();
        group->kind = Kind::sequence;
        group->line = token().line;
        parseMembers(*group, "]]");
        expect("]]");
        if (type.kind == Kind::choice) {
          for (const Member& member : group->root) type.additions.push_back(member);
        } else {
          type.additions.push_back({"", std::move(group), true});
        }
      } else {
        Member member;
        member.name = word();
        member.type = parseType();
        if (take("OPTIONAL")) {
          member.optional = true;
        } else if (take("DEFAULT")) {
          member.optional = true;
          skipValue();
        }
        (type.extensible ? type.additions : type.root).push_back(std::move(member));
      }
      if (!take(",") && !at(close)) fail("expected a comma, found " + token().text);
    }
  }

  void skipValue() {
    if (token().kind == Token::Kind::end || token().kind == Token::Kind::symbol) {
      fail("expected a value, found " + token().text);
    } else {
      ++position_;
    }
  }

  void parseItems(Definition& type) {
    expect("{");
    do {
      if (take("...")) {
        type.extensible = true;
      } else {
        (type.extensible ? type.addedItems : type.items).push_back(word());
      }
    } while (take(","));
    expect("}");
  }

  // Parses "(…)" or "SIZE (…)", if present.
  void parseConstraint(Definition& type) {
    if (take("SIZE")) {
      parseBounds(type);
    } else if (take("(")) {
      if (take("CONTAINING")) {
        type.content = parseType();
      } else if (take("SIZE")) {
        parseBounds(type);
      } else {
        --position_;
        parseBounds(type);
        return;
      }
      expect(")");
    }
  }

  void parseBounds(Definition& type) {
    Bounds bounds;
    expect("(");
    bounds.lower = parseNumber("MIN");
    bounds.upper = take("..") ? parseNumber("MAX") : bounds.lower;
    if (take(",")) {
      expect("...");
      bounds.extensible = true;
    }
    expect(")");
    type.bounds = bounds;
  }

  std::optional<Number> parseNumber(std::string_view open) {
    if (take(open)) return std::nullopt;
    if (token().kind == Token::Kind::word) return word();
    return integer();
  }

  Module module_;
  std::vector<Token> tokens_;
  std::size_t position_ = 0;
  std::optional<std::string> failure_;
};

}  // namespace

Result<Module> parseModule(const std::string& file, std::string_view text) {
  auto tokens = tokensOf(file, text);
  if (!tokens) return Failure{tokens.reason()};
  return Parser(file, std::move(*tokens)).parse();
}

}  // namespace vespscope::rrcgen
