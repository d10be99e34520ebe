#include "rrc/lte/CellInformation.h"

namespace vespscope::rrc::lte {
namespace {

// The value of freqBandIndicator that refers to its later, larger form.
constexpr std::uint16_t bandElsewhere = 64;

void readBands(const View& block, CellInformation& cell) {
  const View late = block["nonCriticalExtension.lateNonCriticalExtension"];
  const View later = late["nonCriticalExtension"];
  cell.band = block["freqBandIndicator"].as<std::uint16_t>().value_or(0);
  if (const View band = later["freqBandIndicator-v9e0"]; band && cell.band == bandElsewhere) {
    cell.band = static_cast<std::uint16_t>(band.value());
  }
  for (const View band : late["multiBandInfoList"]) cell.moreBands.push_back(static_cast<std::uint16_t>(band.value()));
  std::size_t index = 0;
  for (const View band : later["multiBandInfoList-v9e0"]) {
    const View large = band["freqBandIndicator-v9e0"];
    if (large && index < cell.moreBands.size() && cell.moreBands[index] == bandElsewhere) {
      cell.moreBands[index] = static_cast<std::uint16_t>(large.value());
    }
    ++index;
  }
}

void readAccess(const View& access, CellInformation& cell) {
  std::optional<Plmn> before;
  for (const View network : access["plmn-IdentityList"]) {
    const auto plmn = plmnOf(network["plmn-Identity"], before);
    if (!plmn) continue;
    before = plmn;
    cell.networks.push_back({*plmn, network["cellReservedForOperatorUse"].item() == "reserved"});
  }
  cell.trackingAreaCode = static_cast<std::uint16_t>(access["trackingAreaCode"].number().value_or(0));
  cell.cellIdentity = static_cast<std::uint32_t>(access["cellIdentity"].number().value_or(0));
  cell.barred = access["cellBarred"].item() == "barred";
  cell.intraFrequencyReselection = access["intraFreqReselection"].item() == "allowed";
  if (const auto group = access["csg-Identity"].number()) cell.csgIdentity = static_cast<std::uint32_t>(*group);
}

}  // namespace

std::optional<MasterInformation> masterInformationOf(const Message& message) {
  const View block = message.body();
  const View phich = block["phich-Config"];
  if (!phich) return std::nullopt;
  return MasterInformation{static_cast<std::uint8_t>(block["dl-Bandwidth"].itemNumber().value_or(0)),
                           phich["phich-Duration"].item() == "extended", phich["phich-Resource"].item(),
                           static_cast<std::uint8_t>(block["systemFrameNumber"].number().value_or(0))};
}

std::optional<CellInformation> cellInformationOf(const Message& message) {
  const View block = message.body();
  if (block.id() != "systemInformationBlockType1"_name || !block["freqBandIndicator"]) return std::nullopt;
  return cellInformationOf(block);
}

CellInformation cellInformationOf(const View& block) {
  CellInformation cell;
  readAccess(block["cellAccessRelatedInfo"], cell);
  readBands(block, cell);
  const View selection = block["cellSelectionInfo"];
  cell.qRxLevMin = selection["q-RxLevMin"].as<std::int8_t>().value_or(0);
  cell.qRxLevMinOffset = selection["q-RxLevMinOffset"].as<std::uint8_t>().value_or(0);
  cell.qQualMin = block.extension("cellSelectionInfo-v920.q-QualMin-r9").as<std::int8_t>();
  cell.maximumPower = block["p-Max"].as<std::int8_t>();
  for (const View entry : block["schedulingInfoList"]) {
    SystemInformationSchedule schedule;
    schedule.period = static_cast<std::uint16_t>(entry["si-Periodicity"].itemNumber().value_or(0));
    for (const View type : entry["sib-MappingInfo"]) schedule.blocks.push_back(type.item());
    cell.schedule.push_back(std::move(schedule));
  }
  if (const View tdd = block["tdd-Config"]) {
    cell.tdd = TddConfiguration{static_cast<std::uint8_t>(tdd["subframeAssignment"].value()),
                                static_cast<std::uint8_t>(tdd["specialSubframePatterns"].value())};
  }
  cell.windowLength = static_cast<std::uint8_t>(block["si-WindowLength"].itemNumber().value_or(0));
  cell.valueTag = static_cast<std::uint8_t>(block["systemInfoValueTag"].value());
  return cell;
}

}  // namespace vespscope::rrc::lte
