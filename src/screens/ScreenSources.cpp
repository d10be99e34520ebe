#include "screens/ScreenSources.h"

#include <algorithm>
#include <array>

#include "metrics/MetricValidator.h"

namespace vespscope {
namespace {

using Decoder = MetricValidator;

// The latest value of one metric.
template <auto Stored>
const Record* latest(const Decoder& decoder) {
  const std::optional<Record>& stored = decoder.*Stored;
  return stored ? &*stored : nullptr;
}

template <auto Holder, auto Field>
const Record* record(const Decoder& decoder) {
  return &(decoder.*Holder.*Field);
}

template <auto Holder, auto Field>
const RecordList& list(const Decoder& decoder) {
  return decoder.*Holder.*Field;
}

template <auto Holder, auto Field>
const Record* firstOf(const Decoder& decoder) {
  const RecordList& records = decoder.*Holder.*Field;
  return records.empty() ? nullptr : &records.front();
}

constexpr ScreenSource single(std::string_view key, const Record* (*source)(const Decoder&)) {
  return {.key = key, .record = source};
}

constexpr ScreenSource many(std::string_view key, std::string_view headerPrefix,
                            const RecordList& (*source)(const Decoder&)) {
  return {.key = key, .list = source, .headerPrefix = headerPrefix};
}

constexpr auto lteScreens = std::to_array<ScreenSource>({
    single("LTE NAS", latest<&Decoder::myLTEEMMContextDict>),
    single("LTE RRC State", latest<&Decoder::myLTERRCStateDict>),
    single("LTE Serving Cell Info", latest<&Decoder::myLTESCellInfoDict>),
    single("LTE Serving Cell Meas", firstOf<&Decoder::myLTE, &LTE::RsrpRsrqSinr>),
    many("LTE Tx Power", "TxPowerInfo ", list<&Decoder::myLTE, &LTE::TxPower>),
    single("LTE Sel Resel Parameters", record<&Decoder::myLTE, &LTE::SelReselCellInfo>),
    many("LTE EUTRA Neighbor Info", "EUTRA Neighbor ", list<&Decoder::myLTE, &LTE::EutraNbrs>),
    single("LTE C-DRX", latest<&Decoder::myLTECDRXConfigDict>),
    many("LTE LTE Neighbor Cell Meas", "LTE Neighbor ", list<&Decoder::myLTE, &LTE::EutraNbrsMeas>),
    many("LTE UMTS Neighbor Cell Meas", "UMTS Neighbor ", list<&Decoder::myLTE, &LTE::UtraNbrsMeas>),
    many("LTE GSM Neighbor Cell Meas", "GSM Neighbor ", list<&Decoder::myLTE, &LTE::GeraNbrsMeas>),
    many("LTE CA Status", "", list<&Decoder::myLTE, &LTE::CAStatusList>),
    many("LTE Active Bearers", "PDP ", list<&Decoder::myCommon, &Common::activeBearer>),
    single("LTE Component Carrier Info", latest<&Decoder::myLTECompCarrDict>),
});

constexpr auto umtsScreens = std::to_array<ScreenSource>({
    single("UMTS NAS GMM", latest<&Decoder::myGMMContextDict>),
    single("UMTS NAS MM", latest<&Decoder::myMMContextDict>),
    single("UMTS RRC State", latest<&Decoder::myUMTSRRCStateDict>),
    single("UMTS RRC Configuration", latest<&Decoder::myUMTSRRCConfigDict>),
    single("UMTS Serving Cell Info", latest<&Decoder::myUMTSCellInfoDict>),
    many("UMTS Serving Cell Meas", "RxInfo ", list<&Decoder::myUMTS, &UMTS::rXInfo>),
    many("UMTS Tx Power", "TxPowerInfo ", list<&Decoder::myUMTS, &UMTS::TxPower>),
    single("UMTS Sel Resel Parameters", record<&Decoder::myUMTS, &UMTS::SelReselCellInfo>),
    many("UMTS EUTRA Neighbor Info", "EUTRA Neighbor ", list<&Decoder::myUMTS, &UMTS::eUtraNbrs>),
    many("UMTS UTRA Neighbor Info", "UTRA Neighbor ", list<&Decoder::myUMTS, &UMTS::utraNbrs>),
    many("UMTS GSM Neighbor Info", "GSM Neighbor ", list<&Decoder::myUMTS, &UMTS::geraNbrs>),
    many("UMTS LTE Neighbor Cell Meas", "LTE Neighbor ", list<&Decoder::myUMTS, &UMTS::eUtraNbrMeas>),
    many("UMTS UMTS Neighbor Cell Meas", "UMTS Neighbor ", list<&Decoder::myUMTS, &UMTS::utraNbrMeas>),
    many("UMTS GSM Neighbor Cell Meas", "GSM Neighbor ", list<&Decoder::myUMTS, &UMTS::geraNbrMeas>),
    many("UMTS Active Bearers", "PDP ", list<&Decoder::myCommon, &Common::activeBearer>),
    single("UMTS Serving Cell Measurement", firstOf<&Decoder::myUMTS, &UMTS::rXInfo>),
});

constexpr auto gsmScreens = std::to_array<ScreenSource>({
    single("GSM NAS GMM", latest<&Decoder::myGMMContextDict>),
    single("GSM NAS MM", latest<&Decoder::myMMContextDict>),
    single("GSM Serving Cell Info", latest<&Decoder::myGSMScellInfoDict>),
    single("GSM Idle Config", latest<&Decoder::myGSMIdleConfigInfoDict>),
    single("GSM Idle Serv Cell Meas", latest<&Decoder::myGSMIdleScellMeasDict>),
    // Kept without its technology, and "GSM GPRS Config" without the row's own: the catalogue's rows of these names
    // do not find them and say so to their users.
    single("Connected Serv Cell Meas", latest<&Decoder::myGSMConnRfMeasDict>),
    single("GSM GPRS Config", latest<&Decoder::myGSMGPRSConfigDict>),
    many("GSM LTE Neighbor Cell Meas", "LTE Neighbor ", list<&Decoder::myGSM, &GSM::eUtraNbrMeas>),
    many("GSM UMTS Neighbor Cell Meas", "UMTS Neighbor ", list<&Decoder::myGSM, &GSM::utraNbrMeas>),
    many("GSM GSM Neighbor Cell Meas", "GSM Neighbor ", list<&Decoder::myGSM, &GSM::geraNbrMeas>),
    many("GSM Active Bearers", "PDP ", list<&Decoder::myCommon, &Common::activeBearer>),
});

constexpr auto deviceScreens = std::to_array<ScreenSource>({
    many("Device Info SIM Files", "SIM Content ", list<&Decoder::myCommon, &Common::simContents>),
});

template <class Screens>
const ScreenSource* findIn(const Screens& screens, std::string_view key) {
  const auto found =
      std::find_if(screens.begin(), screens.end(), [key](const ScreenSource& screen) { return screen.key == key; });
  return found == screens.end() ? nullptr : &*found;
}

}  // namespace

const ScreenSource* screenSource(std::string_view key) {
  if (const ScreenSource* found = findIn(lteScreens, key)) return found;
  if (const ScreenSource* found = findIn(umtsScreens, key)) return found;
  if (const ScreenSource* found = findIn(gsmScreens, key)) return found;
  return findIn(deviceScreens, key);
}

}  // namespace vespscope
