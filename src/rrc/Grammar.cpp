#include "rrc/Grammar.h"

namespace vespscope::rrc::grammar {

extern constexpr Type types[] = {
#include "rrc/tables/Types.inc"
};
extern constexpr Field fields[] = {
#include "rrc/tables/Fields.inc"
};
extern constexpr NameId items[] = {
#include "rrc/tables/Items.inc"
};
extern constexpr Range ranges[] = {
#include "rrc/tables/Ranges.inc"
};

}  // namespace vespscope::rrc::grammar
