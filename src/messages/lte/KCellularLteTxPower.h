// LTE transmit power, one entry per subframe.
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
#include "messages/lte/TxPowerInfo.h"

namespace vespscope {

class KCellularLteTxPower final : public Message<KCellularLteTxPower> {
 public:
  static constexpr std::string_view className = "KCellularLteTxPower";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  void clearTxPowerInfos() noexcept { _txPowerInfos.clear(); }
  void addTxPowerInfo(std::shared_ptr<TxPowerInfo> txPowerInfo) { _txPowerInfos.add(std::move(txPowerInfo)); }
  [[nodiscard]] std::size_t txPowerInfosCount() const noexcept { return _txPowerInfos.size(); }
  [[nodiscard]] const std::shared_ptr<TxPowerInfo>& txPowerInfoAtIndex(std::size_t index) const { return _txPowerInfos.at(index); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        messageListField(2, "tx_power_info", &Self::_txPowerInfos));
  }

 private:
  friend class Message<KCellularLteTxPower>;

  std::uint64_t _timestamp = 0;
  MessageList<TxPowerInfo> _txPowerInfos;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularLteTxPower>;

}  // namespace vespscope
