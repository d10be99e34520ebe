#include "metrics/MetricValidator.h"

#include <optional>
#include <string_view>
#include <utility>

#include "client/RhoxWrapper.h"
#include "metrics/EventRows.h"
#include "platform/dates/DateFormatter.h"
#include "platform/log/DivertedSystemLog.h"
#include "platform/log/Log.h"
#include "values/Text.h"

namespace vespscope {
namespace {

// Upper-case hexadecimal of an identifier's low 32 bits, at least two characters wide, padded with a blank.
void appendHexadecimal(std::string& out, std::int64_t identifier) {
  constexpr std::string_view digits = "0123456789ABCDEF";
  const auto number = static_cast<std::uint32_t>(identifier);
  if (number < 0x10) out += ' ';
  int shift = 28;
  while (shift > 0 && number >> shift == 0) shift -= 4;
  for (; shift >= 0; shift -= 4) out += digits[number >> shift & 15];
}

}  // namespace

MetricValidator::MetricValidator() : lines_(&log::print) {}
MetricValidator::MetricValidator(LineSink lines) : lines_(std::move(lines)), logsNothing_(true) {}
MetricValidator::~MetricValidator() = default;

std::shared_ptr<MetricValidator> MetricValidator::shared() {
  // The wrapper holds its delegate weakly, so the decoder is made whole before it becomes one.
  static const std::shared_ptr<MetricValidator> instance = [] {
    auto validator = std::make_shared<MetricValidator>();
    validator->mySharedRhoxInstance = RhoxWrapper::sharedInstance();
    validator->mySharedRhoxInstance->listen();
    validator->mySharedRhoxInstance->setDelegate(validator);
    return validator;
  }();
  return instance;
}

void MetricValidator::eventsDidUpdate(std::shared_ptr<const Record> /*dictionary*/) { print("I dont care for events"); }

void MetricValidator::metricsDidUpdate(std::shared_ptr<const Record> dictionary) {
  if (dictionary == nullptr) log::fatal("a metric event without a dictionary");
  if (processMetric(*dictionary)) print("Received Valid Metric");
}

bool MetricValidator::processMetric(const Record& event) {
  const Value* identifier = event.find(metricIDKey);
  metricID = identifier == nullptr ? std::nullopt : identifier->asInteger();
  if (!metricID) log::fatal("a metric event without an integer identifier");
  if (lines_) {
    line_ = "Metric ID in Hex = ";
    appendHexadecimal(line_, *metricID);
    print(line_);
  }

  const EventRow* row = findEventRow(*metricID);
  if (row == nullptr) {
    print("I dont care for this Metric");
    return false;
  }

  std::optional<log::DivertedSystemLog> silence;
  if (logsNothing_) silence.emplace(lines_);
  const Value* payload = event.find(payloadKey);
  DecodedPayload decoded = row->decode(payload == nullptr ? nullptr : payload->asBytes());
  if (!decoded.ok) ++decodeFailures_;

  std::optional<Record>& stored = this->*row->stored;
  stored = std::move(decoded.record);
  if (decoded.ok && observer_) observer_(*metricID, *stored);
  writeOutTimestamp(*this, stored);
  if (lines_) {
    line_ = row->literal;
    appendText(line_, *stored);
    print(line_);
  }
  postProcess(*this, *stored, row->steps);
  return true;
}

void MetricValidator::forget() {
  myLTE = {};
  myUMTS = {};
  myGSM = {};
  myCommon = {};
  for (const EventRow& row : eventRows()) (this->*row.stored).reset();
}

std::string MetricValidator::formatTimestamp(double milliseconds) const {
  return dates::DateFormatter("yyyy-MM-dd HH:mm:ss zzz").stringFromSeconds(milliseconds / 1000.0);
}

}  // namespace vespscope
