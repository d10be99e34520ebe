// What the tables are made for: the types that can be read on their own, and the contents of byte strings that the
// definitions describe only in prose.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "values/Result.h"

namespace vespscope::rrcgen {

struct TypeName {
  std::string module;
  std::string type;
};

struct Selection {
  struct Pdu {
    std::string name;
    TypeName type;
  };
  // The content of each byte string that is a field with this name.
  struct Content {
    std::string module;
    std::string field;
    TypeName type;
  };
  std::vector<Pdu> pdus;
  std::vector<Content> contents;
};

// Parses lines "pdu NAME MODULE TYPE" and "content MODULE FIELD MODULE TYPE"; # begins a comment. An error names `file`
// and line.
[[nodiscard]] Result<Selection> parseSelection(const std::string& file, const std::string& text);

}  // namespace vespscope::rrcgen
