// What every mobility context shares: the subscriber, equivalent networks, forbidden areas.
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
#include "messages/lte/KCellularTrackingAreaId.h"
#include "messages/mobility/KCellularLocationAreaId.h"
#include "messages/mobility/Plmn.h"

namespace vespscope {

class KCellularMmCommonInfo final : public Message<KCellularMmCommonInfo> {
 public:
  static constexpr std::string_view className = "KCellularMmCommonInfo";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  // Null when absent.
  [[nodiscard]] const Bytes* imsi() const noexcept { return _imsi.get(); }
  void setImsi(Bytes imsi) { _imsi = std::make_shared<const Bytes>(std::move(imsi)); }
  void clearImsi() noexcept { _imsi = nullptr; }
  [[nodiscard]] bool hasImsi() const noexcept { return _imsi != nullptr; }

  void clearEplmnLists() noexcept { _eplmnLists.clear(); }
  void addEplmnList(std::shared_ptr<Plmn> eplmnList) { _eplmnLists.add(std::move(eplmnList)); }
  [[nodiscard]] std::size_t eplmnListsCount() const noexcept { return _eplmnLists.size(); }
  [[nodiscard]] const std::shared_ptr<Plmn>& eplmnListAtIndex(std::size_t index) const { return _eplmnLists.at(index); }

  void clearRoamingFlaiLists() noexcept { _roamingFlaiLists.clear(); }
  void addRoamingFlaiList(std::shared_ptr<KCellularLocationAreaId> roamingFlaiList) { _roamingFlaiLists.add(std::move(roamingFlaiList)); }
  [[nodiscard]] std::size_t roamingFlaiListsCount() const noexcept { return _roamingFlaiLists.size(); }
  [[nodiscard]] const std::shared_ptr<KCellularLocationAreaId>& roamingFlaiListAtIndex(std::size_t index) const { return _roamingFlaiLists.at(index); }

  void clearRegProvFlaiLists() noexcept { _regProvFlaiLists.clear(); }
  void addRegProvFlaiList(std::shared_ptr<KCellularLocationAreaId> regProvFlaiList) { _regProvFlaiLists.add(std::move(regProvFlaiList)); }
  [[nodiscard]] std::size_t regProvFlaiListsCount() const noexcept { return _regProvFlaiLists.size(); }
  [[nodiscard]] const std::shared_ptr<KCellularLocationAreaId>& regProvFlaiListAtIndex(std::size_t index) const { return _regProvFlaiLists.at(index); }

  void clearRoamingFtaiLists() noexcept { _roamingFtaiLists.clear(); }
  void addRoamingFtaiList(std::shared_ptr<KCellularTrackingAreaId> roamingFtaiList) { _roamingFtaiLists.add(std::move(roamingFtaiList)); }
  [[nodiscard]] std::size_t roamingFtaiListsCount() const noexcept { return _roamingFtaiLists.size(); }
  [[nodiscard]] const std::shared_ptr<KCellularTrackingAreaId>& roamingFtaiListAtIndex(std::size_t index) const { return _roamingFtaiLists.at(index); }

  void clearRegProvFtaiLists() noexcept { _regProvFtaiLists.clear(); }
  void addRegProvFtaiList(std::shared_ptr<KCellularTrackingAreaId> regProvFtaiList) { _regProvFtaiLists.add(std::move(regProvFtaiList)); }
  [[nodiscard]] std::size_t regProvFtaiListsCount() const noexcept { return _regProvFtaiLists.size(); }
  [[nodiscard]] const std::shared_ptr<KCellularTrackingAreaId>& regProvFtaiListAtIndex(std::size_t index) const { return _regProvFtaiLists.at(index); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        contentField(2, "imsi", &Self::_imsi),
        messageListField(3, "eplmn_list", &Self::_eplmnLists),
        messageListField(4, "roaming_flai_list", &Self::_roamingFlaiLists),
        messageListField(5, "reg_prov_flai_list", &Self::_regProvFlaiLists),
        messageListField(6, "roaming_ftai_list", &Self::_roamingFtaiLists),
        messageListField(7, "reg_prov_ftai_list", &Self::_regProvFtaiLists));
  }

 private:
  friend class Message<KCellularMmCommonInfo>;

  std::uint64_t _timestamp = 0;
  std::shared_ptr<const Bytes> _imsi;
  MessageList<Plmn> _eplmnLists;
  MessageList<KCellularLocationAreaId> _roamingFlaiLists;
  MessageList<KCellularLocationAreaId> _regProvFlaiLists;
  MessageList<KCellularTrackingAreaId> _roamingFtaiLists;
  MessageList<KCellularTrackingAreaId> _regProvFtaiLists;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularMmCommonInfo>;

}  // namespace vespscope
