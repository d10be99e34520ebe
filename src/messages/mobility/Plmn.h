// A network identity (3GPP TS 24.008 10.5.1.3).
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

class Plmn final : public Message<Plmn> {
 public:
  static constexpr std::string_view className = "Plmn";

  // Null when absent.
  [[nodiscard]] const Bytes* encodedPlmn() const noexcept { return _encodedPlmn.get(); }
  void setEncodedPlmn(Bytes encodedPlmn) { _encodedPlmn = std::make_shared<const Bytes>(std::move(encodedPlmn)); }
  void clearEncodedPlmn() noexcept { _encodedPlmn = nullptr; }
  [[nodiscard]] bool hasEncodedPlmn() const noexcept { return _encodedPlmn != nullptr; }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        contentField(1, "encoded_plmn", &Self::_encodedPlmn));
  }

 private:
  friend class Message<Plmn>;

  std::shared_ptr<const Bytes> _encodedPlmn;
  Presence<std::uint8_t> _has;
};

extern template class Message<Plmn>;

}  // namespace vespscope
