// Every value of simulated hours is within its legal range.
#include <map>
#include <string>

#include <gtest/gtest.h>

#include "sources/scenario/Drive.h"
#include "sources/scenario/LegalRanges.h"
#include "values/Text.h"
#include "values/Value.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;

// Checks every field of every message of an hour; reports each distinct fault once.
class Inspection {
 public:
  void look(const MetricEvent& event) {
    const std::shared_ptr<WireMessage> message = decoded(event);
    if (message == nullptr) return fault(std::string(metricName(event)) + " cannot be decoded");
    const Record record = message->dictionaryRepresentation();
    const Value* timestamp = record.find("timestamp");
    const auto milliseconds = std::chrono::floor<std::chrono::milliseconds>(event.time).count();
    if (timestamp == nullptr || timestamp->asInteger() != milliseconds) {
      fault(std::string(metricName(event)) + " is not stamped with its event's time");
    }
    lookAt(std::string(message->messageClass()), record);
  }

  [[nodiscard]] const std::map<std::string, int>& faults() const { return faults_; }
  // The number of occurrences of each field.
  [[nodiscard]] const std::map<std::string, int>& seen() const { return seen_; }

 private:
  void fault(const std::string& what) { ++faults_[what]; }

  void lookAt(const std::string& path, const Record& record) {
    for (const Entry& entry : record) {
      if (entry.key.view() == "timestamp") continue;
      lookAt(path + '.' + std::string(entry.key.view()), entry.value);
    }
  }

  void lookAt(const std::string& path, const Value& value) {
    if (const Record* record = value.asRecord()) return lookAt(path, *record);
    if (const List* list = value.asList()) {
      for (const Value& each : *list) lookAt(path, each);
      return;
    }
    ++seen_[path];
    if (const std::string* text = value.asText()) {
      if (text->empty() || text->starts_with("(unknown")) fault(path + " is " + *text);
      return;
    }
    const auto range = legalRanges().find(path);
    if (const Bytes* bytes = value.asBytes()) {
      if (range == legalRanges().end() || bytes->empty()) fault(path + " has no legal length");
      const auto size = static_cast<std::int64_t>(bytes->size());
      if (range != legalRanges().end() && !range->second.holds(size)) fault(path + " is long " + std::to_string(size));
      return;
    }
    if (value.asBool()) return;
    if (range == legalRanges().end()) return fault(path + " has no legal range");
    const std::optional<std::int64_t> number = value.asInteger();
    if (!number || !range->second.holds(*number)) fault(path + " is " + toText(value));
  }

  std::map<std::string, int> faults_;
  std::map<std::string, int> seen_;
};

TEST(ScenarioStreamLegalValues, EveryFieldOfAnHourIsWithinItsLegalRange) {
  Inspection inspection;
  for (const std::uint64_t seed : {1U, 2U, 3U}) {
    for (const MetricEvent& event : driveOf(seed, 1h)) inspection.look(event);
  }
  for (const auto& [what, count] : inspection.faults()) ADD_FAILURE() << what << ", " << count << " times";
  for (const auto& [path, range] : legalRanges()) {
    EXPECT_TRUE(inspection.seen().contains(path)) << path << " never occurred";
  }
}

}  // namespace
}  // namespace vespscope::test
