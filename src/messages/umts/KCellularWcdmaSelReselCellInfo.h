// Selection and reselection parameters of the serving UMTS cell (3GPP TS 25.304, 25.331).
//
// Written by messagegen from schema/umts.proto; change it there.
// clang-format off
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string_view>
#include <tuple>
#include <utility>

#include "messages/Message.h"
#include "messages/umts/EutraFreqInfo.h"
#include "messages/umts/GsmFreqInfo.h"
#include "messages/umts/UtraFreqInfo.h"

namespace vespscope {

class KCellularWcdmaSelReselCellInfo final : public Message<KCellularWcdmaSelReselCellInfo> {
 public:
  static constexpr std::string_view className = "KCellularWcdmaSelReselCellInfo";

  // Duplex mode of the cell.
  struct DuplexMode {
    enum : std::int32_t {
      FDD = 0,
      TDD = 1,
    };
    // What a field that is not set reads as.
    static constexpr std::int32_t firstDeclared = FDD;
    static constexpr EnumerationName names[] = {
      {FDD, "FDD"},
      {TDD, "TDD"},
    };
    // The name of `number`, if it has one.
    [[nodiscard]] static std::optional<std::string_view> nameOf(std::int32_t number) { return enumerationName(names, number); }
  };

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  [[nodiscard]] std::uint32_t hsdpaCapable() const noexcept { return _hsdpaCapable; }
  void setHsdpaCapable(std::uint32_t hsdpaCapable) noexcept {
    _hsdpaCapable = hsdpaCapable;
    _has.set(5);
  }
  void setHasHsdpaCapable(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasHsdpaCapable() const noexcept { return _has.test(5); }

  [[nodiscard]] std::uint32_t edchCapable() const noexcept { return _edchCapable; }
  void setEdchCapable(std::uint32_t edchCapable) noexcept {
    _edchCapable = edchCapable;
    _has.set(3);
  }
  void setHasEdchCapable(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasEdchCapable() const noexcept { return _has.test(3); }

  // A value of DuplexMode, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t duplexMode() const noexcept { return hasDuplexMode() ? _duplexMode : DuplexMode::firstDeclared; }
  void setDuplexMode(std::int32_t duplexMode) noexcept {
    _duplexMode = duplexMode;
    _has.set(2);
  }
  void setHasDuplexMode(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasDuplexMode() const noexcept { return _has.test(2); }

  [[nodiscard]] std::size_t multiBandInfosCount() const noexcept { return _multiBandInfos.size(); }
  [[nodiscard]] std::span<const std::uint32_t> multiBandInfos() const noexcept { return _multiBandInfos.values(); }
  void clearMultiBandInfos() noexcept { _multiBandInfos.clear(); }
  void addMultiBandInfo(std::uint32_t multiBandInfo) { _multiBandInfos.add(multiBandInfo); }
  [[nodiscard]] std::uint32_t multiBandInfoAtIndex(std::size_t index) const { return _multiBandInfos.at(index); }
  void setMultiBandInfos(const std::uint32_t* values, std::size_t count) { _multiBandInfos.assign(values, count); }

  [[nodiscard]] std::uint32_t imsEmergencySupport() const noexcept { return _imsEmergencySupport; }
  void setImsEmergencySupport(std::uint32_t imsEmergencySupport) noexcept {
    _imsEmergencySupport = imsEmergencySupport;
    _has.set(6);
  }
  void setHasImsEmergencySupport(bool present) noexcept { _has.set(6, present); }
  [[nodiscard]] bool hasImsEmergencySupport() const noexcept { return _has.test(6); }

  [[nodiscard]] std::uint32_t cellBarred() const noexcept { return _cellBarred; }
  void setCellBarred(std::uint32_t cellBarred) noexcept {
    _cellBarred = cellBarred;
    _has.set(1);
  }
  void setHasCellBarred(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasCellBarred() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t fachMeasOccInfoPresent() const noexcept { return _fachMeasOccInfoPresent; }
  void setFachMeasOccInfoPresent(std::uint32_t fachMeasOccInfoPresent) noexcept {
    _fachMeasOccInfoPresent = fachMeasOccInfoPresent;
    _has.set(4);
  }
  void setHasFachMeasOccInfoPresent(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasFachMeasOccInfoPresent() const noexcept { return _has.test(4); }

  [[nodiscard]] std::int32_t sRxlev() const noexcept { return _sRxlev; }
  void setSRxlev(std::int32_t sRxlev) noexcept {
    _sRxlev = sRxlev;
    _has.set(11);
  }
  void setHasSRxlev(bool present) noexcept { _has.set(11, present); }
  [[nodiscard]] bool hasSRxlev() const noexcept { return _has.test(11); }

  [[nodiscard]] std::int32_t sQual() const noexcept { return _sQual; }
  void setSQual(std::int32_t sQual) noexcept {
    _sQual = sQual;
    _has.set(10);
  }
  void setHasSQual(bool present) noexcept { _has.set(10, present); }
  [[nodiscard]] bool hasSQual() const noexcept { return _has.test(10); }

  [[nodiscard]] std::int32_t sIntrasearch() const noexcept { return _sIntrasearch; }
  void setSIntrasearch(std::int32_t sIntrasearch) noexcept {
    _sIntrasearch = sIntrasearch;
    _has.set(9);
  }
  void setHasSIntrasearch(bool present) noexcept { _has.set(9, present); }
  [[nodiscard]] bool hasSIntrasearch() const noexcept { return _has.test(9); }

  [[nodiscard]] std::int32_t sIntersearch() const noexcept { return _sIntersearch; }
  void setSIntersearch(std::int32_t sIntersearch) noexcept {
    _sIntersearch = sIntersearch;
    _has.set(8);
  }
  void setHasSIntersearch(bool present) noexcept { _has.set(8, present); }
  [[nodiscard]] bool hasSIntersearch() const noexcept { return _has.test(8); }

  [[nodiscard]] std::int32_t sSearchRat() const noexcept { return _sSearchRat; }
  void setSSearchRat(std::int32_t sSearchRat) noexcept {
    _sSearchRat = sSearchRat;
    _has.set(12);
  }
  void setHasSSearchRat(bool present) noexcept { _has.set(12, present); }
  [[nodiscard]] bool hasSSearchRat() const noexcept { return _has.test(12); }

  [[nodiscard]] std::uint32_t sCellPrio() const noexcept { return _sCellPrio; }
  void setSCellPrio(std::uint32_t sCellPrio) noexcept {
    _sCellPrio = sCellPrio;
    _has.set(7);
  }
  void setHasSCellPrio(bool present) noexcept { _has.set(7, present); }
  [[nodiscard]] bool hasSCellPrio() const noexcept { return _has.test(7); }

  void clearEutraPrioInfos() noexcept { _eutraPrioInfos.clear(); }
  void addEutraPrioInfo(std::shared_ptr<EutraFreqInfo> eutraPrioInfo) { _eutraPrioInfos.add(std::move(eutraPrioInfo)); }
  [[nodiscard]] std::size_t eutraPrioInfosCount() const noexcept { return _eutraPrioInfos.size(); }
  [[nodiscard]] const std::shared_ptr<EutraFreqInfo>& eutraPrioInfoAtIndex(std::size_t index) const { return _eutraPrioInfos.at(index); }

  void clearUtraPrioInfos() noexcept { _utraPrioInfos.clear(); }
  void addUtraPrioInfo(std::shared_ptr<UtraFreqInfo> utraPrioInfo) { _utraPrioInfos.add(std::move(utraPrioInfo)); }
  [[nodiscard]] std::size_t utraPrioInfosCount() const noexcept { return _utraPrioInfos.size(); }
  [[nodiscard]] const std::shared_ptr<UtraFreqInfo>& utraPrioInfoAtIndex(std::size_t index) const { return _utraPrioInfos.at(index); }

  void clearGsmPrioInfos() noexcept { _gsmPrioInfos.clear(); }
  void addGsmPrioInfo(std::shared_ptr<GsmFreqInfo> gsmPrioInfo) { _gsmPrioInfos.add(std::move(gsmPrioInfo)); }
  [[nodiscard]] std::size_t gsmPrioInfosCount() const noexcept { return _gsmPrioInfos.size(); }
  [[nodiscard]] const std::shared_ptr<GsmFreqInfo>& gsmPrioInfoAtIndex(std::size_t index) const { return _gsmPrioInfos.at(index); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        numberField<NumberKind::uint32>(2, "hsdpa_capable", &Self::_hsdpaCapable, 5),
        numberField<NumberKind::uint32>(3, "edch_capable", &Self::_edchCapable, 3),
        enumerationField(4, "duplex_mode", &Self::_duplexMode, 2, DuplexMode::names),
        numberListField<NumberKind::uint32>(5, "multi_band_info", &Self::_multiBandInfos),
        numberField<NumberKind::uint32>(6, "ims_emergency_support", &Self::_imsEmergencySupport, 6),
        numberField<NumberKind::uint32>(7, "cell_barred", &Self::_cellBarred, 1),
        numberField<NumberKind::uint32>(8, "fach_meas_occ_info_present", &Self::_fachMeasOccInfoPresent, 4),
        numberField<NumberKind::sint32>(9, "s_rxlev", &Self::_sRxlev, 11),
        numberField<NumberKind::sint32>(10, "s_qual", &Self::_sQual, 10),
        numberField<NumberKind::sint32>(11, "s_intrasearch", &Self::_sIntrasearch, 9),
        numberField<NumberKind::sint32>(12, "s_intersearch", &Self::_sIntersearch, 8),
        numberField<NumberKind::sint32>(13, "s_search_rat", &Self::_sSearchRat, 12),
        numberField<NumberKind::uint32>(21, "s_cell_prio", &Self::_sCellPrio, 7),
        messageListField(22, "eutra_prio_info", &Self::_eutraPrioInfos),
        messageListField(23, "utra_prio_info", &Self::_utraPrioInfos),
        messageListField(24, "gsm_prio_info", &Self::_gsmPrioInfos));
  }

 private:
  friend class Message<KCellularWcdmaSelReselCellInfo>;

  std::uint64_t _timestamp = 0;
  NumberList<std::uint32_t> _multiBandInfos;
  MessageList<EutraFreqInfo> _eutraPrioInfos;
  MessageList<UtraFreqInfo> _utraPrioInfos;
  MessageList<GsmFreqInfo> _gsmPrioInfos;
  std::uint32_t _hsdpaCapable = 0;
  std::uint32_t _edchCapable = 0;
  std::int32_t _duplexMode = 0;
  std::uint32_t _imsEmergencySupport = 0;
  std::uint32_t _cellBarred = 0;
  std::uint32_t _fachMeasOccInfoPresent = 0;
  std::int32_t _sRxlev = 0;
  std::int32_t _sQual = 0;
  std::int32_t _sIntrasearch = 0;
  std::int32_t _sIntersearch = 0;
  std::int32_t _sSearchRat = 0;
  std::uint32_t _sCellPrio = 0;
  Presence<std::uint16_t> _has;
};

extern template class Message<KCellularWcdmaSelReselCellInfo>;

}  // namespace vespscope
