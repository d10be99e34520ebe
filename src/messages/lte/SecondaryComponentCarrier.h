// One secondary component carrier (3GPP TS 36.321 5.13, activation and deactivation).
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

class SecondaryComponentCarrier final : public Message<SecondaryComponentCarrier> {
 public:
  static constexpr std::string_view className = "SecondaryComponentCarrier";

  // State of the carrier.
  struct State {
    enum : std::int32_t {
      SCC_STATE_DECONFIGURED = 0,
      SCC_STATE_CONFIGURED_DEACTIVATED = 1,
      SCC_STATE_ACTIVATED = 2,
    };
    // What a field that is not set reads as.
    static constexpr std::int32_t firstDeclared = SCC_STATE_DECONFIGURED;
    static constexpr EnumerationName names[] = {
      {SCC_STATE_DECONFIGURED, "SCC_STATE_DECONFIGURED"},
      {SCC_STATE_CONFIGURED_DEACTIVATED, "SCC_STATE_CONFIGURED_DEACTIVATED"},
      {SCC_STATE_ACTIVATED, "SCC_STATE_ACTIVATED"},
    };
    // The name of `number`, if it has one.
    [[nodiscard]] static std::optional<std::string_view> nameOf(std::int32_t number) { return enumerationName(names, number); }
  };

