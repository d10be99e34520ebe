// Measurements of neighbouring E-UTRA cells.
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
#include "messages/lte/EgwErrcNbrEutraMeas.h"

namespace vespscope {

class KCellularLteNbrEutraCellMeas final : public Message<KCellularLteNbrEutraCellMeas> {
 public:
  static constexpr std::string_view className = "KCellularLteNbrEutraCellMeas";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  void clearMeasNbrEutras() noexcept { _measNbrEutras.clear(); }
  void addMeasNbrEutra(std::shared_ptr<EgwErrcNbrEutraMeas> measNbrEutra) { _measNbrEutras.add(std::move(measNbrEutra)); }
  [[nodiscard]] std::size_t measNbrEutrasCount() const noexcept { return _measNbrEutras.size(); }
  [[nodiscard]] const std::shared_ptr<EgwErrcNbrEutraMeas>& measNbrEutraAtIndex(std::size_t index) const { return _measNbrEutras.at(index); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        messageListField(2, "meas_nbr_eutra", &Self::_measNbrEutras));
  }

 private:
  friend class Message<KCellularLteNbrEutraCellMeas>;

  std::uint64_t _timestamp = 0;
  MessageList<EgwErrcNbrEutraMeas> _measNbrEutras;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularLteNbrEutraCellMeas>;

}  // namespace vespscope
