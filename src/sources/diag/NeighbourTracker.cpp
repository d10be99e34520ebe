#include "sources/diag/NeighbourTracker.h"

#include <algorithm>
#include <memory>

#include "messages/lte/EgwErrcNbrEutraMeas.h"
#include "messages/lte/KCellularLteNbrEutraCellMeas.h"
#include "radio/Channel.h"
#include "radio/Levels.h"
#include "registry/MetricRows.h"

namespace vespscope::sources::diag {

using radio::Direction;
using radio::Earfcn;
using radio::Rsrp;
using radio::Rsrq;

void NeighbourTracker::take(const NeighbourMeasurementRecord& record, EventList& out) {
  measuredAt_ = out.time();
  keep(record.serving.earfcn, record.neighbours, out);
  report(out);
}

void NeighbourTracker::takeReported(std::uint32_t earfcn, const std::vector<NeighbourMeasurement>& neighbours,
                                    EventList& out) {
  if (measuredAt_ && stillCounts(*measuredAt_, out.time())) return;
  keep(earfcn, neighbours, out);
  report(out);
}

void NeighbourTracker::take(const NeighbourCarriersRecord& record, EventList& out) {
  if (!record.carriers.empty()) measuredAt_ = out.time();
  for (const NeighbourCarrier& carrier : record.carriers) keep(carrier.earfcn, carrier.neighbours, out);
  if (!record.carriers.empty()) report(out);
}

void NeighbourTracker::keep(std::uint32_t earfcn, const std::vector<NeighbourMeasurement>& neighbours,
                            const EventList& out) {
  std::erase_if(carriers_, [&](const auto& entry) { return !stillCounts(entry.second.time, out.time()); });
  carriers_[earfcn] = {neighbours, out.time()};
  if (carriers_.size() > maximumCarriers) {
    carriers_.erase(std::min_element(carriers_.begin(), carriers_.end(), [](const auto& left, const auto& right) {
      return left.second.time < right.second.time;
    }));
  }
}

void NeighbourTracker::report(EventList& out) const {
  KCellularLteNbrEutraCellMeas message;
  for (const auto& [earfcn, carrier] : carriers_) {
    for (const NeighbourMeasurement& neighbour : carrier.neighbours) {
      auto cell = std::make_shared<EgwErrcNbrEutraMeas>();
      cell->setNbrEarfcn(earfcn);
      cell->setNbrPhysCellId(neighbour.pci);
      if (const auto channel = Earfcn::fromNumber(earfcn, Direction::downlink)) cell->setFreqBandInd(channel->band());
      if (const auto rsrp = Rsrp::fromLevel(neighbour.rsrp)) {
        cell->setNbrRsrp(rsrp->code());
        if (const auto rsrq = Rsrq::fromLevel(neighbour.rsrq)) cell->setNbrRsrq(rsrq->code());
      }
      message.addMeasNbrEutra(std::move(cell));
    }
  }
  out.add(metricIdentifier("K_LTE_INTRARAT_MEAS"), message);
}

}  // namespace vespscope::sources::diag
