// Frequencies and bandwidths of the primary and up to two secondary component carriers.
//
// Written by messagegen from schema/lte.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class KCellularLteComponentCarrierInfo final : public Message<KCellularLteComponentCarrierInfo> {
 public:
  static constexpr std::string_view className = "KCellularLteComponentCarrierInfo";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  [[nodiscard]] std::uint32_t pccEarfcn() const noexcept { return _pccEarfcn; }
  void setPccEarfcn(std::uint32_t pccEarfcn) noexcept {
    _pccEarfcn = pccEarfcn;
    _has.set(2);
  }
  void setHasPccEarfcn(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasPccEarfcn() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t scc0Earfcn() const noexcept { return _scc0Earfcn; }
  void setScc0Earfcn(std::uint32_t scc0Earfcn) noexcept {
    _scc0Earfcn = scc0Earfcn;
    _has.set(4);
  }
  void setHasScc0Earfcn(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasScc0Earfcn() const noexcept { return _has.test(4); }

  [[nodiscard]] std::uint32_t scc1Earfcn() const noexcept { return _scc1Earfcn; }
  void setScc1Earfcn(std::uint32_t scc1Earfcn) noexcept {
    _scc1Earfcn = scc1Earfcn;
    _has.set(6);
  }
  void setHasScc1Earfcn(bool present) noexcept { _has.set(6, present); }
  [[nodiscard]] bool hasScc1Earfcn() const noexcept { return _has.test(6); }

  [[nodiscard]] std::uint32_t pccBandwidth() const noexcept { return _pccBandwidth; }
  void setPccBandwidth(std::uint32_t pccBandwidth) noexcept {
    _pccBandwidth = pccBandwidth;
    _has.set(1);
  }
  void setHasPccBandwidth(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasPccBandwidth() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t scc0Bandwidth() const noexcept { return _scc0Bandwidth; }
  void setScc0Bandwidth(std::uint32_t scc0Bandwidth) noexcept {
    _scc0Bandwidth = scc0Bandwidth;
    _has.set(3);
  }
  void setHasScc0Bandwidth(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasScc0Bandwidth() const noexcept { return _has.test(3); }

  [[nodiscard]] std::uint32_t scc1Bandwidth() const noexcept { return _scc1Bandwidth; }
  void setScc1Bandwidth(std::uint32_t scc1Bandwidth) noexcept {
    _scc1Bandwidth = scc1Bandwidth;
    _has.set(5);
  }
  void setHasScc1Bandwidth(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasScc1Bandwidth() const noexcept { return _has.test(5); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        numberField<NumberKind::uint32>(2, "pcc_earfcn", &Self::_pccEarfcn, 2),
        numberField<NumberKind::uint32>(3, "scc0_earfcn", &Self::_scc0Earfcn, 4),
        numberField<NumberKind::uint32>(4, "scc1_earfcn", &Self::_scc1Earfcn, 6),
        numberField<NumberKind::uint32>(5, "pcc_bandwidth", &Self::_pccBandwidth, 1),
        numberField<NumberKind::uint32>(6, "scc0_bandwidth", &Self::_scc0Bandwidth, 3),
        numberField<NumberKind::uint32>(7, "scc1_bandwidth", &Self::_scc1Bandwidth, 5));
  }

 private:
  friend class Message<KCellularLteComponentCarrierInfo>;

  std::uint64_t _timestamp = 0;
  std::uint32_t _pccEarfcn = 0;
  std::uint32_t _scc0Earfcn = 0;
  std::uint32_t _scc1Earfcn = 0;
  std::uint32_t _pccBandwidth = 0;
  std::uint32_t _scc0Bandwidth = 0;
  std::uint32_t _scc1Bandwidth = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularLteComponentCarrierInfo>;

}  // namespace vespscope
