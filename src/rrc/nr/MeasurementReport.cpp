#include "rrc/nr/MeasurementReport.h"

namespace vespscope::rrc::nr {
namespace {

Levels levelsOf(const View& quantities) {
  return {quantities["rsrp"].as<std::uint8_t>(), quantities["rsrq"].as<std::uint8_t>(),
          quantities["sinr"].as<std::uint8_t>()};
}

MeasuredCell nrCellOf(const View& result) {
  const View cell = result["measResult.cellResults"];
  return {result["physCellId"].as<std::uint16_t>(), levelsOf(cell.either("resultsSSB-Cell", "resultsCSI-RS-Cell"))};
}

}  // namespace

std::optional<MeasurementReport> measurementReportOf(const Message& message) {
  return measurementReportOf(message.body());
}

std::optional<MeasurementReport> measurementReportOf(const View& body) {
  const View results = body["criticalExtensions"].chosen()["measResults"];
  const View serving = results["measResultServingMOList"];
  if (!serving) return std::nullopt;
  MeasurementReport report;
  report.measurement = static_cast<std::uint8_t>(results["measId"].value());
  for (const View entry : serving) {
    ServingCell cell{static_cast<std::uint8_t>(entry["servCellId"].value()), nrCellOf(entry["measResultServingCell"]),
                     std::nullopt};
    if (const View best = entry["measResultBestNeighCell"]) cell.neighbour = nrCellOf(best);
    report.serving.push_back(cell);
  }
  for (const View entry : results["measResultNeighCells.measResultListNR"]) report.nr.push_back(nrCellOf(entry));
  for (const View entry : results["measResultNeighCells.measResultListEUTRA"]) {
    report.lte.push_back({entry["eutra-PhysCellId"].as<std::uint16_t>(), levelsOf(entry["measResult"])});
  }
  return report;
}

}  // namespace vespscope::rrc::nr
