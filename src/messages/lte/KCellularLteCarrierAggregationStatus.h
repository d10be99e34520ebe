// State and measurements of every secondary component carrier.
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
#include "messages/lte/SecondaryComponentCarrier.h"

namespace vespscope {

class KCellularLteCarrierAggregationStatus final : public Message<KCellularLteCarrierAggregationStatus> {
 public:
  static constexpr std::string_view className = "KCellularLteCarrierAggregationStatus";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  void clearSccLists() noexcept { _sccLists.clear(); }
  void addSccList(std::shared_ptr<SecondaryComponentCarrier> sccList) { _sccLists.add(std::move(sccList)); }
  [[nodiscard]] std::size_t sccListsCount() const noexcept { return _sccLists.size(); }
  [[nodiscard]] const std::shared_ptr<SecondaryComponentCarrier>& sccListAtIndex(std::size_t index) const { return _sccLists.at(index); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        messageListField(2, "scc_list", &Self::_sccLists));
  }

 private:
  friend class Message<KCellularLteCarrierAggregationStatus>;

  std::uint64_t _timestamp = 0;
  MessageList<SecondaryComponentCarrier> _sccLists;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularLteCarrierAggregationStatus>;

}  // namespace vespscope
