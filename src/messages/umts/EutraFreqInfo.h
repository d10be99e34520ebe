// Reselection priority of one E-UTRA frequency.
//
// Written by messagegen from schema/umts.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class EutraFreqInfo final : public Message<EutraFreqInfo> {
 public:
  static constexpr std::string_view className = "EutraFreqInfo";

  [[nodiscard]] std::uint32_t earfcn() const noexcept { return _earfcn; }
  void setEarfcn(std::uint32_t earfcn) noexcept {
    _earfcn = earfcn;
    _has.set(0);
  }
  void setHasEarfcn(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasEarfcn() const noexcept { return _has.test(0); }

  [[nodiscard]] std::uint32_t prio() const noexcept { return _prio; }
  void setPrio(std::uint32_t prio) noexcept {
    _prio = prio;
    _has.set(1);
  }
  void setHasPrio(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasPrio() const noexcept { return _has.test(1); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint32>(1, "earfcn", &Self::_earfcn, 0),
        numberField<NumberKind::uint32>(2, "prio", &Self::_prio, 1));
  }

 private:
  friend class Message<EutraFreqInfo>;

  std::uint32_t _earfcn = 0;
  std::uint32_t _prio = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<EutraFreqInfo>;

}  // namespace vespscope
