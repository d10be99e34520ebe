#include "metrics/EventRows.h"

#include <algorithm>
#include <array>

#include "messages/WireReader.h"
#include "messages/gsm/KCellularGsmCsRfMeasurement.h"
#include "messages/gsm/KCellularGsmGprsConfig.h"
#include "messages/gsm/KCellularGsmGrrEventMeasCr.h"
#include "messages/gsm/KCellularGsmIdleConfig.h"
#include "messages/gsm/KCellularGsmIdleScellMeasurement.h"
#include "messages/gsm/KCellularGsmScellInfo.h"
#include "messages/lte/KCellularEmmContext.h"
#include "messages/lte/KCellularLteCarrierAggregationStatus.h"
#include "messages/lte/KCellularLteCdrxConfig.h"
#include "messages/lte/KCellularLteComponentCarrierInfo.h"
#include "messages/lte/KCellularLteNbrEutraCellMeas.h"
#include "messages/lte/KCellularLteNbrInterRatCellMeas.h"
#include "messages/lte/KCellularLteRrcState.h"
#include "messages/lte/KCellularLteRsrpRsrqSinr.h"
#include "messages/lte/KCellularLteScellInfo.h"
#include "messages/lte/KCellularLteSelReselCellInfo.h"
#include "messages/lte/KCellularLteTxPower.h"
#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "messages/mobility/KCellularGmmContext.h"
#include "messages/mobility/KCellularMmCommonInfo.h"
#include "messages/mobility/KCellularMmContext.h"
#include "messages/mobility/KCellularSimCardFiles.h"
#include "messages/umts/KCellularWcdmaCellInfo.h"
#include "messages/umts/KCellularWcdmaNbrCellMeas.h"
#include "messages/umts/KCellularWcdmaRrcConfiguration.h"
#include "messages/umts/KCellularWcdmaRrcConnectionState.h"
#include "messages/umts/KCellularWcdmaScellMeasurement.h"
#include "messages/umts/KCellularWcdmaSelReselCellInfo.h"
#include "messages/umts/KCellularWcdmaTxPower.h"
#include "registry/MetricRows.h"

