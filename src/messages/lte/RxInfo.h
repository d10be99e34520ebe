// What one receive antenna measures.
//
// Written by messagegen from schema/lte.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class RxInfo final : public Message<RxInfo> {
 public:
  static constexpr std::string_view className = "RxInfo";

  [[nodiscard]] std::int32_t rssi() const noexcept { return _rssi; }
  void setRssi(std::int32_t rssi) noexcept {
    _rssi = rssi;
    _has.set(2);
  }
  void setHasRssi(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasRssi() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t rsrpRange() const noexcept { return _rsrpRange; }
  void setRsrpRange(std::uint32_t rsrpRange) noexcept {
    _rsrpRange = rsrpRange;
    _has.set(0);
  }
  void setHasRsrpRange(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasRsrpRange() const noexcept { return _has.test(0); }

  [[nodiscard]] std::uint32_t rsrqRange() const noexcept { return _rsrqRange; }
  void setRsrqRange(std::uint32_t rsrqRange) noexcept {
    _rsrqRange = rsrqRange;
    _has.set(1);
  }
  void setHasRsrqRange(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasRsrqRange() const noexcept { return _has.test(1); }

  [[nodiscard]] std::int32_t snr() const noexcept { return _snr; }
  void setSnr(std::int32_t snr) noexcept {
    _snr = snr;
    _has.set(3);
  }
  void setHasSnr(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasSnr() const noexcept { return _has.test(3); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::sint32>(1, "rssi", &Self::_rssi, 2),
        numberField<NumberKind::uint32>(2, "rsrp_range", &Self::_rsrpRange, 0),
        numberField<NumberKind::uint32>(3, "rsrq_range", &Self::_rsrqRange, 1),
        numberField<NumberKind::sint32>(4, "snr", &Self::_snr, 3));
  }

 private:
  friend class Message<RxInfo>;

  std::int32_t _rssi = 0;
  std::uint32_t _rsrpRange = 0;
  std::uint32_t _rsrqRange = 0;
  std::int32_t _snr = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<RxInfo>;

}  // namespace vespscope
