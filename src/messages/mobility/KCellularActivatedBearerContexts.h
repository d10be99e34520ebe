// The activated bearers; the count is a field of its own, independent of the list.
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
#include "messages/mobility/BearerContext.h"

namespace vespscope {

class KCellularActivatedBearerContexts final : public Message<KCellularActivatedBearerContexts> {
 public:
  static constexpr std::string_view className = "KCellularActivatedBearerContexts";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  [[nodiscard]] std::uint32_t bearerContextCount() const noexcept { return _bearerContextCount; }
  void setBearerContextCount(std::uint32_t bearerContextCount) noexcept {
    _bearerContextCount = bearerContextCount;
    _has.set(1);
  }
  void setHasBearerContextCount(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasBearerContextCount() const noexcept { return _has.test(1); }

  void clearBearerContexts() noexcept { _bearerContexts.clear(); }
  void addBearerContexts(std::shared_ptr<BearerContext> bearerContexts) { _bearerContexts.add(std::move(bearerContexts)); }
  [[nodiscard]] std::size_t bearerContextsCount() const noexcept { return _bearerContexts.size(); }
  [[nodiscard]] const std::shared_ptr<BearerContext>& bearerContextsAtIndex(std::size_t index) const { return _bearerContexts.at(index); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        numberField<NumberKind::uint32>(2, "bearer_context_count", &Self::_bearerContextCount, 1),
        messageListField(3, "bearer_contexts", &Self::_bearerContexts));
  }

 private:
  friend class Message<KCellularActivatedBearerContexts>;

  std::uint64_t _timestamp = 0;
  MessageList<BearerContext> _bearerContexts;
  std::uint32_t _bearerContextCount = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularActivatedBearerContexts>;

}  // namespace vespscope
