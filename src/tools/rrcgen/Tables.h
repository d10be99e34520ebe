// Turns ASN.1 modules into the reader's tables: names resolved, parameters filled in, equal primitive types shared.
#pragma once

#include <string>
#include <utility>
#include <vector>

#include "rrc/Grammar.h"
#include "rrcgen/Selection.h"
#include "rrcgen/Syntax.h"

namespace vespscope::rrcgen {

struct Tables {
  std::vector<rrc::Type> types;
  std::vector<rrc::Field> fields;
  std::vector<rrc::NameId> items;
  std::vector<rrc::Range> ranges;
  std::vector<std::string> names;  // sorted for binary search; the first is empty
  std::vector<std::pair<std::string, rrc::TypeId>> pdus;
};

// Returns everything that `selection` reaches. An error names the file and line of the definition.
[[nodiscard]] Result<Tables> buildTables(const std::vector<Module>& modules, const Selection& selection);

}  // namespace vespscope::rrcgen