  [[nodiscard]] std::uint32_t index() const noexcept { return _index; }
  void setIndex(std::uint32_t index) noexcept {
    _index = index;
    _has.set(4);
  }
  void setHasIndex(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasIndex() const noexcept { return _has.test(4); }

  // A value of State, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t state() const noexcept { return hasState() ? _state : State::firstDeclared; }
  void setState(std::int32_t state) noexcept {
    _state = state;
    _has.set(10);
  }
  void setHasState(bool present) noexcept { _has.set(10, present); }
  [[nodiscard]] bool hasState() const noexcept { return _has.test(10); }

  [[nodiscard]] std::uint32_t pci() const noexcept { return _pci; }
  void setPci(std::uint32_t pci) noexcept {
    _pci = pci;
    _has.set(5);
  }
  void setHasPci(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasPci() const noexcept { return _has.test(5); }

  [[nodiscard]] std::uint32_t dlEarfcn() const noexcept { return _dlEarfcn; }
  void setDlEarfcn(std::uint32_t dlEarfcn) noexcept {
    _dlEarfcn = dlEarfcn;
    _has.set(1);
  }
  void setHasDlEarfcn(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasDlEarfcn() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t dlRfBand() const noexcept { return _dlRfBand; }
  void setDlRfBand(std::uint32_t dlRfBand) noexcept {
    _dlRfBand = dlRfBand;
    _has.set(2);
  }
  void setHasDlRfBand(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasDlRfBand() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t dlBandwidth() const noexcept { return _dlBandwidth; }
  void setDlBandwidth(std::uint32_t dlBandwidth) noexcept {
    _dlBandwidth = dlBandwidth;
    _has.set(0);
  }
  void setHasDlBandwidth(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasDlBandwidth() const noexcept { return _has.test(0); }

  [[nodiscard]] bool hasUplink() const noexcept { return _hasUplink; }
  void setHasUplink(bool hasUplink) noexcept {
    _hasUplink = hasUplink;
    _has.set(3);
  }
  void setHasHasUplink(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasHasUplink() const noexcept { return _has.test(3); }

  [[nodiscard]] std::uint32_t ulEarfcn() const noexcept { return _ulEarfcn; }
  void setUlEarfcn(std::uint32_t ulEarfcn) noexcept {
    _ulEarfcn = ulEarfcn;
    _has.set(12);
  }
  void setHasUlEarfcn(bool present) noexcept { _has.set(12, present); }
  [[nodiscard]] bool hasUlEarfcn() const noexcept { return _has.test(12); }

  [[nodiscard]] std::uint32_t ulRfBand() const noexcept { return _ulRfBand; }
  void setUlRfBand(std::uint32_t ulRfBand) noexcept {
    _ulRfBand = ulRfBand;
    _has.set(13);
  }
  void setHasUlRfBand(bool present) noexcept { _has.set(13, present); }
  [[nodiscard]] bool hasUlRfBand() const noexcept { return _has.test(13); }

  [[nodiscard]] std::uint32_t ulBandwidth() const noexcept { return _ulBandwidth; }
  void setUlBandwidth(std::uint32_t ulBandwidth) noexcept {
    _ulBandwidth = ulBandwidth;
    _has.set(11);
  }
  void setHasUlBandwidth(bool present) noexcept { _has.set(11, present); }
  [[nodiscard]] bool hasUlBandwidth() const noexcept { return _has.test(11); }

  [[nodiscard]] std::int32_t rsrp() const noexcept { return _rsrp; }
  void setRsrp(std::int32_t rsrp) noexcept {
    _rsrp = rsrp;
    _has.set(6);
  }
  void setHasRsrp(bool present) noexcept { _has.set(6, present); }
  [[nodiscard]] bool hasRsrp() const noexcept { return _has.test(6); }

  [[nodiscard]] std::int32_t rsrq() const noexcept { return _rsrq; }
  void setRsrq(std::int32_t rsrq) noexcept {
    _rsrq = rsrq;
    _has.set(7);
  }
  void setHasRsrq(bool present) noexcept { _has.set(7, present); }
  [[nodiscard]] bool hasRsrq() const noexcept { return _has.test(7); }

  [[nodiscard]] std::int32_t snr() const noexcept { return _snr; }
  void setSnr(std::int32_t snr) noexcept {
    _snr = snr;
    _has.set(9);
  }
  void setHasSnr(bool present) noexcept { _has.set(9, present); }
  [[nodiscard]] bool hasSnr() const noexcept { return _has.test(9); }

  [[nodiscard]] std::int32_t rssi() const noexcept { return _rssi; }
  void setRssi(std::int32_t rssi) noexcept {
    _rssi = rssi;
    _has.set(8);
  }
  void setHasRssi(bool present) noexcept { _has.set(8, present); }
  [[nodiscard]] bool hasRssi() const noexcept { return _has.test(8); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint32>(1, "index", &Self::_index, 4),
        enumerationField(2, "state", &Self::_state, 10, State::names),
        numberField<NumberKind::uint32>(3, "pci", &Self::_pci, 5),
        numberField<NumberKind::uint32>(4, "dl_earfcn", &Self::_dlEarfcn, 1),
        numberField<NumberKind::uint32>(5, "dl_rf_band", &Self::_dlRfBand, 2),
        numberField<NumberKind::uint32>(6, "dl_bandwidth", &Self::_dlBandwidth, 0),
        numberField<NumberKind::boolean>(7, "has_uplink", &Self::_hasUplink, 3),
        numberField<NumberKind::uint32>(8, "ul_earfcn", &Self::_ulEarfcn, 12),
        numberField<NumberKind::uint32>(9, "ul_rf_band", &Self::_ulRfBand, 13),
        numberField<NumberKind::uint32>(10, "ul_bandwidth", &Self::_ulBandwidth, 11),
        numberField<NumberKind::sint32>(11, "rsrp", &Self::_rsrp, 6),
        numberField<NumberKind::sint32>(12, "rsrq", &Self::_rsrq, 7),
        numberField<NumberKind::sint32>(13, "snr", &Self::_snr, 9),
        numberField<NumberKind::sint32>(14, "rssi", &Self::_rssi, 8));
  }

 private:
  friend class Message<SecondaryComponentCarrier>;

  std::uint32_t _index = 0;
  std::int32_t _state = 0;
  std::uint32_t _pci = 0;
  std::uint32_t _dlEarfcn = 0;
  std::uint32_t _dlRfBand = 0;
  std::uint32_t _dlBandwidth = 0;
  std::uint32_t _ulEarfcn = 0;
  std::uint32_t _ulRfBand = 0;
  std::uint32_t _ulBandwidth = 0;
  std::int32_t _rsrp = 0;
  std::int32_t _rsrq = 0;
  std::int32_t _snr = 0;
  std::int32_t _rssi = 0;
  bool _hasUplink = false;
  Presence<std::uint16_t> _has;
};

extern template class Message<SecondaryComponentCarrier>;

}  // namespace vespscope
