#include "sources/diag/CarrierTracker.h"

#include <memory>

#include "messages/lte/KCellularLteCarrierAggregationStatus.h"
#include "messages/lte/KCellularLteComponentCarrierInfo.h"
#include "messages/lte/KCellularLteRsrpRsrqSinr.h"
#include "messages/lte/RsrpRsrqSinr.h"
#include "messages/lte/SecondaryComponentCarrier.h"
#include "radio/Channel.h"
#include "radio/Levels.h"
#include "registry/MetricRows.h"

namespace vespscope::sources::diag {
namespace {

using radio::Direction;
using radio::Earfcn;
using radio::hundredths;
using radio::rounded;
using radio::Rsrp;
using radio::Rsrq;
using radio::sinrSteps;

// A secondary's levels are reported with the primary's while they are no older than this.
constexpr std::chrono::nanoseconds levelsLifetime = std::chrono::seconds(1);

std::shared_ptr<RsrpRsrqSinr> levelsOf(const ServingMeasurement& cell) {
  auto levels = std::make_shared<RsrpRsrqSinr>();
  levels->setPhyCellId(cell.cell.pci);
  // The message has fields for two antennas.
  const auto& first = cell.antennas[0];
  const auto& second = cell.antennas[1];
  if (first && Rsrp::isMeasurable(first->rsrp)) {
    levels->setRsrp0(rounded(first->rsrp));
    if (Rsrq::isMeasurable(first->rsrq)) levels->setRsrq0(rounded(first->rsrq));
    if (first->snr) levels->setSinr0(sinrSteps(*first->snr));
  }
  if (second && Rsrp::isMeasurable(second->rsrp)) {
    levels->setRsrp1(rounded(second->rsrp));
    if (Rsrq::isMeasurable(second->rsrq)) levels->setRsrq1(rounded(second->rsrq));
    if (second->snr) levels->setSinr1(sinrSteps(*second->snr));
  }
  return levels;
}

// The SNR of the antenna from which the combined levels are taken.
std::optional<double> snrOfStrongest(const ServingMeasurement& cell) {
  std::optional<AntennaLevels> strongest;
  for (const auto& antenna : cell.antennas) {
    if (antenna && (!strongest || antenna->rsrp > strongest->rsrp)) strongest = antenna;
  }
  return strongest ? strongest->snr : std::nullopt;
}

std::shared_ptr<SecondaryComponentCarrier> carrierOf(const ServingMeasurement& cell) {
  auto carrier = std::make_shared<SecondaryComponentCarrier>();
  carrier->setIndex(cell.cellIndex);
  carrier->setPci(cell.cell.pci);
  carrier->setDlEarfcn(cell.cell.earfcn);
  if (const auto channel = Earfcn::fromNumber(cell.cell.earfcn, Direction::downlink))
    carrier->setDlRfBand(channel->band());
  return carrier;
}

std::shared_ptr<SecondaryComponentCarrier> activeCarrierOf(const ServingMeasurement& cell) {
  auto carrier = carrierOf(cell);
  carrier->setState(SecondaryComponentCarrier::State::SCC_STATE_ACTIVATED);
  if (Rsrp::isMeasurable(cell.combined.rsrp)) {
    carrier->setRsrp(hundredths(cell.combined.rsrp));
    if (Rsrq::isMeasurable(cell.combined.rsrq)) carrier->setRsrq(hundredths(cell.combined.rsrq));
    carrier->setRssi(hundredths(cell.combined.rssi));
    if (const auto snr = snrOfStrongest(cell)) carrier->setSnr(rounded(*snr));
  }
  return carrier;
}

std::shared_ptr<SecondaryComponentCarrier> deconfiguredCarrierOf(const ServingMeasurement& cell) {
  auto carrier = carrierOf(cell);
  carrier->setState(SecondaryComponentCarrier::State::SCC_STATE_DECONFIGURED);
  return carrier;
}

}  // namespace

void CarrierTracker::take(const ServingMeasurementRecord& record, EventList& out) {
  bool primarySeen = false;
  bool secondarySeen = false;
  for (const ServingMeasurement& cell : record.cells) {
    if (!cell.serving) continue;
    if (cell.cellIndex == 0) {
      primary_ = cell;
      primaryAt_ = out.time();
      primarySeen = true;
    } else {
      secondaries_[cell.cellIndex] = {cell, out.time()};
      secondarySeen = true;
    }
  }
  reportCarriers(out);
  // The primary's measurement is as frequent as the secondaries' and first in the list, so one report covers both.
  if (primarySeen) reportLevels(out);
  if (secondarySeen) reportStatus({}, out);
}

void CarrierTracker::takeReported(const CellName& cell, double rsrp, std::optional<double> rsrq, EventList& out) const {
  if ((primary_ && stillCounts(primaryAt_, out.time())) || !Rsrp::isMeasurable(rsrp)) return;
  auto levels = std::make_shared<RsrpRsrqSinr>();
  levels->setPhyCellId(cell.pci);
  levels->setRsrp0(rounded(rsrp));
  if (rsrq && Rsrq::isMeasurable(*rsrq)) levels->setRsrq0(rounded(*rsrq));
  KCellularLteRsrpRsrqSinr message;
  message.addInstValues(std::move(levels));
  out.add(metricIdentifier("K_LTE_RSRP_RSRQ_SINR"), message);
}

void CarrierTracker::expire(EventList& out) {
  std::vector<Secondary> gone;
  for (auto entry = secondaries_.begin(); entry != secondaries_.end();) {
    if (stillCounts(entry->second.time, out.time())) {
      ++entry;
    } else {
      gone.push_back(entry->second);
      entry = secondaries_.erase(entry);
    }
  }
  drop(gone, out);
}

void CarrierTracker::endConnection(EventList& out) {
  std::vector<Secondary> gone;
  gone.reserve(secondaries_.size());
  for (const auto& [index, secondary] : secondaries_) gone.push_back(secondary);
  secondaries_.clear();
  drop(gone, out);
}

void CarrierTracker::drop(const std::vector<Secondary>& gone, EventList& out) {
  if (gone.empty()) return;
  reportCarriers(out);
  reportStatus(gone, out);
}

void CarrierTracker::reportLevels(EventList& out) const {
  KCellularLteRsrpRsrqSinr message;
  message.addInstValues(levelsOf(*primary_));
  for (const auto& [index, secondary] : secondaries_) {
    if (stillCounts(secondary.time, out.time(), levelsLifetime)) message.addInstValues(levelsOf(secondary.measurement));
  }
  out.add(metricIdentifier("K_LTE_RSRP_RSRQ_SINR"), message);
}

void CarrierTracker::reportStatus(const std::vector<Secondary>& gone, EventList& out) const {
  KCellularLteCarrierAggregationStatus message;
  for (const auto& [index, secondary] : secondaries_) message.addSccList(activeCarrierOf(secondary.measurement));
  for (const Secondary& secondary : gone) message.addSccList(deconfiguredCarrierOf(secondary.measurement));
  out.add(metricIdentifier("K_LTE_CA_STATUS"), message);
}

void CarrierTracker::reportCarriers(EventList& out) {
  if (!primary_) return;
  Carriers carriers{primary_->cell.earfcn, {}};
  for (const auto& [index, secondary] : secondaries_) carriers.secondaries.push_back(secondary.measurement.cell.earfcn);
  if (reportedCarriers_ == carriers) return;
  KCellularLteComponentCarrierInfo message;
  message.setPccEarfcn(carriers.primary);
  if (!carriers.secondaries.empty()) message.setScc0Earfcn(carriers.secondaries[0]);
  if (carriers.secondaries.size() > 1) message.setScc1Earfcn(carriers.secondaries[1]);
  out.add(metricIdentifier("K_LTE_COMPCARR_INFO"), message);
  reportedCarriers_ = std::move(carriers);
}

}  // namespace vespscope::sources::diag
