#include "rrc/lte/Release.h"

namespace vespscope::rrc::lte {
namespace {

using Carriers = std::vector<DedicatedPriorities::Carrier>;
using Technology = Redirection::Technology;

constexpr std::uint32_t carrierElsewhere = 65535;

std::uint32_t carrierOf(const View& view) { return view.as<std::uint32_t>().value_or(0); }

Redirection redirectionOf(const View& info, const View& later) {
  Redirection redirection;
  const View target = info.chosen();
  switch (target.id()) {
    case "eutra"_name:
      redirection.technology = Technology::lte;
      redirection.carriers = {target.value() == carrierElsewhere && later ? carrierOf(later) : carrierOf(target)};
      break;
    case "geran"_name:
      redirection.technology = Technology::gsm;
      redirection.gsmCarriers = gsmCarriersOf(target);
      break;
    case "utra-FDD"_name:
      redirection.technology = Technology::umtsFdd;
      redirection.carriers = {carrierOf(target)};
      break;
    case "utra-TDD"_name:
      redirection.technology = Technology::umtsTdd;
      redirection.carriers = {carrierOf(target)};
      break;
    case "utra-TDD-r10"_name:
      redirection.technology = Technology::umtsTdd;
      for (const View carrier : target) redirection.carriers.push_back(carrierOf(carrier));
      break;
    case "cdma2000-HRPD"_name:
    case "cdma2000-1xRTT"_name:
      redirection.technology = Technology::cdma2000;
      break;
    case "nr-r15"_name:
    case "nr-r17"_name:
      redirection.technology = Technology::nr;
      redirection.carriers = {carrierOf(target.either("carrierFreq-r15", "carrierFreq-r17"))};
      break;
    default:
      break;
  }
  return redirection;
}

Carriers carriersOf(const View& list) {
  Carriers carriers;
  for (const View entry : list) {
    const View carrier = either(entry["carrierFreq"], entry.either("carrierFreq-r12", "carrierFreq-r15"));
    const View priority = either(entry["cellReselectionPriority"],
                                 entry.either("cellReselectionPriority-r12", "cellReselectionPriority-r15"));
    carriers.push_back({carrierOf(carrier), static_cast<std::uint8_t>(priority.value())});
  }
  return carriers;
}

DedicatedPriorities prioritiesOf(const View& info, const View& later) {
  DedicatedPriorities priorities;
  priorities.lte = carriersOf(info["freqPriorityListEUTRA"]);
  std::size_t index = 0;
  for (const View entry : later["freqPriorityListEUTRA-v9e0"]) {
    const View carrier = entry["carrierFreq-v9e0"];
    if (carrier && index < priorities.lte.size()) priorities.lte[index].carrier = carrierOf(carrier);
    ++index;
  }
  for (const auto& carrier : carriersOf(info["freqPriorityListExtEUTRA-r12"])) priorities.lte.push_back(carrier);
  for (const View entry : info["freqPriorityListGERAN"]) {
    priorities.gsm.push_back(
        {gsmCarriersOf(entry["carrierFreqs"]), static_cast<std::uint8_t>(entry["cellReselectionPriority"].value())});
  }
  priorities.umtsFdd = carriersOf(info["freqPriorityListUTRA-FDD"]);
  priorities.umtsTdd = carriersOf(info["freqPriorityListUTRA-TDD"]);
  priorities.nr = carriersOf(info["freqPriorityListNR-r15"]);
  if (const auto minutes = info["t320"].itemNumber()) priorities.validity = static_cast<std::uint8_t>(*minutes);
  return priorities;
}

}  // namespace

std::optional<Release> releaseOf(const Message& message) {
  const View content = message.content();
  if (content.id() != "rrcConnectionRelease-r8"_name) return std::nullopt;
  const View late = content["nonCriticalExtension.lateNonCriticalExtension"];
  Release release;
  release.cause = content["releaseCause"].item();
  if (const View info = content["redirectedCarrierInfo"]) {
    release.redirection = redirectionOf(info, late["redirectedCarrierInfo-v9e0.eutra-v9e0"]);
  }
  if (const View info = content["idleModeMobilityControlInfo"]) {
    release.priorities = prioritiesOf(info, late["idleModeMobilityControlInfo-v9e0"]);
  }
  return release;
}

}  // namespace vespscope::rrc::lte
