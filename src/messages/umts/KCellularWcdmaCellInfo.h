// Identity, band and frequency of the serving UMTS cell.
//
// Written by messagegen from schema/umts.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>
#include <tuple>

#include "messages/Message.h"
#include "messages/common/SystemBand.h"

namespace vespscope {

class KCellularWcdmaCellInfo final : public Message<KCellularWcdmaCellInfo> {
 public:
  static constexpr std::string_view className = "KCellularWcdmaCellInfo";

  // What the cell supports of HSPA.
  struct Hspa {
    enum : std::int32_t {
      SYS_HS_IND_HSDPA_HSUPA_UNSUPP_CELL = 0,
      SYS_HS_IND_HSDPA_SUPP_CELL = 1,
      SYS_HS_IND_HSUPA_SUPP_CELL = 2,
      SYS_HS_IND_HSDPA_HSUPA_SUPP_CELL = 3,
    };
    // What a field that is not set reads as.
    static constexpr std::int32_t firstDeclared = SYS_HS_IND_HSDPA_HSUPA_UNSUPP_CELL;
    static constexpr EnumerationName names[] = {
      {SYS_HS_IND_HSDPA_HSUPA_UNSUPP_CELL, "SYS_HS_IND_HSDPA_HSUPA_UNSUPP_CELL"},
      {SYS_HS_IND_HSDPA_SUPP_CELL, "SYS_HS_IND_HSDPA_SUPP_CELL"},
      {SYS_HS_IND_HSUPA_SUPP_CELL, "SYS_HS_IND_HSUPA_SUPP_CELL"},
      {SYS_HS_IND_HSDPA_HSUPA_SUPP_CELL, "SYS_HS_IND_HSDPA_HSUPA_SUPP_CELL"},
    };
    // The name of `number`, if it has one.
    [[nodiscard]] static std::optional<std::string_view> nameOf(std::int32_t number) { return enumerationName(names, number); }
  };

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  [[nodiscard]] std::uint32_t mcc() const noexcept { return _mcc; }
  void setMcc(std::uint32_t mcc) noexcept {
    _mcc = mcc;
    _has.set(5);
  }
  void setHasMcc(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasMcc() const noexcept { return _has.test(5); }

  [[nodiscard]] std::uint32_t mnc() const noexcept { return _mnc; }
  void setMnc(std::uint32_t mnc) noexcept {
    _mnc = mnc;
    _has.set(6);
  }
  void setHasMnc(bool present) noexcept { _has.set(6, present); }
  [[nodiscard]] bool hasMnc() const noexcept { return _has.test(6); }

  [[nodiscard]] std::uint32_t lac() const noexcept { return _lac; }
  void setLac(std::uint32_t lac) noexcept {
    _lac = lac;
    _has.set(4);
  }
  void setHasLac(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasLac() const noexcept { return _has.test(4); }

  [[nodiscard]] std::uint32_t cellId() const noexcept { return _cellId; }
  void setCellId(std::uint32_t cellId) noexcept {
    _cellId = cellId;
    _has.set(1);
  }
  void setHasCellId(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasCellId() const noexcept { return _has.test(1); }

  // A value of SystemBand, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t wcdmaBand() const noexcept { return hasWcdmaBand() ? _wcdmaBand : SystemBand::firstDeclared; }
  void setWcdmaBand(std::int32_t wcdmaBand) noexcept {
    _wcdmaBand = wcdmaBand;
    _has.set(9);
  }
  void setHasWcdmaBand(bool present) noexcept { _has.set(9, present); }
  [[nodiscard]] bool hasWcdmaBand() const noexcept { return _has.test(9); }

  [[nodiscard]] std::uint32_t dlUarfcn() const noexcept { return _dlUarfcn; }
  void setDlUarfcn(std::uint32_t dlUarfcn) noexcept {
    _dlUarfcn = dlUarfcn;
    _has.set(2);
  }
  void setHasDlUarfcn(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasDlUarfcn() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t psc() const noexcept { return _psc; }
  void setPsc(std::uint32_t psc) noexcept {
    _psc = psc;
    _has.set(8);
  }
  void setHasPsc(bool present) noexcept { _has.set(8, present); }
  [[nodiscard]] bool hasPsc() const noexcept { return _has.test(8); }

  [[nodiscard]] std::uint32_t numMncDigits() const noexcept { return _numMncDigits; }
  void setNumMncDigits(std::uint32_t numMncDigits) noexcept {
    _numMncDigits = numMncDigits;
    _has.set(7);
  }
  void setHasNumMncDigits(bool present) noexcept { _has.set(7, present); }
  [[nodiscard]] bool hasNumMncDigits() const noexcept { return _has.test(7); }

  // A value of Hspa, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t hspa() const noexcept { return hasHspa() ? _hspa : Hspa::firstDeclared; }
  void setHspa(std::int32_t hspa) noexcept {
    _hspa = hspa;
    _has.set(3);
  }
  void setHasHspa(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasHspa() const noexcept { return _has.test(3); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        numberField<NumberKind::uint32>(4, "mcc", &Self::_mcc, 5),
        numberField<NumberKind::uint32>(5, "mnc", &Self::_mnc, 6),
        numberField<NumberKind::uint32>(6, "lac", &Self::_lac, 4),
        numberField<NumberKind::uint32>(7, "cell_id", &Self::_cellId, 1),
        enumerationField(8, "wcdma_band", &Self::_wcdmaBand, 9, SystemBand::names),
        numberField<NumberKind::uint32>(9, "dl_uarfcn", &Self::_dlUarfcn, 2),
        numberField<NumberKind::uint32>(10, "psc", &Self::_psc, 8),
        numberField<NumberKind::uint32>(13, "num_mnc_digits", &Self::_numMncDigits, 7),
        enumerationField(14, "hspa", &Self::_hspa, 3, Hspa::names));
  }

 private:
  friend class Message<KCellularWcdmaCellInfo>;

  std::uint64_t _timestamp = 0;
  std::uint32_t _mcc = 0;
  std::uint32_t _mnc = 0;
  std::uint32_t _lac = 0;
  std::uint32_t _cellId = 0;
  std::int32_t _wcdmaBand = 0;
  std::uint32_t _dlUarfcn = 0;
  std::uint32_t _psc = 0;
  std::uint32_t _numMncDigits = 0;
  std::int32_t _hspa = 0;
  Presence<std::uint16_t> _has;
};

extern template class Message<KCellularWcdmaCellInfo>;

}  // namespace vespscope
