// The reader of metric configurations, and delivery by their rules.
#include "manager/Configuration.h"

#include <memory>
#include <string>

#include "Fuzz.h"
#include "manager/DeliveryFilter.h"
#include "registry/MetricRows.h"

using namespace vespscope;
using namespace vespscope::manager;

namespace {

// Repeats parts of some inputs up to the bound and beyond it, to reach deep and long structures.
void readGrown(std::string_view text) {
  if (text.size() < 3 || text.size() > 512) return;
  const std::string_view part = text.substr(text.size() / 3, text.size() / 3);
  std::string grown(text.substr(0, text.size() / 3));
  for (const std::size_t size : {Configuration::sizeLimit - text.size(), Configuration::sizeLimit + 1}) {
    while (grown.size() < size) grown += part;
    const Result<Configuration> read = Configuration::parse(grown + std::string(text.substr(2 * (text.size() / 3))));
    fuzz::require(read.ok() || read.reason().size() < 4096, "a refusal is longer than a line");
    fuzz::require(!read.ok() || size < Configuration::sizeLimit, "a text beyond the bound is accepted");
  }
}

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string_view text(reinterpret_cast<const char*>(data), size);
  if (size % 16 == 0) readGrown(text);
  const Result<Configuration> read = Configuration::parse(text);
  const Result<Configuration> again = Configuration::parse(text);
  fuzz::require(read.ok() == again.ok(), "the same text is read in two ways");
  if (!read) {
    fuzz::require(read.reason() == again.reason(), "the same text is refused in two ways");
    fuzz::require(!read.reason().empty(), "a refusal says nothing");
    fuzz::require(read.reason().find_first_of("\n\r\x1B") == std::string::npos, "a refusal is more than one line");
    return 0;
  }
  fuzz::require(read->size() > 0 && read->size() <= metricRows.size(), "rules of metrics that there are not");
  std::size_t rules = 0;
  DeliveryFilter filter;
  filter.setConfiguration(std::make_shared<const Configuration>(*read));
  std::vector<SharedEvent> due;
  for (int round = 0; round < 3; ++round) {
    for (const MetricRow& row : metricRows) {
      const MetricRule* rule = read->ruleFor(row.identifier());
      rules += rule != nullptr ? 1 : 0;
      due.clear();
      const DeliveryFilter::Clock::time_point now{std::chrono::seconds(round)};
      filter.offer(std::make_shared<const MetricEvent>(
                       MetricEvent{row.identifier(), 0, {0x08, static_cast<std::uint8_t>(round)}, {}}),
                   now, due);
      fuzz::require(rule != nullptr || due.empty(), "a metric that is not named is delivered");
      fuzz::require(rule == nullptr || round > 0 || due.size() == 1, "the first event of a metric is not delivered");
      filter.collect(now, due);
    }
  }
  fuzz::require(rules == 3 * read->size(), "a rule cannot be found");
  return 0;
}
