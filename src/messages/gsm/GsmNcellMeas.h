// Measurement of one neighbouring GSM cell.
//
// Written by messagegen from schema/gsm.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class GsmNcellMeas final : public Message<GsmNcellMeas> {
 public:
  static constexpr std::string_view className = "GsmNcellMeas";

  [[nodiscard]] std::uint32_t mcc() const noexcept { return _mcc; }
  void setMcc(std::uint32_t mcc) noexcept {
    _mcc = mcc;
    _has.set(4);
  }
  void setHasMcc(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasMcc() const noexcept { return _has.test(4); }

  [[nodiscard]] std::uint32_t mnc() const noexcept { return _mnc; }
  void setMnc(std::uint32_t mnc) noexcept {
    _mnc = mnc;
    _has.set(5);
  }
  void setHasMnc(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasMnc() const noexcept { return _has.test(5); }

  [[nodiscard]] std::uint32_t lac() const noexcept { return _lac; }
  void setLac(std::uint32_t lac) noexcept {
    _lac = lac;
    _has.set(3);
  }
  void setHasLac(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasLac() const noexcept { return _has.test(3); }

  [[nodiscard]] std::uint32_t ci() const noexcept { return _ci; }
  void setCi(std::uint32_t ci) noexcept {
    _ci = ci;
    _has.set(2);
  }
  void setHasCi(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasCi() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t bsic() const noexcept { return _bsic; }
  void setBsic(std::uint32_t bsic) noexcept {
    _bsic = bsic;
    _has.set(1);
  }
  void setHasBsic(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasBsic() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t arfcn() const noexcept { return _arfcn; }
  void setArfcn(std::uint32_t arfcn) noexcept {
    _arfcn = arfcn;
    _has.set(0);
  }
  void setHasArfcn(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasArfcn() const noexcept { return _has.test(0); }

  [[nodiscard]] std::uint32_t rxlev() const noexcept { return _rxlev; }
  void setRxlev(std::uint32_t rxlev) noexcept {
    _rxlev = rxlev;
    _has.set(6);
  }
  void setHasRxlev(bool present) noexcept { _has.set(6, present); }
  [[nodiscard]] bool hasRxlev() const noexcept { return _has.test(6); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint32>(1, "mcc", &Self::_mcc, 4),
        numberField<NumberKind::uint32>(2, "mnc", &Self::_mnc, 5),
        numberField<NumberKind::uint32>(3, "lac", &Self::_lac, 3),
        numberField<NumberKind::uint32>(4, "ci", &Self::_ci, 2),
        numberField<NumberKind::uint32>(5, "bsic", &Self::_bsic, 1),
        numberField<NumberKind::uint32>(6, "arfcn", &Self::_arfcn, 0),
        numberField<NumberKind::uint32>(7, "rxlev", &Self::_rxlev, 6));
  }

 private:
  friend class Message<GsmNcellMeas>;

  std::uint32_t _mcc = 0;
  std::uint32_t _mnc = 0;
  std::uint32_t _lac = 0;
  std::uint32_t _ci = 0;
  std::uint32_t _bsic = 0;
  std::uint32_t _arfcn = 0;
  std::uint32_t _rxlev = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<GsmNcellMeas>;

}  // namespace vespscope
