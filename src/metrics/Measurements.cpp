#include "metrics/Measurements.h"

#include <algorithm>
#include <array>
#include <optional>
#include <span>
#include <string_view>
#include <variant>

#include "platform/log/Log.h"

namespace vespscope {
namespace {

// An integer code whose unit is 1 dB: the level is code - `origin` (dBm).
struct Level {
  std::int64_t origin;
};
// A code of half decibels: code x 0.5 - `origin` (dB), in 32-bit arithmetic.
struct HalfDecibels {
  float origin;
};
// Integer hundredths, truncated toward zero.
struct WholeHundredths {};
// Hundredths in 32-bit arithmetic.
struct Hundredths {};
// A channel bandwidth code.
struct Bandwidth {};

using Rule = std::variant<Level, HalfDecibels, WholeHundredths, Hundredths, Bandwidth>;

struct Conversion {
  Measured measured;
  std::string_view key;
  Rule rule;
};

// Together for each kind of element.
constexpr std::array<Conversion, 16> conversions = {{
    {Measured::umtsNeighbour, "rscp", Level{116}},
    {Measured::umtsNeighbour, "cpich_rscp", Level{116}},
    {Measured::umtsNeighbour, "ecno", HalfDecibels{24.5F}},
    // The message spells this one "cpich_ecn0", with a zero, so its code is shown as it is: kept that way.
    {Measured::umtsNeighbour, "cpich_ecno", HalfDecibels{24.5F}},
    {Measured::gsmNeighbour, "rxlev", Level{110}},
    {Measured::lteNeighbour, "rsrp", Level{140}},
    {Measured::lteNeighbour, "nbr_rsrp", Level{140}},
    {Measured::lteNeighbour, "rsrq", HalfDecibels{19.5F}},
    {Measured::lteNeighbour, "nbr_rsrq", HalfDecibels{19.5F}},
    {Measured::antennaPorts, "sinr0", HalfDecibels{0.0F}},
    {Measured::antennaPorts, "sinr1", HalfDecibels{0.0F}},
    {Measured::secondaryCarrier, "rsrp", WholeHundredths{}},
    {Measured::secondaryCarrier, "rssi", WholeHundredths{}},
    {Measured::secondaryCarrier, "rsrq", Hundredths{}},
    {Measured::secondaryCarrier, "dl_bandwidth", Bandwidth{}},
    {Measured::neighbourFrequency, "dl_bw", Bandwidth{}},
}};

// The conversions of each kind of element.
constexpr auto conversionsOf = [] {
  std::array<std::span<const Conversion>, static_cast<std::size_t>(Measured::secondaryCarrier) + 1> all{};
  for (std::size_t kind = 0; kind < all.size(); ++kind) {
    const auto isOfKind = [kind](const Conversion& each) { return static_cast<std::size_t>(each.measured) == kind; };
    const auto first = std::find_if(conversions.begin(), conversions.end(), isOfKind);
    const auto last = std::find_if_not(first, conversions.end(), isOfKind);
    if (std::any_of(last, conversions.end(), isOfKind)) throw "the conversions of one kind are not together";
    all[kind] = {first, last};
  }
  return all;
}();

// Applies one rule to one raw value; empty when the value is not of the type that the rule reads.
struct Converter {
  const Value& raw;
  const BandwidthTable& bandwidths;

  std::optional<Value> operator()(Level level) const {
    const std::optional<std::int64_t> code = raw.asInteger();
    if (!code) return std::nullopt;
    std::int64_t result = 0;
    if (__builtin_sub_overflow(*code, level.origin, &result)) log::fatal("a measurement code leaves the 64-bit range");
    return result;
  }
  std::optional<Value> operator()(HalfDecibels decibels) const {
    const std::optional<float> code = raw.asFloat();
    if (!code) return std::nullopt;
    return *code * 0.5F - decibels.origin;
  }
  std::optional<Value> operator()(WholeHundredths /*rule*/) const {
    const std::optional<std::int64_t> code = raw.asInteger();
    if (!code) return std::nullopt;
    return *code / 100;
  }
  std::optional<Value> operator()(Hundredths /*rule*/) const {
    const std::optional<float> code = raw.asFloat();
    if (!code) return std::nullopt;
    return *code / 100.0F;
  }
  std::optional<Value> operator()(Bandwidth /*rule*/) const {
    const std::optional<std::int32_t> code = raw.asInt32();
    if (!code) return std::nullopt;
    const auto found = bandwidths.find(*code);
    if (found == bandwidths.end()) return std::nullopt;
    return found->second;
  }
};

}  // namespace

void convertMeasurements(Record& element, Measured measured, const BandwidthTable& bandwidths) {
  for (const Conversion& conversion : conversionsOf[static_cast<std::size_t>(measured)]) {
    Value* raw = element.find(conversion.key);
    if (raw == nullptr) continue;
    if (std::optional<Value> converted = std::visit(Converter{*raw, bandwidths}, conversion.rule)) {
      *raw = std::move(*converted);
    } else {
      element.remove(conversion.key);
    }
  }
}

}  // namespace vespscope
