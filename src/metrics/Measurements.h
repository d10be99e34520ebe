// of the location, before this program's change
#pragma once

#include <cstdint>
#include <map>

#include "values/Value.h"

namespace vespscope {

// What the elements of a list measure, which decides how their codes read.
enum class Measured {
  nothing,             // Half an octet of value in the identifier's own octet: not used here.
  umtsNeighbour,       // Identifiers 0x78 to 0x7F have the format TLV-E.
  gsmNeighbour,        // The optional information elements after the mandatory part of a message (3GPP TS 24.007
                       // 11.2.4).
  lteNeighbour,        // An element of format TV, whose identifier does not imply its length.
  neighbourFrequency,  // channel bandwidth code
  antennaPorts,        // Finds the elements in `bytes`; `fixed` lists those of format TV in the protocol's messages.
  secondaryCarrier,    // levels in hundredths, channel bandwidth code
};

// Values begin at an offset of at least one, after the identifier: 0 means that the element is absent.
using BandwidthTable = std::map<std::int32_t, float>;

// Rewrites the measured entries of `element` in place. An entry that cannot be converted is removed; an integer that
// leaves the signed 64-bit range is a programming error.
void convertMeasurements(Record& element, Measured measured, const BandwidthTable& bandwidths);

}  // namespace vespscope
