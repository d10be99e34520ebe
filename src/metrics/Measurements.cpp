#include "metrics/Measurements.h"

#include <algorithm>
#include <array>
#include <optional>
#include <span>
#include <string_view>
#include <utility>
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

// The conversions of one kind of element.
class Kind {
 public:
  constexpr Kind() = default;
  explicit constexpr Kind(std::span<const Conversion> all) : conversions_(all) {
    for (const Conversion& conversion : all) sizes_ |= bitOf(conversion.key.size());
  }

  [[nodiscard]] constexpr bool empty() const { return conversions_.empty(); }
  // The conversion of the values under `key`; null when there is none. Most keys are ruled out by their size.
  [[nodiscard]] const Conversion* find(std::string_view key) const {
    if ((sizes_ & bitOf(key.size())) == 0) return nullptr;
    for (const Conversion& conversion : conversions_) {
      if (conversion.key == key) return &conversion;
    }
    return nullptr;
  }

 private:
  static constexpr std::uint64_t bitOf(std::size_t size) { return std::uint64_t{1} << (size % 64); }

  std::span<const Conversion> conversions_;
  std::uint64_t sizes_ = 0;  // the bits of the keys' sizes
};

constexpr auto kinds = [] {
  std::array<Kind, static_cast<std::size_t>(Measured::secondaryCarrier) + 1> all{};
  for (std::size_t kind = 0; kind < all.size(); ++kind) {
    const auto isOfKind = [kind](const Conversion& each) { return static_cast<std::size_t>(each.measured) == kind; };
    const auto first = std::find_if(conversions.begin(), conversions.end(), isOfKind);
    const auto last = std::find_if_not(first, conversions.end(), isOfKind);
    if (std::any_of(last, conversions.end(), isOfKind)) throw "the conversions of one kind are not together";
    all[kind] = Kind({first, last});
  }
  return all;
}();

// Applies one rule to one raw value in its place; false when the value is not of the type that the rule reads.
struct Converter {
  Value& value;
  const BandwidthTable& bandwidths;

  bool operator()(Level level) const {
    const std::optional<std::int64_t> code = value.asInteger();
    std::int64_t result = 0;
    if (code && __builtin_sub_overflow(*code, level.origin, &result)) {
      log::fatal("a measurement code leaves the 64-bit range");
    }
    return replaceIf(code.has_value(), result);
  }
  bool operator()(HalfDecibels decibels) const {
    const std::optional<float> code = value.asFloat();
    return replaceIf(code.has_value(), code.value_or(0) * 0.5F - decibels.origin);
  }
  bool operator()(WholeHundredths /*rule*/) const {
    const std::optional<std::int64_t> code = value.asInteger();
    return replaceIf(code.has_value(), code.value_or(0) / 100);
  }
  bool operator()(Hundredths /*rule*/) const {
    const std::optional<float> code = value.asFloat();
    return replaceIf(code.has_value(), code.value_or(0) / 100.0F);
  }
  bool operator()(Bandwidth /*rule*/) const {
    const std::optional<std::int32_t> code = value.asInt32();
    const auto found = code ? bandwidths.find(*code) : bandwidths.end();
    return found != bandwidths.end() && replaceIf(true, found->second);
  }

 private:
  [[nodiscard]] bool replaceIf(bool converted, Value result) const {
    if (converted) value = std::move(result);
    return converted;
  }
};

}  // namespace

void convertMeasurements(Record& element, Measured measured, const BandwidthTable& bandwidths) {
  const Kind& kind = kinds[static_cast<std::size_t>(measured)];
  if (kind.empty()) return;
  for (std::size_t index = 0; index < element.size();) {
    Entry& entry = element.begin()[index];
    const Conversion* conversion = kind.find(entry.key.view());
    if (conversion == nullptr || std::visit(Converter{entry.value, bandwidths}, conversion->rule)) {
      ++index;
    } else {
      element.remove(conversion->key);
    }
  }
}

}  // namespace vespscope
