#include "sources/diag/ServingCellTracker.h"

#include "messages/lte/KCellularLteScellInfo.h"
#include "radio/Bandwidth.h"
#include "radio/CellIdentity.h"
#include "radio/Channel.h"
#include "registry/MetricRows.h"

namespace vespscope::sources::diag {
namespace {

void reportDescription(const ServingCellRecord& record, EventList& out) {
  KCellularLteScellInfo message;
  message.setPhyCellId(record.cell.pci);
  message.setDlFreq(record.cell.earfcn);
  message.setUlFreq(record.uplinkEarfcn);
  if (const auto width = radio::Bandwidth::fromResourceBlocks(record.downlinkBlocks)) {
    message.setDlBw(width->halfMegahertz());
  }
  if (const auto width = radio::Bandwidth::fromResourceBlocks(record.uplinkBlocks)) {
    message.setUlBw(width->halfMegahertz());
  }
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
  reportDescription(record, out);
}

void ServingCellTracker::name(const CellName& cell, const CellBroadcast* broadcast, EventList& out) {
  if (current_ == cell) return;
  current_ = cell;
  // A late message of the previous cell may occur between a description and the next measurement of the described cell.
  if (described_ && described_->cell == cell && stillCounts(describedAt_, out.time())) {
    return reportDescription(*described_, out);
  }
  reported_.clear();
  report(cell, broadcast, out);
}

std::optional<std::uint8_t> ServingCellTracker::downlinkBlocks(const CellBroadcast* broadcast) const {
  if (described_ && described_->cell == current_) return described_->downlinkBlocks;
  return broadcast == nullptr ? std::nullopt : broadcast->downlinkBlocks;
}

void ServingCellTracker::supplement(const CellBroadcast& broadcast, EventList& out) {
  if (current_ != broadcast.cell || (described_ && described_->cell == broadcast.cell)) return;
  report(broadcast.cell, &broadcast, out);
}

void ServingCellTracker::report(const CellName& cell, const CellBroadcast* broadcast, EventList& out) {
  KCellularLteScellInfo message;
  message.setPhyCellId(cell.pci);
  message.setDlFreq(cell.earfcn);
  const auto channel = radio::Earfcn::fromNumber(cell.earfcn, radio::Direction::downlink);
  if (channel) message.setFreqBandInd(channel->band());
  if (broadcast != nullptr) {
    if (const auto width = radio::Bandwidth::fromResourceBlocks(broadcast->downlinkBlocks.value_or(0))) {
      message.setDlBw(width->halfMegahertz());
    }
    if (broadcast->access) {
      // If the broadcast omits it, the uplink channel has the band's default distance from the downlink's.
      const auto uplink = channel ? channel->paired() : std::nullopt;
      if (broadcast->access->uplinkCarrier) {
        message.setUlFreq(*broadcast->access->uplinkCarrier);
      } else if (uplink) {
        message.setUlFreq(uplink->number());
      }
      const auto blocks =
          broadcast->access->uplinkBandwidth ? broadcast->access->uplinkBandwidth : broadcast->downlinkBlocks;
      if (const auto width = radio::Bandwidth::fromResourceBlocks(blocks.value_or(0))) {
        message.setUlBw(width->halfMegahertz());
      }
    }
    if (broadcast->information) {
      message.setFreqBandInd(broadcast->information->band);
      message.setTrackingAreaCode(broadcast->information->trackingAreaCode);
      message.setCellId(broadcast->information->cellIdentity);
      if (!broadcast->information->networks.empty()) {
        const auto& plmn = broadcast->information->networks.front().plmn;
        message.setNumMncDigits(plmn.networkDigits);
        message.setSelPlmnMcc(plmn.countryCode);
        message.setSelPlmnMnc(plmn.networkCode);
      }
    }
  }
  Bytes content = message.encoded();
  if (content == reported_) return;
  reported_ = std::move(content);
  out.add(metricIdentifier("K_LTE_SCELL_INFO"), message);
}

}  // namespace vespscope::sources::diag
