#include "sources/diag/ServingCellTracker.h"

#include <array>

#include "messages/lte/KCellularLteScellInfo.h"
#include "registry/MetricRows.h"
#include "sources/diag/EutraBand.h"

namespace vespscope::sources::diag {
namespace {

// Channel bandwidth in half-MHz steps (3GPP TS 36.101 table 5.6-1); 1.4 MHz becomes the nearest step.
std::optional<std::uint32_t> bandwidthSteps(std::uint8_t resourceBlocks) {
  struct Bandwidth {
    std::uint8_t blocks;
    std::uint32_t steps;
  };
  constexpr std::array<Bandwidth, 6> bandwidths = {{{6, 3}, {15, 6}, {25, 10}, {50, 20}, {75, 30}, {100, 40}}};
  for (const Bandwidth& bandwidth : bandwidths) {
    if (bandwidth.blocks == resourceBlocks) return bandwidth.steps;
  }
  return std::nullopt;
}

void report(const ServingCellRecord& record, EventList& out) {
  constexpr std::uint32_t highestCellIdentity = (1U << 28) - 1;
  KCellularLteScellInfo message;
  message.setPhyCellId(record.cell.pci);
  message.setDlFreq(record.cell.earfcn);
  message.setUlFreq(record.uplinkEarfcn);
  if (const auto steps = bandwidthSteps(record.downlinkBlocks)) message.setDlBw(*steps);
  if (const auto steps = bandwidthSteps(record.uplinkBlocks)) message.setUlBw(*steps);
  if (record.cellIdentity <= highestCellIdentity) message.setCellId(record.cellIdentity);
  message.setFreqBandInd(record.band);
  message.setTrackingAreaCode(record.trackingAreaCode);
  if (record.mcc <= 999 && (record.mncDigits == 2 || record.mncDigits == 3)) {
    message.setNumMncDigits(record.mncDigits);
    message.setSelPlmnMcc(record.mcc);
    message.setSelPlmnMnc(record.mnc);
  }
  out.add(metricIdentifier("K_LTE_SCELL_INFO"), message);
}

}  // namespace

void ServingCellTracker::describe(const ServingCellRecord& record, EventList& out) {
  current_ = record.cell;
  described_ = record;
  describedAt_ = out.time();
  report(record, out);
}

void ServingCellTracker::name(const CellName& cell, EventList& out) {
  if (current_ == cell) return;
  current_ = cell;
  // Late news of the cell before may lie between a description and the next measurement of the cell described.
  if (described_ && described_->cell == cell && stillCounts(describedAt_, out.time())) return report(*described_, out);
  KCellularLteScellInfo message;
  message.setPhyCellId(cell.pci);
  message.setDlFreq(cell.earfcn);
  if (const auto band = eutraBandOfDownlink(cell.earfcn)) message.setFreqBandInd(*band);
  out.add(metricIdentifier("K_LTE_SCELL_INFO"), message);
}

}  // namespace vespscope::sources::diag
