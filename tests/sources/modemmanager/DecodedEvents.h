// Metric events of a modem as text: the contents of their messages, without the timestamp.
#pragma once

#include <chrono>
#include <cstdint>
#include <map>
#include <string>
#include <utility>

#include <gtest/gtest.h>

#include "messages/WireReader.h"
#include "messages/gsm/KCellularGsmGrrEventMeasCr.h"
#include "messages/gsm/KCellularGsmIdleScellMeasurement.h"
#include "messages/gsm/KCellularGsmScellInfo.h"
#include "messages/lte/KCellularEmmContext.h"
#include "messages/lte/KCellularLteNbrEutraCellMeas.h"
#include "messages/lte/KCellularLteNbrInterRatCellMeas.h"
#include "messages/lte/KCellularLteRsrpRsrqSinr.h"
#include "messages/lte/KCellularLteScellInfo.h"
#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "messages/mobility/KCellularGmmContext.h"
#include "messages/mobility/KCellularMmCommonInfo.h"
#include "messages/mobility/KCellularMmContext.h"
#include "messages/mobility/KCellularSimCardFiles.h"
#include "messages/umts/KCellularWcdmaCellInfo.h"
#include "messages/umts/KCellularWcdmaNbrCellMeas.h"
#include "messages/umts/KCellularWcdmaScellMeasurement.h"
#include "registry/MetricRows.h"
#include "values/MetricEvent.h"
#include "values/Text.h"

namespace vespscope::test {

template <class Message>
std::string contentOf(const MetricEvent& event) {
  Message message;
  WireReader reader(event.payload);
  EXPECT_TRUE(message.readFrom(reader));
  EXPECT_TRUE(message.hasTimestamp());
  EXPECT_EQ(std::chrono::milliseconds(message.timestamp()),
            std::chrono::duration_cast<std::chrono::milliseconds>(event.time));
  Record record = message.dictionaryRepresentation();
  record.remove("timestamp");
  return toText(Value(record));
}

// A short name for the event's metric, and its contents.
inline std::pair<std::string, std::string> decodedEvent(const MetricEvent& event) {
  using Decoder = std::string (*)(const MetricEvent&);
  static const std::map<std::int32_t, std::pair<std::string, Decoder>> decoders = {
      {metricIdentifier("K_LTE_EMM_CTXT"), {"EMM", contentOf<KCellularEmmContext>}},
      {metricIdentifier("K_CELLULAR_MM_CTXT"), {"MM", contentOf<KCellularMmContext>}},
      {metricIdentifier("K_CELLULAR_GMM_CTXT"), {"GMM", contentOf<KCellularGmmContext>}},
      {metricIdentifier("K_CELLULAR_MM_INFO"), {"common", contentOf<KCellularMmCommonInfo>}},
      {metricIdentifier("K_CELLULAR_ACTIVE_BEARER"), {"bearers", contentOf<KCellularActivatedBearerContexts>}},
      {metricIdentifier("K_SIM_FILE_INFO"), {"SIM", contentOf<KCellularSimCardFiles>}},
      {metricIdentifier("K_LTE_SCELL_INFO"), {"LTE cell", contentOf<KCellularLteScellInfo>}},
      {metricIdentifier("K_LTE_RSRP_RSRQ_SINR"), {"LTE level", contentOf<KCellularLteRsrpRsrqSinr>}},
      {metricIdentifier("K_LTE_INTRARAT_MEAS"), {"LTE neighbours", contentOf<KCellularLteNbrEutraCellMeas>}},
      {metricIdentifier("K_LTE_INTERRAT_MEAS"), {"LTE others", contentOf<KCellularLteNbrInterRatCellMeas>}},
      {metricIdentifier("K_UMTS_SCELL_INFO"), {"UMTS cell", contentOf<KCellularWcdmaCellInfo>}},
      {metricIdentifier("K_UMTS_SCELL_MEAS"), {"UMTS level", contentOf<KCellularWcdmaScellMeasurement>}},
      {metricIdentifier("K_UMTS_NCELL_MEAS"), {"UMTS neighbours", contentOf<KCellularWcdmaNbrCellMeas>}},
      {metricIdentifier("K_GSM_SCELL_INFO"), {"GSM cell", contentOf<KCellularGsmScellInfo>}},
      {metricIdentifier("K_GSM_IDLE_SCELL_MEAS"), {"GSM level", contentOf<KCellularGsmIdleScellMeasurement>}},
      {metricIdentifier("K_GSM_NCELL_MEAS"), {"GSM neighbours", contentOf<KCellularGsmGrrEventMeasCr>}},
  };
  const auto& [name, decode] = decoders.at(event.metricID);
  return {name, decode(event)};
}

}  // namespace vespscope::test
