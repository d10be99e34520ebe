#include "sources/diag/LteSignalling.h"

#include <memory>

#include "messages/lte/KCellularLteNbrInterRatCellMeas.h"
#include "radio/Levels.h"
#include "registry/MetricRows.h"
#include "rrc/lte/MeasurementReport.h"
#include "sources/diag/BitReader.h"

namespace vespscope::sources::diag {
namespace {

using rrc::Pdu;
using rrc::lte::MeasurementObject;
using rrc::lte::MeasurementReport;

// Returns the message's index in c1 of its channel, if the message is in c1.
std::optional<unsigned> messageType(std::span<const std::uint8_t> message, unsigned width) {
  BitReader bits(message);
  if (bits.read(1) != 0U) return std::nullopt;
  return bits.read(width);
}

template <class Level, class Code>
std::optional<double> levelOf(const std::optional<Code>& code) {
  const auto level = code ? Level::fromCode(*code) : std::nullopt;
  if (!level) return std::nullopt;
  return level->level();
}

// Neighbours of other technologies, which no record measures.
void reportOtherTechnologies(const MeasurementReport& report, const MeasurementObject* object, EventList& out) {
  if (report.umts.empty() && report.gsm.empty()) return;
  KCellularLteNbrInterRatCellMeas message;
  for (const auto& neighbour : report.umts) {
    auto cell = std::make_shared<EgwErrcNbrUtraMeas>();
    if (object != nullptr && object->carrier) cell->setUarfcn(*object->carrier);
    cell->setPsc(neighbour.scramblingCode);
    if (neighbour.rscp) cell->setRscp(*neighbour.rscp);
    if (neighbour.ecNo) cell->setEcno(*neighbour.ecNo);
    message.addMeasNbrUtra(std::move(cell));
  }
  for (const auto& neighbour : report.gsm) {
    auto cell = std::make_shared<EgwErrcNbrGeranMeas>();
    cell->setArfcn(neighbour.channel);
    cell->setBsic(neighbour.identityCode);
    cell->setRxlev(neighbour.rxlev);
    message.addMeasNbrGeran(std::move(cell));
  }
  out.add(metricIdentifier("K_LTE_INTERRAT_MEAS"), message);
}

std::vector<NeighbourMeasurement> neighboursOf(const MeasurementReport& report) {
  std::vector<NeighbourMeasurement> neighbours;
  for (const auto& neighbour : report.lte) {
    // A level that was not reported ranks below all measured ones.
    constexpr double absent = -180;
    neighbours.push_back({neighbour.physicalCell, levelOf<radio::Rsrp>(neighbour.levels.rsrp).value_or(absent),
                          levelOf<radio::Rsrq>(neighbour.levels.rsrq).value_or(absent)});
  }
  return neighbours;
}

}  // namespace

void LteSignalling::take(const RrcMessageRecord& record, ServingCellTracker& serving, Levels levels, EventList& out) {
  constexpr unsigned setup = 3;
  constexpr unsigned reestablishment = 0;
  constexpr unsigned reconfiguration = 4;
  constexpr unsigned measurementReport = 1;
  switch (record.channel) {
    case RrcChannel::broadcast:
    case RrcChannel::systemInformation:
      return takeBroadcast(record, serving, out);
    case RrcChannel::downlinkCcch: {
      const auto type = messageType(record.message, 2);
      if ((type != setup && type != reestablishment) || message_.read(Pdu::lteDlCcch, record.message)) return;
      const auto change = type == setup ? rrc::lte::connectionSetupOf(message_) : rrc::lte::reestablishmentOf(message_);
      if (change) takeChange(*change, record.cell, levels.carriers, out);
      return;
    }
    case RrcChannel::downlinkDcch: {
      if (messageType(record.message, 4) != reconfiguration) return;
      if (message_.read(Pdu::lteDlDcch, record.message)) return;
      if (const auto change = rrc::lte::reconfigurationOf(message_)) {
        takeChange(*change, record.cell, levels.carriers, out);
      }
      return;
    }
    case RrcChannel::uplinkDcch:
      if (messageType(record.message, 4) == measurementReport) takeReport(record, levels, out);
      return;
    case RrcChannel::multicast:
    case RrcChannel::paging:
    case RrcChannel::uplinkCcch:
    case RrcChannel::other:
      return;
  }
}

void LteSignalling::takeBroadcast(const RrcMessageRecord& record, ServingCellTracker& serving, EventList& out) {
  const Pdu pdu = record.channel == RrcChannel::broadcast ? Pdu::lteBcchBch : Pdu::lteBcchDlSch;
  if (message_.read(pdu, record.message)) return;
  broadcasts_.take(record.cell, message_, out);
  const CellBroadcast* broadcast = broadcasts_.find(record.cell);
  if (broadcast == nullptr || serving.current() != record.cell) return;
  serving.supplement(*broadcast, out);
  broadcasts_.report(record.cell, out);
}

void LteSignalling::takeChange(const rrc::lte::Reconfiguration& change, const CellName& serving,
                               CarrierTracker& carriers, EventList& out) {
  dedicated_.take(change, serving, out);
  carriers.take(change, out);
}

void LteSignalling::takeReport(const RrcMessageRecord& record, Levels levels, EventList& out) {
  if (message_.read(Pdu::lteUlDcch, record.message)) return;
  const auto report = rrc::lte::measurementReportOf(message_);
  if (!report) return;
  if (const auto rsrp = levelOf<radio::Rsrp>(report->primary.rsrp)) {
    levels.carriers.takeReported(record.cell, *rsrp, levelOf<radio::Rsrq>(report->primary.rsrq), out);
  }
  const MeasurementObject* object = dedicated_.objectOf(report->measurement);
  // Without its configuration the neighbours' carrier is unknown.
  const bool onLte = object != nullptr && object->technology == MeasurementObject::Technology::lte && object->carrier;
  if (onLte && !report->lte.empty()) levels.neighbours.takeReported(*object->carrier, neighboursOf(*report), out);
  reportOtherTechnologies(*report, object, out);
}

}  // namespace vespscope::sources::diag
