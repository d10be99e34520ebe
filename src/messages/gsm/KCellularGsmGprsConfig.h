// GPRS configuration of the serving GSM cell (3GPP TS 44.060, GPRS cell options).
//
// Written by messagegen from schema/gsm.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class KCellularGsmGprsConfig final : public Message<KCellularGsmGprsConfig> {
 public:
  static constexpr std::string_view className = "KCellularGsmGprsConfig";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  [[nodiscard]] bool gprsSup() const noexcept { return _gprsSup; }
  void setGprsSup(bool gprsSup) noexcept {
    _gprsSup = gprsSup;
    _has.set(5);
  }
  void setHasGprsSup(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasGprsSup() const noexcept { return _has.test(5); }

  [[nodiscard]] std::uint32_t rac() const noexcept { return _rac; }
  void setRac(std::uint32_t rac) noexcept {
    _rac = rac;
    _has.set(9);
  }
  void setHasRac(bool present) noexcept { _has.set(9, present); }
  [[nodiscard]] bool hasRac() const noexcept { return _has.test(9); }

  [[nodiscard]] bool spPgCy() const noexcept { return _spPgCy; }
  void setSpPgCy(bool spPgCy) noexcept {
    _spPgCy = spPgCy;
    _has.set(10);
  }
  void setHasSpPgCy(bool present) noexcept { _has.set(10, present); }
  [[nodiscard]] bool hasSpPgCy() const noexcept { return _has.test(10); }

  [[nodiscard]] std::uint32_t nco() const noexcept { return _nco; }
  void setNco(std::uint32_t nco) noexcept {
    _nco = nco;
    _has.set(6);
  }
  void setHasNco(bool present) noexcept { _has.set(6, present); }
  [[nodiscard]] bool hasNco() const noexcept { return _has.test(6); }

  [[nodiscard]] std::uint32_t nom() const noexcept { return _nom; }
  void setNom(std::uint32_t nom) noexcept {
    _nom = nom;
    _has.set(7);
  }
  void setHasNom(bool present) noexcept { _has.set(7, present); }
  [[nodiscard]] bool hasNom() const noexcept { return _has.test(7); }

  [[nodiscard]] std::uint32_t crHyst() const noexcept { return _crHyst; }
  void setCrHyst(std::uint32_t crHyst) noexcept {
    _crHyst = crHyst;
    _has.set(3);
  }
  void setHasCrHyst(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasCrHyst() const noexcept { return _has.test(3); }

  [[nodiscard]] std::uint32_t accThr() const noexcept { return _accThr; }
  void setAccThr(std::uint32_t accThr) noexcept {
    _accThr = accThr;
    _has.set(1);
  }
  void setHasAccThr(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasAccThr() const noexcept { return _has.test(1); }

  [[nodiscard]] bool extUplTbfSupported() const noexcept { return _extUplTbfSupported; }
  void setExtUplTbfSupported(bool extUplTbfSupported) noexcept {
    _extUplTbfSupported = extUplTbfSupported;
    _has.set(4);
  }
  void setHasExtUplTbfSupported(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasExtUplTbfSupported() const noexcept { return _has.test(4); }

  [[nodiscard]] std::uint32_t priorityClass() const noexcept { return _priorityClass; }
  void setPriorityClass(std::uint32_t priorityClass) noexcept {
    _priorityClass = priorityClass;
    _has.set(8);
  }
  void setHasPriorityClass(bool present) noexcept { _has.set(8, present); }
  [[nodiscard]] bool hasPriorityClass() const noexcept { return _has.test(8); }

  [[nodiscard]] std::uint32_t cellBarAccess2() const noexcept { return _cellBarAccess2; }
  void setCellBarAccess2(std::uint32_t cellBarAccess2) noexcept {
    _cellBarAccess2 = cellBarAccess2;
    _has.set(2);
  }
  void setHasCellBarAccess2(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasCellBarAccess2() const noexcept { return _has.test(2); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        numberField<NumberKind::boolean>(2, "gprs_sup", &Self::_gprsSup, 5),
        numberField<NumberKind::uint32>(3, "rac", &Self::_rac, 9),
        numberField<NumberKind::boolean>(4, "sp_pg_cy", &Self::_spPgCy, 10),
        numberField<NumberKind::uint32>(5, "nco", &Self::_nco, 6),
        numberField<NumberKind::uint32>(6, "nom", &Self::_nom, 7),
        numberField<NumberKind::uint32>(7, "cr_hyst", &Self::_crHyst, 3),
        numberField<NumberKind::uint32>(8, "acc_thr", &Self::_accThr, 1),
        numberField<NumberKind::boolean>(9, "ext_upl_tbf_supported", &Self::_extUplTbfSupported, 4),
        numberField<NumberKind::uint32>(10, "priority_class", &Self::_priorityClass, 8),
        numberField<NumberKind::uint32>(11, "cell_bar_access_2", &Self::_cellBarAccess2, 2));
  }

 private:
  friend class Message<KCellularGsmGprsConfig>;

  std::uint64_t _timestamp = 0;
  std::uint32_t _rac = 0;
  std::uint32_t _nco = 0;
  std::uint32_t _nom = 0;
  std::uint32_t _crHyst = 0;
  std::uint32_t _accThr = 0;
  std::uint32_t _priorityClass = 0;
  std::uint32_t _cellBarAccess2 = 0;
  bool _gprsSup = false;
  bool _spPgCy = false;
  bool _extUplTbfSupported = false;
  Presence<std::uint16_t> _has;
};

extern template class Message<KCellularGsmGprsConfig>;

}  // namespace vespscope
