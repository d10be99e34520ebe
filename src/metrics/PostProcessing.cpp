#include "metrics/PostProcessing.h"

#include <algorithm>
#include <optional>
#include <string>
#include <utility>

#include "platform/log/Log.h"
#include "values/Text.h"

namespace vespscope {
namespace {

constexpr std::string_view timestampKey = "timestamp";

// `target` takes `value` under `key`, a text that outlives it, or loses its own when there is none.
void setOrRemove(Record& target, std::string_view key, const Value* value) {
  if (value != nullptr) {
    target.set(Key::ofStatic(key), *value);
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
    const Value* timestamp = report.find(timestampKey);
    const Value* shared = step.shared.empty() ? nullptr : report.find(step.shared);
    for (Record& element : list) {
      convertMeasurements(element, step.measured, validator.dlbwlookup);
      setOrRemove(element, timestampKey, timestamp);
      if (!step.shared.empty()) setOrRemove(element, step.shared, shared);
    }
  }

  void operator()(const FillTemplate& step) const {
    Record& target = step.field(validator);
    Record filled;
    filled.reserve(target.size());
    for (const Entry& entry : target) {
      if (const Value* value = report.find(entry.key.view())) filled.append(entry.key, *value);
    }
    target = std::move(filled);
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
