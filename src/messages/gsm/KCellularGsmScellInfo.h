// Identity, band and channel of the serving GSM cell.
//
// Written by messagegen from schema/gsm.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>
#include <tuple>

#include "messages/Message.h"
#include "messages/common/SystemBand.h"

namespace vespscope {

class KCellularGsmScellInfo final : public Message<KCellularGsmScellInfo> {
 public:
  static constexpr std::string_view className = "KCellularGsmScellInfo";

  // Whether a dedicated channel is in use; there is no value 0.
  struct State {
    enum : std::int32_t {
      DEDICATED_STATE = 1,
      NON_DEDICATED_STATE = 2,
    };
    // What a field that is not set reads as.
    static constexpr std::int32_t firstDeclared = DEDICATED_STATE;
    static constexpr EnumerationName names[] = {
      {DEDICATED_STATE, "DEDICATED_STATE"},
      {NON_DEDICATED_STATE, "NON_DEDICATED_STATE"},
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
    _has.set(6);
  }
  void setHasMcc(bool present) noexcept { _has.set(6, present); }
  [[nodiscard]] bool hasMcc() const noexcept { return _has.test(6); }

  [[nodiscard]] std::uint32_t mnc() const noexcept { return _mnc; }
  void setMnc(std::uint32_t mnc) noexcept {
    _mnc = mnc;
    _has.set(7);
  }
  void setHasMnc(bool present) noexcept { _has.set(7, present); }
  [[nodiscard]] bool hasMnc() const noexcept { return _has.test(7); }

  [[nodiscard]] std::uint32_t lac() const noexcept { return _lac; }
  void setLac(std::uint32_t lac) noexcept {
    _lac = lac;
    _has.set(5);
  }
  void setHasLac(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasLac() const noexcept { return _has.test(5); }

  [[nodiscard]] std::uint32_t cellId() const noexcept { return _cellId; }
  void setCellId(std::uint32_t cellId) noexcept {
    _cellId = cellId;
    _has.set(3);
  }
  void setHasCellId(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasCellId() const noexcept { return _has.test(3); }

  // A value of SystemBand, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t gsmBand() const noexcept { return hasGsmBand() ? _gsmBand : SystemBand::firstDeclared; }
  void setGsmBand(std::int32_t gsmBand) noexcept {
    _gsmBand = gsmBand;
    _has.set(4);
  }
  void setHasGsmBand(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasGsmBand() const noexcept { return _has.test(4); }

  [[nodiscard]] std::uint32_t arfcn() const noexcept { return _arfcn; }
  void setArfcn(std::uint32_t arfcn) noexcept {
    _arfcn = arfcn;
    _has.set(1);
  }
  void setHasArfcn(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasArfcn() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t bsic() const noexcept { return _bsic; }
  void setBsic(std::uint32_t bsic) noexcept {
    _bsic = bsic;
    _has.set(2);
  }
  void setHasBsic(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasBsic() const noexcept { return _has.test(2); }

  // A value of State, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t state() const noexcept { return hasState() ? _state : State::firstDeclared; }
  void setState(std::int32_t state) noexcept {
    _state = state;
    _has.set(9);
  }
  void setHasState(bool present) noexcept { _has.set(9, present); }
  [[nodiscard]] bool hasState() const noexcept { return _has.test(9); }

  [[nodiscard]] std::uint32_t numMncDigits() const noexcept { return _numMncDigits; }
  void setNumMncDigits(std::uint32_t numMncDigits) noexcept {
    _numMncDigits = numMncDigits;
    _has.set(8);
  }
  void setHasNumMncDigits(bool present) noexcept { _has.set(8, present); }
  [[nodiscard]] bool hasNumMncDigits() const noexcept { return _has.test(8); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        numberField<NumberKind::uint32>(4, "mcc", &Self::_mcc, 6),
        numberField<NumberKind::uint32>(5, "mnc", &Self::_mnc, 7),
        numberField<NumberKind::uint32>(6, "lac", &Self::_lac, 5),
        numberField<NumberKind::uint32>(7, "cell_id", &Self::_cellId, 3),
        enumerationField(8, "gsm_band", &Self::_gsmBand, 4, SystemBand::names),
        numberField<NumberKind::uint32>(9, "arfcn", &Self::_arfcn, 1),
        numberField<NumberKind::uint32>(10, "bsic", &Self::_bsic, 2),
        enumerationField(11, "state", &Self::_state, 9, State::names),
        numberField<NumberKind::uint32>(13, "num_mnc_digits", &Self::_numMncDigits, 8));
  }

 private:
  friend class Message<KCellularGsmScellInfo>;

  std::uint64_t _timestamp = 0;
  std::uint32_t _mcc = 0;
  std::uint32_t _mnc = 0;
  std::uint32_t _lac = 0;
  std::uint32_t _cellId = 0;
  std::int32_t _gsmBand = 0;
  std::uint32_t _arfcn = 0;
  std::uint32_t _bsic = 0;
  std::int32_t _state = 0;
  std::uint32_t _numMncDigits = 0;
  Presence<std::uint16_t> _has;
};

extern template class Message<KCellularGsmScellInfo>;

}  // namespace vespscope
