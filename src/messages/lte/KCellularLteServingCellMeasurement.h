// Measurement of the serving LTE cell, one entry per receive antenna.
//
// Written by messagegen from schema/lte.proto; change it there.
// clang-format off
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>
#include <tuple>
#include <utility>

#include "messages/Message.h"
#include "messages/lte/RxInfo.h"

namespace vespscope {

class KCellularLteServingCellMeasurement final : public Message<KCellularLteServingCellMeasurement> {
 public:
  static constexpr std::string_view className = "KCellularLteServingCellMeasurement";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  [[nodiscard]] bool isConnectedMode() const noexcept { return _isConnectedMode; }
  void setIsConnectedMode(bool isConnectedMode) noexcept {
    _isConnectedMode = isConnectedMode;
    _has.set(1);
  }
  void setHasIsConnectedMode(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasIsConnectedMode() const noexcept { return _has.test(1); }

  void clearRxInfos() noexcept { _rxInfos.clear(); }
  void addRxInfo(std::shared_ptr<RxInfo> rxInfo) { _rxInfos.add(std::move(rxInfo)); }
  [[nodiscard]] std::size_t rxInfosCount() const noexcept { return _rxInfos.size(); }
  [[nodiscard]] const std::shared_ptr<RxInfo>& rxInfoAtIndex(std::size_t index) const { return _rxInfos.at(index); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        numberField<NumberKind::boolean>(2, "is_connected_mode", &Self::_isConnectedMode, 1),
        messageListField(3, "rx_info", &Self::_rxInfos));
  }

 private:
  friend class Message<KCellularLteServingCellMeasurement>;

  std::uint64_t _timestamp = 0;
  MessageList<RxInfo> _rxInfos;
  bool _isConnectedMode = false;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularLteServingCellMeasurement>;

}  // namespace vespscope
