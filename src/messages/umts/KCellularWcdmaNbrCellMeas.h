// Measurements of UTRA, GSM and LTE neighbours while on UMTS.
//
// Written by messagegen from schema/umts.proto; change it there.
// clang-format off
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>
#include <tuple>
#include <utility>

#include "messages/Message.h"
#include "messages/umts/GsmCellMeasResult.h"
#include "messages/umts/LteCellMeasResult.h"
#include "messages/umts/UtraCellMeasResult.h"

namespace vespscope {

class KCellularWcdmaNbrCellMeas final : public Message<KCellularWcdmaNbrCellMeas> {
 public:
  static constexpr std::string_view className = "KCellularWcdmaNbrCellMeas";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  void clearMeasUtraResults() noexcept { _measUtraResults.clear(); }
  void addMeasUtraResult(std::shared_ptr<UtraCellMeasResult> measUtraResult) { _measUtraResults.add(std::move(measUtraResult)); }
  [[nodiscard]] std::size_t measUtraResultsCount() const noexcept { return _measUtraResults.size(); }
  [[nodiscard]] const std::shared_ptr<UtraCellMeasResult>& measUtraResultAtIndex(std::size_t index) const { return _measUtraResults.at(index); }

  void clearMeasGsmResults() noexcept { _measGsmResults.clear(); }
  void addMeasGsmResult(std::shared_ptr<GsmCellMeasResult> measGsmResult) { _measGsmResults.add(std::move(measGsmResult)); }
  [[nodiscard]] std::size_t measGsmResultsCount() const noexcept { return _measGsmResults.size(); }
  [[nodiscard]] const std::shared_ptr<GsmCellMeasResult>& measGsmResultAtIndex(std::size_t index) const { return _measGsmResults.at(index); }

  void clearMeasLteResults() noexcept { _measLteResults.clear(); }
  void addMeasLteResult(std::shared_ptr<LteCellMeasResult> measLteResult) { _measLteResults.add(std::move(measLteResult)); }
  [[nodiscard]] std::size_t measLteResultsCount() const noexcept { return _measLteResults.size(); }
  [[nodiscard]] const std::shared_ptr<LteCellMeasResult>& measLteResultAtIndex(std::size_t index) const { return _measLteResults.at(index); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        messageListField(2, "meas_utra_result", &Self::_measUtraResults),
        messageListField(3, "meas_gsm_result", &Self::_measGsmResults),
        messageListField(4, "meas_lte_result", &Self::_measLteResults));
  }

 private:
  friend class Message<KCellularWcdmaNbrCellMeas>;

  std::uint64_t _timestamp = 0;
  MessageList<UtraCellMeasResult> _measUtraResults;
  MessageList<GsmCellMeasResult> _measGsmResults;
  MessageList<LteCellMeasResult> _measLteResults;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularWcdmaNbrCellMeas>;

}  // namespace vespscope
