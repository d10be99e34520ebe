#include "tools/vespctl/State.h"

#include <array>
#include <string_view>

#include <nlohmann/json.hpp>

#include "metrics/MetricValidator.h"

namespace vespscope::tools {
namespace {

using tools::toJson;

Json toJson(const LTE& lte) {
  return {{"SelReselCellInfo", toJson(lte.SelReselCellInfo)}, {"EutraNbrs", toJson(lte.EutraNbrs)},
          {"RsrpRsrqSinr", toJson(lte.RsrpRsrqSinr)},         {"TxPower", toJson(lte.TxPower)},
          {"EutraNbrsMeas", toJson(lte.EutraNbrsMeas)},       {"UtraNbrsMeas", toJson(lte.UtraNbrsMeas)},
          {"GeraNbrsMeas", toJson(lte.GeraNbrsMeas)},         {"CAStatusList", toJson(lte.CAStatusList)},
          {"MMCommonInfo", toJson(lte.MMCommonInfo)},         {"IMSI", toJson(lte.IMSI)}};
}

Json toJson(const UMTS& umts) {
  return {{"rXInfo", toJson(umts.rXInfo)},
          {"TxPower", toJson(umts.TxPower)},
          {"SelReselCellInfo", toJson(umts.SelReselCellInfo)},
          {"eUtraNbrs", toJson(umts.eUtraNbrs)},
          {"utraNbrs", toJson(umts.utraNbrs)},
          {"geraNbrs", toJson(umts.geraNbrs)},
          {"eUtraNbrMeas", toJson(umts.eUtraNbrMeas)},
          {"utraNbrMeas", toJson(umts.utraNbrMeas)},
          {"geraNbrMeas", toJson(umts.geraNbrMeas)}};
}

Json toJson(const GSM& gsm) {
  return {{"eUtraNbrMeas", toJson(gsm.eUtraNbrMeas)},
          {"utraNbrMeas", toJson(gsm.utraNbrMeas)},
          {"geraNbrMeas", toJson(gsm.geraNbrMeas)}};
}

Json toJson(const Common& common) {
  return {{"activeBearer", toJson(common.activeBearer)}, {"simContents", toJson(common.simContents)}};
}

struct StoredDictionary {
  std::string_view name;
  std::optional<Record> MetricValidator::*member;
};

constexpr std::array<StoredDictionary, 30> storedDictionaries = {{
    {"myLTERRCStateDict", &MetricValidator::myLTERRCStateDict},
    {"myLTECDRXConfigDict", &MetricValidator::myLTECDRXConfigDict},
    {"myLTESCellInfoDict", &MetricValidator::myLTESCellInfoDict},
    {"myLTESCellMeasDict", &MetricValidator::myLTESCellMeasDict},
    {"myLTESelReselDict", &MetricValidator::myLTESelReselDict},
    {"myLTERsrpRsrqSinrDict", &MetricValidator::myLTERsrpRsrqSinrDict},
    {"myLTECompCarrDict", &MetricValidator::myLTECompCarrDict},
    {"myLTETxPowerDict", &MetricValidator::myLTETxPowerDict},
    {"myLTEInterRatMeasDict", &MetricValidator::myLTEInterRatMeasDict},
    {"myLTEIntraRatMeasDict", &MetricValidator::myLTEIntraRatMeasDict},
    {"myLTECAStatusDict", &MetricValidator::myLTECAStatusDict},
    {"myLTEEMMContextDict", &MetricValidator::myLTEEMMContextDict},
    {"myCellularMMCommonInfoDict", &MetricValidator::myCellularMMCommonInfoDict},
    {"myCellularActiveBearerDict", &MetricValidator::myCellularActiveBearerDict},
    {"myGMMContextDict", &MetricValidator::myGMMContextDict},
    {"myMMContextDict", &MetricValidator::myMMContextDict},
    {"myUMTSRRCStateDict", &MetricValidator::myUMTSRRCStateDict},
    {"myUMTSRRCConfigDict", &MetricValidator::myUMTSRRCConfigDict},
    {"myUMTSCellInfoDict", &MetricValidator::myUMTSCellInfoDict},
    {"myUMTSCellMeasDict", &MetricValidator::myUMTSCellMeasDict},
    {"myUMTSTxPowerDict", &MetricValidator::myUMTSTxPowerDict},
    {"myUMTSSelReselDict", &MetricValidator::myUMTSSelReselDict},
    {"myUMTSNbrMeasDict", &MetricValidator::myUMTSNbrMeasDict},
    {"myGSMScellInfoDict", &MetricValidator::myGSMScellInfoDict},
    {"myGSMIdleConfigInfoDict", &MetricValidator::myGSMIdleConfigInfoDict},
    {"myGSMIdleScellMeasDict", &MetricValidator::myGSMIdleScellMeasDict},
    {"myGSMConnRfMeasDict", &MetricValidator::myGSMConnRfMeasDict},
    {"myGSMNbrMeasDict", &MetricValidator::myGSMNbrMeasDict},
    {"myGSMGPRSConfigDict", &MetricValidator::myGSMGPRSConfigDict},
    {"mySIMFileInfoDict", &MetricValidator::mySIMFileInfoDict},
}};

}  // namespace

Json stateOf(const MetricValidator& validator) {
  Json json = {{"metricID", validator.metricID ? Json(*validator.metricID) : Json(nullptr)},
               {"myLTE", toJson(validator.myLTE)},
               {"myUMTS", toJson(validator.myUMTS)},
               {"myGSM", toJson(validator.myGSM)},
               {"myCommon", toJson(validator.myCommon)}};
  for (const StoredDictionary& stored : storedDictionaries) {
    json[std::string(stored.name)] = toJson(validator.*stored.member);
  }
  return json;
}

}  // namespace vespscope::tools
