#include "rrc/nr/MasterInformation.h"

namespace vespscope::rrc::nr {

std::optional<MasterInformation> masterInformationOf(const Message& message) {
  const View block = message.body();
  const View control = block["pdcch-ConfigSIB1"];
  if (!block["subCarrierSpacingCommon"] || !control) return std::nullopt;
  return MasterInformation{static_cast<std::uint8_t>(block["systemFrameNumber"].number().value_or(0)),
                           block["subCarrierSpacingCommon"].item() == "scs30or120",
                           static_cast<std::uint8_t>(block["ssb-SubcarrierOffset"].value()),
                           static_cast<std::uint8_t>(control["controlResourceSetZero"].value()),
                           static_cast<std::uint8_t>(control["searchSpaceZero"].value()),
                           block["cellBarred"].item() == "barred",
                           block["intraFreqReselection"].item() == "allowed"};
}

}  // namespace vespscope::rrc::nr
