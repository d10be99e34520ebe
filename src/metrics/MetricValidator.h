// The one consumer of metric events: decodes each payload and keeps the latest value of every metric.
#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

#include "client/RhoxWrapperDelegate.h"
#include "metrics/Common.h"
#include "metrics/GSM.h"
#include "metrics/LTE.h"
#include "metrics/UMTS.h"
#include "registry/MetricRows.h"
#include "values/Value.h"

namespace vespscope {

class RhoxWrapper;

// Belongs to the main thread, where the wrapper delivers and the screens read. Events replace values and never clear
// them.
class MetricValidator : public RhoxWrapperDelegate {
 public:
  // The decoder that the shared wrapper feeds, made on first use and kept until the process ends: it asks the
  // wrapper to listen and becomes its delegate.
  static std::shared_ptr<MetricValidator> shared();

  // Takes a decoder's lines, one at a time.
  using LineSink = std::function<void(std::string_view line)>;
  // Sees a report that was decoded, before its codes become units and its timestamp (milliseconds) text.
  using Observer = std::function<void(std::int64_t identifier, const Record& report)>;

  // A decoder that no wrapper feeds; it prints its lines, and reading its messages logs theirs.
  MetricValidator();
  // All its lines, those that reading its messages logs included, go to `lines` instead; without a function there are
  // none.
  explicit MetricValidator(LineSink lines);
  MetricValidator(const MetricValidator&) = delete;
  MetricValidator& operator=(const MetricValidator&) = delete;
  ~MetricValidator() override;

  // Prints one line; the argument is not read.
  void eventsDidUpdate(std::shared_ptr<const Record> dictionary) override;
  // Processes the event and prints a line when it was recognised; an absent dictionary is a programming error.
  void metricsDidUpdate(std::shared_ptr<const Record> dictionary) override;

  // Forgets all values: later events belong to another SIM card.
  void forget();

  // Called for each decoded report of a handled metric from here on, in place of the observer before; may be empty.
  void setObserver(Observer observer) { observer_ = std::move(observer); }

  // Full metric identifiers.
  const std::int64_t K_LTE_CDRX_CONFIG = metricIdentifier("K_LTE_CDRX_CONFIG");
  const std::int64_t K_LTE_RRC_STATE = metricIdentifier("K_LTE_RRC_STATE");
  const std::int64_t K_LTE_SCELL_INFO = metricIdentifier("K_LTE_SCELL_INFO");
  const std::int64_t K_LTE_RLF = metricIdentifier("K_LTE_RLF");
  const std::int64_t K_LTE_SEL_RESEL_INFO = metricIdentifier("K_LTE_SEL_RESEL_INFO");
  const std::int64_t K_LTE_SCELL_MEAS = metricIdentifier("K_LTE_SCELL_MEAS");
  const std::int64_t K_LTE_TX_POWER = metricIdentifier("K_LTE_TX_POWER");
  const std::int64_t K_LTE_RSRP_RSRQ_SINR = metricIdentifier("K_LTE_RSRP_RSRQ_SINR");
  const std::int64_t K_LTE_COMPCARR_INFO = metricIdentifier("K_LTE_COMPCARR_INFO");
  const std::int64_t K_LTE_CA_STATUS = metricIdentifier("K_LTE_CA_STATUS");
  const std::int64_t K_LTE_INTERRAT_MEAS = metricIdentifier("K_LTE_INTERRAT_MEAS");
  const std::int64_t K_LTE_INTRARAT_MEAS = metricIdentifier("K_LTE_INTRARAT_MEAS");
  const std::int64_t K_CELLULAR_MM_INFO = metricIdentifier("K_CELLULAR_MM_INFO");
  const std::int64_t K_CELLULAR_ACTIVE_BEARER = metricIdentifier("K_CELLULAR_ACTIVE_BEARER");
  const std::int64_t K_LTE_EMM_CTXT = metricIdentifier("K_LTE_EMM_CTXT");
  const std::int64_t K_CELLULAR_MM_CTXT = metricIdentifier("K_CELLULAR_MM_CTXT");
  const std::int64_t K_CELLULAR_GMM_CTXT = metricIdentifier("K_CELLULAR_GMM_CTXT");
  const std::int64_t K_UMTS_RRC_STATE = metricIdentifier("K_UMTS_RRC_STATE");
  const std::int64_t K_UMTS_RRC_CONFIG = metricIdentifier("K_UMTS_RRC_CONFIG");
  const std::int64_t K_UMTS_SCELL_INFO = metricIdentifier("K_UMTS_SCELL_INFO");
  const std::int64_t K_UMTS_SCELL_MEAS = metricIdentifier("K_UMTS_SCELL_MEAS");
  const std::int64_t K_UMTS_TX_POWER = metricIdentifier("K_UMTS_TX_POWER");
  const std::int64_t K_UMTS_SEL_RESEL_INFO = metricIdentifier("K_UMTS_SEL_RESEL_INFO");
  const std::int64_t K_UMTS_NCELL_MEAS = metricIdentifier("K_UMTS_NCELL_MEAS");
  const std::int64_t K_GSM_SCELL_INFO = metricIdentifier("K_GSM_SCELL_INFO");
  const std::int64_t K_GSM_IDLE_CONFIG = metricIdentifier("K_GSM_IDLE_CONFIG");
  const std::int64_t K_GSM_IDLE_SCELL_MEAS = metricIdentifier("K_GSM_IDLE_SCELL_MEAS");
  const std::int64_t K_GSM_CS_RF_MEAS = metricIdentifier("K_GSM_CS_RF_MEAS");
  const std::int64_t K_GSM_NCELL_MEAS = metricIdentifier("K_GSM_NCELL_MEAS");
  const std::int64_t K_GSM_GPRS_CONFIG = metricIdentifier("K_GSM_GPRS_CONFIG");
  const std::int64_t K_SIM_FILE_INFO = metricIdentifier("K_SIM_FILE_INFO");

