#include "sources/diag/ServingCellTracker.h"

#include "messages/lte/KCellularLteScellInfo.h"
#include "radio/Bandwidth.h"
#include "radio/CellIdentity.h"
#include "radio/Channel.h"
#include "registry/MetricRows.h"

namespace vespscope::sources::diag {
namespace {

void report(const ServingCellRecord& record, EventList& out) {
  KCellularLteScellInfo message;
  message.setPhyCellId(record.cell.pci);
  message.setDlFreq(record.cell.earfcn);
  message.setUlFreq(record.uplinkEarfcn);
  if (const auto width = radio::Bandwidth::fromResourceBlocks(record.downlinkBlocks))
    message.setDlBw(width->halfMegahertz());
  if (const auto width = radio::Bandwidth::fromResourceBlocks(record.uplinkBlocks))
    message.setUlBw(width->halfMegahertz());
  if (const auto cell = radio::EutraCellIdentity::fromNumber(record.cellIdentity)) message.setCellId(cell->number());
  message.setFreqBandInd(record.band);
  message.setTrackingAreaCode(record.trackingAreaCode);
  if (record.plmn) {
    message.setNumMncDigits(record.plmn->mncDigits());
    message.setSelPlmnMcc(record.plmn->mcc());
    message.setSelPlmnMnc(record.plmn->mnc());
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
  if (const auto channel = radio::Earfcn::fromNumber(cell.earfcn, radio::Direction::downlink))
    message.setFreqBandInd(channel->band());
  out.add(metricIdentifier("K_LTE_SCELL_INFO"), message);
}

}  // namespace vespscope::sources::diag
