// RSRP, RSRQ and SINR of one cell on its first two antennas.
//
// Written by messagegen from schema/lte.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class RsrpRsrqSinr final : public Message<RsrpRsrqSinr> {
 public:
  static constexpr std::string_view className = "RsrpRsrqSinr";

  [[nodiscard]] std::uint32_t phyCellId() const noexcept { return _phyCellId; }
  void setPhyCellId(std::uint32_t phyCellId) noexcept {
    _phyCellId = phyCellId;
    _has.set(0);
  }
  void setHasPhyCellId(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasPhyCellId() const noexcept { return _has.test(0); }

  [[nodiscard]] std::int32_t rsrp0() const noexcept { return _rsrp0; }
  void setRsrp0(std::int32_t rsrp0) noexcept {
    _rsrp0 = rsrp0;
    _has.set(1);
  }
  void setHasRsrp0(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasRsrp0() const noexcept { return _has.test(1); }

  [[nodiscard]] std::int32_t rsrp1() const noexcept { return _rsrp1; }
  void setRsrp1(std::int32_t rsrp1) noexcept {
    _rsrp1 = rsrp1;
    _has.set(2);
  }
  void setHasRsrp1(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasRsrp1() const noexcept { return _has.test(2); }

  [[nodiscard]] std::int32_t rsrq0() const noexcept { return _rsrq0; }
  void setRsrq0(std::int32_t rsrq0) noexcept {
    _rsrq0 = rsrq0;
    _has.set(3);
  }
  void setHasRsrq0(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasRsrq0() const noexcept { return _has.test(3); }

  [[nodiscard]] std::int32_t rsrq1() const noexcept { return _rsrq1; }
  void setRsrq1(std::int32_t rsrq1) noexcept {
    _rsrq1 = rsrq1;
    _has.set(4);
  }
  void setHasRsrq1(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasRsrq1() const noexcept { return _has.test(4); }

  [[nodiscard]] std::int32_t sinr0() const noexcept { return _sinr0; }
  void setSinr0(std::int32_t sinr0) noexcept {
    _sinr0 = sinr0;
    _has.set(5);
  }
  void setHasSinr0(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasSinr0() const noexcept { return _has.test(5); }

  [[nodiscard]] std::int32_t sinr1() const noexcept { return _sinr1; }
  void setSinr1(std::int32_t sinr1) noexcept {
    _sinr1 = sinr1;
    _has.set(6);
  }
  void setHasSinr1(bool present) noexcept { _has.set(6, present); }
  [[nodiscard]] bool hasSinr1() const noexcept { return _has.test(6); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint32>(1, "phy_cell_id", &Self::_phyCellId, 0),
        numberField<NumberKind::sint32>(4, "rsrp0", &Self::_rsrp0, 1),
        numberField<NumberKind::sint32>(5, "rsrp1", &Self::_rsrp1, 2),
        numberField<NumberKind::sint32>(7, "rsrq0", &Self::_rsrq0, 3),
        numberField<NumberKind::sint32>(8, "rsrq1", &Self::_rsrq1, 4),
        numberField<NumberKind::sint32>(10, "sinr0", &Self::_sinr0, 5),
        numberField<NumberKind::sint32>(11, "sinr1", &Self::_sinr1, 6));
  }

 private:
  friend class Message<RsrpRsrqSinr>;

  std::uint32_t _phyCellId = 0;
  std::int32_t _rsrp0 = 0;
  std::int32_t _rsrp1 = 0;
  std::int32_t _rsrq0 = 0;
  std::int32_t _rsrq1 = 0;
  std::int32_t _sinr0 = 0;
  std::int32_t _sinr1 = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<RsrpRsrqSinr>;

}  // namespace vespscope
