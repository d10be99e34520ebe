#include "screens/ScreenSources.h"

#include <algorithm>
#include <array>

#include "metrics/MetricValidator.h"
#include "registry/MetricRows.h"

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

constexpr ScreenSource single(std::string_view key, std::optional<std::int64_t> metric,
                              const Record* (*source)(const Decoder&)) {
  return {.key = key, .metric = metric, .record = source};
}

constexpr ScreenSource many(std::string_view key, std::string_view headerPrefix, std::optional<std::int64_t> metric,
                            const RecordList& (*source)(const Decoder&)) {
  return {.key = key, .metric = metric, .list = source, .headerPrefix = headerPrefix};
}

constexpr auto lteScreens = std::to_array<ScreenSource>({
    single("LTE NAS", metricIdentifier("K_LTE_EMM_CTXT"), latest<&Decoder::myLTEEMMContextDict>),
    single("LTE RRC State", metricIdentifier("K_LTE_RRC_STATE"), latest<&Decoder::myLTERRCStateDict>),
    single("LTE Serving Cell Info", metricIdentifier("K_LTE_SCELL_INFO"), latest<&Decoder::myLTESCellInfoDict>),
    single("LTE Serving Cell Meas", metricIdentifier("K_LTE_RSRP_RSRQ_SINR"),
           firstOf<&Decoder::myLTE, &LTE::RsrpRsrqSinr>),
    many("LTE Tx Power", "TxPowerInfo ", metricIdentifier("K_LTE_TX_POWER"), list<&Decoder::myLTE, &LTE::TxPower>),
    single("LTE Sel Resel Parameters", metricIdentifier("K_LTE_SEL_RESEL_INFO"),
           record<&Decoder::myLTE, &LTE::SelReselCellInfo>),
    many("LTE EUTRA Neighbor Info", "EUTRA Neighbor ", metricIdentifier("K_LTE_SEL_RESEL_INFO"),
         list<&Decoder::myLTE, &LTE::EutraNbrs>),
    single("LTE C-DRX", metricIdentifier("K_LTE_CDRX_CONFIG"), latest<&Decoder::myLTECDRXConfigDict>),
    many("LTE LTE Neighbor Cell Meas", "LTE Neighbor ", metricIdentifier("K_LTE_INTRARAT_MEAS"),
         list<&Decoder::myLTE, &LTE::EutraNbrsMeas>),
    many("LTE UMTS Neighbor Cell Meas", "UMTS Neighbor ", metricIdentifier("K_LTE_INTERRAT_MEAS"),
         list<&Decoder::myLTE, &LTE::UtraNbrsMeas>),
    many("LTE GSM Neighbor Cell Meas", "GSM Neighbor ", metricIdentifier("K_LTE_INTERRAT_MEAS"),
         list<&Decoder::myLTE, &LTE::GeraNbrsMeas>),
    many("LTE CA Status", "", metricIdentifier("K_LTE_CA_STATUS"), list<&Decoder::myLTE, &LTE::CAStatusList>),
    many("LTE Active Bearers", "PDP ", metricIdentifier("K_CELLULAR_ACTIVE_BEARER"),
         list<&Decoder::myCommon, &Common::activeBearer>),
    single("LTE Component Carrier Info", metricIdentifier("K_LTE_COMPCARR_INFO"), latest<&Decoder::myLTECompCarrDict>),
});

