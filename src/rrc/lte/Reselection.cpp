#include "rrc/lte/Reselection.h"

namespace vespscope::rrc::lte {
namespace {

// The value of a 16-bit channel number that refers to its later, larger form.
constexpr std::uint32_t carrierElsewhere = 65535;

template <class Number>
Number numberOf(const View& view) {
  return view.as<Number>().value_or(0);
}

std::optional<std::uint8_t> blocksOf(const View& bandwidth) {
  const auto number = bandwidth.itemNumber();
  return number ? std::optional(static_cast<std::uint8_t>(*number)) : std::nullopt;
}

std::optional<AccessBarring> barringOf(const View& barring) {
  if (!barring) return std::nullopt;
  return AccessBarring{static_cast<std::uint8_t>(barring["ac-BarringFactor"].itemNumber().value_or(0)),
                       static_cast<std::uint16_t>(barring["ac-BarringTime"].itemNumber().value_or(0)),
                       static_cast<std::uint8_t>(barring["ac-BarringForSpecialAC"].number().value_or(0))};
}

AccessInformation accessOf(const View& block) {
  AccessInformation access;
  const View barring = block["ac-BarringInfo"];
  access.emergencyBarred = barring["ac-BarringForEmergency"].value() != 0;
  access.signalling = barringOf(barring["ac-BarringForMO-Signalling"]);
  access.data = barringOf(barring["ac-BarringForMO-Data"]);
  access.csFallback = barringOf(block["ac-BarringForCSFB-r10"]);
  access.uplinkCarrier = block["freqInfo.ul-CarrierFreq"].as<std::uint16_t>();
  access.uplinkBandwidth = blocksOf(block["freqInfo.ul-Bandwidth"]);
  return access;
}

ServingReselection servingOf(const View& block) {
  ServingReselection serving;
  const View own = block["cellReselectionServingFreqInfo"];
  const View intra = block["intraFreqCellReselectionInfo"];
  serving.hysteresis = static_cast<std::uint8_t>(block["cellReselectionInfoCommon.q-Hyst"].itemNumber().value_or(0));
  serving.sNonIntraSearch = own["s-NonIntraSearch"].as<std::uint8_t>();
  serving.threshServingLow = numberOf<std::uint8_t>(own["threshServingLow"]);
  serving.threshServingLowQ = block["threshServingLowQ-r9"].as<std::uint8_t>();
  serving.priority = numberOf<std::uint8_t>(own["cellReselectionPriority"]);
  serving.qRxLevMin = numberOf<std::int8_t>(intra["q-RxLevMin"]);
  serving.qQualMin = block["q-QualMin-r9"].as<std::int8_t>();
  serving.maximumPower = intra["p-Max"].as<std::int8_t>();
  serving.sIntraSearch = intra["s-IntraSearch"].as<std::uint8_t>();
  serving.sIntraSearchP = block["s-IntraSearch-v920.s-IntraSearchP-r9"].as<std::uint8_t>();
  serving.sIntraSearchQ = block["s-IntraSearch-v920.s-IntraSearchQ-r9"].as<std::uint8_t>();
  serving.sNonIntraSearchP = block["s-NonIntraSearch-v920.s-NonIntraSearchP-r9"].as<std::uint8_t>();
  serving.sNonIntraSearchQ = block["s-NonIntraSearch-v920.s-NonIntraSearchQ-r9"].as<std::uint8_t>();
  serving.measuredBandwidth = blocksOf(intra["allowedMeasBandwidth"]);
  serving.antennaPort1 = intra["presenceAntennaPort1"].value() != 0;
  serving.neighbourConfiguration = static_cast<std::uint8_t>(intra["neighCellConfig"].number().value_or(0));
  serving.reselectionTime = numberOf<std::uint8_t>(intra["t-ReselectionEUTRA"]);
  return serving;
}

// An entry of the first list, or one of the list of release 12, whose names end in -r12.
LteNeighbourFrequency lteFrequencyOf(const View& entry) {
  LteNeighbourFrequency frequency;
  const auto field = [&](const Path& first, const Path& later) { return entry.either(first, later); };
  const View quality = field("threshX-Q-r9", "threshX-Q-r12");
  frequency.carrier = numberOf<std::uint32_t>(field("dl-CarrierFreq", "dl-CarrierFreq-r12"));
  frequency.qRxLevMin = numberOf<std::int8_t>(field("q-RxLevMin", "q-RxLevMin-r12"));
  frequency.qQualMin = field("q-QualMin-r9", "q-QualMin-r12").as<std::int8_t>();
  frequency.maximumPower = field("p-Max", "p-Max-r12").as<std::int8_t>();
  frequency.reselectionTime = numberOf<std::uint8_t>(field("t-ReselectionEUTRA", "t-ReselectionEUTRA-r12"));
  frequency.threshXHigh = numberOf<std::uint8_t>(field("threshX-High", "threshX-High-r12"));
  frequency.threshXLow = numberOf<std::uint8_t>(field("threshX-Low", "threshX-Low-r12"));
  frequency.threshXHighQ = quality.either("threshX-HighQ-r9", "threshX-HighQ-r12").as<std::uint8_t>();
  frequency.threshXLowQ = quality.either("threshX-LowQ-r9", "threshX-LowQ-r12").as<std::uint8_t>();
  frequency.measuredBandwidth = blocksOf(field("allowedMeasBandwidth", "allowedMeasBandwidth-r12")).value_or(0);
  frequency.antennaPort1 = field("presenceAntennaPort1", "presenceAntennaPort1-r12").value() != 0;
  frequency.priority = field("cellReselectionPriority", "cellReselectionPriority-r12").as<std::uint8_t>();
  frequency.neighbourConfiguration =
      static_cast<std::uint8_t>(field("neighCellConfig", "neighCellConfig-r12").number().value_or(0));
  frequency.offset = static_cast<std::int8_t>(field("q-OffsetFreq", "q-OffsetFreq-r12").itemNumber().value_or(0));
  for (const View cell : field("interFreqNeighCellList", "interFreqNeighCellList-r12")) {
    frequency.cells.push_back({numberOf<std::uint16_t>(cell["physCellId"]),
                               static_cast<std::int8_t>(cell["q-OffsetCell"].itemNumber().value_or(0))});
  }
  frequency.excludedCells = cellRangesOf(field("interFreqExcludedCellList", "interFreqExcludedCellList-r12"));
  return frequency;
}

std::vector<LteNeighbourFrequency> lteOf(const View& block) {
  std::vector<LteNeighbourFrequency> frequencies;
  for (const View entry : block["interFreqCarrierFreqList"]) frequencies.push_back(lteFrequencyOf(entry));
  std::size_t index = 0;
  for (const View entry : block["lateNonCriticalExtension.nonCriticalExtension.interFreqCarrierFreqList-v9e0"]) {
    const View carrier = entry["dl-CarrierFreq-v9e0"];
    if (carrier && index < frequencies.size() && frequencies[index].carrier == carrierElsewhere) {
      frequencies[index].carrier = numberOf<std::uint32_t>(carrier);
    }
    ++index;
  }
  for (const View entry : block["interFreqCarrierFreqListExt-r12"]) frequencies.push_back(lteFrequencyOf(entry));
  return frequencies;
}

UmtsNeighbourFrequency umtsFrequencyOf(const View& entry, bool tdd) {
  UmtsNeighbourFrequency frequency;
  const auto field = [&](const Path& first, const Path& later) { return entry.either(first, later); };
  frequency.tdd = tdd;
  frequency.carrier = numberOf<std::uint16_t>(field("carrierFreq", "carrierFreq-r12"));
  frequency.priority = field("cellReselectionPriority", "cellReselectionPriority-r12").as<std::uint8_t>();
  frequency.threshXHigh = numberOf<std::uint8_t>(field("threshX-High", "threshX-High-r12"));
  frequency.threshXLow = numberOf<std::uint8_t>(field("threshX-Low", "threshX-Low-r12"));
  frequency.qRxLevMin = numberOf<std::int8_t>(field("q-RxLevMin", "q-RxLevMin-r12"));
  frequency.maximumPower = numberOf<std::int8_t>(field("p-MaxUTRA", "p-MaxUTRA-r12"));
  frequency.qQualMin = field("q-QualMin", "q-QualMin-r12").as<std::int8_t>();
  return frequency;
}

std::vector<UmtsNeighbourFrequency> umtsOf(const View& block) {
  std::vector<UmtsNeighbourFrequency> frequencies;
  const auto add = [&](const Path& list, bool tdd) {
    for (const View entry : block[list]) frequencies.push_back(umtsFrequencyOf(entry, tdd));
  };
  add("carrierFreqListUTRA-FDD", false);
  add("carrierFreqListUTRA-FDD-Ext-r12", false);
  add("carrierFreqListUTRA-TDD", true);
  add("carrierFreqListUTRA-TDD-Ext-r12", true);
  return frequencies;
}

std::vector<GsmNeighbourFrequencies> gsmOf(const View& block) {
  std::vector<GsmNeighbourFrequencies> groups;
  for (const View entry : block["carrierFreqsInfoList"]) {
    const View common = entry["commonInfo"];
    groups.push_back({gsmCarriersOf(entry["carrierFreqs"]), common["cellReselectionPriority"].as<std::uint8_t>(),
                      static_cast<std::uint8_t>(common["ncc-Permitted"].number().value_or(0)),
                      numberOf<std::uint8_t>(common["q-RxLevMin"]), common["p-MaxGERAN"].as<std::uint8_t>(),
                      numberOf<std::uint8_t>(common["threshX-High"]), numberOf<std::uint8_t>(common["threshX-Low"])});
  }
  return groups;
}

}  // namespace

std::optional<SystemInformation> systemInformationOf(const Message& message) {
  // NR has blocks of the same names with other content.
  if (message.pdu() != Pdu::lteBcchDlSch) return std::nullopt;
  const View blocks = message.content()["sib-TypeAndInfo"];
  if (!blocks) return std::nullopt;
  SystemInformation information;
  for (const View entry : blocks) {
    const View block = entry.chosen();
    switch (block.id()) {
      case "sib2"_name:
        information.access = accessOf(block);
        break;
      case "sib3"_name:
        information.serving = servingOf(block);
        break;
      case "sib5"_name:
        information.lte = lteOf(block);
        break;
      case "sib6"_name:
        information.umts = umtsOf(block);
        information.umtsReselectionTime = block["t-ReselectionUTRA"].as<std::uint8_t>();
        break;
      case "sib7"_name:
        information.gsm = gsmOf(block);
        information.gsmReselectionTime = block["t-ReselectionGERAN"].as<std::uint8_t>();
        break;
      default:
        break;
    }
  }
  return information;
}

}  // namespace vespscope::rrc::lte
