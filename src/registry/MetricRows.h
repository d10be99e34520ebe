// The 31 cellular metrics: tag, registry text and identifier name, declared once for every reader of them.
#pragma once

#include <array>
#include <cstdint>
#include <string_view>

namespace vespscope {

// Bits 16-23 of a full metric identifier; bits 0-15 hold the tag.
inline constexpr std::int32_t metricGroup = 0x3C0000;

struct MetricRow {
  std::uint16_t tag;
  std::string_view registryText;  // the registry's spelling, including the six lower-case initials
  std::string_view identifierName;

  [[nodiscard]] constexpr std::int32_t identifier() const { return metricGroup + tag; }
};

inline constexpr std::array<MetricRow, 31> metricRows = {{
    {0x4E04, "KCellularLteRrcState", "K_LTE_RRC_STATE"},
    {0x4E18, "KCellularLteCdrxConfig", "K_LTE_CDRX_CONFIG"},
    {0x4E25, "KCellularLteRadioLinkFailure", "K_LTE_RLF"},
    {0x40C2, "KCellularLteScellInfo", "K_LTE_SCELL_INFO"},
    {0xD30E, "KCellularLteSelReselCellInfo", "K_LTE_SEL_RESEL_INFO"},
    {0xD301, "KCellularLteServingCellMeasurement", "K_LTE_SCELL_MEAS"},
    {0xD302, "KCellularLteTxPower", "K_LTE_TX_POWER"},
    {0x4F6A, "KCellularRsrpRsrqSinr", "K_LTE_RSRP_RSRQ_SINR"},
    {0xD50C, "KCellularEmmContext", "K_LTE_EMM_CTXT"},
    {0xD30B, "KCellularLteComponentCarrierInfo", "K_LTE_COMPCARR_INFO"},
    {0xD313, "KCellularLteCarrierAggregationStatus", "K_LTE_CA_STATUS"},
    {0xD310, "KCellularLteNbrInterRatCellMeas", "K_LTE_INTERRAT_MEAS"},
    {0xD30F, "KCellularLteNbrEutraCellMeas", "K_LTE_INTRARAT_MEAS"},
    {0xD509, "KCellularMmCommonInfo", "K_CELLULAR_MM_INFO"},
    {0xD50D, "KCellularActivatedBearerContexts", "K_CELLULAR_ACTIVE_BEARER"},
    {0xD112, "KCellularWcdmaRrcConnectionState", "K_UMTS_RRC_STATE"},
    {0x300C, "KCellularWcdmaCellInfo", "K_UMTS_SCELL_INFO"},
    {0xD102, "KCellularWcdmaScellMeasurement", "K_UMTS_SCELL_MEAS"},
    {0xD103, "KCellularWcdmaTxPower", "K_UMTS_TX_POWER"},
    {0xD105, "KCellularWcdmaNbrCellMeas", "K_UMTS_NCELL_MEAS"},
    {0xD104, "KCellularWcdmaSelReselCellInfo", "K_UMTS_SEL_RESEL_INFO"},
    {0xD113, "KCellularWcdmaRrcConfiguration", "K_UMTS_RRC_CONFIG"},
    {0xD50A, "KCellularMmContext", "K_CELLULAR_MM_CTXT"},
    {0xD50B, "KCellularGmmContext", "K_CELLULAR_GMM_CTXT"},
    {0x2E0C, "kCellularGsmScellInfo", "K_GSM_SCELL_INFO"},
    {0xD001, "kCellularGsmIdleConfig", "K_GSM_IDLE_CONFIG"},
    {0xD002, "kCellularGsmIdleScellMeasurement", "K_GSM_IDLE_SCELL_MEAS"},
    {0xD003, "kCellularGsmCsRfMeasurement", "K_GSM_CS_RF_MEAS"},
    {0xD009, "kCellularGsmGrrEventMeasCr", "K_GSM_NCELL_MEAS"},
    {0xD00C, "kCellularGsmGprsConfig", "K_GSM_GPRS_CONFIG"},
    {0x0013, "kCellularSimCardFiles", "K_SIM_FILE_INFO"},
}};

// The row whose identifier has the name `name` ("K_LTE_RRC_STATE"); an unknown name does not compile.
consteval std::int32_t metricIdentifier(std::string_view name) {
  for (const MetricRow& row : metricRows) {
    if (row.identifierName == name) return row.identifier();
  }
  throw "no such metric";
}

}  // namespace vespscope
