// Measurement of one neighbouring UTRA cell.
//
// Written by messagegen from schema/lte.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class EgwErrcNbrUtraMeas final : public Message<EgwErrcNbrUtraMeas> {
 public:
  static constexpr std::string_view className = "EgwErrcNbrUtraMeas";

  [[nodiscard]] std::uint32_t uarfcn() const noexcept { return _uarfcn; }
  void setUarfcn(std::uint32_t uarfcn) noexcept {
    _uarfcn = uarfcn;
    _has.set(3);
  }
  void setHasUarfcn(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasUarfcn() const noexcept { return _has.test(3); }

  [[nodiscard]] std::uint32_t psc() const noexcept { return _psc; }
  void setPsc(std::uint32_t psc) noexcept {
    _psc = psc;
    _has.set(1);
  }
  void setHasPsc(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasPsc() const noexcept { return _has.test(1); }

  [[nodiscard]] std::int32_t rscp() const noexcept { return _rscp; }
  void setRscp(std::int32_t rscp) noexcept {
    _rscp = rscp;
    _has.set(2);
  }
  void setHasRscp(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasRscp() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t ecno() const noexcept { return _ecno; }
  void setEcno(std::uint32_t ecno) noexcept {
    _ecno = ecno;
    _has.set(0);
  }
  void setHasEcno(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasEcno() const noexcept { return _has.test(0); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint32>(1, "uarfcn", &Self::_uarfcn, 3),
        numberField<NumberKind::uint32>(2, "psc", &Self::_psc, 1),
        numberField<NumberKind::sint32>(3, "rscp", &Self::_rscp, 2),
        numberField<NumberKind::uint32>(4, "ecno", &Self::_ecno, 0));
  }

 private:
  friend class Message<EgwErrcNbrUtraMeas>;

  std::uint32_t _uarfcn = 0;
  std::uint32_t _psc = 0;
  std::int32_t _rscp = 0;
  std::uint32_t _ecno = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<EgwErrcNbrUtraMeas>;

}  // namespace vespscope
