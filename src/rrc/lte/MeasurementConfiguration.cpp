#include "rrc/lte/MeasurementConfiguration.h"

namespace vespscope::rrc::lte {
namespace {

using Technology = MeasurementObject::Technology;

constexpr std::uint32_t carrierElsewhere = 65535;

std::vector<std::uint8_t> numbersOf(const View& list) {
  std::vector<std::uint8_t> numbers;
  for (const View number : list) numbers.push_back(static_cast<std::uint8_t>(number.value()));
  return numbers;
}

Technology technologyOf(const View& object) {
  switch (object.id()) {
    case "measObjectEUTRA"_name:
      return Technology::lte;
    case "measObjectUTRA"_name:
      return Technology::umts;
    case "measObjectGERAN"_name:
      return Technology::gsm;
    case "measObjectCDMA2000"_name:
      return Technology::cdma2000;
    case "measObjectWLAN-r13"_name:
      return Technology::wlan;
    case "measObjectNR-r15"_name:
      return Technology::nr;
    default:
      return Technology::later;
  }
}

MeasurementObject objectOf(const View& entry) {
  MeasurementObject object;
  const View content = entry["measObject"].chosen();
  object.id = static_cast<std::uint8_t>(entry.either("measObjectId", "measObjectId-r13").value());
  object.technology = technologyOf(content);
  switch (object.technology) {
    case Technology::lte:
      object.carrier = content.either("carrierFreq-r13", "carrierFreq").as<std::uint32_t>();
      object.bandwidth = static_cast<std::uint8_t>(content["allowedMeasBandwidth"].itemNumber().value_or(0));
      object.offset = static_cast<std::int8_t>(content["offsetFreq"].itemNumber().value_or(0));
      object.cellToIdentify = content["cellForWhichToReportCGI"].as<std::uint16_t>();
      for (const View cell : content["cellsToAddModList"]) {
        object.cells.push_back({static_cast<std::uint8_t>(cell["cellIndex"].value()),
                                static_cast<std::uint16_t>(cell["physCellId"].value()),
                                static_cast<std::int8_t>(cell["cellIndividualOffset"].itemNumber().value_or(0))});
      }
      break;
    case Technology::umts:
      object.carrier = content["carrierFreq"].as<std::uint32_t>();
      object.offset = content["offsetFreq"].as<std::int8_t>().value_or(0);
      break;
    case Technology::gsm:
      object.gsmCarriers = gsmCarriersOf(content["carrierFreqs"]);
      object.offset = content["offsetFreq"].as<std::int8_t>().value_or(0);
      break;
    case Technology::nr:
      object.carrier = content["carrierFreq-r15"].as<std::uint32_t>();
      object.offset = content["offsetFreq-r15"].as<std::int8_t>().value_or(0);
      break;
    case Technology::cdma2000:
    case Technology::wlan:
    case Technology::later:
      break;
  }
  return object;
}

// Adds what an event compares with: a code, a choice of codes, or a choice of technologies with such.
void addThreshold(const View& threshold, ReportConfiguration& report) {
  const View code = threshold.chosen();
  if (code.kind() != Kind::integer) return;
  report.thresholds.push_back({code.name(), static_cast<std::int16_t>(code.value())});
}

void readEvent(const View& event, ReportConfiguration& report) {
  const View condition = event["eventId"].chosen();
  report.trigger = condition.name();
  report.hysteresis = event["hysteresis"].as<std::uint8_t>();
  if (const auto time = event["timeToTrigger"].itemNumber()) report.timeToTrigger = static_cast<std::uint16_t>(*time);
  report.offset = condition.either("a3-Offset", "a6-Offset-r10").as<std::int8_t>();
  if (report.offset) return;
  for (const View field : condition) addThreshold(field, report);
}

std::uint32_t millisecondsOf(const View& interval) {
  constexpr int millisecondsPerMinute = 60'000;
  const int number = interval.itemNumber().value_or(0);
  return static_cast<std::uint32_t>(interval.item().starts_with("min") ? number * millisecondsPerMinute : number);
}

ReportConfiguration reportOf(const View& entry) {
  ReportConfiguration report;
  const View content = entry["reportConfig"].chosen();
  report.id = static_cast<std::uint8_t>(entry["reportConfigId"].value());
  report.interTechnology = content.id() == "reportConfigInterRAT"_name;
  const View trigger = content["triggerType"].chosen();
  if (trigger.id() == "event"_name) {
    readEvent(trigger, report);
  } else {
    report.trigger = trigger.name();
    report.purpose = trigger["purpose"].item();
  }
  report.triggerQuantity = content["triggerQuantity"].item();
  report.maximumCells = static_cast<std::uint8_t>(content["maxReportCells"].value());
  report.interval = millisecondsOf(content["reportInterval"]);
  if (const auto amount = content["reportAmount"].itemNumber()) report.amount = static_cast<std::uint8_t>(*amount);
  return report;
}

void readObjects(const View& configuration, MeasurementConfiguration& result) {
  result.removedObjects = numbersOf(configuration["measObjectToRemoveList"]);
  for (const View id : configuration["measObjectToRemoveListExt-r13"]) {
    result.removedObjects.push_back(static_cast<std::uint8_t>(id.value()));
  }
  for (const View entry : configuration["measObjectToAddModList"]) result.objects.push_back(objectOf(entry));
  std::size_t index = 0;
  for (const View entry : configuration["measObjectToAddModList-v9e0"]) {
    const View carrier = entry["measObjectEUTRA-v9e0.carrierFreq-v9e0"];
    if (carrier && index < result.objects.size() && result.objects[index].carrier == carrierElsewhere) {
      result.objects[index].carrier = carrier.as<std::uint32_t>();
    }
    ++index;
  }
  for (const View entry : configuration["measObjectToAddModListExt-r13"]) result.objects.push_back(objectOf(entry));
}

void readIdentities(const View& configuration, MeasurementConfiguration& result) {
  const auto number = [](const View& view) { return static_cast<std::uint8_t>(view.value()); };
  result.removedIdentities = numbersOf(configuration["measIdToRemoveList"]);
  for (const View id : configuration["measIdToRemoveListExt-r12"]) result.removedIdentities.push_back(number(id));
  for (const View entry : configuration["measIdToAddModList"]) {
    result.identities.push_back(
        {number(entry["measId"]), number(entry["measObjectId"]), number(entry["reportConfigId"])});
  }
  const auto replaceObjects = [&](const View& list, std::size_t index) {
    for (const View entry : list) {
      const View object = entry["measObjectId-v1310"];
      if (object && index < result.identities.size()) result.identities[index].object = number(object);
      ++index;
    }
  };
  const std::size_t first = result.identities.size();
  replaceObjects(configuration["measIdToAddModList-v1310"], 0);
  for (const View entry : configuration["measIdToAddModListExt-r12"]) {
    result.identities.push_back(
        {number(entry["measId-v1250"]), number(entry["measObjectId-r12"]), number(entry["reportConfigId-r12"])});
  }
  replaceObjects(configuration["measIdToAddModListExt-v1310"], first);
}

}  // namespace

MeasurementConfiguration measurementConfigurationOf(const View& configuration) {
  MeasurementConfiguration result;
  readObjects(configuration, result);
  result.removedReports = numbersOf(configuration["reportConfigToRemoveList"]);
  for (const View entry : configuration["reportConfigToAddModList"]) result.reports.push_back(reportOf(entry));
  readIdentities(configuration, result);
  result.sMeasure = configuration["s-Measure"].as<std::uint8_t>();
  return result;
}

}  // namespace vespscope::rrc::lte
