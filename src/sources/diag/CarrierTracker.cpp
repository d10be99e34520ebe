#include "sources/diag/CarrierTracker.h"

#include <iterator>
#include <memory>
#include <utility>

#include "messages/lte/KCellularLteCarrierAggregationStatus.h"
#include "messages/lte/KCellularLteComponentCarrierInfo.h"
#include "messages/lte/KCellularLteRsrpRsrqSinr.h"
#include "messages/lte/RsrpRsrqSinr.h"
#include "messages/lte/SecondaryComponentCarrier.h"
#include "radio/Bandwidth.h"
#include "radio/Channel.h"
#include "radio/Levels.h"
#include "registry/MetricRows.h"

namespace vespscope::sources::diag {
namespace {

using radio::Bandwidth;
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

// The unit of the metric; 1.4 MHz is no number of it.
std::optional<std::uint32_t> megahertz(std::optional<std::uint8_t> blocks) {
  const auto width = Bandwidth::fromResourceBlocks(blocks.value_or(0));
  if (!width || width->kilohertz() % 1000 != 0) return std::nullopt;
  return width->kilohertz() / 1000;
}

// What the network has said of the cell, as far as its messages were seen.
void describe(const rrc::lte::SecondaryCell& cell, std::uint32_t downlink, SecondaryComponentCarrier& carrier) {
  if (const auto width = Bandwidth::fromResourceBlocks(cell.bandwidth.value_or(0))) {
    carrier.setDlBandwidth(width->code());
  }
  carrier.setHasUplink(cell.uplink);
  if (!cell.uplink) return;
  const auto channel = Earfcn::fromNumber(downlink, Direction::downlink);
  const auto paired = channel ? channel->paired() : std::nullopt;
  if (cell.uplinkCarrier) {
    carrier.setUlEarfcn(*cell.uplinkCarrier);
  } else if (paired) {
    carrier.setUlEarfcn(paired->number());
  }
  if (channel) carrier.setUlRfBand(channel->band());
  const auto blocks = cell.uplinkBandwidth ? cell.uplinkBandwidth : cell.bandwidth;
  if (const auto width = Bandwidth::fromResourceBlocks(blocks.value_or(0))) carrier.setUlBandwidth(width->code());
}

void setLevels(const ServingMeasurement& cell, SecondaryComponentCarrier& carrier) {
  if (!Rsrp::isMeasurable(cell.combined.rsrp)) return;
  carrier.setRsrp(hundredths(cell.combined.rsrp));
  if (Rsrq::isMeasurable(cell.combined.rsrq)) carrier.setRsrq(hundredths(cell.combined.rsrq));
  carrier.setRssi(hundredths(cell.combined.rssi));
  if (const auto snr = snrOfStrongest(cell)) carrier.setSnr(rounded(*snr));
}

}  // namespace

CellName CarrierTracker::Secondary::name() const {
  if (measured) return measured->cell;
  return {configured->downlinkCarrier.value_or(0), configured->physicalCell.value_or(0)};
}

void CarrierTracker::serve(const CellName& cell, std::optional<std::uint8_t> blocks, EventList& out) {
  const Carrier carrier{cell.earfcn, blocks};
  if (primaryCarrier_ == carrier) return;
  primaryCarrier_ = carrier;
  reportCarriers(out);
}

void CarrierTracker::take(const ServingMeasurementRecord& record, EventList& out) {
  bool primarySeen = false;
  bool secondarySeen = false;
  for (const ServingMeasurement& cell : record.cells) {
    if (!cell.serving) continue;
    if (cell.cellIndex == 0) {
      primary_ = cell;
      primaryAt_ = out.time();
      primarySeen = true;
    } else if (!isLate(cell, out.time())) {
      Secondary& secondary = secondaries_[cell.cellIndex];
      // Another cell under this index was set up by a message that the log does not have.
      if (secondary.configured && secondary.configured->downlinkCarrier &&
          CellName{*secondary.configured->downlinkCarrier, secondary.configured->physicalCell.value_or(0)} !=
              cell.cell) {
        secondary.configured.reset();
      }
      secondary.measured = cell;
      secondary.measuredAt = out.time();
      secondarySeen = true;
    }
  }
  reportCarriers(out);
  // The primary's measurement is as frequent as the secondaries' and first in the list, so one report covers both.
  if (primarySeen) reportLevels(out);
  if (secondarySeen) reportStatus({}, out);
}

void CarrierTracker::take(const rrc::lte::Reconfiguration& change, EventList& out) {
  Secondaries gone;
  if (change.fullConfiguration) gone.swap(secondaries_);
  for (const std::uint8_t index : change.releasedCells) release(index, gone);
  for (const rrc::lte::SecondaryCell& cell : change.addedCells) {
    configure(cell);
    gone.erase(cell.index);
  }
  if (change.addedCells.empty() && gone.empty()) return;
  reportChange(gone, out);
  released_ = std::move(gone);
  releasedAt_ = out.time();
}

bool CarrierTracker::isLate(const ServingMeasurement& cell, std::chrono::nanoseconds time) const {
  constexpr std::chrono::nanoseconds latest = std::chrono::milliseconds(100);
  const auto released = released_.find(cell.cellIndex);
  return released != released_.end() && released->second.name() == cell.cell &&
         !secondaries_.contains(cell.cellIndex) && stillCounts(releasedAt_, time, latest);
}

void CarrierTracker::configure(const rrc::lte::SecondaryCell& cell) {
  const auto known = secondaries_.find(cell.index);
  if (cell.physicalCell && cell.downlinkCarrier) {
    const CellName name{*cell.downlinkCarrier, *cell.physicalCell};
    if (known != secondaries_.end() && known->second.name() == name) {
      known->second.configured = cell;
    } else {
      secondaries_[cell.index] = {cell, std::nullopt, {}};
    }
  } else if (known != secondaries_.end() && !known->second.configured) {
    // It is changed, so it had been set up before the log began.
    known->second.configured = cell;
  }
}

void CarrierTracker::release(std::uint8_t index, Secondaries& gone) {
  if (auto released = secondaries_.extract(index)) gone.insert(std::move(released));
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
  Secondaries gone;
  bool deactivated = false;
  for (auto entry = secondaries_.begin(); entry != secondaries_.end();) {
    const auto next = std::next(entry);
    Secondary& secondary = entry->second;
    if (secondary.measured && !stillCounts(secondary.measuredAt, out.time())) {
      if (secondary.configured && secondary.configured->downlinkCarrier) {
        secondary.measured.reset();
        deactivated = true;
      } else {
        gone.insert(secondaries_.extract(entry));
      }
    }
    entry = next;
  }
  if (deactivated || !gone.empty()) reportChange(gone, out);
}

void CarrierTracker::endConnection(EventList& out) {
  Secondaries gone;
  gone.swap(secondaries_);
  if (gone.empty()) return;
  reportChange(gone, out);
  released_ = std::move(gone);
  releasedAt_ = out.time();
}

void CarrierTracker::reportChange(const Secondaries& gone, EventList& out) {
  reportCarriers(out);
  reportStatus(gone, out);
}

void CarrierTracker::reportLevels(EventList& out) const {
  KCellularLteRsrpRsrqSinr message;
  message.addInstValues(levelsOf(*primary_));
  for (const auto& [index, secondary] : secondaries_) {
    if (secondary.measured && stillCounts(secondary.measuredAt, out.time(), levelsLifetime)) {
      message.addInstValues(levelsOf(*secondary.measured));
    }
  }
  out.add(metricIdentifier("K_LTE_RSRP_RSRQ_SINR"), message);
}

void CarrierTracker::reportStatus(const Secondaries& gone, EventList& out) const {
  using State = SecondaryComponentCarrier::State;
  KCellularLteCarrierAggregationStatus message;
  const auto add = [&message](std::uint8_t index, const Secondary& secondary, std::int32_t state) {
    auto carrier = std::make_shared<SecondaryComponentCarrier>();
    const CellName name = secondary.name();
    carrier->setIndex(index);
    carrier->setPci(name.pci);
    carrier->setDlEarfcn(name.earfcn);
    if (const auto channel = Earfcn::fromNumber(name.earfcn, Direction::downlink)) {
      carrier->setDlRfBand(channel->band());
    }
    if (secondary.configured) describe(*secondary.configured, name.earfcn, *carrier);
    carrier->setState(state);
    if (state == State::SCC_STATE_ACTIVATED) setLevels(*secondary.measured, *carrier);
    message.addSccList(std::move(carrier));
  };
  for (const auto& [index, secondary] : secondaries_) {
    add(index, secondary, secondary.measured ? State::SCC_STATE_ACTIVATED : State::SCC_STATE_CONFIGURED_DEACTIVATED);
  }
  for (const auto& [index, secondary] : gone) add(index, secondary, State::SCC_STATE_DECONFIGURED);
  out.add(metricIdentifier("K_LTE_CA_STATUS"), message);
}

void CarrierTracker::reportCarriers(EventList& out) {
  if (!primaryCarrier_) return;
  // The first report needs more than the name of a cell, which Serving Cell Info has too.
  const bool known = megahertz(primaryCarrier_->blocks) || primary_ || !secondaries_.empty();
  if (reportedCarriers_.empty() && !known) return;
  std::vector<Carrier> carriers{*primaryCarrier_};
  for (const auto& [index, secondary] : secondaries_) {
    carriers.push_back(
        {secondary.name().earfcn, secondary.configured ? secondary.configured->bandwidth : std::nullopt});
  }
  if (reportedCarriers_ == carriers) return;
  KCellularLteComponentCarrierInfo message;
  message.setPccEarfcn(carriers[0].earfcn);
  if (const auto width = megahertz(carriers[0].blocks)) message.setPccBandwidth(*width);
  if (carriers.size() > 1) {
    message.setScc0Earfcn(carriers[1].earfcn);
    if (const auto width = megahertz(carriers[1].blocks)) message.setScc0Bandwidth(*width);
  }
  if (carriers.size() > 2) {
    message.setScc1Earfcn(carriers[2].earfcn);
    if (const auto width = megahertz(carriers[2].blocks)) message.setScc1Bandwidth(*width);
  }
  out.add(metricIdentifier("K_LTE_COMPCARR_INFO"), message);
  reportedCarriers_ = std::move(carriers);
}

}  // namespace vespscope::sources::diag
