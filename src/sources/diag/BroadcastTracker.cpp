#include "sources/diag/BroadcastTracker.h"

#include <algorithm>
#include <array>
#include <memory>

#include "messages/lte/KCellularLteSelReselCellInfo.h"
#include "messages/lte/NbrEutra.h"
#include "radio/Bandwidth.h"
#include "radio/Channel.h"
#include "registry/MetricRows.h"

namespace vespscope::sources::diag {
namespace {

using rrc::lte::LteNeighbourFrequency;
using Message = KCellularLteSelReselCellInfo;

// The metric contains the raw codes of 3GPP TS 36.331 6.2.2 and 6.3.1; the reader returns quantities.

// q-Hyst: dB0..dB6, then dB8, dB10 .. dB24.
std::uint32_t hysteresisCode(std::uint8_t dB) { return dB <= 6 ? dB : 7U + (dB - 8U) / 2U; }

// ac-BarringFactor: p00, p05, p10, …
std::optional<std::uint32_t> factorCode(std::uint8_t percent) {
  constexpr std::array<std::uint8_t, 16> factors = {0, 5, 10, 15, 20, 25, 30, 40, 50, 60, 70, 75, 80, 85, 90, 95};
  const auto* found = std::find(factors.begin(), factors.end(), percent);
  if (found == factors.end()) return std::nullopt;
  return static_cast<std::uint32_t>(found - factors.begin());
}

// ac-BarringTime: s4, s8, s16 .. s512.
std::optional<std::uint32_t> timeCode(std::uint16_t seconds) {
  for (std::uint32_t code = 0; code < 8; ++code) {
    if (seconds == 4U << code) return code;
  }
  return std::nullopt;
}

void setBarring(const rrc::lte::AccessInformation& access, Message& message) {
  message.setAcBarringForEmergency(access.emergencyBarred ? 1 : 0);
  if (const auto& barring = access.signalling) {
    if (const auto code = factorCode(barring->factor)) message.setMoSignallingAcBarringFactor(*code);
    if (const auto code = timeCode(barring->time)) message.setMoSignallingAcBarringTime(*code);
    message.setMoSignallingAcBarringForSpecialAc(barring->specialClasses);
  }
  if (const auto& barring = access.data) {
    if (const auto code = factorCode(barring->factor)) message.setMoDataAcBarringFactor(*code);
    if (const auto code = timeCode(barring->time)) message.setMoDataAcBarringTime(*code);
    message.setMoDataAcBarringForSpecialAc(barring->specialClasses);
  }
}

void setReselection(const rrc::lte::ServingReselection& block, Message& message) {
  message.setQRxLevMin(block.qRxLevMin);
  if (block.qQualMin) message.setQQualMin(*block.qQualMin);
  message.setQHyst(hysteresisCode(block.hysteresis));
  if (const auto search = block.sNonIntraSearchP ? block.sNonIntraSearchP : block.sNonIntraSearch) {
    message.setSNonIntraSearchP(*search);
  }
  if (block.sNonIntraSearchQ) message.setSNonIntraSearchQ(*block.sNonIntraSearchQ);
  if (const auto search = block.sIntraSearchP ? block.sIntraSearchP : block.sIntraSearch) {
    message.setSIntraSearchP(*search);
  }
  if (block.sIntraSearchQ) message.setSIntraSearchQ(*block.sIntraSearchQ);
  message.setThreshServingLowP(block.threshServingLow);
  if (block.threshServingLowQ) message.setThreshServingLowQ(*block.threshServingLowQ);
  message.setPriorityOperatingFreq(block.priority);
}

std::shared_ptr<NbrEutra> frequencyOf(const LteNeighbourFrequency& frequency) {
  auto element = std::make_shared<NbrEutra>();
  element->setEarfcn(frequency.carrier);
  element->setQRxlevMin(frequency.qRxLevMin);
  if (frequency.qQualMin) element->setQQualMin(*frequency.qQualMin);
  element->setQOffset(frequency.offset);
  if (frequency.maximumPower) element->setPmax(*frequency.maximumPower);
  if (const auto width = radio::Bandwidth::fromResourceBlocks(frequency.measuredBandwidth)) {
    element->setDlBw(width->code());
  }
  element->setThresXHighP(frequency.threshXHigh);
  element->setThresXLowP(frequency.threshXLow);
  if (frequency.threshXHighQ) element->setThresXHighQ(*frequency.threshXHighQ);
  if (frequency.threshXLowQ) element->setThresXLowQ(*frequency.threshXLowQ);
  if (frequency.priority) element->setPriority(*frequency.priority);
  if (const auto channel = radio::Earfcn::fromNumber(frequency.carrier, radio::Direction::downlink)) {
    element->setFrameType(channel->direction() == radio::Direction::both ? NbrEutra::FrameType::TDD
                                                                         : NbrEutra::FrameType::FDD);
    element->setBand(channel->band());
  }
  return element;
}

}  // namespace

void BroadcastTracker::take(const CellName& cell, const rrc::Message& message, const EventList& out) {
  if (const auto master = rrc::lte::masterInformationOf(message)) {
    CellBroadcast& entry = entryOf(cell);
    entry.heardAt = out.time();
    entry.downlinkBlocks = master->bandwidth;
  } else if (auto information = rrc::lte::cellInformationOf(message)) {
    CellBroadcast& entry = entryOf(cell);
    entry.heardAt = out.time();
    entry.information = std::move(information);
  } else if (auto system = rrc::lte::systemInformationOf(message)) {
    CellBroadcast& entry = entryOf(cell);
    entry.heardAt = out.time();
    if (system->access) entry.access = system->access;
    if (system->serving) entry.reselection = system->serving;
    if (system->lte) entry.frequencies = std::move(system->lte);
  }
}

const CellBroadcast* BroadcastTracker::find(const CellName& cell) const {
  const auto found =
      std::find_if(cells_.begin(), cells_.end(), [&](const CellBroadcast& entry) { return entry.cell == cell; });
  return found == cells_.end() ? nullptr : &*found;
}

CellBroadcast& BroadcastTracker::entryOf(const CellName& cell) {
  const auto found =
      std::find_if(cells_.begin(), cells_.end(), [&](const CellBroadcast& entry) { return entry.cell == cell; });
  if (found != cells_.end()) return *found;
  if (cells_.size() == maximumCells) {
    cells_.erase(std::min_element(cells_.begin(), cells_.end(),
                                  [](const auto& left, const auto& right) { return left.heardAt < right.heardAt; }));
  }
  cells_.push_back({});
  cells_.back().cell = cell;
  return cells_.back();
}

void BroadcastTracker::report(const CellName& serving, EventList& out) {
  const CellBroadcast* broadcast = find(serving);
  // A decoder drops the parameters for good that one report lacks.
  if (broadcast == nullptr || !broadcast->reselection) return;
  Message message;
  if (broadcast->information) {
    message.addMultiBandInfo(broadcast->information->band);
    for (const std::uint16_t band : broadcast->information->moreBands) message.addMultiBandInfo(band);
  }
  if (broadcast->access) setBarring(*broadcast->access, message);
  if (broadcast->reselection) setReselection(*broadcast->reselection, message);
  if (broadcast->frequencies) {
    for (const LteNeighbourFrequency& frequency : *broadcast->frequencies) {
      message.addNbrEutra(frequencyOf(frequency));
    }
  }
  Bytes content = message.encoded();
  if (content == reported_) return;
  reported_ = std::move(content);
  out.add(metricIdentifier("K_LTE_SEL_RESEL_INFO"), message);
}

}  // namespace vespscope::sources::diag
