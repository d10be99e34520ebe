// Elementary files read from the SIM card.
//
// Written by messagegen from schema/mobility.proto; change it there.
// clang-format off
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>
#include <tuple>
#include <utility>

#include "messages/Message.h"
#include "messages/mobility/ElementaryFile.h"

namespace vespscope {

class KCellularSimCardFiles final : public Message<KCellularSimCardFiles> {
 public:
  static constexpr std::string_view className = "KCellularSimCardFiles";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  void clearEfLists() noexcept { _efLists.clear(); }
  void addEfList(std::shared_ptr<ElementaryFile> efList) { _efLists.add(std::move(efList)); }
  [[nodiscard]] std::size_t efListsCount() const noexcept { return _efLists.size(); }
  [[nodiscard]] const std::shared_ptr<ElementaryFile>& efListAtIndex(std::size_t index) const { return _efLists.at(index); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        messageListField(2, "ef_list", &Self::_efLists));
  }

 private:
  friend class Message<KCellularSimCardFiles>;

  std::uint64_t _timestamp = 0;
  MessageList<ElementaryFile> _efLists;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularSimCardFiles>;

}  // namespace vespscope
