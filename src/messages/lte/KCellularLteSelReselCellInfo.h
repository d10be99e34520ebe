// Selection, reselection and barring parameters that the serving LTE cell broadcasts (3GPP TS 36.304, 36.331).
//
// Written by messagegen from schema/lte.proto; change it there.
// clang-format off
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>
#include <string_view>
#include <tuple>
#include <utility>

#include "messages/Message.h"
#include "messages/lte/NbrEutra.h"

namespace vespscope {

class KCellularLteSelReselCellInfo final : public Message<KCellularLteSelReselCellInfo> {
 public:
  static constexpr std::string_view className = "KCellularLteSelReselCellInfo";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  [[nodiscard]] std::size_t multiBandInfosCount() const noexcept { return _multiBandInfos.size(); }
  [[nodiscard]] std::span<const std::uint32_t> multiBandInfos() const noexcept { return _multiBandInfos.values(); }
  void clearMultiBandInfos() noexcept { _multiBandInfos.clear(); }
  void addMultiBandInfo(std::uint32_t multiBandInfo) { _multiBandInfos.add(multiBandInfo); }
  [[nodiscard]] std::uint32_t multiBandInfoAtIndex(std::size_t index) const { return _multiBandInfos.at(index); }
  void setMultiBandInfos(const std::uint32_t* values, std::size_t count) { _multiBandInfos.assign(values, count); }

