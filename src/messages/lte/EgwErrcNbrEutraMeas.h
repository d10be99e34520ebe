// Measurement of one neighbouring E-UTRA cell.
//
// Written by messagegen from schema/lte.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class EgwErrcNbrEutraMeas final : public Message<EgwErrcNbrEutraMeas> {
 public:
  static constexpr std::string_view className = "EgwErrcNbrEutraMeas";

  [[nodiscard]] std::uint32_t nbrEarfcn() const noexcept { return _nbrEarfcn; }
  void setNbrEarfcn(std::uint32_t nbrEarfcn) noexcept {
    _nbrEarfcn = nbrEarfcn;
    _has.set(1);
  }
  void setHasNbrEarfcn(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasNbrEarfcn() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t nbrPhysCellId() const noexcept { return _nbrPhysCellId; }
  void setNbrPhysCellId(std::uint32_t nbrPhysCellId) noexcept {
    _nbrPhysCellId = nbrPhysCellId;
    _has.set(2);
  }
  void setHasNbrPhysCellId(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasNbrPhysCellId() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t freqBandInd() const noexcept { return _freqBandInd; }
  void setFreqBandInd(std::uint32_t freqBandInd) noexcept {
    _freqBandInd = freqBandInd;
    _has.set(0);
  }
  void setHasFreqBandInd(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasFreqBandInd() const noexcept { return _has.test(0); }

  [[nodiscard]] std::int32_t nbrRsrp() const noexcept { return _nbrRsrp; }
  void setNbrRsrp(std::int32_t nbrRsrp) noexcept {
    _nbrRsrp = nbrRsrp;
    _has.set(3);
  }
  void setHasNbrRsrp(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasNbrRsrp() const noexcept { return _has.test(3); }

  [[nodiscard]] std::int32_t nbrRsrq() const noexcept { return _nbrRsrq; }
  void setNbrRsrq(std::int32_t nbrRsrq) noexcept {
    _nbrRsrq = nbrRsrq;
    _has.set(4);
  }
  void setHasNbrRsrq(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasNbrRsrq() const noexcept { return _has.test(4); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint32>(1, "nbr_earfcn", &Self::_nbrEarfcn, 1),
        numberField<NumberKind::uint32>(2, "nbr_phys_cell_id", &Self::_nbrPhysCellId, 2),
        numberField<NumberKind::uint32>(3, "freq_band_ind", &Self::_freqBandInd, 0),
        numberField<NumberKind::sint32>(4, "nbr_rsrp", &Self::_nbrRsrp, 3),
        numberField<NumberKind::sint32>(5, "nbr_rsrq", &Self::_nbrRsrq, 4));
  }

 private:
  friend class Message<EgwErrcNbrEutraMeas>;

  std::uint32_t _nbrEarfcn = 0;
  std::uint32_t _nbrPhysCellId = 0;
  std::uint32_t _freqBandInd = 0;
  std::int32_t _nbrRsrp = 0;
  std::int32_t _nbrRsrq = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<EgwErrcNbrEutraMeas>;

}  // namespace vespscope
