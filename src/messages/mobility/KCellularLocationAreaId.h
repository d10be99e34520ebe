// Location area identity (3GPP TS 23.003 4.1).
//
// Written by messagegen from schema/mobility.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <memory>
#include <string_view>
#include <tuple>
#include <utility>

#include "messages/Message.h"

namespace vespscope {

class KCellularLocationAreaId final : public Message<KCellularLocationAreaId> {
 public:
  static constexpr std::string_view className = "KCellularLocationAreaId";

  // Null when absent.
  [[nodiscard]] const Bytes* encodedPlmn() const noexcept { return _encodedPlmn.get(); }
  void setEncodedPlmn(Bytes encodedPlmn) { _encodedPlmn = std::make_shared<const Bytes>(std::move(encodedPlmn)); }
  void clearEncodedPlmn() noexcept { _encodedPlmn = nullptr; }
  [[nodiscard]] bool hasEncodedPlmn() const noexcept { return _encodedPlmn != nullptr; }

  [[nodiscard]] std::uint32_t lac() const noexcept { return _lac; }
  void setLac(std::uint32_t lac) noexcept {
    _lac = lac;
    _has.set(0);
  }
  void setHasLac(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasLac() const noexcept { return _has.test(0); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        contentField(1, "encoded_plmn", &Self::_encodedPlmn),
        numberField<NumberKind::uint32>(2, "lac", &Self::_lac, 0));
  }

 private:
  friend class Message<KCellularLocationAreaId>;

  std::shared_ptr<const Bytes> _encodedPlmn;
  std::uint32_t _lac = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularLocationAreaId>;

}  // namespace vespscope
