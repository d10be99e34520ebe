// Measurement of one neighbouring LTE cell.
//
// Written by messagegen from schema/umts.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class LteCellMeasResult final : public Message<LteCellMeasResult> {
 public:
  static constexpr std::string_view className = "LteCellMeasResult";

  [[nodiscard]] std::uint32_t earfcn() const noexcept { return _earfcn; }
  void setEarfcn(std::uint32_t earfcn) noexcept {
    _earfcn = earfcn;
    _has.set(0);
  }
  void setHasEarfcn(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasEarfcn() const noexcept { return _has.test(0); }

  [[nodiscard]] std::uint32_t phyCellId() const noexcept { return _phyCellId; }
  void setPhyCellId(std::uint32_t phyCellId) noexcept {
    _phyCellId = phyCellId;
    _has.set(2);
  }
  void setHasPhyCellId(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasPhyCellId() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t eutraBand() const noexcept { return _eutraBand; }
  void setEutraBand(std::uint32_t eutraBand) noexcept {
    _eutraBand = eutraBand;
    _has.set(1);
  }
  void setHasEutraBand(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasEutraBand() const noexcept { return _has.test(1); }

  [[nodiscard]] std::int32_t rsrp() const noexcept { return _rsrp; }
  void setRsrp(std::int32_t rsrp) noexcept {
    _rsrp = rsrp;
    _has.set(3);
  }
  void setHasRsrp(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasRsrp() const noexcept { return _has.test(3); }

  [[nodiscard]] std::int32_t rsrq() const noexcept { return _rsrq; }
  void setRsrq(std::int32_t rsrq) noexcept {
    _rsrq = rsrq;
    _has.set(4);
  }
  void setHasRsrq(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasRsrq() const noexcept { return _has.test(4); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint32>(1, "earfcn", &Self::_earfcn, 0),
        numberField<NumberKind::uint32>(2, "phy_cell_id", &Self::_phyCellId, 2),
        numberField<NumberKind::uint32>(3, "eutra_band", &Self::_eutraBand, 1),
        numberField<NumberKind::sint32>(4, "rsrp", &Self::_rsrp, 3),
        numberField<NumberKind::sint32>(5, "rsrq", &Self::_rsrq, 4));
  }

 private:
  friend class Message<LteCellMeasResult>;

  std::uint32_t _earfcn = 0;
  std::uint32_t _phyCellId = 0;
  std::uint32_t _eutraBand = 0;
  std::int32_t _rsrp = 0;
  std::int32_t _rsrq = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<LteCellMeasResult>;

}  // namespace vespscope
