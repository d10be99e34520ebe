#include "sources/diag/RecordMapper.h"

#include <type_traits>

#include "sources/diag/NrRecords.h"
#include "sources/nas/Security.h"

namespace vespscope::sources::diag {
namespace {

using std::chrono::nanoseconds;

// Even a sleeping phone logs more often than the first limit; records may be out of order by up to the second one.
constexpr nanoseconds longestSilence = std::chrono::seconds(60);
constexpr nanoseconds longestStepBack = std::chrono::seconds(1);

bool isGap(nanoseconds before, nanoseconds now) {
  return now - before > longestSilence || before - now > longestStepBack;
}

// Whether anything of the record is understood; other parts are counted.
template <class Record>
bool countParts(const RecordKind& kind, const Record& decoded, DiagReport& report) {
  if constexpr (requires { decoded.unread; }) {
    bool understood = decoded.unread.empty();
    if constexpr (requires { decoded.cells; }) understood |= !decoded.cells.empty();
    if constexpr (requires { decoded.carriers; }) understood |= !decoded.carriers.empty();
    RecordCounts& counts = understood ? report.partsSkipped : report.skipped;
    // A record of which nothing is understood is counted once, by its first part.
    for (const UnreadSubpacket& unread : decoded.unread) {
      ++counts[{kind.code, unread.version, unread.subpacket}];
      if (!understood) break;
    }
    return understood;
  }
  return true;
}

// Returns the kind of a record that begins with its version.
RecordKind versionedKind(const LogRecord& record) {
  if (record.payload.empty()) return {record.code, std::nullopt, std::nullopt};
  return {record.code, record.payload[0], std::nullopt};
}

// Counts the record, and passes it to `handle` if it could be read. A `handle` with a result may skip the record: it
// returns the part under which the record is counted.
template <class Record, class Handle>
void handleDecoded(RecordKind kind, const Decoded<Record>& decoded, DiagReport& report, const Handle& handle) {
  if (const auto* fault = std::get_if<RecordFault>(&decoded)) {
    ++(*fault == RecordFault::unknownVersion ? report.skipped : report.broken)[kind];
    return;
  }
  const auto& meaning = std::get<Record>(decoded);
  if (!countParts(kind, meaning, report)) return;
  if constexpr (std::is_void_v<std::invoke_result_t<Handle, const Record&>>) {
    handle(meaning);
  } else if (const std::optional<std::uint8_t> part = handle(meaning)) {
    kind.part = part;
    ++report.skipped[kind];
    return;
  }
  ++report.read[kind];
}

// Returns the type of a skipped message, which is at `offset`; empty when the message was taken.
std::optional<std::uint8_t> skippedType(bool taken, nas::Span message, std::size_t offset) {
  if (taken) return std::nullopt;
  return offset < message.size() ? message[offset] : std::uint8_t{0};
}

}  // namespace

std::vector<MetricEvent> RecordMapper::take(const LogRecord& record, DiagReport& report) {
  EventList out(static_cast<std::int32_t>(record.radio), record.time);
  // The phone's activity during the gap is unknown.
  if (lastTime_ && isGap(*lastTime_, record.time)) {
    knowledge_ = {};
    carriers_.endConnection(out);
  }
  carriers_.expire(out);
  lastTime_ = record.time;
  if (!takeLteRadio(record, report, out) && !takeNas(record, report, out) && !takeOtherRadio(record, report, out)) {
    ++report.skipped[{record.code, std::nullopt, std::nullopt}];
  }
  return out.take();
}

bool RecordMapper::takeLteRadio(const LogRecord& record, DiagReport& report, EventList& out) {
  const RecordKind kind = versionedKind(record);
  const auto takeNeighbours = [&](const auto& decoded) { neighbours_.take(decoded, out); };
  switch (record.code) {
    case servingCellCode:
      handleDecoded(kind, servingCellOf(record.payload), report, [&](const ServingCellRecord& decoded) {
        knowledge_.servingCell.describe(decoded, out);
        knowledge_.signalling.reportBroadcast(decoded.cell, out);
        servePrimary(out);
      });
      return true;
    case servingMeasurementCode:
      handleDecoded(kind, servingMeasurementOf(record.payload), report,
                    [&](const ServingMeasurementRecord& decoded) { take(decoded, out); });
      return true;
    case neighbourMeasurementCode:
      handleDecoded(kind, neighbourMeasurementOf(record.payload), report,
                    [&](const NeighbourMeasurementRecord& decoded) { take(decoded, out); });
      return true;
    case idleNeighboursCode:
      handleDecoded(kind, idleNeighboursOf(record.payload), report, takeNeighbours);
      return true;
    case connectedNeighboursCode:
      handleDecoded(kind, connectedNeighboursOf(record.payload), report, takeNeighbours);
      return true;
    case rrcMessageCode:
      handleDecoded(kind, rrcMessageOf(record.payload), report,
                    [&](const RrcMessageRecord& decoded) { take(decoded, out); });
      return true;
    default:
      return false;
  }
}

bool RecordMapper::takeNas(const LogRecord& record, DiagReport& report, EventList& out) {
  const RecordKind kind{record.code, std::nullopt, std::nullopt};
  const auto takeRegistration = [&](const GmmRegistrationRecord& decoded) { knowledge_.mobility.take(decoded, out); };
  switch (record.code) {
    case emmStateCode:
      handleDecoded(versionedKind(record), emmStateOf(record.payload), report,
                    [&](const EmmStateRecord& decoded) { take(decoded, out); });
      return true;
    case bearerStateCode:
      handleDecoded(versionedKind(record), bearerStateOf(record.payload), report,
                    [&](const BearerStateRecord& decoded) { knowledge_.bearers.take(decoded, out); });
      return true;
    case esmMessageInCode:
    case esmMessageOutCode:
      handleDecoded(versionedKind(record), epsMessageOf(record.payload), report, [&](const NasMessageRecord& decoded) {
        return skippedType(takeEpsSession(decoded.message, out), decoded.message, 2);
      });
      return true;
    case emmMessageInCode:
    case emmMessageOutCode:
      handleDecoded(versionedKind(record), epsMessageOf(record.payload), report, [&](const NasMessageRecord& decoded) {
        return skippedType(takeEpsMobility(decoded.message, record.code == emmMessageOutCode, out), decoded.message, 1);
      });
      return true;
    case securedEsmInCode:
    case securedEsmOutCode:
    case securedEmmInCode:
    case securedEmmOutCode:
      // Most are logged again without a security header in another record, which changes nothing.
      handleDecoded(versionedKind(record), epsMessageOf(record.payload), report, [&](const NasMessageRecord& decoded) {
        return skippedType(takeSecured(decoded.message, record.code == securedEmmOutCode, out), decoded.message, 0);
      });
      return true;
    case gmmStateCode:
      handleDecoded(kind, mobilityStateOf(record.payload), report,
                    [&](const MobilityStateRecord& decoded) { knowledge_.mobility.takePacket(decoded, out); });
      return true;
    case mmStateCode:
      handleDecoded(kind, mobilityStateOf(record.payload), report,
                    [&](const MobilityStateRecord& decoded) { knowledge_.mobility.takeCircuit(decoded, out); });
      return true;
    case gmmRegistrationCode:
      handleDecoded(kind, gmmRegistrationOf(record.payload), report, takeRegistration);
      return true;
    case gprsMessageCode:
      handleDecoded(kind, gprsMessageOf(record.payload), report, [&](const NasMessageRecord& decoded) {
        return skippedType(takeGprsMessage(decoded.message, out), decoded.message, 1);
      });
      return true;
    default:
      return false;
  }
}

bool RecordMapper::takeOtherRadio(const LogRecord& record, DiagReport& report, EventList& out) {
  RecordKind kind{record.code, std::nullopt, std::nullopt};
  switch (record.code) {
    case nrRrcMessageCode:
      // No metric has values of NR yet: the record is only checked, for the report.
      handleDecoded(versionedKind(record), nrRrcMessageOf(record.payload), report, [](const NrRrcMessageRecord&) {});
      return true;
    case wcdmaCellCode:
      handleDecoded(kind, wcdmaCellOf(record.payload), report,
                    [&](const WcdmaCellRecord& decoded) { WcdmaTracker::describe(decoded, out); });
      return true;
    case wcdmaRrcCode: {
      const auto decoded = wcdmaRrcOf(record.payload);
      if (!record.payload.empty() && !std::holds_alternative<WcdmaRrcRecord>(decoded)) kind.part = record.payload[0];
      handleDecoded(kind, decoded, report, [&](const WcdmaRrcRecord& message) { take(message, out); });
      return true;
    }
    case gsmMessageCode:
      handleDecoded(kind, gsmMessageOf(record.payload), report, [&](const GsmMessageRecord& decoded) {
        const auto information = gsmSystemInformationOf(decoded.message);
        if (information) knowledge_.gsm.take(*information, out);
        return information ? std::nullopt : std::optional(decoded.type);
      });
      return true;
    default:
      return false;
  }
}

void RecordMapper::take(const ServingMeasurementRecord& record, EventList& out) {
  for (const ServingMeasurement& cell : record.cells) {
    if (cell.serving && cell.cellIndex == 0) nameServingCell(cell.cell, out);
  }
  carriers_.take(record, out);
}

void RecordMapper::take(const RrcMessageRecord& record, EventList& out) {
  // Broadcasts may be from another cell than the serving one; dedicated messages are not, and paging is received in the
  // cell that the phone camps on.
  const bool camped = record.channel == RrcChannel::paging && !knowledge_.servingCell.hasDescriptions();
  if (isDedicated(record.channel) || camped) nameServingCell(record.cell, out);
  if (record.narrowband) return;
  if (record.channel == RrcChannel::paging) knowledge_.rrc.takePaging(out);
  knowledge_.signalling.take(record, knowledge_.servingCell, {carriers_, neighbours_}, out);
  // It may have been the bandwidth of the serving cell.
  if (record.channel == RrcChannel::broadcast) servePrimary(out);
  const auto meaning = rrcMeaningOf(record.channel, record.message);
  if (!meaning || !knowledge_.rrc.take(*meaning, out)) return;
  carriers_.endConnection(out);
  if (!knowledge_.rrc.isIdle()) return;
  knowledge_.signalling.endConnection(out);
  knowledge_.emm.endConnection(out);
}

void RecordMapper::take(const NeighbourMeasurementRecord& record, EventList& out) {
  neighbours_.take(record, out);
  // The record of another carrier has a secondary cell's levels.
  if (knowledge_.servingCell.current() == record.serving) {
    carriers_.takeReported(record.serving, record.servingRsrp, record.servingRsrq, out);
  }
}

void RecordMapper::nameServingCell(const CellName& cell, EventList& out) {
  if (knowledge_.servingCell.current() == cell) return;
  knowledge_.servingCell.name(cell, knowledge_.signalling.broadcastOf(cell), out);
  knowledge_.signalling.reportBroadcast(cell, out);
  servePrimary(out);
}

void RecordMapper::servePrimary(EventList& out) {
  const auto& cell = knowledge_.servingCell.current();
  if (!cell) return;
  carriers_.serve(*cell, knowledge_.servingCell.downlinkBlocks(knowledge_.signalling.broadcastOf(*cell)), out);
}

void RecordMapper::take(const EmmStateRecord& record, EventList& out) {
  knowledge_.emm.take(record, out);
  if (EmmTracker::isDeregistered(record)) knowledge_.bearers.clear(out);
}

bool RecordMapper::takeEpsSession(nas::Span message, EventList& out) {
  const auto session = nas::epsSessionMessageOf(message);
  if (session) knowledge_.bearers.take(*session, out);
  return session.has_value();
}

bool RecordMapper::takeEpsMobility(nas::Span message, bool outgoing, EventList& out) {
  const auto mobility = nas::epsMobilityMessageOf(message);
  if (!mobility) return false;
  if (knowledge_.emm.take(*mobility, outgoing, out)) knowledge_.bearers.clear(out);
  knowledge_.mobility.take(*mobility, out);
  takeEpsSession(mobility->session, out);
  return true;
}

bool RecordMapper::takeSecured(nas::Span sent, bool outgoing, EventList& out) {
  const auto plain = nas::plainMessageIn(sent);
  return plain && (takeEpsMobility(*plain, outgoing, out) || takeEpsSession(*plain, out));
}

bool RecordMapper::takeGprsMessage(nas::Span message, EventList& out) {
  if (const auto mobility = nas::mobilityMessageOf(message)) {
    knowledge_.mobility.take(*mobility, out);
    const bool left = mobility->domain == nas::Domain::packet && mobility->kind == nas::MobilityKind::detach;
    if (left) knowledge_.bearers.clear(out);
    return true;
  }
  const auto session = nas::sessionMessageOf(message);
  if (session) knowledge_.bearers.take(*session, out);
  return session.has_value();
}

void RecordMapper::take(const WcdmaRrcRecord& record, EventList& out) {
  const auto meaning = wcdmaRrcMeaningOf(record.channel, record.message);
  if (!meaning) return;
  if (knowledge_.wcdma.take(*meaning, out)) knowledge_.mobility.endConnection(out);
  if (!meaning->nasMessage.empty()) takeGprsMessage(meaning->nasMessage, out);
}

}  // namespace vespscope::sources::diag
