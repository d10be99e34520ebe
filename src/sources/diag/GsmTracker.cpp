#include "sources/diag/GsmTracker.h"

#include "messages/gsm/KCellularGsmGprsConfig.h"
#include "messages/gsm/KCellularGsmIdleConfig.h"
#include "messages/gsm/KCellularGsmScellInfo.h"
#include "registry/MetricRows.h"

namespace vespscope::sources::diag {
namespace {

constexpr std::uint32_t flag(bool value) { return value ? 1 : 0; }

void reportPacket(const GsmPacketDescription& cell, EventList& out) {
  KCellularGsmGprsConfig message;
  message.setGprsSup(true);
  message.setRac(cell.routingAreaCode);
  message.setSpPgCy(cell.splitPaging);
  message.setNco(cell.networkControlOrder);
  message.setNom(cell.networkMode);
  message.setAccThr(cell.accessThreshold);
  if (cell.extendedUplinkBlockFlow) message.setExtUplTbfSupported(*cell.extendedUplinkBlockFlow);
  out.add(metricIdentifier("K_GSM_GPRS_CONFIG"), message);
}

}  // namespace

void GsmTracker::take(const GsmSystemInformation& information, EventList& out) {
  if (const auto* cell = std::get_if<GsmCellDescription>(&information)) return describe(*cell, out);
  if (const auto* cell = std::get_if<GsmCellReminder>(&information)) return remind(*cell, out);
  reportPacket(std::get<GsmPacketDescription>(information), out);
}

void GsmTracker::describe(const GsmCellDescription& cell, EventList& out) {
  // The message is broadcast about twice a second.
  if (cell_ == cell) return;
  const bool sameCell = cell_ && cell_->cellIdentity == cell.cellIdentity && cell_->area == cell.area;
  cell_ = cell;
  if (!sameCell) {
    cellBroadcast_.reset();
    KCellularGsmScellInfo message;
    if (cell.area) {
      message.setMcc(cell.area->plmn.mcc());
      message.setMnc(cell.area->plmn.mnc());
      message.setLac(cell.area->lac);
      message.setNumMncDigits(cell.area->plmn.mncDigits());
    }
    message.setCellId(cell.cellIdentity);
    out.add(metricIdentifier("K_GSM_SCELL_INFO"), message);
  }
  report(out);
}

// Taken if it may be from the described cell: one in the same area.
void GsmTracker::remind(const GsmCellReminder& cell, EventList& out) {
  if (!cell_ || cell_->area != cell.area || cellBroadcast_ == cell.cellBroadcast) return;
  cellBroadcast_ = cell.cellBroadcast;
  report(out);
}

void GsmTracker::report(EventList& out) const {
  KCellularGsmIdleConfig message;
  if (cell_->area) {
    message.setMcc(cell_->area->plmn.mcc());
    message.setMnc(cell_->area->plmn.mnc());
    message.setLac(cell_->area->lac);
  }
  message.setCi(cell_->cellIdentity);
  message.setDtxFromBs(cell_->uplinkDtx);
  message.setRadioLinkTimeout(cell_->radioLinkTimeout);
  message.setMsTxpwr(cell_->selection.maximumPower);
  message.setRxAccMin(cell_->selection.minimumLevel);
  message.setCba(flag(cell_->access.barred));
  message.setC2Valid(flag(cell_->reselection.has_value()));
  if (cell_->reselection) {
    message.setCbq(flag(cell_->reselection->lowPriority));
    message.setCrOffset(cell_->reselection->offset);
    message.setTmpOffset(cell_->reselection->temporaryOffset);
    message.setPenaltyT(cell_->reselection->penaltyTime);
  }
  message.setT3212(cell_->locationTimer);
  message.setAcc(cell_->access.barredClasses);
  message.setBsPaMfrms(cell_->pagingMultiframes);
  message.setMaxRetransCs(cell_->access.maximumRetransmissions);
  message.setEmergCallAllowed(flag(cell_->access.emergencyAllowed));
  message.setAttachAllowed(flag(cell_->attachAllowed));
  if (cellBroadcast_) message.setCbchSupported(flag(*cellBroadcast_));
  message.setReestAllowed(flag(cell_->access.reestablishmentAllowed));
  message.setEcsc(flag(cell_->earlyClassmarkSending));
  message.setSi2TerNeeded(flag(cell_->secondTerBroadcast));
  out.add(metricIdentifier("K_GSM_IDLE_CONFIG"), message);
}

}  // namespace vespscope::sources::diag
