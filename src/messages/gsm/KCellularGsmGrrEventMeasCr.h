// Measurements of GSM, UMTS and LTE neighbours while on GSM.
//
// Written by messagegen from schema/gsm.proto; change it there.
// clang-format off
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>
#include <tuple>
#include <utility>

#include "messages/Message.h"
#include "messages/gsm/GsmNcellMeas.h"
#include "messages/gsm/LteNcellMeas.h"
#include "messages/gsm/UmtsNcellMeas.h"

namespace vespscope {

class KCellularGsmGrrEventMeasCr final : public Message<KCellularGsmGrrEventMeasCr> {
 public:
  static constexpr std::string_view className = "KCellularGsmGrrEventMeasCr";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  void clearGsmNcellMeas() noexcept { _gsmNcellMeas.clear(); }
  void addGsmNcellMeas(std::shared_ptr<GsmNcellMeas> gsmNcellMeas) { _gsmNcellMeas.add(std::move(gsmNcellMeas)); }
  [[nodiscard]] std::size_t gsmNcellMeasCount() const noexcept { return _gsmNcellMeas.size(); }
  [[nodiscard]] const std::shared_ptr<GsmNcellMeas>& gsmNcellMeasAtIndex(std::size_t index) const { return _gsmNcellMeas.at(index); }

  void clearUmtsNcellMeas() noexcept { _umtsNcellMeas.clear(); }
  void addUmtsNcellMeas(std::shared_ptr<UmtsNcellMeas> umtsNcellMeas) { _umtsNcellMeas.add(std::move(umtsNcellMeas)); }
  [[nodiscard]] std::size_t umtsNcellMeasCount() const noexcept { return _umtsNcellMeas.size(); }
  [[nodiscard]] const std::shared_ptr<UmtsNcellMeas>& umtsNcellMeasAtIndex(std::size_t index) const { return _umtsNcellMeas.at(index); }

  void clearLteNcellMeas() noexcept { _lteNcellMeas.clear(); }
  void addLteNcellMeas(std::shared_ptr<LteNcellMeas> lteNcellMeas) { _lteNcellMeas.add(std::move(lteNcellMeas)); }
  [[nodiscard]] std::size_t lteNcellMeasCount() const noexcept { return _lteNcellMeas.size(); }
  [[nodiscard]] const std::shared_ptr<LteNcellMeas>& lteNcellMeasAtIndex(std::size_t index) const { return _lteNcellMeas.at(index); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        messageListField(2, "gsm_ncell_meas", &Self::_gsmNcellMeas),
        messageListField(3, "umts_ncell_meas", &Self::_umtsNcellMeas),
        messageListField(4, "lte_ncell_meas", &Self::_lteNcellMeas));
  }

 private:
  friend class Message<KCellularGsmGrrEventMeasCr>;

  std::uint64_t _timestamp = 0;
  MessageList<GsmNcellMeas> _gsmNcellMeas;
  MessageList<UmtsNcellMeas> _umtsNcellMeas;
  MessageList<LteNcellMeas> _lteNcellMeas;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularGsmGrrEventMeasCr>;

}  // namespace vespscope