  [[nodiscard]] std::uint32_t imsEmergencySupport() const noexcept { return _imsEmergencySupport; }
  void setImsEmergencySupport(std::uint32_t imsEmergencySupport) noexcept {
    _imsEmergencySupport = imsEmergencySupport;
    _has.set(2);
  }
  void setHasImsEmergencySupport(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasImsEmergencySupport() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t acBarringForEmergency() const noexcept { return _acBarringForEmergency; }
  void setAcBarringForEmergency(std::uint32_t acBarringForEmergency) noexcept {
    _acBarringForEmergency = acBarringForEmergency;
    _has.set(1);
  }
  void setHasAcBarringForEmergency(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasAcBarringForEmergency() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t moSignallingAcBarringFactor() const noexcept { return _moSignallingAcBarringFactor; }
  void setMoSignallingAcBarringFactor(std::uint32_t moSignallingAcBarringFactor) noexcept {
    _moSignallingAcBarringFactor = moSignallingAcBarringFactor;
    _has.set(6);
  }
  void setHasMoSignallingAcBarringFactor(bool present) noexcept { _has.set(6, present); }
  [[nodiscard]] bool hasMoSignallingAcBarringFactor() const noexcept { return _has.test(6); }

  [[nodiscard]] std::uint32_t moSignallingAcBarringTime() const noexcept { return _moSignallingAcBarringTime; }
  void setMoSignallingAcBarringTime(std::uint32_t moSignallingAcBarringTime) noexcept {
    _moSignallingAcBarringTime = moSignallingAcBarringTime;
    _has.set(8);
  }
  void setHasMoSignallingAcBarringTime(bool present) noexcept { _has.set(8, present); }
  [[nodiscard]] bool hasMoSignallingAcBarringTime() const noexcept { return _has.test(8); }

  [[nodiscard]] std::uint32_t moSignallingAcBarringForSpecialAc() const noexcept { return _moSignallingAcBarringForSpecialAc; }
  void setMoSignallingAcBarringForSpecialAc(std::uint32_t moSignallingAcBarringForSpecialAc) noexcept {
    _moSignallingAcBarringForSpecialAc = moSignallingAcBarringForSpecialAc;
    _has.set(7);
  }
  void setHasMoSignallingAcBarringForSpecialAc(bool present) noexcept { _has.set(7, present); }
  [[nodiscard]] bool hasMoSignallingAcBarringForSpecialAc() const noexcept { return _has.test(7); }

  [[nodiscard]] std::uint32_t moDataAcBarringFactor() const noexcept { return _moDataAcBarringFactor; }
  void setMoDataAcBarringFactor(std::uint32_t moDataAcBarringFactor) noexcept {
    _moDataAcBarringFactor = moDataAcBarringFactor;
    _has.set(3);
  }
  void setHasMoDataAcBarringFactor(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasMoDataAcBarringFactor() const noexcept { return _has.test(3); }

  [[nodiscard]] std::uint32_t moDataAcBarringTime() const noexcept { return _moDataAcBarringTime; }
  void setMoDataAcBarringTime(std::uint32_t moDataAcBarringTime) noexcept {
    _moDataAcBarringTime = moDataAcBarringTime;
    _has.set(5);
  }
  void setHasMoDataAcBarringTime(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasMoDataAcBarringTime() const noexcept { return _has.test(5); }

  [[nodiscard]] std::uint32_t moDataAcBarringForSpecialAc() const noexcept { return _moDataAcBarringForSpecialAc; }
  void setMoDataAcBarringForSpecialAc(std::uint32_t moDataAcBarringForSpecialAc) noexcept {
    _moDataAcBarringForSpecialAc = moDataAcBarringForSpecialAc;
    _has.set(4);
  }
  void setHasMoDataAcBarringForSpecialAc(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasMoDataAcBarringForSpecialAc() const noexcept { return _has.test(4); }

  [[nodiscard]] std::int32_t qRxLevMin() const noexcept { return _qRxLevMin; }
  void setQRxLevMin(std::int32_t qRxLevMin) noexcept {
    _qRxLevMin = qRxLevMin;
    _has.set(12);
  }
  void setHasQRxLevMin(bool present) noexcept { _has.set(12, present); }
  [[nodiscard]] bool hasQRxLevMin() const noexcept { return _has.test(12); }

  [[nodiscard]] std::int32_t qQualMin() const noexcept { return _qQualMin; }
  void setQQualMin(std::int32_t qQualMin) noexcept {
    _qQualMin = qQualMin;
    _has.set(11);
  }
  void setHasQQualMin(bool present) noexcept { _has.set(11, present); }
  [[nodiscard]] bool hasQQualMin() const noexcept { return _has.test(11); }

  [[nodiscard]] std::uint32_t qHyst() const noexcept { return _qHyst; }
  void setQHyst(std::uint32_t qHyst) noexcept {
    _qHyst = qHyst;
    _has.set(10);
  }
  void setHasQHyst(bool present) noexcept { _has.set(10, present); }
  [[nodiscard]] bool hasQHyst() const noexcept { return _has.test(10); }

  [[nodiscard]] std::uint32_t sNonIntraSearchP() const noexcept { return _sNonIntraSearchP; }
  void setSNonIntraSearchP(std::uint32_t sNonIntraSearchP) noexcept {
    _sNonIntraSearchP = sNonIntraSearchP;
    _has.set(15);
  }
  void setHasSNonIntraSearchP(bool present) noexcept { _has.set(15, present); }
  [[nodiscard]] bool hasSNonIntraSearchP() const noexcept { return _has.test(15); }

  [[nodiscard]] std::uint32_t sNonIntraSearchQ() const noexcept { return _sNonIntraSearchQ; }
  void setSNonIntraSearchQ(std::uint32_t sNonIntraSearchQ) noexcept {
    _sNonIntraSearchQ = sNonIntraSearchQ;
    _has.set(16);
  }
  void setHasSNonIntraSearchQ(bool present) noexcept { _has.set(16, present); }
  [[nodiscard]] bool hasSNonIntraSearchQ() const noexcept { return _has.test(16); }

  [[nodiscard]] std::uint32_t sIntraSearchP() const noexcept { return _sIntraSearchP; }
  void setSIntraSearchP(std::uint32_t sIntraSearchP) noexcept {
    _sIntraSearchP = sIntraSearchP;
    _has.set(13);
  }
  void setHasSIntraSearchP(bool present) noexcept { _has.set(13, present); }
  [[nodiscard]] bool hasSIntraSearchP() const noexcept { return _has.test(13); }

  [[nodiscard]] std::uint32_t sIntraSearchQ() const noexcept { return _sIntraSearchQ; }
  void setSIntraSearchQ(std::uint32_t sIntraSearchQ) noexcept {
    _sIntraSearchQ = sIntraSearchQ;
    _has.set(14);
  }
  void setHasSIntraSearchQ(bool present) noexcept { _has.set(14, present); }
  [[nodiscard]] bool hasSIntraSearchQ() const noexcept { return _has.test(14); }

  [[nodiscard]] std::uint32_t threshServingLowP() const noexcept { return _threshServingLowP; }
  void setThreshServingLowP(std::uint32_t threshServingLowP) noexcept {
    _threshServingLowP = threshServingLowP;
    _has.set(17);
  }
  void setHasThreshServingLowP(bool present) noexcept { _has.set(17, present); }
  [[nodiscard]] bool hasThreshServingLowP() const noexcept { return _has.test(17); }

  [[nodiscard]] std::uint32_t threshServingLowQ() const noexcept { return _threshServingLowQ; }
  void setThreshServingLowQ(std::uint32_t threshServingLowQ) noexcept {
    _threshServingLowQ = threshServingLowQ;
    _has.set(18);
  }
  void setHasThreshServingLowQ(bool present) noexcept { _has.set(18, present); }
  [[nodiscard]] bool hasThreshServingLowQ() const noexcept { return _has.test(18); }

  [[nodiscard]] std::uint32_t priorityOperatingFreq() const noexcept { return _priorityOperatingFreq; }
  void setPriorityOperatingFreq(std::uint32_t priorityOperatingFreq) noexcept {
    _priorityOperatingFreq = priorityOperatingFreq;
    _has.set(9);
  }
  void setHasPriorityOperatingFreq(bool present) noexcept { _has.set(9, present); }
  [[nodiscard]] bool hasPriorityOperatingFreq() const noexcept { return _has.test(9); }

  void clearNbrEutras() noexcept { _nbrEutras.clear(); }
  void addNbrEutra(std::shared_ptr<NbrEutra> nbrEutra) { _nbrEutras.add(std::move(nbrEutra)); }
  [[nodiscard]] std::size_t nbrEutrasCount() const noexcept { return _nbrEutras.size(); }
  [[nodiscard]] const std::shared_ptr<NbrEutra>& nbrEutraAtIndex(std::size_t index) const { return _nbrEutras.at(index); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        numberListField<NumberKind::uint32>(2, "multi_band_info", &Self::_multiBandInfos),
        numberField<NumberKind::uint32>(3, "ims_emergency_support", &Self::_imsEmergencySupport, 2),
        numberField<NumberKind::uint32>(4, "ac_barring_for_emergency", &Self::_acBarringForEmergency, 1),
        numberField<NumberKind::uint32>(5, "mo_signalling_ac_barring_factor", &Self::_moSignallingAcBarringFactor, 6),
        numberField<NumberKind::uint32>(6, "mo_signalling_ac_barring_time", &Self::_moSignallingAcBarringTime, 8),
        numberField<NumberKind::uint32>(7, "mo_signalling_ac_barring_for_special_ac", &Self::_moSignallingAcBarringForSpecialAc, 7),
        numberField<NumberKind::uint32>(8, "mo_data_ac_barring_factor", &Self::_moDataAcBarringFactor, 3),
        numberField<NumberKind::uint32>(9, "mo_data_ac_barring_time", &Self::_moDataAcBarringTime, 5),
        numberField<NumberKind::uint32>(10, "mo_data_ac_barring_for_special_ac", &Self::_moDataAcBarringForSpecialAc, 4),
        numberField<NumberKind::sint32>(11, "QRxLevMin", &Self::_qRxLevMin, 12),
        numberField<NumberKind::sint32>(12, "QQualMin", &Self::_qQualMin, 11),
        numberField<NumberKind::uint32>(13, "Q_hyst", &Self::_qHyst, 10),
        numberField<NumberKind::uint32>(14, "S_non_intra_search_P", &Self::_sNonIntraSearchP, 15),
        numberField<NumberKind::uint32>(15, "S_non_intra_search_Q", &Self::_sNonIntraSearchQ, 16),
        numberField<NumberKind::uint32>(16, "S_intra_search_P", &Self::_sIntraSearchP, 13),
        numberField<NumberKind::uint32>(17, "S_intra_search_Q", &Self::_sIntraSearchQ, 14),
        numberField<NumberKind::uint32>(18, "Thresh_serving_lowP", &Self::_threshServingLowP, 17),
        numberField<NumberKind::uint32>(19, "Thresh_serving_lowQ", &Self::_threshServingLowQ, 18),
        numberField<NumberKind::uint32>(20, "priority_operating_freq", &Self::_priorityOperatingFreq, 9),
        messageListField(21, "nbr_eutra", &Self::_nbrEutras));
  }

 private:
  friend class Message<KCellularLteSelReselCellInfo>;

  std::uint64_t _timestamp = 0;
  NumberList<std::uint32_t> _multiBandInfos;
  MessageList<NbrEutra> _nbrEutras;
  std::uint32_t _imsEmergencySupport = 0;
  std::uint32_t _acBarringForEmergency = 0;
  std::uint32_t _moSignallingAcBarringFactor = 0;
  std::uint32_t _moSignallingAcBarringTime = 0;
  std::uint32_t _moSignallingAcBarringForSpecialAc = 0;
  std::uint32_t _moDataAcBarringFactor = 0;
  std::uint32_t _moDataAcBarringTime = 0;
  std::uint32_t _moDataAcBarringForSpecialAc = 0;
  std::int32_t _qRxLevMin = 0;
  std::int32_t _qQualMin = 0;
  std::uint32_t _qHyst = 0;
  std::uint32_t _sNonIntraSearchP = 0;
  std::uint32_t _sNonIntraSearchQ = 0;
  std::uint32_t _sIntraSearchP = 0;
  std::uint32_t _sIntraSearchQ = 0;
  std::uint32_t _threshServingLowP = 0;
  std::uint32_t _threshServingLowQ = 0;
  std::uint32_t _priorityOperatingFreq = 0;
  Presence<std::uint32_t> _has;
};

extern template class Message<KCellularLteSelReselCellInfo>;

}  // namespace vespscope
