// A metric configuration: which metrics an application wants reported, and how often.
#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <string_view>
#include <vector>

#include "manager/TomlBounds.h"
#include "values/Result.h"

namespace vespscope::manager {

struct MetricRule {
  std::int32_t metricID = 0;
  // At most one event in each period, by the events' own time. Zero: every event that differs from the previous one.
  std::chrono::milliseconds period{0};
  bool everyEvent = false;  // every event, even one that equals the previous one

  [[nodiscard]] bool onChange() const { return period.count() == 0 && !everyEvent; }
};

class Configuration {
 public:
  static constexpr std::size_t sizeLimit = TomlBounds{}.size;  // bytes
  static constexpr std::chrono::milliseconds shortestPeriod{1};
  static constexpr std::chrono::milliseconds longestPeriod{86'400'000};  // a day

  // Reads TOML whose table [metrics] gives each wanted metric, by the name of its identifier, a period or
  // one of the words "change" and "event":
  //   K_LTE_RRC_STATE = { on = "change" }
  //   K_LTE_TX_POWER = { period_ms = 1000 }
  //   K_LTE_RLF = { on = "event" }
  // Errors name the line. A text that exceeds TomlBounds is rejected before it is parsed.
  static Result<Configuration> parse(std::string_view toml);

  // The rule of a metric, or null when the configuration does not name it.
  [[nodiscard]] const MetricRule* ruleFor(std::int32_t metricID) const;
  [[nodiscard]] std::size_t size() const { return rules_.size(); }

 private:
  std::vector<MetricRule> rules_;
};

}  // namespace vespscope::manager