namespace vespscope {
namespace {

template <class MessageClass>
DecodedPayload decodeAs(const Bytes* payload) {
  DecodedPayload decoded;
  if (payload == nullptr) return decoded;
  MessageClass message;
  WireReader reader(*payload);
  decoded.ok = message.readFrom(reader);
  if (decoded.ok) decoded.record = message.dictionaryRepresentation();
  return decoded;
}

// The field `list` of the decoder's holder `holder`.
template <auto holder, auto part>
auto& field(MetricValidator& validator) {
  return validator.*holder.*part;
}

constexpr std::array<EventRow, 29> rows = {{
    {metricIdentifier("K_SIM_FILE_INFO"),
     "KCellularSimCardFiles",
     &decodeAs<KCellularSimCardFiles>,
     &MetricValidator::mySIMFileInfoDict,
     "Received SIM Card File Info is ",
     {{ReplaceList{"ef_list", field<&MetricValidator::myCommon, &Common::simContents>}}}},
    {metricIdentifier("K_GSM_SCELL_INFO"), "KCellularGsmScellInfo", &decodeAs<KCellularGsmScellInfo>,
     &MetricValidator::myGSMScellInfoDict, "Received GSM Serving Cell Info "},
    {metricIdentifier("K_UMTS_SCELL_INFO"), "KCellularWcdmaCellInfo", &decodeAs<KCellularWcdmaCellInfo>,
     &MetricValidator::myUMTSCellInfoDict, "Received UMTS Serving Cell Info is "},
    {metricIdentifier("K_LTE_SCELL_INFO"),
     "KCellularLteScellInfo",
     &decodeAs<KCellularLteScellInfo>,
     &MetricValidator::myLTESCellInfoDict,
     "Current Serving Cell Info is ",
     {{Halve{"dl_bw"}, Halve{"ul_bw"}}}},
    {metricIdentifier("K_LTE_RRC_STATE"), "KCellularLteRrcState", &decodeAs<KCellularLteRrcState>,
     &MetricValidator::myLTERRCStateDict, "Current RRC state is "},
    {metricIdentifier("K_LTE_CDRX_CONFIG"), "KCellularLteCdrxConfig", &decodeAs<KCellularLteCdrxConfig>,
     &MetricValidator::myLTECDRXConfigDict, "Current CDRX Config is "},
    {metricIdentifier("K_LTE_RSRP_RSRQ_SINR"),
     "KCellularLteRsrpRsrqSinr",
     &decodeAs<KCellularLteRsrpRsrqSinr>,
     &MetricValidator::myLTERsrpRsrqSinrDict,
     "Received RSRP RSRQ SINR is : ",
     {{ReplaceList{"inst_values", field<&MetricValidator::myLTE, &LTE::RsrpRsrqSinr>, Measured::antennaPorts}}}},
    {metricIdentifier("K_GSM_IDLE_CONFIG"), "KCellularGsmIdleConfig", &decodeAs<KCellularGsmIdleConfig>,
     &MetricValidator::myGSMIdleConfigInfoDict, "Received GSM Idle Config Info is "},
    {metricIdentifier("K_GSM_IDLE_SCELL_MEAS"), "KCellularGsmIdleScellMeasurement",
     &decodeAs<KCellularGsmIdleScellMeasurement>, &MetricValidator::myGSMIdleScellMeasDict,
     "Received GSM Idle Serving Cell Meas Info is "},
    {metricIdentifier("K_GSM_CS_RF_MEAS"), "KCellularGsmCsRfMeasurement", &decodeAs<KCellularGsmCsRfMeasurement>,
     &MetricValidator::myGSMConnRfMeasDict, "Received GSM Connected Serving Cell Meas Info is "},
    {metricIdentifier("K_GSM_NCELL_MEAS"),
     "KCellularGsmGrrEventMeasCr",
     &decodeAs<KCellularGsmGrrEventMeasCr>,
     &MetricValidator::myGSMNbrMeasDict,
     "Received GSM Nbr Cell Meas Info is ",
     {{ReplaceList{"gsm_ncell_meas", field<&MetricValidator::myGSM, &GSM::geraNbrMeas>, Measured::gsmNeighbour},
       ReplaceList{"umts_ncell_meas", field<&MetricValidator::myGSM, &GSM::utraNbrMeas>, Measured::umtsNeighbour},
       ReplaceList{"lte_ncell_meas", field<&MetricValidator::myGSM, &GSM::eUtraNbrMeas>, Measured::lteNeighbour}}}},
    {metricIdentifier("K_GSM_GPRS_CONFIG"), "KCellularGsmGprsConfig", &decodeAs<KCellularGsmGprsConfig>,
     &MetricValidator::myGSMGPRSConfigDict, "Received GSM GPRS Config Info is "},
    {metricIdentifier("K_UMTS_SCELL_MEAS"),
     "KCellularWcdmaScellMeasurement",
     &decodeAs<KCellularWcdmaScellMeasurement>,
     &MetricValidator::myUMTSCellMeasDict,
     "Received UMTS Serving Cell Meas is ",
     {{ReplaceList{"rx_info", field<&MetricValidator::myUMTS, &UMTS::rXInfo>, Measured::nothing, "connected_mode"}}}},
    {metricIdentifier("K_UMTS_TX_POWER"),
     "KCellularWcdmaTxPower",
     &decodeAs<KCellularWcdmaTxPower>,
     &MetricValidator::myUMTSTxPowerDict,
     "Received Tx Power is ",
     {{ReplaceList{"tx_power_info", field<&MetricValidator::myUMTS, &UMTS::TxPower>}}}},
    {metricIdentifier("K_UMTS_SEL_RESEL_INFO"),
     "KCellularWcdmaSelReselCellInfo",
     &decodeAs<KCellularWcdmaSelReselCellInfo>,
     &MetricValidator::myUMTSSelReselDict,
     "Received UMTS Cell Resel Info is ",
     {{WriteOutIntegers{"multi_band_info"}, FillTemplate{field<&MetricValidator::myUMTS, &UMTS::SelReselCellInfo>},
       ReplaceList{"eutra_prio_info", field<&MetricValidator::myUMTS, &UMTS::eUtraNbrs>}}}},
    {metricIdentifier("K_UMTS_NCELL_MEAS"),
     "KCellularWcdmaNbrCellMeas",
     &decodeAs<KCellularWcdmaNbrCellMeas>,
     &MetricValidator::myUMTSNbrMeasDict,
     "Received UMTS InterRat Meas Info is ",
     {{ReplaceList{"meas_utra_result", field<&MetricValidator::myUMTS, &UMTS::utraNbrMeas>, Measured::umtsNeighbour},
       ReplaceList{"meas_gsm_result", field<&MetricValidator::myUMTS, &UMTS::geraNbrMeas>, Measured::gsmNeighbour},
       ReplaceList{"meas_lte_result", field<&MetricValidator::myUMTS, &UMTS::eUtraNbrMeas>, Measured::lteNeighbour}}}},
    {metricIdentifier("K_UMTS_RRC_STATE"), "KCellularWcdmaRrcConnectionState",
     &decodeAs<KCellularWcdmaRrcConnectionState>, &MetricValidator::myUMTSRRCStateDict,
     "Received UMTS RRC Connection State is "},
    {metricIdentifier("K_UMTS_RRC_CONFIG"), "KCellularWcdmaRrcConfiguration", &decodeAs<KCellularWcdmaRrcConfiguration>,
     &MetricValidator::myUMTSRRCConfigDict, "Received UMTS RRC Configuration is "},
    {metricIdentifier("K_LTE_TX_POWER"),
     "KCellularLteTxPower",
     &decodeAs<KCellularLteTxPower>,
     &MetricValidator::myLTETxPowerDict,
     "Received LTE Tx Power is ",
     {{ReplaceList{"tx_power_info", field<&MetricValidator::myLTE, &LTE::TxPower>}}}},
    {metricIdentifier("K_LTE_COMPCARR_INFO"), "KCellularLteComponentCarrierInfo",
     &decodeAs<KCellularLteComponentCarrierInfo>, &MetricValidator::myLTECompCarrDict,
     "Received Component Carrier info is "},
    {metricIdentifier("K_LTE_SEL_RESEL_INFO"),
     "KCellularLteSelReselCellInfo",
     &decodeAs<KCellularLteSelReselCellInfo>,
     &MetricValidator::myLTESelReselDict,
     "Received LTE Cell Resel Info is ",
     {{WriteOutIntegers{"multi_band_info"}, FillTemplate{field<&MetricValidator::myLTE, &LTE::SelReselCellInfo>},
       ReplaceList{"nbr_eutra", field<&MetricValidator::myLTE, &LTE::EutraNbrs>, Measured::neighbourFrequency}}}},
    {metricIdentifier("K_LTE_INTRARAT_MEAS"),
     "KCellularLteNbrEutraCellMeas",
     &decodeAs<KCellularLteNbrEutraCellMeas>,
     &MetricValidator::myLTEIntraRatMeasDict,
     "Received LTE IRAT Meas is ",
     {{ReplaceList{"meas_nbr_eutra", field<&MetricValidator::myLTE, &LTE::EutraNbrsMeas>, Measured::lteNeighbour}}}},
    {metricIdentifier("K_LTE_INTERRAT_MEAS"),
     "KCellularLteNbrInterRatCellMeas",
     &decodeAs<KCellularLteNbrInterRatCellMeas>,
     &MetricValidator::myLTEInterRatMeasDict,
     "Received LTE InterRat Meas Info is ",
     {{ReplaceList{"meas_nbr_utra", field<&MetricValidator::myLTE, &LTE::UtraNbrsMeas>, Measured::umtsNeighbour},
       ReplaceList{"meas_nbr_geran", field<&MetricValidator::myLTE, &LTE::GeraNbrsMeas>, Measured::gsmNeighbour}}}},
    {metricIdentifier("K_LTE_CA_STATUS"),
     "KCellularLteCarrierAggregationStatus",
     &decodeAs<KCellularLteCarrierAggregationStatus>,
     &MetricValidator::myLTECAStatusDict,
     "Received CA Status Dict is ",
     {{ReplaceList{"scc_list", field<&MetricValidator::myLTE, &LTE::CAStatusList>, Measured::secondaryCarrier}}}},
    {metricIdentifier("K_CELLULAR_MM_INFO"), "KCellularMmCommonInfo", &decodeAs<KCellularMmCommonInfo>,
     &MetricValidator::myCellularMMCommonInfoDict, "Received MM Common Info Dict is : "},
    {metricIdentifier("K_CELLULAR_MM_CTXT"), "KCellularMmContext", &decodeAs<KCellularMmContext>,
     &MetricValidator::myMMContextDict, "Received MM Context Info is "},
    {metricIdentifier("K_CELLULAR_GMM_CTXT"), "KCellularGmmContext", &decodeAs<KCellularGmmContext>,
     &MetricValidator::myGMMContextDict, "Received GMM Context Info is "},
    {metricIdentifier("K_LTE_EMM_CTXT"),
     "KCellularEmmContext",
     &decodeAs<KCellularEmmContext>,
     &MetricValidator::myLTEEMMContextDict,
     "Received EMM Context is ",
     {{WriteOutRecord{"guti"}, WriteOutRecordList{"tai_list"}}}},
    {metricIdentifier("K_CELLULAR_ACTIVE_BEARER"),
     "KCellularActivatedBearerContexts",
     &decodeAs<KCellularActivatedBearerContexts>,
     &MetricValidator::myCellularActiveBearerDict,
     "Received Bearer Context Info is ",
     {{ReplaceList{"bearer_contexts", field<&MetricValidator::myCommon, &Common::activeBearer>}}}},
}};

static_assert(std::is_sorted(rows.begin(), rows.end(), [](const EventRow& left, const EventRow& right) {
  return left.identifier < right.identifier;
}));

// Close together, so that a search stays within a few lines of the cache.
constexpr auto identifiers = [] {
  std::array<std::int64_t, rows.size()> all{};
  std::transform(rows.begin(), rows.end(), all.begin(), [](const EventRow& row) { return row.identifier; });
  return all;
}();

}  // namespace

std::span<const EventRow> eventRows() { return rows; }

const EventRow* findEventRow(std::int64_t identifier) {
  // Without a branch for each step: metrics come in no order that a processor could foresee.
  std::size_t first = 0;
  for (std::size_t left = identifiers.size(); left > 1;) {
    const std::size_t half = left / 2;
    first += identifiers[first + half - 1] < identifier ? half : 0;
    left -= half;
  }
  return identifiers[first] == identifier ? &rows[first] : nullptr;
}

}  // namespace vespscope
