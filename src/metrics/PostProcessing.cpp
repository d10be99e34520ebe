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
  if (value == nullptr) {
    target.remove(key);
  } else if (Value* present = target.find(key)) {
    *present = *value;
  } else {
    target.append(Key::ofStatic(key), *value);
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
    if (entry == nullptr || !isRecordList(*entry)) return;
    const List& reported = *entry->asList();
    const Value* timestamp = report.find(timestampKey);
    const Value* shared = step.shared.empty() ? nullptr : report.find(step.shared);
    RecordList& list = step.field(validator);
    list.resize(reported.size());
    for (std::size_t index = 0; index < list.size(); ++index) {
      constexpr std::size_t added = 2;
      Record& element = list[index];
      element.assign(*reported[index].asRecord(), added);
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
    validator.print(text);
    *entry = std::move(text);
  }

  void operator()(const WriteOutRecord& step) const {
    Value* entry = report.find(step.key);
    if (entry != nullptr && entry->asRecord() != nullptr) *entry = toText(*entry);
  }

  void operator()(const WriteOutRecordList& step) const {
    Value* entry = report.find(step.key);
    if (entry != nullptr && isRecordList(*entry)) *entry = toText(*entry);
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
