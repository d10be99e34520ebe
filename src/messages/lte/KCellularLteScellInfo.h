// Identity, frequencies and bandwidths of the serving LTE cell.
//
// Written by messagegen from schema/lte.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class KCellularLteScellInfo final : public Message<KCellularLteScellInfo> {
 public:
  static constexpr std::string_view className = "KCellularLteScellInfo";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  [[nodiscard]] std::uint32_t phyCellId() const noexcept { return _phyCellId; }
  void setPhyCellId(std::uint32_t phyCellId) noexcept {
    _phyCellId = phyCellId;
    _has.set(6);
  }
  void setHasPhyCellId(bool present) noexcept { _has.set(6, present); }
  [[nodiscard]] bool hasPhyCellId() const noexcept { return _has.test(6); }

  [[nodiscard]] std::uint32_t dlFreq() const noexcept { return _dlFreq; }
  void setDlFreq(std::uint32_t dlFreq) noexcept {
    _dlFreq = dlFreq;
    _has.set(3);
  }
  void setHasDlFreq(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasDlFreq() const noexcept { return _has.test(3); }

  [[nodiscard]] std::uint32_t ulFreq() const noexcept { return _ulFreq; }
  void setUlFreq(std::uint32_t ulFreq) noexcept {
    _ulFreq = ulFreq;
    _has.set(13);
  }
  void setHasUlFreq(bool present) noexcept { _has.set(13, present); }
  [[nodiscard]] bool hasUlFreq() const noexcept { return _has.test(13); }

  [[nodiscard]] std::uint32_t dlBw() const noexcept { return _dlBw; }
  void setDlBw(std::uint32_t dlBw) noexcept {
    _dlBw = dlBw;
    _has.set(2);
  }
  void setHasDlBw(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasDlBw() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t ulBw() const noexcept { return _ulBw; }
  void setUlBw(std::uint32_t ulBw) noexcept {
    _ulBw = ulBw;
    _has.set(12);
  }
  void setHasUlBw(bool present) noexcept { _has.set(12, present); }
  [[nodiscard]] bool hasUlBw() const noexcept { return _has.test(12); }

  [[nodiscard]] std::uint32_t cellId() const noexcept { return _cellId; }
  void setCellId(std::uint32_t cellId) noexcept {
    _cellId = cellId;
    _has.set(1);
  }
  void setHasCellId(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasCellId() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t freqBandInd() const noexcept { return _freqBandInd; }
  void setFreqBandInd(std::uint32_t freqBandInd) noexcept {
    _freqBandInd = freqBandInd;
    _has.set(4);
  }
  void setHasFreqBandInd(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasFreqBandInd() const noexcept { return _has.test(4); }

  [[nodiscard]] std::uint32_t trackingAreaCode() const noexcept { return _trackingAreaCode; }
  void setTrackingAreaCode(std::uint32_t trackingAreaCode) noexcept {
    _trackingAreaCode = trackingAreaCode;
    _has.set(11);
  }
  void setHasTrackingAreaCode(bool present) noexcept { _has.set(11, present); }
  [[nodiscard]] bool hasTrackingAreaCode() const noexcept { return _has.test(11); }

  [[nodiscard]] std::uint32_t numMncDigits() const noexcept { return _numMncDigits; }
  void setNumMncDigits(std::uint32_t numMncDigits) noexcept {
    _numMncDigits = numMncDigits;
    _has.set(5);
  }
  void setHasNumMncDigits(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasNumMncDigits() const noexcept { return _has.test(5); }

  [[nodiscard]] std::uint32_t selPlmnMcc() const noexcept { return _selPlmnMcc; }
  void setSelPlmnMcc(std::uint32_t selPlmnMcc) noexcept {
    _selPlmnMcc = selPlmnMcc;
    _has.set(7);
  }
  void setHasSelPlmnMcc(bool present) noexcept { _has.set(7, present); }
  [[nodiscard]] bool hasSelPlmnMcc() const noexcept { return _has.test(7); }

  [[nodiscard]] std::uint32_t selPlmnMnc() const noexcept { return _selPlmnMnc; }
  void setSelPlmnMnc(std::uint32_t selPlmnMnc) noexcept {
    _selPlmnMnc = selPlmnMnc;
    _has.set(8);
  }
  void setHasSelPlmnMnc(bool present) noexcept { _has.set(8, present); }
  [[nodiscard]] bool hasSelPlmnMnc() const noexcept { return _has.test(8); }

  [[nodiscard]] std::uint32_t tddSfAssignment() const noexcept { return _tddSfAssignment; }
  void setTddSfAssignment(std::uint32_t tddSfAssignment) noexcept {
    _tddSfAssignment = tddSfAssignment;
    _has.set(9);
  }
  void setHasTddSfAssignment(bool present) noexcept { _has.set(9, present); }
  [[nodiscard]] bool hasTddSfAssignment() const noexcept { return _has.test(9); }

  [[nodiscard]] std::uint32_t tddSsfPatterns() const noexcept { return _tddSsfPatterns; }
  void setTddSsfPatterns(std::uint32_t tddSsfPatterns) noexcept {
    _tddSsfPatterns = tddSsfPatterns;
    _has.set(10);
  }
  void setHasTddSsfPatterns(bool present) noexcept { _has.set(10, present); }
  [[nodiscard]] bool hasTddSsfPatterns() const noexcept { return _has.test(10); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        numberField<NumberKind::uint32>(2, "phy_cell_id", &Self::_phyCellId, 6),
        numberField<NumberKind::uint32>(3, "dl_freq", &Self::_dlFreq, 3),
        numberField<NumberKind::uint32>(4, "ul_freq", &Self::_ulFreq, 13),
        numberField<NumberKind::uint32>(5, "dl_bw", &Self::_dlBw, 2),
        numberField<NumberKind::uint32>(6, "ul_bw", &Self::_ulBw, 12),
        numberField<NumberKind::uint32>(7, "cell_id", &Self::_cellId, 1),
        numberField<NumberKind::uint32>(8, "freq_band_ind", &Self::_freqBandInd, 4),
        numberField<NumberKind::uint32>(9, "tracking_area_code", &Self::_trackingAreaCode, 11),
        numberField<NumberKind::uint32>(10, "num_mnc_digits", &Self::_numMncDigits, 5),
        numberField<NumberKind::uint32>(11, "sel_plmn_mcc", &Self::_selPlmnMcc, 7),
        numberField<NumberKind::uint32>(12, "sel_plmn_mnc", &Self::_selPlmnMnc, 8),
        numberField<NumberKind::uint32>(14, "tdd_sf_assignment", &Self::_tddSfAssignment, 9),
        numberField<NumberKind::uint32>(15, "tdd_ssf_patterns", &Self::_tddSsfPatterns, 10));
  }

 private:
  friend class Message<KCellularLteScellInfo>;

  std::uint64_t _timestamp = 0;
  std::uint32_t _phyCellId = 0;
  std::uint32_t _dlFreq = 0;
  std::uint32_t _ulFreq = 0;
  std::uint32_t _dlBw = 0;
  std::uint32_t _ulBw = 0;
  std::uint32_t _cellId = 0;
  std::uint32_t _freqBandInd = 0;
  std::uint32_t _trackingAreaCode = 0;
  std::uint32_t _numMncDigits = 0;
  std::uint32_t _selPlmnMcc = 0;
  std::uint32_t _selPlmnMnc = 0;
  std::uint32_t _tddSfAssignment = 0;
  std::uint32_t _tddSsfPatterns = 0;
  Presence<std::uint16_t> _has;
};

extern template class Message<KCellularLteScellInfo>;

}  // namespace vespscope
