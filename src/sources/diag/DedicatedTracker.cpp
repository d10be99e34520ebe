#include "sources/diag/DedicatedTracker.h"

#include <algorithm>

#include "messages/lte/KCellularLteCdrxConfig.h"
#include "messages/lte/LteRrcState.h"
#include "registry/MetricRows.h"

namespace vespscope::sources::diag {

using rrc::lte::MeasurementObject;
using rrc::lte::Reconfiguration;

void DedicatedTracker::take(const Reconfiguration& change, const CellName& serving, EventList& out) {
  if (change.fullConfiguration) {
    objects_.clear();
    measurements_.clear();
  }
  if (change.mobility && change.mobility->downlinkCarrier) {
    exchangeObjects(serving.earfcn, *change.mobility->downlinkCarrier);
  }
  if (change.measurements) measure(*change.measurements);
  if (change.drx == Reconfiguration::Drx::unchanged) return;
  const auto before = reception_;
  reception_ = change.drx == Reconfiguration::Drx::set ? change.drxSetting : std::nullopt;
  if (reception_ != before) report(out);
}

void DedicatedTracker::endConnection(EventList& out) {
  objects_.clear();
  measurements_.clear();
  if (!reception_) return;
  reception_.reset();
  report(out);
}

const MeasurementObject* DedicatedTracker::objectOf(std::uint8_t measurement) const {
  const auto identity = measurements_.find(measurement);
  if (identity == measurements_.end()) return nullptr;
  const auto object = objects_.find(identity->second);
  return object == objects_.end() ? nullptr : &object->second;
}

// In the order of 3GPP TS 36.331 5.5.2.1.
void DedicatedTracker::measure(const rrc::lte::MeasurementConfiguration& change) {
  for (const std::uint8_t id : change.removedObjects) {
    objects_.erase(id);
    std::erase_if(measurements_, [id](const auto& entry) { return entry.second == id; });
  }
  for (const MeasurementObject& object : change.objects) objects_[object.id] = object;
  for (const std::uint8_t id : change.removedIdentities) measurements_.erase(id);
  for (const auto& identity : change.identities) measurements_[identity.id] = identity.object;
}

void DedicatedTracker::exchangeObjects(std::uint32_t source, std::uint32_t target) {
  if (source == target) return;
  const auto objectOn = [this](std::uint32_t carrier) {
    return std::find_if(objects_.begin(), objects_.end(), [carrier](const auto& entry) {
      return entry.second.technology == MeasurementObject::Technology::lte && entry.second.carrier == carrier;
    });
  };
  const auto from = objectOn(source);
  const auto to = objectOn(target);
  if (to == objects_.end()) {
    // The network links new objects, or none.
    if (from != objects_.end()) {
      std::erase_if(measurements_, [&](const auto& entry) { return entry.second == from->first; });
    }
    return;
  }
  for (auto& [id, object] : measurements_) {
    if (from != objects_.end() && object == from->first) {
      object = to->first;
    } else if (object == to->first && from != objects_.end()) {
      object = from->first;
    }
  }
}

void DedicatedTracker::report(EventList& out) const {
  KCellularLteCdrxConfig message;
  if (reception_) {
    message.setOnDurationMs(reception_->onDuration);
    message.setDrxInactivityMs(reception_->inactivity);
    message.setDrxRetxTimerMs(reception_->retransmission);
    message.setLongDrxCycleMs(reception_->longCycle);
    if (reception_->shortCycle) {
      message.setShortDrxCycleMs(reception_->shortCycle->length);
      message.setDrxShortCycleNum(reception_->shortCycle->repetitions);
    }
    message.setRrcState(LteRrcState::KLTE_RRC_STATE_CONNECTED);
  }
  message.setCdrxConfigStatus(reception_ ? 1 : 0);
  out.add(metricIdentifier("K_LTE_CDRX_CONFIG"), message);
}

}  // namespace vespscope::sources::diag