constexpr auto umtsScreens = std::to_array<ScreenSource>({
    single("UMTS NAS GMM", metricIdentifier("K_CELLULAR_GMM_CTXT"), latest<&Decoder::myGMMContextDict>),
    single("UMTS NAS MM", metricIdentifier("K_CELLULAR_MM_CTXT"), latest<&Decoder::myMMContextDict>),
    single("UMTS RRC State", metricIdentifier("K_UMTS_RRC_STATE"), latest<&Decoder::myUMTSRRCStateDict>),
    single("UMTS RRC Configuration", metricIdentifier("K_UMTS_RRC_CONFIG"), latest<&Decoder::myUMTSRRCConfigDict>),
    single("UMTS Serving Cell Info", metricIdentifier("K_UMTS_SCELL_INFO"), latest<&Decoder::myUMTSCellInfoDict>),
    many("UMTS Serving Cell Meas", "RxInfo ", metricIdentifier("K_UMTS_SCELL_MEAS"),
         list<&Decoder::myUMTS, &UMTS::rXInfo>),
    many("UMTS Tx Power", "TxPowerInfo ", metricIdentifier("K_UMTS_TX_POWER"), list<&Decoder::myUMTS, &UMTS::TxPower>),
    single("UMTS Sel Resel Parameters", metricIdentifier("K_UMTS_SEL_RESEL_INFO"),
           record<&Decoder::myUMTS, &UMTS::SelReselCellInfo>),
    many("UMTS EUTRA Neighbor Info", "EUTRA Neighbor ", metricIdentifier("K_UMTS_SEL_RESEL_INFO"),
         list<&Decoder::myUMTS, &UMTS::eUtraNbrs>),
    many("UMTS UTRA Neighbor Info", "UTRA Neighbor ", std::nullopt, list<&Decoder::myUMTS, &UMTS::utraNbrs>),
    many("UMTS GSM Neighbor Info", "GSM Neighbor ", std::nullopt, list<&Decoder::myUMTS, &UMTS::geraNbrs>),
    many("UMTS LTE Neighbor Cell Meas", "LTE Neighbor ", metricIdentifier("K_UMTS_NCELL_MEAS"),
         list<&Decoder::myUMTS, &UMTS::eUtraNbrMeas>),
    many("UMTS UMTS Neighbor Cell Meas", "UMTS Neighbor ", metricIdentifier("K_UMTS_NCELL_MEAS"),
         list<&Decoder::myUMTS, &UMTS::utraNbrMeas>),
    many("UMTS GSM Neighbor Cell Meas", "GSM Neighbor ", metricIdentifier("K_UMTS_NCELL_MEAS"),
         list<&Decoder::myUMTS, &UMTS::geraNbrMeas>),
    many("UMTS Active Bearers", "PDP ", metricIdentifier("K_CELLULAR_ACTIVE_BEARER"),
         list<&Decoder::myCommon, &Common::activeBearer>),
    single("UMTS Serving Cell Measurement", metricIdentifier("K_UMTS_SCELL_MEAS"),
           firstOf<&Decoder::myUMTS, &UMTS::rXInfo>),
});

constexpr auto gsmScreens = std::to_array<ScreenSource>({
    single("GSM NAS GMM", metricIdentifier("K_CELLULAR_GMM_CTXT"), latest<&Decoder::myGMMContextDict>),
    single("GSM NAS MM", metricIdentifier("K_CELLULAR_MM_CTXT"), latest<&Decoder::myMMContextDict>),
    single("GSM Serving Cell Info", metricIdentifier("K_GSM_SCELL_INFO"), latest<&Decoder::myGSMScellInfoDict>),
    single("GSM Idle Config", metricIdentifier("K_GSM_IDLE_CONFIG"), latest<&Decoder::myGSMIdleConfigInfoDict>),
    single("GSM Idle Serv Cell Meas", metricIdentifier("K_GSM_IDLE_SCELL_MEAS"),
           latest<&Decoder::myGSMIdleScellMeasDict>),
    // Kept without its technology, and "GSM GPRS Config" without the row's own: the catalogue's rows of these names do
    // not find them and show that to the user.
    single("Connected Serv Cell Meas", metricIdentifier("K_GSM_CS_RF_MEAS"), latest<&Decoder::myGSMConnRfMeasDict>),
    single("GSM GPRS Config", metricIdentifier("K_GSM_GPRS_CONFIG"), latest<&Decoder::myGSMGPRSConfigDict>),
    many("GSM LTE Neighbor Cell Meas", "LTE Neighbor ", metricIdentifier("K_GSM_NCELL_MEAS"),
         list<&Decoder::myGSM, &GSM::eUtraNbrMeas>),
    many("GSM UMTS Neighbor Cell Meas", "UMTS Neighbor ", metricIdentifier("K_GSM_NCELL_MEAS"),
         list<&Decoder::myGSM, &GSM::utraNbrMeas>),
    many("GSM GSM Neighbor Cell Meas", "GSM Neighbor ", metricIdentifier("K_GSM_NCELL_MEAS"),
         list<&Decoder::myGSM, &GSM::geraNbrMeas>),
    many("GSM Active Bearers", "PDP ", metricIdentifier("K_CELLULAR_ACTIVE_BEARER"),
         list<&Decoder::myCommon, &Common::activeBearer>),
});

constexpr auto deviceScreens = std::to_array<ScreenSource>({
    many("Device Info SIM Files", "SIM Content ", metricIdentifier("K_SIM_FILE_INFO"),
         list<&Decoder::myCommon, &Common::simContents>),
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
