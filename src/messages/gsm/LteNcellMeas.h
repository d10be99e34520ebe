// Measurement of one neighbouring LTE cell.
//
// Written by messagegen from schema/gsm.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class LteNcellMeas final : public Message<LteNcellMeas> {
 public:
  static constexpr std::string_view className = "LteNcellMeas";

  [[nodiscard]] std::uint32_t physicalCellId() const noexcept { return _physicalCellId; }
  void setPhysicalCellId(std::uint32_t physicalCellId) noexcept {
    _physicalCellId = physicalCellId;
    _has.set(2);
  }
  void setHasPhysicalCellId(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasPhysicalCellId() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t bandwidth() const noexcept { return _bandwidth; }
  void setBandwidth(std::uint32_t bandwidth) noexcept {
    _bandwidth = bandwidth;
    _has.set(0);
  }
  void setHasBandwidth(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasBandwidth() const noexcept { return _has.test(0); }

  [[nodiscard]] std::uint32_t rsrp() const noexcept { return _rsrp; }
  void setRsrp(std::uint32_t rsrp) noexcept {
    _rsrp = rsrp;
    _has.set(3);
  }
  void setHasRsrp(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasRsrp() const noexcept { return _has.test(3); }

  [[nodiscard]] std::uint32_t earfcn() const noexcept { return _earfcn; }
  void setEarfcn(std::uint32_t earfcn) noexcept {
    _earfcn = earfcn;
    _has.set(1);
  }
  void setHasEarfcn(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasEarfcn() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t rsrq() const noexcept { return _rsrq; }
  void setRsrq(std::uint32_t rsrq) noexcept {
    _rsrq = rsrq;
    _has.set(4);
  }
  void setHasRsrq(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasRsrq() const noexcept { return _has.test(4); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint32>(1, "physical_cell_id", &Self::_physicalCellId, 2),
        numberField<NumberKind::uint32>(2, "bandwidth", &Self::_bandwidth, 0),
        numberField<NumberKind::uint32>(3, "rsrp", &Self::_rsrp, 3),
        numberField<NumberKind::uint32>(4, "earfcn", &Self::_earfcn, 1),
        numberField<NumberKind::uint32>(5, "rsrq", &Self::_rsrq, 4));
  }

 private:
  friend class Message<LteNcellMeas>;

  std::uint32_t _physicalCellId = 0;
  std::uint32_t _bandwidth = 0;
  std::uint32_t _rsrp = 0;
  std::uint32_t _earfcn = 0;
  std::uint32_t _rsrq = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<LteNcellMeas>;

}  // namespace vespscope
