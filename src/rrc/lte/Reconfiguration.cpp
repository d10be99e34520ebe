#include "rrc/lte/Reconfiguration.h"

namespace vespscope::rrc::lte {
namespace {

constexpr std::uint32_t carrierElsewhere = 65535;

std::uint16_t wordOf(const std::optional<int>& number) { return static_cast<std::uint16_t>(number.value_or(0)); }

std::optional<std::uint8_t> blocksOf(const View& bandwidth) {
  const auto number = bandwidth.itemNumber();
  return number ? std::optional(static_cast<std::uint8_t>(*number)) : std::nullopt;
}

std::optional<std::uint32_t> carrierOf(const View& carrier, const View& later) {
  if (later && (!carrier || carrier.value() == carrierElsewhere)) return later.as<std::uint32_t>();
  return carrier.as<std::uint32_t>();
}

// The later releases add values to the cycle and to the retransmission timer.
DiscontinuousReception receptionOf(const View& setup, const View& main) {
  DiscontinuousReception reception;
  const View later = main["drx-Config-v1130"];
  const View cycle =
      either(main["drx-Config-v1310.longDRX-CycleStartOffset-v1310"].first(),
             either(later["longDRX-CycleStartOffset-v1130"], setup["longDRX-CycleStartOffset"]).chosen());
  reception.onDuration = wordOf(setup["onDurationTimer"].itemNumber());
  reception.inactivity = wordOf(setup["drx-InactivityTimer"].itemNumber());
  reception.retransmission =
      wordOf(either(later["drx-RetransmissionTimer-v1130"], setup["drx-RetransmissionTimer"]).itemNumber());
  reception.longCycle = wordOf(numberIn(cycle.name()));
  reception.startOffset = static_cast<std::uint16_t>(cycle.value());
  if (const View brief = setup["shortDRX"]) {
    reception.shortCycle = {wordOf(either(later["shortDRX-Cycle-v1130"], brief["shortDRX-Cycle"]).itemNumber()),
                            static_cast<std::uint8_t>(brief["drxShortCycleTimer"].value())};
  }
  return reception;
}

void readReception(const View& dedicated, Reconfiguration& result) {
  const View main = dedicated["mac-MainConfig.explicitValue"];
  const View drx = main["drx-Config"].chosen();
  if (!drx) {
    // The default MAC configuration has no discontinuous reception (3GPP TS 36.331 9.2.2).
    if (dedicated["mac-MainConfig.defaultValue"]) result.drx = Reconfiguration::Drx::released;
    return;
  }
  if (drx.id() == "release"_name) {
    result.drx = Reconfiguration::Drx::released;
  } else {
    result.drx = Reconfiguration::Drx::set;
    result.drxSetting = receptionOf(drx, main);
  }
}

MobilityControl mobilityOf(const View& control) {
  MobilityControl mobility;
  const View carrier = control["carrierFreq"];
  const View later = control["carrierFreq-v9e0"];
  mobility.physicalCell = static_cast<std::uint16_t>(control["targetPhysCellId"].value());
  mobility.downlinkCarrier = carrierOf(carrier["dl-CarrierFreq"], later["dl-CarrierFreq-v9e0"]);
  mobility.uplinkCarrier = carrierOf(carrier["ul-CarrierFreq"], later["ul-CarrierFreq-v9e0"]);
  mobility.downlinkBandwidth = blocksOf(control["carrierBandwidth.dl-Bandwidth"]);
  mobility.uplinkBandwidth = blocksOf(control["carrierBandwidth.ul-Bandwidth"]);
  mobility.t304 = wordOf(control["t304"].itemNumber());
  mobility.cRnti = static_cast<std::uint16_t>(control["newUE-Identity"].number().value_or(0));
  return mobility;
}

void readCommon(const View& common, SecondaryCell& cell) {
  const View uplink = common["ul-Configuration-r10"];
  cell.bandwidth = blocksOf(common["nonUL-Configuration-r10.dl-Bandwidth-r10"]);
  cell.uplink = static_cast<bool>(uplink);
  cell.uplinkCarrier = carrierOf(uplink["ul-FreqInfo-r10.ul-CarrierFreq-r10"], common["ul-CarrierFreq-v1090"]);
  cell.uplinkBandwidth = blocksOf(uplink["ul-FreqInfo-r10.ul-Bandwidth-r10"]);
}

// The lists of releases 10, 13 and 16 differ only in the suffix of their names.
SecondaryCell cellOf(const View& entry) {
  SecondaryCell cell;
  const auto field = [&](const Path& one, const Path& two, const Path& three) {
    return either(entry[one], either(entry[two], entry[three]));
  };
  cell.index = static_cast<std::uint8_t>(field("sCellIndex-r10", "sCellIndex-r13", "sCellIndex-r16").value());
  const View identity = field("cellIdentification-r10", "cellIdentification-r13", "cellIdentification-r16");
  cell.physicalCell =
      either(identity["physCellId-r10"], identity.either("physCellId-r13", "physCellId-r16")).as<std::uint16_t>();
  cell.downlinkCarrier =
      carrierOf(either(identity["dl-CarrierFreq-r10"], identity.either("dl-CarrierFreq-r13", "dl-CarrierFreq-r16")),
                entry["dl-CarrierFreq-v1090"]);
  readCommon(field("radioResourceConfigCommonSCell-r10", "radioResourceConfigCommonSCell-r13",
                   "radioResourceConfigCommonSCell-r16"),
             cell);
  return cell;
}

void readCells(const View& content, Reconfiguration& result) {
  const auto release = [&](const View& list) {
    for (const View index : list) result.releasedCells.push_back(static_cast<std::uint8_t>(index.value()));
  };
  const auto add = [&](const View& list) {
    for (const View entry : list) result.addedCells.push_back(cellOf(entry));
  };
  release(content.extension("sCellToReleaseList-r10"));
  release(content.extension("sCellToReleaseListExt-r13"));
  add(content.extension("sCellToAddModList-r10"));
  add(content.extension("sCellToAddModListExt-r13"));
  for (const View group : content.extension("sCellGroupToAddModList-r15")) {
    release(group["sCellToReleaseList-r15"]);
    add(group["sCellToAddModList-r15"]);
  }
}

std::optional<Reconfiguration> dedicatedOf(const Message& message, NameId name) {
  const View dedicated = message.content()["radioResourceConfigDedicated"];
  if (message.body().id() != name || !dedicated) return std::nullopt;
  Reconfiguration result;
  readReception(dedicated, result);
  return result;
}

}  // namespace

std::optional<Reconfiguration> reconfigurationOf(const Message& message) {
  const View content = message.content();
  if (content.id() != "rrcConnectionReconfiguration-r8"_name) return std::nullopt;
  Reconfiguration result;
  readReception(content["radioResourceConfigDedicated"], result);
  if (const View measurements = content["measConfig"]) result.measurements = measurementConfigurationOf(measurements);
  if (const View control = content["mobilityControlInfo"]) result.mobility = mobilityOf(control);
  readCells(content, result);
  const View nr = content.extension("nr-Config-r15").chosen();
  result.nrReleased = nr.id() == "release"_name;
  result.nrConfiguration = nr["nr-SecondaryCellGroupConfig-r15"].first();
  result.fullConfiguration = static_cast<bool>(content.extension("fullConfig-r9"));
  for (const View nas : either(content["dedicatedInfoNASList"], content.extension("dedicatedInfoNASList-r15"))) {
    result.nas.push_back(nas.bytes());
  }
  return result;
}

std::optional<Reconfiguration> connectionSetupOf(const Message& message) {
  return dedicatedOf(message, "rrcConnectionSetup"_name);
}

std::optional<Reconfiguration> reestablishmentOf(const Message& message) {
  return dedicatedOf(message, "rrcConnectionReestablishment"_name);
}

}  // namespace vespscope::rrc::lte
