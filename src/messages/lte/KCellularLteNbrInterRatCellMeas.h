// Measurements of UTRA and GERAN neighbours while on LTE.
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
#include "messages/lte/EgwErrcNbrGeranMeas.h"
#include "messages/lte/EgwErrcNbrUtraMeas.h"

namespace vespscope {

class KCellularLteNbrInterRatCellMeas final : public Message<KCellularLteNbrInterRatCellMeas> {
 public:
  static constexpr std::string_view className = "KCellularLteNbrInterRatCellMeas";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  void clearMeasNbrUtras() noexcept { _measNbrUtras.clear(); }
  void addMeasNbrUtra(std::shared_ptr<EgwErrcNbrUtraMeas> measNbrUtra) { _measNbrUtras.add(std::move(measNbrUtra)); }
  [[nodiscard]] std::size_t measNbrUtrasCount() const noexcept { return _measNbrUtras.size(); }
  [[nodiscard]] const std::shared_ptr<EgwErrcNbrUtraMeas>& measNbrUtraAtIndex(std::size_t index) const { return _measNbrUtras.at(index); }

  void clearMeasNbrGerans() noexcept { _measNbrGerans.clear(); }
  void addMeasNbrGeran(std::shared_ptr<EgwErrcNbrGeranMeas> measNbrGeran) { _measNbrGerans.add(std::move(measNbrGeran)); }
  [[nodiscard]] std::size_t measNbrGeransCount() const noexcept { return _measNbrGerans.size(); }
  [[nodiscard]] const std::shared_ptr<EgwErrcNbrGeranMeas>& measNbrGeranAtIndex(std::size_t index) const { return _measNbrGerans.at(index); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        messageListField(2, "meas_nbr_utra", &Self::_measNbrUtras),
        messageListField(3, "meas_nbr_geran", &Self::_measNbrGerans));
  }

 private:
  friend class Message<KCellularLteNbrInterRatCellMeas>;

  std::uint64_t _timestamp = 0;
  MessageList<EgwErrcNbrUtraMeas> _measNbrUtras;
  MessageList<EgwErrcNbrGeranMeas> _measNbrGerans;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularLteNbrInterRatCellMeas>;

}  // namespace vespscope
