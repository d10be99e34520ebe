// Reselection priority of one GSM frequency.
//
// Written by messagegen from schema/umts.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class GsmFreqInfo final : public Message<GsmFreqInfo> {
 public:
  static constexpr std::string_view className = "GsmFreqInfo";

  [[nodiscard]] std::uint32_t arfcn() const noexcept { return _arfcn; }
  void setArfcn(std::uint32_t arfcn) noexcept {
    _arfcn = arfcn;
    _has.set(0);
  }
  void setHasArfcn(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasArfcn() const noexcept { return _has.test(0); }

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
        numberField<NumberKind::uint32>(1, "arfcn", &Self::_arfcn, 0),
        numberField<NumberKind::uint32>(2, "prio", &Self::_prio, 1));
  }

 private:
  friend class Message<GsmFreqInfo>;

  std::uint32_t _arfcn = 0;
  std::uint32_t _prio = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<GsmFreqInfo>;

}  // namespace vespscope
