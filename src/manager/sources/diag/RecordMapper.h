// Turns the log records of one radio into metric events.
#pragma once

#include <chrono>
#include <optional>
#include <vector>

#include "manager/sources/diag/CarrierTracker.h"
#include "manager/sources/diag/DiagReport.h"
#include "manager/sources/diag/LogRecord.h"
#include "manager/sources/diag/NeighbourTracker.h"
#include "manager/sources/diag/RrcTracker.h"
#include "manager/sources/diag/ServingCellTracker.h"

namespace vespscope::manager::diag {

class RecordMapper {
 public:
  // The record's events, in order; what became of the record is counted in `report`.
  [[nodiscard]] std::vector<MetricEvent> take(const LogRecord& record, DiagReport& report);

 private:
  void take(const ServingCellRecord& record, EventList& out);
  void take(const ServingMeasurementRecord& record, EventList& out);
  void take(const NeighbourMeasurementRecord& record, EventList& out);
  void take(const RrcMessageRecord& record, EventList& out);
  template <class Record>
  void takeDecoded(const LogRecord& record, const Decoded<Record>& decoded, DiagReport& report, EventList& out);

  std::optional<std::chrono::nanoseconds> lastTime_;
  RrcTracker rrc_;
  ServingCellTracker servingCell_;
  CarrierTracker carriers_;
  NeighbourTracker neighbours_;
};

}  // namespace vespscope::manager::diag
