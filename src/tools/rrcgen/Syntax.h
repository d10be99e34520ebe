// Parses the definitions of an ASN.1 module (ITU-T X.680) in the subset that RRC uses.
#pragma once

#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "rrc/Grammar.h"
#include "values/Result.h"

namespace vespscope::rrcgen {

struct Definition;

// A number, or the name of one.
using Number = std::variant<std::int64_t, std::string>;

// "(0..7)", "(SIZE (1..maxBands))"; absent bounds are MIN and MAX.
struct Bounds {
  std::optional<Number> lower;
  std::optional<Number> upper;
  bool extensible = false;
};

// A field of a sequence or an alternative of a choice; without a name, a group of extension additions.
struct Member {
  std::string name;
  std::shared_ptr<const Definition> type;
  bool optional = false;  // or with a default
};

struct Definition {
  rrc::Kind kind = rrc::Kind::null;  // unknown: a reference to `reference`
  std::string reference;
  std::vector<std::shared_ptr<const Definition>> arguments;  // for the reference
  std::optional<Bounds> bounds;
  bool extensible = false;
  std::vector<Member> root;
  std::vector<Member> additions;
  std::vector<std::string> items;  // of an enumeration
  std::vector<std::string> addedItems;
  std::shared_ptr<const Definition> content;  // the element of a list, or the content of a byte string
  int line = 0;
};

struct TypeAssignment {
  std::vector<std::string> parameters;
  std::shared_ptr<const Definition> type;
};

struct Module {
  std::string name;
  std::string file;
  std::map<std::string, std::string, std::less<>> imports;  // symbol to module
  std::map<std::string, TypeAssignment, std::less<>> types;
  std::map<std::string, std::int64_t, std::less<>> values;
};

// Returns the module in `text`, or an error that names `file` and line.
[[nodiscard]] Result<Module> parseModule(const std::string& file, std::string_view text);

}  // namespace vespscope::rrcgen
