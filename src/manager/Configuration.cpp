#include "manager/Configuration.h"

#include <algorithm>
#include <optional>
#include <sstream>
#include <string>

#include <toml++/toml.h>

#include "registry/MetricRows.h"
#include "values/Text.h"

namespace vespscope::manager {
namespace {

std::string atLine(const toml::source_region& source, const std::string& reason) {
  return "line " + std::to_string(source.begin.line) + ": " + reason;
}

std::string typeOf(const toml::node& node) {
  std::ostringstream text;
  text << node.type();
  return text.str();
}

const MetricRow* rowNamed(std::string_view name) {
  const auto* found = std::find_if(metricRows.begin(), metricRows.end(),
                                   [name](const MetricRow& row) { return row.identifierName == name; });
  return found == metricRows.end() ? nullptr : found;
}

Result<std::chrono::milliseconds> parsePeriod(std::string_view metric, const toml::node& node) {
  const std::string subject = std::string(metric) + ": period_ms ";
  const auto* number = node.as_integer();
  if (number == nullptr) {
    return Failure{atLine(node.source(), subject + "must be an integer, not a value of type " + typeOf(node))};
  }
  constexpr std::int64_t shortest = Configuration::shortestPeriod.count();
  constexpr std::int64_t longest = Configuration::longestPeriod.count();
  if (number->get() < shortest || number->get() > longest) {
    return Failure{atLine(node.source(), subject + "must be " + std::to_string(shortest) + " to " +
                                             std::to_string(longest) + ", not " + std::to_string(number->get()))};
  }
  return std::chrono::milliseconds(number->get());
}

Result<MetricRule> parseRule(std::string_view metric, const toml::node& node) {
  const MetricRow* row = rowNamed(metric);
  if (row == nullptr) return Failure{atLine(node.source(), "there is no metric " + printable(metric))};
  const toml::table* table = node.as_table();
  if (table == nullptr) {
    return Failure{
        atLine(node.source(),
               std::string(metric) + " must be a table with period_ms or on, not a value of type " + typeOf(node))};
  }
  for (const auto& [key, value] : *table) {
    if (key.str() != "period_ms" && key.str() != "on") {
      return Failure{atLine(value.source(), std::string(metric) + ": there is no setting " + printable(key.str()))};
    }
  }
  const toml::node* period = table->get("period_ms");
  const toml::node* on = table->get("on");
  if ((period == nullptr) == (on == nullptr)) {
    return Failure{atLine(node.source(),
                          std::string(metric) + " needs either period_ms or on" + (on == nullptr ? "" : ", not both"))};
  }
  MetricRule rule{.metricID = row->identifier()};
  if (on != nullptr) {
    const auto* word = on->as_string();
    if (word == nullptr || (word->get() != "change" && word->get() != "event")) {
      return Failure{atLine(on->source(), std::string(metric) + ": on must be \"change\" or \"event\"")};
    }
    rule.everyEvent = word->get() == "event";
    return rule;
  }
  const Result<std::chrono::milliseconds> length = parsePeriod(metric, *period);
  if (!length) return Failure{length.reason()};
  rule.period = *length;
  return rule;
}

}  // namespace

Result<Configuration> Configuration::parse(std::string_view toml) {
  if (toml.empty()) return Failure{std::string("the configuration is empty")};
  if (const std::optional<std::string> violation = violationOf(toml)) return Failure{*violation};
  toml::table root;
  try {
    root = toml::parse(toml);
  } catch (const toml::parse_error& error) {
    return Failure{atLine(error.source(), printable(error.description()))};
  }
  for (const auto& [key, value] : root) {
    if (key.str() != "metrics") {
      return Failure{atLine(value.source(), "there is no setting " + printable(key.str()) + " outside [metrics]")};
    }
  }
  const toml::node* metrics = root.get("metrics");
  if (metrics == nullptr) return Failure{std::string("line 1: there is no table [metrics]")};
  if (!metrics->is_table()) {
    return Failure{atLine(metrics->source(), "metrics must be a table, not a value of type " + typeOf(*metrics))};
  }
  Configuration configuration;
  // The table orders its keys by name; the error to report is the first by line.
  std::optional<std::pair<toml::source_index, std::string>> first;
  for (const auto& [key, value] : *metrics->as_table()) {
    const Result<MetricRule> rule = parseRule(key.str(), value);
    if (rule) {
      configuration.rules_.push_back(*rule);
    } else if (const toml::source_index line = value.source().begin.line; !first || line < first->first) {
      first = {line, rule.reason()};
    }
  }
  if (first) return Failure{first->second};
  if (configuration.rules_.empty()) return Failure{atLine(metrics->source(), "[metrics] names no metric")};
  std::sort(configuration.rules_.begin(), configuration.rules_.end(),
            [](const MetricRule& one, const MetricRule& other) { return one.metricID < other.metricID; });
  return configuration;
}

const MetricRule* Configuration::ruleFor(std::int32_t metricID) const {
  const auto found =
      std::lower_bound(rules_.begin(), rules_.end(), metricID,
                       [](const MetricRule& rule, std::int32_t wanted) { return rule.metricID < wanted; });
  return found != rules_.end() && found->metricID == metricID ? &*found : nullptr;
}

}  // namespace vespscope::manager
