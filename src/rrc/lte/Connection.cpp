#include "rrc/lte/Connection.h"

namespace vespscope::rrc::lte {
namespace {

// The content of the message, when it is the one with this name.
View contentOf(const Message& message, NameId name) { return message.body().id() == name ? message.content() : View(); }

}  // namespace

std::optional<ConnectionRequest> connectionRequestOf(const Message& message) {
  const View content = contentOf(message, "rrcConnectionRequest"_name);
  const View cause = content.either("establishmentCause", "establishmentCause-r15");
  if (!cause) return std::nullopt;
  const NameId identity = content.either("ue-Identity", "ue-Identity-r15").chosen().id();
  return ConnectionRequest{cause.item(), identity != "randomValue"_name};
}

std::optional<ConnectionReject> connectionRejectOf(const Message& message) {
  const View wait = contentOf(message, "rrcConnectionReject"_name)["waitTime"];
  if (!wait) return std::nullopt;
  return ConnectionReject{static_cast<std::uint8_t>(wait.value())};
}

std::optional<ConnectionSetupComplete> connectionSetupCompleteOf(const Message& message) {
  const View content = contentOf(message, "rrcConnectionSetupComplete"_name);
  const View nas = content["dedicatedInfoNAS"];
  if (!nas) return std::nullopt;
  return ConnectionSetupComplete{static_cast<std::uint8_t>(content["selectedPLMN-Identity"].value()), nas.bytes()};
}

std::optional<ReestablishmentRequest> reestablishmentRequestOf(const Message& message) {
  const View content = contentOf(message, "rrcConnectionReestablishmentRequest"_name);
  const View cause = content["reestablishmentCause"];
  if (!cause) return std::nullopt;
  return ReestablishmentRequest{static_cast<std::uint16_t>(content["ue-Identity.c-RNTI"].number().value_or(0)),
                                static_cast<std::uint16_t>(content["ue-Identity.physCellId"].value()), cause.item()};
}

std::optional<SecurityMode> securityModeOf(const Message& message) {
  const View algorithms = contentOf(message, "securityModeCommand"_name)["securityConfigSMC.securityAlgorithmConfig"];
  const View ciphering = algorithms["cipheringAlgorithm"];
  const View integrity = algorithms["integrityProtAlgorithm"];
  if (ciphering.kind() != Kind::enumerated || !integrity) return std::nullopt;
  return SecurityMode{ciphering.item(), integrity.item()};
}

std::optional<MobilityFromLte> mobilityFromLteOf(const Message& message) {
  const View content = contentOf(message, "mobilityFromEUTRACommand"_name);
  const View purpose = content["purpose"].first();
  if (!purpose) return std::nullopt;
  const View technology = purpose["targetRAT-Type"];
  return MobilityFromLte{content["cs-FallbackIndicator"].value() != 0, purpose.name(),
                         technology.kind() == Kind::choice ? technology.chosen().name() : technology.item()};
}

std::optional<Paging> pagingOf(const Message& message) {
  const View body = message.body();
  if (message.pdu() != Pdu::ltePcch || body.id() != "paging"_name) return std::nullopt;
  return Paging{static_cast<std::uint8_t>(body["pagingRecordList"].value()),
                static_cast<bool>(body["systemInfoModification"]), static_cast<bool>(body["etws-Indication"]),
                static_cast<bool>(body.extension("cmas-Indication-r9"))};
}

std::optional<std::vector<std::uint8_t>> transferredNasOf(const Message& message) {
  const NameId name = message.body().id();
  if (name != "dlInformationTransfer"_name && name != "ulInformationTransfer"_name) return std::nullopt;
  const View content = message.content();
  const View type =
      either(content["dedicatedInfoType"], content.either("dedicatedInfoType-r15", "dedicatedInfoType-r16"));
  const View nas = type.either("dedicatedInfoNAS", "dedicatedInfoNAS-r16");
  if (!nas) return std::nullopt;
  return nas.bytes();
}

}  // namespace vespscope::rrc::lte
