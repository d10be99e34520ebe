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
  // Returns the record's events, in order, and counts the record in `report`.
  [[nodiscard]] std::vector<MetricEvent> take(const LogRecord& record, DiagReport& report);

 private:
  // The state learnt from the records of one radio; a gap in the log resets all of it.
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

  // Each returns whether it handles the record's code.
  bool takeLteRadio(const LogRecord& record, DiagReport& report, EventList& out);
  bool takeNas(const LogRecord& record, DiagReport& report, EventList& out);
  bool takeOtherRadio(const LogRecord& record, DiagReport& report, EventList& out);

  void take(const ServingMeasurementRecord& record, EventList& out);
  void take(const RrcMessageRecord& record, EventList& out);
  void take(const NeighbourMeasurementRecord& record, EventList& out);
  void nameServingCell(const CellName& cell, EventList& out);
  // Gives the serving cell and its bandwidth to the carriers.
  void servePrimary(EventList& out);
  void take(const EmmStateRecord& record, EventList& out);
  void take(const WcdmaRrcRecord& record, EventList& out);
  // Returns false for a message without anything that a metric needs.
  bool takeEpsSession(nas::Span message, EventList& out);
  bool takeEpsMobility(nas::Span message, bool outgoing, EventList& out);
  // Also returns false for a ciphered message.
  bool takeSecured(nas::Span sent, bool outgoing, EventList& out);
  bool takeGprsMessage(nas::Span message, EventList& out);

  std::optional<std::chrono::nanoseconds> lastTime_;
  Knowledge knowledge_;
  CarrierTracker carriers_;
  NeighbourTracker neighbours_;
};

}  // namespace vespscope::sources::diag
