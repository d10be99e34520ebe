#include "manager/sources/diag/RecordMapper.h"

namespace vespscope::manager::diag {
namespace {

using std::chrono::nanoseconds;

// A phone that sleeps still logs more often than this; records of different runs may be as close as the other.
constexpr nanoseconds longestSilence = std::chrono::seconds(60);
constexpr nanoseconds longestStepBack = std::chrono::seconds(1);

bool isGap(nanoseconds before, nanoseconds now) {
  return now - before > longestSilence || before - now > longestStepBack;
}

void countUnread(const LogRecord& record, const ServingMeasurementRecord& decoded, DiagReport& report) {
  for (const auto& unread : decoded.unread) ++report.skipped[{record.code, unread.version, unread.subpacket}];
}
template <class Record>
void countUnread(const LogRecord& /*record*/, const Record& /*decoded*/, DiagReport& /*report*/) {}

}  // namespace

std::vector<MetricEvent> RecordMapper::take(const LogRecord& record, DiagReport& report) {
  EventList out(static_cast<std::int32_t>(record.radio), record.time);
  carriers_.expire(out);
  if (lastTime_ && isGap(*lastTime_, record.time)) {
    // What the phone did meanwhile is not known.
    rrc_ = {};
    servingCell_ = {};
  }
  lastTime_ = record.time;
  switch (record.code) {
    case servingCellCode:
      takeDecoded(record, servingCellOf(record.payload), report, out);
      break;
    case servingMeasurementCode:
      takeDecoded(record, servingMeasurementOf(record.payload), report, out);
      break;
    case neighbourMeasurementCode:
      takeDecoded(record, neighbourMeasurementOf(record.payload), report, out);
      break;
    case rrcMessageCode:
      takeDecoded(record, rrcMessageOf(record.payload), report, out);
      break;
    default:
      ++report.skipped[{record.code, std::nullopt, std::nullopt}];
  }
  return out.take();
}

template <class Record>
void RecordMapper::takeDecoded(const LogRecord& record, const Decoded<Record>& decoded, DiagReport& report,
                               EventList& out) {
  RecordKind kind{record.code, std::nullopt, std::nullopt};
  if (!record.payload.empty()) kind.version = record.payload[0];
  if (const auto* fault = std::get_if<RecordFault>(&decoded)) {
    ++(*fault == RecordFault::unknownVersion ? report.skipped : report.broken)[kind];
    return;
  }
  const auto& meaning = std::get<Record>(decoded);
  ++report.read[kind];
  countUnread(record, meaning, report);
  take(meaning, out);
}

void RecordMapper::take(const ServingCellRecord& record, EventList& out) { servingCell_.describe(record, out); }

void RecordMapper::take(const ServingMeasurementRecord& record, EventList& out) {
  for (const ServingMeasurement& cell : record.cells) {
    if (cell.serving && cell.cellIndex == 0) servingCell_.name(cell.cell, out);
  }
  carriers_.take(record, out);
}

void RecordMapper::take(const NeighbourMeasurementRecord& record, EventList& out) { neighbours_.take(record, out); }

void RecordMapper::take(const RrcMessageRecord& record, EventList& out) {
  // Broadcast and paging may come from another cell than the serving one; these four channels do not.
  if (record.channel == RrcChannel::other) return;
  servingCell_.name(record.cell, out);
  const auto meaning = rrcMeaningOf(record.channel, record.message);
  if (meaning && rrc_.take(*meaning, out)) carriers_.endConnection(out);
}

}  // namespace vespscope::manager::diag
