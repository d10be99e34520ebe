#include "rrc/Grammar.h"

namespace vespscope::rrc {
namespace {

constexpr Type types[] = {
#include "rrc/tables/Types.inc"
};
constexpr Field fields[] = {
#include "rrc/tables/Fields.inc"
};
constexpr NameId items[] = {
#include "rrc/tables/Items.inc"
};
constexpr Range ranges[] = {
#include "rrc/tables/Ranges.inc"
};

}  // namespace

const Grammar grammar{types, fields, items, ranges};

}  // namespace vespscope::rrc
