#include "metrics/PostProcessing.h"

#include <algorithm>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "platform/log/Log.h"
#include "values/Text.h"

namespace vespscope {
namespace {

constexpr std::string_view timestampKey = "timestamp";

// `target` takes `source`'s value under `key`, or loses its own when `source` has none.
void copyOrRemove(Record& target, std::string_view key, const Record& source) {
  if (const Value* value = source.find(key)) {
    target.set(Key(key), *value);
  } else {
    target.remove(key);
  }
}

bool isIntegerList(const Value& value) {
  const List* list = value.asList();
  return list != nullptr &&
         std::all_of(list->begin(), list->end(), [](const Value& element) { return element.asInteger().has_value(); });
}

struct Runner {
  MetricValidator& validator;
  Record& report;

  void operator()(NoStep /*step*/) const {}

  void operator()(const ReplaceList& step) const {
    const Value* entry = report.find(step.key);
    if (entry == nullptr) return;
    std::optional<RecordList> elements = recordListOf(*entry);
    if (!elements) return;
    RecordList& list = step.field(validator);
    list = std::move(*elements);
    for (Record& element : list) {
      convertMeasurements(element, step.measured, validator.dlbwlookup);
      copyOrRemove(element, timestampKey, report);
      if (!step.shared.empty()) copyOrRemove(element, step.shared, report);
    }
  }

  void operator()(const FillTemplate& step) const {
    Record& target = step.field(validator);
    std::vector<std::string> keys;
    keys.reserve(target.size());
    for (const Entry& entry : target) keys.emplace_back(entry.key.view());
    for (const std::string& key : keys) copyOrRemove(target, key, report);
  }

  void operator()(const WriteOutIntegers& step) const {
    Value* entry = report.find(step.key);
    if (entry == nullptr || !isIntegerList(*entry)) return;
    std::string text = toText(*entry);
    log::print(text);
    *entry = std::move(text);
  }

  void operator()(const WriteOutRecord& step) const {
    Value* entry = report.find(step.key);
    if (entry != nullptr && entry->asRecord() != nullptr) *entry = toText(*entry);
  }

  void operator()(const WriteOutRecordList& step) const {
    Value* entry = report.find(step.key);
    if (entry != nullptr && recordListOf(*entry)) *entry = toText(*entry);
  }

  void operator()(const Halve& step) const {
    Value* entry = report.find(step.key);
    if (entry == nullptr) return;
    if (const std::optional<std::int32_t> value = entry->asInt32()) *entry = *value / 2;
  }
};

}  // namespace

void postProcess(MetricValidator& validator, Record& report, const Steps& steps) {
  for (const Step& step : steps) std::visit(Runner{validator, report}, step);
}

void writeOutTimestamp(const MetricValidator& validator, std::optional<Record>& report) {
  if (!report) log::fatal("a recognised metric has no dictionary");
  Value* timestamp = report->find(timestampKey);
  if (timestamp == nullptr) return;
  if (const std::optional<double> milliseconds = timestamp->asDouble()) {
    *timestamp = validator.formatTimestamp(*milliseconds);
  }
}

}  // namespace vespscope