  // The wrapper that feeds this decoder; null when none does.
  std::shared_ptr<RhoxWrapper> mySharedRhoxInstance;

  // Keys of the event dictionary; the profile is not read.
  std::string metricIDKey = "kKeyMetricID";
  std::string payloadKey = "kKeyPayload";
  std::string profileIDKey = "kKeyProfileID";

  // The identifier of the last event, recognised or not.
  std::optional<std::int64_t> metricID;

  LTE myLTE;
  UMTS myUMTS;
  GSM myGSM;
  Common myCommon;

  // The latest value of one metric each, absent until its first event.
  std::optional<Record> myLTERRCStateDict;
  std::optional<Record> myLTECDRXConfigDict;
  std::optional<Record> myLTESCellInfoDict;
  std::optional<Record> myLTESCellMeasDict;  // never written: its metric is not handled
  std::optional<Record> myLTESelReselDict;
  std::optional<Record> myLTERsrpRsrqSinrDict;
  std::optional<Record> myLTECompCarrDict;
  std::optional<Record> myLTETxPowerDict;
  std::optional<Record> myLTEInterRatMeasDict;
  std::optional<Record> myLTEIntraRatMeasDict;
  std::optional<Record> myLTECAStatusDict;
  std::optional<Record> myLTEEMMContextDict;
  std::optional<Record> myCellularMMCommonInfoDict;
  std::optional<Record> myCellularActiveBearerDict;
  std::optional<Record> myGMMContextDict;
  std::optional<Record> myMMContextDict;
  std::optional<Record> myUMTSRRCStateDict;
  std::optional<Record> myUMTSRRCConfigDict;
  std::optional<Record> myUMTSCellInfoDict;
  std::optional<Record> myUMTSCellMeasDict;
  std::optional<Record> myUMTSTxPowerDict;
  std::optional<Record> myUMTSSelReselDict;
  std::optional<Record> myUMTSNbrMeasDict;
  std::optional<Record> myGSMScellInfoDict;
  std::optional<Record> myGSMIdleConfigInfoDict;
  std::optional<Record> myGSMIdleScellMeasDict;
  std::optional<Record> myGSMConnRfMeasDict;
  std::optional<Record> myGSMNbrMeasDict;
  std::optional<Record> myGSMGPRSConfigDict;
  std::optional<Record> mySIMFileInfoDict;

  // LTE channel bandwidth code to MHz.
  const std::map<std::int32_t, float> dlbwlookup = {{0, 1.4F},  {1, 3.0F},  {2, 5.0F},
                                                    {3, 10.0F}, {4, 15.0F}, {5, 20.0F}};

  // Decodes and stores one event. True when its metric is handled, even when the payload does not decode; an event
  // without an integer identifier is a programming error.
  virtual bool processMetric(const Record& event);

  // Milliseconds since 1970-01-01 00:00 UTC as "yyyy-MM-dd HH:mm:ss zzz" in the device's time zone.
  [[nodiscard]] std::string formatTimestamp(double milliseconds) const;

  // Events of a handled metric whose payload was missing or did not decode.
  [[nodiscard]] std::uint64_t decodeFailures() const { return decodeFailures_; }

  // Hands one line of the decoding to the sink.
  void print(std::string_view line) const {
    if (lines_) lines_(line);
  }

 private:
  LineSink lines_;
  bool logsNothing_ = false;  // the system log's lines go to `lines_` as well
  Observer observer_;
  std::uint64_t decodeFailures_ = 0;
  std::string line_;  // the log line under way, kept for its memory
};

}  // namespace vespscope
