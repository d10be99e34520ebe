// Reselection priority of one UTRA frequency.
//
// Written by messagegen from schema/umts.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class UtraFreqInfo final : public Message<UtraFreqInfo> {
 public:
  static constexpr std::string_view className = "UtraFreqInfo";

  [[nodiscard]] std::uint32_t uarfcn() const noexcept { return _uarfcn; }
  void setUarfcn(std::uint32_t uarfcn) noexcept {
    _uarfcn = uarfcn;
    _has.set(1);
  }
  void setHasUarfcn(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasUarfcn() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t prio() const noexcept { return _prio; }
  void setPrio(std::uint32_t prio) noexcept {
    _prio = prio;
    _has.set(0);
  }
  void setHasPrio(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasPrio() const noexcept { return _has.test(0); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint32>(1, "uarfcn", &Self::_uarfcn, 1),
        numberField<NumberKind::uint32>(2, "prio", &Self::_prio, 0));
  }

 private:
  friend class Message<UtraFreqInfo>;

  std::uint32_t _uarfcn = 0;
  std::uint32_t _prio = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<UtraFreqInfo>;

}  // namespace vespscope
