#include "rrc/lte/MeasurementReport.h"

namespace vespscope::rrc::lte {
namespace {

std::uint8_t byteOf(const View& view) { return static_cast<std::uint8_t>(view.value()); }
std::uint16_t wordOf(const View& view) { return static_cast<std::uint16_t>(view.value()); }
std::optional<std::uint8_t> optionalByteOf(const View& view) { return view.as<std::uint8_t>(); }

LteNeighbour lteNeighbourOf(const View& entry) {
  LteNeighbour neighbour;
  const View result = entry["measResult"];
  neighbour.physicalCell = wordOf(entry["physCellId"]);
  neighbour.levels = {optionalByteOf(result["rsrpResult"]), optionalByteOf(result["rsrqResult"]),
                      optionalByteOf(result["rs-sinr-Result-r13"])};
  if (const View global = entry["cgi-Info"]) {
    neighbour.plmn = plmnOf(global["cellGlobalId.plmn-Identity"]);
    neighbour.cellIdentity = static_cast<std::uint32_t>(global["cellGlobalId.cellIdentity"].number().value_or(0));
    neighbour.trackingAreaCode = static_cast<std::uint16_t>(global["trackingAreaCode"].number().value_or(0));
  }
  return neighbour;
}

UmtsNeighbour umtsNeighbourOf(const View& entry) {
  const View cell = entry["physCellId"].chosen();
  const View result = entry["measResult"];
  return {cell.id() == "tdd"_name, wordOf(cell), result["utra-RSCP"].as<std::int8_t>(),
          optionalByteOf(result["utra-EcN0"])};
}

GsmNeighbour gsmNeighbourOf(const View& entry) {
  const auto colour = [&](const Path& code) { return entry["physCellId"][code].number().value_or(0); };
  return {wordOf(entry["carrierFreq.arfcn"]), entry["carrierFreq.bandIndicator"].item() == "pcs1900",
          static_cast<std::uint8_t>(colour("networkColourCode") * 8 + colour("baseStationColourCode")),
          byteOf(entry["measResult.rssi"])};
}

NrNeighbour nrNeighbourOf(const View& entry) {
  const View result = entry["measResultCell-r15"];
  return {wordOf(entry["pci-r15"]),
          {optionalByteOf(result["rsrpResult-r15"]), optionalByteOf(result["rsrqResult-r15"]),
           optionalByteOf(result["rs-sinr-Result-r15"])}};
}

// The list of release 10 and that of release 13, which has indexes up to 31.
ServingFrequency servingFrequencyOf(const View& entry) {
  ServingFrequency serving;
  serving.index = byteOf(entry.either("servFreqId-r10", "servFreqId-r13"));
  if (const View cell = entry.either("measResultSCell-r10", "measResultSCell-r13")) {
    serving.cell =
        Levels{optionalByteOf(cell.either("rsrpResultSCell-r10", "rsrpResultSCell-r13")),
               optionalByteOf(cell.either("rsrqResultSCell-r10", "rsrqResultSCell-r13")),
               optionalByteOf(either(entry["measResultSCell-v1310.rs-sinr-Result-r13"], cell["rs-sinr-Result-r13"]))};
  }
  if (const View best = entry.either("measResultBestNeighCell-r10", "measResultBestNeighCell-r13")) {
    LteNeighbour neighbour;
    neighbour.physicalCell = wordOf(best.either("physCellId-r10", "physCellId-r13"));
    neighbour.levels = {
        optionalByteOf(best.either("rsrpResultNCell-r10", "rsrpResultNCell-r13")),
        optionalByteOf(best.either("rsrqResultNCell-r10", "rsrqResultNCell-r13")),
        optionalByteOf(either(entry["measResultBestNeighCell-v1310.rs-sinr-Result-r13"], best["rs-sinr-Result-r13"]))};
    serving.neighbour = neighbour;
  }
  return serving;
}

NrServingFrequency nrServingFrequencyOf(const View& entry) {
  NrServingFrequency serving;
  serving.carrier = entry["carrierFreq-r15"].as<std::uint32_t>().value_or(0);
  if (const View cell = entry["measResultSCell-r15"]) serving.cell = nrNeighbourOf(cell);
  if (const View best = entry["measResultBestNeighCell-r15"]) serving.neighbour = nrNeighbourOf(best);
  return serving;
}

}  // namespace

std::optional<MeasurementReport> measurementReportOf(const Message& message) {
  const View results = message.content()["measResults"];
  const View primary = results["measResultPCell"];
  if (!primary) return std::nullopt;
  MeasurementReport report;
  report.measurement = byteOf(results.either("measId-v1250", "measId"));
  report.primary = {optionalByteOf(primary["rsrpResult"]), optionalByteOf(primary["rsrqResult"]),
                    optionalByteOf(results["measResultPCell-v1310.rs-sinr-Result-r13"])};
  for (const View entry : results["measResultServFreqList-r10"]) report.serving.push_back(servingFrequencyOf(entry));
  for (const View entry : results["measResultServFreqListExt-r13"]) {
    report.serving.push_back(servingFrequencyOf(entry));
  }
  for (const View entry : results["measResultServFreqListNR-r15"]) {
    report.nrServing.push_back(nrServingFrequencyOf(entry));
  }
  const View neighbours = results["measResultNeighCells"].chosen();
  for (const View entry : neighbours) {
    switch (neighbours.id()) {
      case "measResultListEUTRA"_name:
        report.lte.push_back(lteNeighbourOf(entry));
        break;
      case "measResultListUTRA"_name:
        report.umts.push_back(umtsNeighbourOf(entry));
        break;
      case "measResultListGERAN"_name:
        report.gsm.push_back(gsmNeighbourOf(entry));
        break;
      case "measResultNeighCellListNR-r15"_name:
        report.nr.push_back(nrNeighbourOf(entry));
        break;
      default:
        break;
    }
  }
  return report;
}

}  // namespace vespscope::rrc::lte
