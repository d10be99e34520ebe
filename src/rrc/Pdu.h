// What may be read on its own: the message of a channel of LTE, NB-IoT or NR, or a message or configuration of NR that
// LTE or a modem's log carries by itself. The values are types of the grammar.
#pragma once

#include "rrc/Grammar.h"

namespace vespscope::rrc {

enum class Pdu : TypeId {
#include "rrc/tables/Pdus.inc"
};

}  // namespace vespscope::rrc
