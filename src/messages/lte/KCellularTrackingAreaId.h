// Tracking area identity (3GPP TS 23.003 19.4.2.3).
//
// Written by messagegen from schema/lte.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <memory>
#include <string_view>
#include <tuple>
#include <utility>

#include "messages/Message.h"

namespace vespscope {

class KCellularTrackingAreaId final : public Message<KCellularTrackingAreaId> {
 public:
  static constexpr std::string_view className = "KCellularTrackingAreaId";

  // Null when absent.
  [[nodiscard]] const Bytes* encodedPlmn() const noexcept { return _encodedPlmn.get(); }
  void setEncodedPlmn(Bytes encodedPlmn) { _encodedPlmn = std::make_shared<const Bytes>(std::move(encodedPlmn)); }
  void clearEncodedPlmn() noexcept { _encodedPlmn = nullptr; }
  [[nodiscard]] bool hasEncodedPlmn() const noexcept { return _encodedPlmn != nullptr; }

  [[nodiscard]] std::uint32_t tac() const noexcept { return _tac; }
  void setTac(std::uint32_t tac) noexcept {
    _tac = tac;
    _has.set(0);
  }
  void setHasTac(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTac() const noexcept { return _has.test(0); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        contentField(1, "encoded_plmn", &Self::_encodedPlmn),
        numberField<NumberKind::uint32>(2, "tac", &Self::_tac, 0));
  }

 private:
  friend class Message<KCellularTrackingAreaId>;

  std::shared_ptr<const Bytes> _encodedPlmn;
  std::uint32_t _tac = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularTrackingAreaId>;

}  // namespace vespscope
