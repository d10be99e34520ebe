// Logarithms and powers that give the same bits on every machine, unlike those of the C library.
#pragma once

namespace vespscope::sources::scenario {

[[nodiscard]] double naturalLog(double value);  // value > 0
[[nodiscard]] double decibels(double ratio);    // 10 log10(ratio), ratio > 0
[[nodiscard]] double ratioOf(double decibels);  // 10^(decibels / 10)

// The angle (degrees, 0..180) with this cosine; accurate to 0.005 degrees.
[[nodiscard]] double arcCosine(double cosine);

// Rounds half away from zero.
[[nodiscard]] int rounded(double value);

}  // namespace vespscope::sources::scenario
