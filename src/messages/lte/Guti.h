// Globally unique temporary identity without its PLMN (3GPP TS 23.003 2.8).
//
// Written by messagegen from schema/lte.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class Guti final : public Message<Guti> {
 public:
  static constexpr std::string_view className = "Guti";

  [[nodiscard]] std::uint32_t mmegi() const noexcept { return _mmegi; }
  void setMmegi(std::uint32_t mmegi) noexcept {
    _mmegi = mmegi;
    _has.set(2);
  }
  void setHasMmegi(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasMmegi() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t mmec() const noexcept { return _mmec; }
  void setMmec(std::uint32_t mmec) noexcept {
    _mmec = mmec;
    _has.set(1);
  }
  void setHasMmec(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasMmec() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t mTmsi() const noexcept { return _mTmsi; }
  void setMTmsi(std::uint32_t mTmsi) noexcept {
    _mTmsi = mTmsi;
    _has.set(0);
  }
  void setHasMTmsi(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasMTmsi() const noexcept { return _has.test(0); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint32>(1, "mmegi", &Self::_mmegi, 2),
        numberField<NumberKind::uint32>(2, "mmec", &Self::_mmec, 1),
        numberField<NumberKind::uint32>(3, "m_tmsi", &Self::_mTmsi, 0));
  }

 private:
  friend class Message<Guti>;

  std::uint32_t _mmegi = 0;
  std::uint32_t _mmec = 0;
  std::uint32_t _mTmsi = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<Guti>;

}  // namespace vespscope
