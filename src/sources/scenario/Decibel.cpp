#include "sources/scenario/Decibel.h"

#include <algorithm>
#include <cmath>

namespace vespscope::sources::scenario {
namespace {

constexpr double ln2 = 0.693147180559945309417;
constexpr double ln10 = 2.302585092994045684018;
constexpr double halfRoot2 = 0.70710678118654752440;

}  // namespace

// Uses only operations that IEEE 754 rounds exactly: the four basic ones, sqrt, frexp and ldexp.
double naturalLog(double value) {
  int exponent = 0;
  double mantissa = std::frexp(value, &exponent);
  if (mantissa < halfRoot2) {
    mantissa *= 2;
    --exponent;
  }
  const double t = (mantissa - 1) / (mantissa + 1);
  const double square = t * t;
  double sum = 0;
  for (int power = 17; power >= 1; power -= 2) sum = sum * square + 1.0 / power;
  return 2 * t * sum + exponent * ln2;
}

double decibels(double ratio) { return naturalLog(ratio) * (10 / ln10); }

double ratioOf(double decibels) {
  const double binary = decibels * (ln10 / ln2 / 10);
  const int whole = rounded(binary);
  const double rest = (binary - whole) * ln2;
  double sum = 1;
  for (int order = 11; order >= 1; --order) sum = 1 + sum * rest / order;
  return std::ldexp(sum, whole);
}

// Abramowitz and Stegun 4.4.45.
double arcCosine(double cosine) {
  const double x = std::min(std::fabs(cosine), 1.0);
  const double radians = std::sqrt(1 - x) * (1.5707288 + x * (-0.2121144 + x * (0.0742610 - x * 0.0187293)));
  const double degrees = radians * 57.295779513082320877;
  return cosine < 0 ? 180 - degrees : degrees;
}

int rounded(double value) { return static_cast<int>(value < 0 ? value - 0.5 : value + 0.5); }

}  // namespace vespscope::sources::scenario
