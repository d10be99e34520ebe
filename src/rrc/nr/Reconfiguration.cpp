#include "rrc/nr/Reconfiguration.h"

namespace vespscope::rrc::nr {
namespace {

std::optional<std::uint16_t> kilohertzOf(const View& spacing) {
  const auto number = spacing.itemNumber();
  return number ? std::optional(static_cast<std::uint16_t>(*number)) : std::nullopt;
}

CellConfiguration cellOf(const View& common) {
  CellConfiguration cell;
  const View frequency = common["downlinkConfigCommon.frequencyInfoDL"];
  const View carrier = frequency["scs-SpecificCarrierList"].first();
  cell.physicalCell = common["physCellId"].as<std::uint16_t>();
  cell.synchronisationBlock = frequency["absoluteFrequencySSB"].as<std::uint32_t>();
  cell.pointA = frequency["absoluteFrequencyPointA"].as<std::uint32_t>();
  for (const View band : frequency["frequencyBandList"]) cell.bands.push_back(static_cast<std::uint16_t>(band.value()));
  cell.bandwidth = carrier["carrierBandwidth"].as<std::uint16_t>();
  cell.carrierSpacing = kilohertzOf(carrier["subcarrierSpacing"]);
  cell.spacing = kilohertzOf(common["ssbSubcarrierSpacing"]);
  return cell;
}

std::optional<CellGroup> groupOf(const View& configuration) {
  const View id = configuration["cellGroupId"];
  if (!id) return std::nullopt;
  CellGroup group;
  group.id = static_cast<std::uint8_t>(id.value());
  if (const View synchronisation = configuration["spCellConfig.reconfigurationWithSync"]) {
    group.main = cellOf(synchronisation["spCellConfigCommon"]);
    group.cRnti = synchronisation["newUE-Identity"].as<std::uint16_t>();
  }
  for (const View entry : configuration["sCellToAddModList"]) {
    group.added.push_back({static_cast<std::uint8_t>(entry["sCellIndex"].value()), cellOf(entry["sCellConfigCommon"])});
  }
  for (const View index : configuration["sCellToReleaseList"]) {
    group.released.push_back(static_cast<std::uint8_t>(index.value()));
  }
  return group;
}

}  // namespace

std::optional<Reconfiguration> reconfigurationOf(const Message& message) { return reconfigurationOf(message.body()); }

std::optional<Reconfiguration> reconfigurationOf(const View& body) {
  const View content = body["criticalExtensions.rrcReconfiguration"];
  if (!content) return std::nullopt;
  return Reconfiguration{groupOf(content.extension("masterCellGroup")), groupOf(content["secondaryCellGroup"])};
}

}  // namespace vespscope::rrc::nr
