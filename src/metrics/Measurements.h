// Turns the raw reporting codes of a report's elements into display units.
#pragma once

#include <cstdint>
#include <map>

#include "values/Value.h"

namespace vespscope {

// What the elements of a list measure, which decides how their codes read.
enum class Measured {
  nothing,             // no entry is a reporting code
  umtsNeighbour,       // 3GPP TS 25.133 9.1.1.3 (CPICH RSCP), 9.1.2.3 (CPICH Ec/No)
  gsmNeighbour,        // 3GPP TS 45.008 8.1.4 (RXLEV)
  lteNeighbour,        // 3GPP TS 36.133 9.1.4 (RSRP), 9.1.7 (RSRQ)
  neighbourFrequency,  // channel bandwidth code
  antennaPorts,        // SINR in half decibels
  secondaryCarrier,    // levels in hundredths, channel bandwidth code
};

// LTE channel bandwidth code to MHz.
using BandwidthTable = std::map<std::int32_t, float>;

// Rewrites the measured entries of `element` in place. An entry that cannot be converted is removed; an integer that
// leaves the signed 64-bit range is a programming error.
void convertMeasurements(Record& element, Measured measured, const BandwidthTable& bandwidths);

}  // namespace vespscope
