// Turns the log records of one radio into metric events.
#pragma once

#include <chrono>
#include <optional>
#include <vector>

#include "sources/diag/BearerTracker.h"
#include "sources/diag/CarrierTracker.h"
#include "sources/diag/DiagReport.h"
#include "sources/diag/EmmTracker.h"
#include "sources/diag/GsmTracker.h"
#include "sources/diag/LogRecord.h"
#include "sources/diag/LteSignalling.h"
#include "sources/diag/MobilityTracker.h"
#include "sources/diag/NeighbourTracker.h"
#include "sources/diag/RrcTracker.h"
#include "sources/diag/ServingCellTracker.h"
#include "sources/diag/WcdmaTracker.h"

namespace vespscope::sources::diag {

class RecordMapper {
 public:
  // The record's events, in order; what became of the record is counted in `report`.
  [[nodiscard]] std::vector<MetricEvent> take(const LogRecord& record, DiagReport& report);

 private:
  // What the records of one radio tell, kept together; a hole in the log ends all of it.
  struct Knowledge {
    RrcTracker rrc;
    LteSignalling signalling;
    ServingCellTracker servingCell;
    EmmTracker emm;
    MobilityTracker mobility;
    BearerTracker bearers;
    WcdmaTracker wcdma;
    GsmTracker gsm;
  };

  // Each tells whether it knows the record's code.
  bool takeLteRadio(const LogRecord& record, DiagReport& report, EventList& out);
  bool takeNas(const LogRecord& record, DiagReport& report, EventList& out);
  bool takeOtherRadio(const LogRecord& record, DiagReport& report, EventList& out);

  void take(const ServingMeasurementRecord& record, EventList& out);
  void take(const RrcMessageRecord& record, EventList& out);
  void take(const NeighbourMeasurementRecord& record, EventList& out);
  void nameServingCell(const CellName& cell, EventList& out);
  void take(const EmmStateRecord& record, EventList& out);
  void take(const WcdmaRrcRecord& record, EventList& out);
  // False for a message that tells nothing that a metric has.
  bool takeEpsSession(nas::Span message, EventList& out);
  bool takeEpsMobility(nas::Span message, bool outgoing, EventList& out);
  // False for a message that is ciphered, too.
  bool takeSecured(nas::Span sent, bool outgoing, EventList& out);
  bool takeGprsMessage(nas::Span message, EventList& out);

  std::optional<std::chrono::nanoseconds> lastTime_;
  Knowledge knowledge_;
  CarrierTracker carriers_;
  NeighbourTracker neighbours_;
};

}  // namespace vespscope::sources::diag
