// Reselection parameters of one neighbouring E-UTRA frequency (3GPP TS 36.331, InterFreqCarrierFreqInfo).
//
// Written by messagegen from schema/lte.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class NbrEutra final : public Message<NbrEutra> {
 public:
  static constexpr std::string_view className = "NbrEutra";

  // Duplex mode of the frequency.
  struct FrameType {
    enum : std::int32_t {
      FDD = 0,
      TDD = 1,
      INVALID = 2,
    };
    // What a field that is not set reads as.
    static constexpr std::int32_t firstDeclared = FDD;
    static constexpr EnumerationName names[] = {
      {FDD, "FDD"},
      {TDD, "TDD"},
      {INVALID, "INVALID"},
    };
    // The name of `number`, if it has one.
    [[nodiscard]] static std::optional<std::string_view> nameOf(std::int32_t number) { return enumerationName(names, number); }
  };

  [[nodiscard]] std::uint32_t earfcn() const noexcept { return _earfcn; }
  void setEarfcn(std::uint32_t earfcn) noexcept {
    _earfcn = earfcn;
    _has.set(2);
  }
  void setHasEarfcn(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasEarfcn() const noexcept { return _has.test(2); }

  [[nodiscard]] std::int32_t qRxlevMin() const noexcept { return _qRxlevMin; }
  void setQRxlevMin(std::int32_t qRxlevMin) noexcept {
    _qRxlevMin = qRxlevMin;
    _has.set(8);
  }
  void setHasQRxlevMin(bool present) noexcept { _has.set(8, present); }
  [[nodiscard]] bool hasQRxlevMin() const noexcept { return _has.test(8); }

  [[nodiscard]] std::int32_t qQualMin() const noexcept { return _qQualMin; }
  void setQQualMin(std::int32_t qQualMin) noexcept {
    _qQualMin = qQualMin;
    _has.set(7);
  }
  void setHasQQualMin(bool present) noexcept { _has.set(7, present); }
  [[nodiscard]] bool hasQQualMin() const noexcept { return _has.test(7); }

  [[nodiscard]] std::int32_t qOffset() const noexcept { return _qOffset; }
  void setQOffset(std::int32_t qOffset) noexcept {
    _qOffset = qOffset;
    _has.set(6);
  }
  void setHasQOffset(bool present) noexcept { _has.set(6, present); }
  [[nodiscard]] bool hasQOffset() const noexcept { return _has.test(6); }

  [[nodiscard]] std::int32_t pmax() const noexcept { return _pmax; }
  void setPmax(std::int32_t pmax) noexcept {
    _pmax = pmax;
    _has.set(4);
  }
  void setHasPmax(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasPmax() const noexcept { return _has.test(4); }

  [[nodiscard]] std::uint32_t dlBw() const noexcept { return _dlBw; }
  void setDlBw(std::uint32_t dlBw) noexcept {
    _dlBw = dlBw;
    _has.set(1);
  }
  void setHasDlBw(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasDlBw() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t thresXHighP() const noexcept { return _thresXHighP; }
  void setThresXHighP(std::uint32_t thresXHighP) noexcept {
    _thresXHighP = thresXHighP;
    _has.set(9);
  }
  void setHasThresXHighP(bool present) noexcept { _has.set(9, present); }
  [[nodiscard]] bool hasThresXHighP() const noexcept { return _has.test(9); }

  [[nodiscard]] std::uint32_t thresXLowP() const noexcept { return _thresXLowP; }
  void setThresXLowP(std::uint32_t thresXLowP) noexcept {
    _thresXLowP = thresXLowP;
    _has.set(11);
  }
  void setHasThresXLowP(bool present) noexcept { _has.set(11, present); }
  [[nodiscard]] bool hasThresXLowP() const noexcept { return _has.test(11); }

  [[nodiscard]] std::uint32_t thresXHighQ() const noexcept { return _thresXHighQ; }
  void setThresXHighQ(std::uint32_t thresXHighQ) noexcept {
    _thresXHighQ = thresXHighQ;
    _has.set(10);
  }
  void setHasThresXHighQ(bool present) noexcept { _has.set(10, present); }
  [[nodiscard]] bool hasThresXHighQ() const noexcept { return _has.test(10); }

  [[nodiscard]] std::uint32_t thresXLowQ() const noexcept { return _thresXLowQ; }
  void setThresXLowQ(std::uint32_t thresXLowQ) noexcept {
    _thresXLowQ = thresXLowQ;
    _has.set(12);
  }
  void setHasThresXLowQ(bool present) noexcept { _has.set(12, present); }
  [[nodiscard]] bool hasThresXLowQ() const noexcept { return _has.test(12); }

  [[nodiscard]] std::uint32_t priority() const noexcept { return _priority; }
  void setPriority(std::uint32_t priority) noexcept {
    _priority = priority;
    _has.set(5);
  }
  void setHasPriority(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasPriority() const noexcept { return _has.test(5); }

  // A value of FrameType, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t frameType() const noexcept { return hasFrameType() ? _frameType : FrameType::firstDeclared; }
  void setFrameType(std::int32_t frameType) noexcept {
    _frameType = frameType;
    _has.set(3);
  }
  void setHasFrameType(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasFrameType() const noexcept { return _has.test(3); }

  [[nodiscard]] std::uint32_t band() const noexcept { return _band; }
  void setBand(std::uint32_t band) noexcept {
    _band = band;
    _has.set(0);
  }
  void setHasBand(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasBand() const noexcept { return _has.test(0); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint32>(1, "earfcn", &Self::_earfcn, 2),
        numberField<NumberKind::sint32>(2, "Q_rxlev_min", &Self::_qRxlevMin, 8),
        numberField<NumberKind::sint32>(3, "Q_qual_min", &Self::_qQualMin, 7),
        numberField<NumberKind::sint32>(4, "Q_offset", &Self::_qOffset, 6),
        numberField<NumberKind::sint32>(5, "Pmax", &Self::_pmax, 4),
        numberField<NumberKind::uint32>(6, "dl_bw", &Self::_dlBw, 1),
        numberField<NumberKind::uint32>(7, "Thres_X_highP", &Self::_thresXHighP, 9),
        numberField<NumberKind::uint32>(8, "Thres_X_lowP", &Self::_thresXLowP, 11),
        numberField<NumberKind::uint32>(9, "Thres_X_highQ", &Self::_thresXHighQ, 10),
        numberField<NumberKind::uint32>(10, "Thres_X_lowQ", &Self::_thresXLowQ, 12),
        numberField<NumberKind::uint32>(11, "priority", &Self::_priority, 5),
        enumerationField(12, "frame_type", &Self::_frameType, 3, FrameType::names),
        numberField<NumberKind::uint32>(13, "band", &Self::_band, 0));
  }

 private:
  friend class Message<NbrEutra>;

  std::uint32_t _earfcn = 0;
  std::int32_t _qRxlevMin = 0;
  std::int32_t _qQualMin = 0;
  std::int32_t _qOffset = 0;
  std::int32_t _pmax = 0;
  std::uint32_t _dlBw = 0;
  std::uint32_t _thresXHighP = 0;
  std::uint32_t _thresXLowP = 0;
  std::uint32_t _thresXHighQ = 0;
  std::uint32_t _thresXLowQ = 0;
  std::uint32_t _priority = 0;
  std::int32_t _frameType = 0;
  std::uint32_t _band = 0;
  Presence<std::uint16_t> _has;
};

extern template class Message<NbrEutra>;

}  // namespace vespscope
