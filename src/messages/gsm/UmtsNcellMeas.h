// Measurement of one neighbouring UMTS cell.
//
// Written by messagegen from schema/gsm.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class UmtsNcellMeas final : public Message<UmtsNcellMeas> {
 public:
  static constexpr std::string_view className = "UmtsNcellMeas";

  [[nodiscard]] std::uint32_t cellType() const noexcept { return _cellType; }
  void setCellType(std::uint32_t cellType) noexcept {
    _cellType = cellType;
    _has.set(0);
  }
  void setHasCellType(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasCellType() const noexcept { return _has.test(0); }

  [[nodiscard]] std::uint32_t cpichSc() const noexcept { return _cpichSc; }
  void setCpichSc(std::uint32_t cpichSc) noexcept {
    _cpichSc = cpichSc;
    _has.set(3);
  }
  void setHasCpichSc(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasCpichSc() const noexcept { return _has.test(3); }

  [[nodiscard]] std::uint32_t dlUarfcn() const noexcept { return _dlUarfcn; }
  void setDlUarfcn(std::uint32_t dlUarfcn) noexcept {
    _dlUarfcn = dlUarfcn;
    _has.set(4);
  }
  void setHasDlUarfcn(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasDlUarfcn() const noexcept { return _has.test(4); }

  [[nodiscard]] std::uint32_t cpichRscp() const noexcept { return _cpichRscp; }
  void setCpichRscp(std::uint32_t cpichRscp) noexcept {
    _cpichRscp = cpichRscp;
    _has.set(2);
  }
  void setHasCpichRscp(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasCpichRscp() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t cpichEcn0() const noexcept { return _cpichEcn0; }
  void setCpichEcn0(std::uint32_t cpichEcn0) noexcept {
    _cpichEcn0 = cpichEcn0;
    _has.set(1);
  }
  void setHasCpichEcn0(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasCpichEcn0() const noexcept { return _has.test(1); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint32>(1, "cell_type", &Self::_cellType, 0),
        numberField<NumberKind::uint32>(2, "cpich_sc", &Self::_cpichSc, 3),
        numberField<NumberKind::uint32>(3, "dl_uarfcn", &Self::_dlUarfcn, 4),
        numberField<NumberKind::uint32>(4, "cpich_rscp", &Self::_cpichRscp, 2),
        numberField<NumberKind::uint32>(5, "cpich_ecn0", &Self::_cpichEcn0, 1));
  }

 private:
  friend class Message<UmtsNcellMeas>;

  std::uint32_t _cellType = 0;
  std::uint32_t _cpichSc = 0;
  std::uint32_t _dlUarfcn = 0;
  std::uint32_t _cpichRscp = 0;
  std::uint32_t _cpichEcn0 = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<UmtsNcellMeas>;

}  // namespace vespscope
