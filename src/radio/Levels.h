// Levels as measurement reports carry them: a raw code for each step of a range.
#pragma once

#include <algorithm>
#include <cmath>
#include <compare>
#include <cstdint>
#include <optional>

namespace vespscope::radio {

// Half away from zero.
[[nodiscard]] inline std::int32_t rounded(double number) { return static_cast<std::int32_t>(std::lround(number)); }
// SINR in half-dB steps.
[[nodiscard]] inline std::int32_t sinrSteps(double dB) { return rounded(dB * 2); }
// Hundredths of dBm or dB.
[[nodiscard]] inline std::int32_t hundredths(double number) { return rounded(number * 100); }

// One reported level. `Scale` gives its range and the level of code 0.
template <class Scale>
class Level {
 public:
  // Whether a receiver can have measured it: modems write zeros for an antenna that did not measure.
  [[nodiscard]] static bool isMeasurable(double level) { return level >= Scale::least && level <= Scale::most; }

  // Empty for a level that no receiver measures; a level beyond the codes has the outermost code.
  [[nodiscard]] static std::optional<Level> fromLevel(double level) {
    if (!isMeasurable(level)) return std::nullopt;
    return Level(std::clamp(Scale::codeOf(level), Scale::lowestCode, Scale::highestCode));
  }
  // Empty for a number that is no code.
  [[nodiscard]] static std::optional<Level> fromCode(std::int32_t code) {
    if (code < Scale::lowestCode || code > Scale::highestCode) return std::nullopt;
    return Level(code);
  }
  // The code of the basic range, 0 and up, that comes nearest to any level.
  [[nodiscard]] static std::uint32_t basicCode(double level) {
    return static_cast<std::uint32_t>(std::clamp(Scale::codeOf(level), 0, Scale::highestBasicCode));
  }

  // May be negative where the extended range has codes below 0.
  [[nodiscard]] std::int32_t code() const { return code_; }
  // dBm or dB, exact to the step.
  [[nodiscard]] double level() const { return Scale::levelOf(code_); }
  auto operator<=>(const Level&) const = default;

 private:
  explicit Level(std::int32_t code) : code_(code) {}

  std::int32_t code_;
};

// RSRP_-17..97 for -156..-44 dBm, 1 dB steps; the basic range begins at 0, -140 dBm (3GPP TS 36.133 9.1.4).
struct RsrpScale {
  static constexpr double least = -156;
  static constexpr double most = -44;
  static constexpr std::int32_t lowestCode = -17;
  static constexpr std::int32_t highestCode = 97;
  static constexpr std::int32_t highestBasicCode = 97;
  static std::int32_t codeOf(double dBm) { return rounded(dBm) + 140; }
  static double levelOf(std::int32_t code) { return code - 140; }
};
// RSRQ_-30..46 for -34..2.5 dB, 0.5 dB steps; the basic range is 0..34, -19.5..-3 dB (3GPP TS 36.133 9.1.7).
struct RsrqScale {
  static constexpr double least = -34;
  static constexpr double most = 2.5;
  static constexpr std::int32_t lowestCode = -30;
  static constexpr std::int32_t highestCode = 46;
  static constexpr std::int32_t highestBasicCode = 34;
  static std::int32_t codeOf(double dB) { return rounded((dB + 19.5) * 2); }
  static double levelOf(std::int32_t code) { return code / 2.0 - 19.5; }
};
// CPICH_RSCP_LEV_00..91 for -116..-25 dBm, 1 dB steps (3GPP TS 25.133 9.1.1.3).
struct RscpScale {
  static constexpr double least = -150;
  static constexpr double most = 0;
  static constexpr std::int32_t lowestCode = 0;
  static constexpr std::int32_t highestCode = 91;
  static constexpr std::int32_t highestBasicCode = 91;
  static std::int32_t codeOf(double dBm) { return rounded(dBm + 116); }
  static double levelOf(std::int32_t code) { return code - 116; }
};
// CPICH_Ec/No_00..49 for -24.5..0 dB, 0.5 dB steps (3GPP TS 25.133 9.1.2.3).
struct EcnoScale {
  static constexpr double least = -50;
  static constexpr double most = 0;
  static constexpr std::int32_t lowestCode = 0;
  static constexpr std::int32_t highestCode = 49;
  static constexpr std::int32_t highestBasicCode = 49;
  static std::int32_t codeOf(double dB) { return rounded((dB + 24.5) * 2); }
  static double levelOf(std::int32_t code) { return code / 2.0 - 24.5; }
};
// RXLEV 0..63 for -110..-47 dBm, 1 dB steps (3GPP TS 45.008 8.1.4).
struct RxlevScale {
  static constexpr double least = -150;
  static constexpr double most = 0;
  static constexpr std::int32_t lowestCode = 0;
  static constexpr std::int32_t highestCode = 63;
  static constexpr std::int32_t highestBasicCode = 63;
  static std::int32_t codeOf(double dBm) { return rounded(dBm + 110); }
  static double levelOf(std::int32_t code) { return code - 110; }
};

using Rsrp = Level<RsrpScale>;
using Rsrq = Level<RsrqScale>;
using Rscp = Level<RscpScale>;
using Ecno = Level<EcnoScale>;
using Rxlev = Level<RxlevScale>;

}  // namespace vespscope::radio
