// One activated bearer: its access point, addresses and name servers.
//
// Written by messagegen from schema/mobility.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <tuple>
#include <utility>

#include "messages/Message.h"

namespace vespscope {

class BearerContext final : public Message<BearerContext> {
 public:
  static constexpr std::string_view className = "BearerContext";

  // Type of an address.
  struct PdpType {
    enum : std::int32_t {
      PDP_TYPE_IPv4 = 0,
      PDP_TYPE_IPv6 = 1,
      PDP_TYPE_IPv4v6 = 2,
      PDP_TYPE_IPv4_PDN = 3,
      PDP_TYPE_IPv6_PDN = 4,
      PDP_TYPE_IPv4v6_PDN = 5,
      PDP_TYPE_PPP = 6,
      PDP_TYPE_NONE = 7,
    };
    // What a field that is not set reads as.
    static constexpr std::int32_t firstDeclared = PDP_TYPE_IPv4;
    static constexpr EnumerationName names[] = {
      {PDP_TYPE_IPv4, "PDP_TYPE_IPv4"},
      {PDP_TYPE_IPv6, "PDP_TYPE_IPv6"},
      {PDP_TYPE_IPv4v6, "PDP_TYPE_IPv4v6"},
      {PDP_TYPE_IPv4_PDN, "PDP_TYPE_IPv4_PDN"},
      {PDP_TYPE_IPv6_PDN, "PDP_TYPE_IPv6_PDN"},
      {PDP_TYPE_IPv4v6_PDN, "PDP_TYPE_IPv4v6_PDN"},
      {PDP_TYPE_PPP, "PDP_TYPE_PPP"},
      {PDP_TYPE_NONE, "PDP_TYPE_NONE"},
    };
    // The name of `number`, if it has one.
    [[nodiscard]] static std::optional<std::string_view> nameOf(std::int32_t number) { return enumerationName(names, number); }
  };

  [[nodiscard]] std::uint32_t cid() const noexcept { return _cid; }
  void setCid(std::uint32_t cid) noexcept {
    _cid = cid;
    _has.set(0);
  }
  void setHasCid(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasCid() const noexcept { return _has.test(0); }

  [[nodiscard]] std::uint32_t nsapi() const noexcept { return _nsapi; }
  void setNsapi(std::uint32_t nsapi) noexcept {
    _nsapi = nsapi;
    _has.set(2);
  }
  void setHasNsapi(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasNsapi() const noexcept { return _has.test(2); }

  // Null when absent.
  [[nodiscard]] const std::string* apn() const noexcept { return _apn.get(); }
  void setApn(std::string apn) { _apn = std::make_shared<const std::string>(std::move(apn)); }
  void clearApn() noexcept { _apn = nullptr; }
  [[nodiscard]] bool hasApn() const noexcept { return _apn != nullptr; }

  // A value of PdpType, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t pdpType() const noexcept { return hasPdpType() ? _pdpType : PdpType::firstDeclared; }
  void setPdpType(std::int32_t pdpType) noexcept {
    _pdpType = pdpType;
    _has.set(3);
  }
  void setHasPdpType(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasPdpType() const noexcept { return _has.test(3); }

  // Null when absent.
  [[nodiscard]] const Bytes* pdpAddr() const noexcept { return _pdpAddr.get(); }
  void setPdpAddr(Bytes pdpAddr) { _pdpAddr = std::make_shared<const Bytes>(std::move(pdpAddr)); }
  void clearPdpAddr() noexcept { _pdpAddr = nullptr; }
  [[nodiscard]] bool hasPdpAddr() const noexcept { return _pdpAddr != nullptr; }

  // A value of PdpType, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t primaryDnsType() const noexcept { return hasPrimaryDnsType() ? _primaryDnsType : PdpType::firstDeclared; }
  void setPrimaryDnsType(std::int32_t primaryDnsType) noexcept {
    _primaryDnsType = primaryDnsType;
    _has.set(4);
  }
  void setHasPrimaryDnsType(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasPrimaryDnsType() const noexcept { return _has.test(4); }

  // Null when absent.
  [[nodiscard]] const Bytes* primaryDnsAddr() const noexcept { return _primaryDnsAddr.get(); }
  void setPrimaryDnsAddr(Bytes primaryDnsAddr) { _primaryDnsAddr = std::make_shared<const Bytes>(std::move(primaryDnsAddr)); }
  void clearPrimaryDnsAddr() noexcept { _primaryDnsAddr = nullptr; }
  [[nodiscard]] bool hasPrimaryDnsAddr() const noexcept { return _primaryDnsAddr != nullptr; }

  // A value of PdpType, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t secondaryDnsType() const noexcept { return hasSecondaryDnsType() ? _secondaryDnsType : PdpType::firstDeclared; }
  void setSecondaryDnsType(std::int32_t secondaryDnsType) noexcept {
    _secondaryDnsType = secondaryDnsType;
    _has.set(5);
  }
  void setHasSecondaryDnsType(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasSecondaryDnsType() const noexcept { return _has.test(5); }

  // Null when absent.
  [[nodiscard]] const Bytes* secondaryDnsAddr() const noexcept { return _secondaryDnsAddr.get(); }
  void setSecondaryDnsAddr(Bytes secondaryDnsAddr) { _secondaryDnsAddr = std::make_shared<const Bytes>(std::move(secondaryDnsAddr)); }
  void clearSecondaryDnsAddr() noexcept { _secondaryDnsAddr = nullptr; }
  [[nodiscard]] bool hasSecondaryDnsAddr() const noexcept { return _secondaryDnsAddr != nullptr; }

  [[nodiscard]] bool isAddrIratMobile() const noexcept { return _isAddrIratMobile; }
  void setIsAddrIratMobile(bool isAddrIratMobile) noexcept {
    _isAddrIratMobile = isAddrIratMobile;
    _has.set(1);
  }
  void setHasIsAddrIratMobile(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasIsAddrIratMobile() const noexcept { return _has.test(1); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint32>(1, "cid", &Self::_cid, 0),
        numberField<NumberKind::uint32>(2, "nsapi", &Self::_nsapi, 2),
        contentField(3, "apn", &Self::_apn),
        enumerationField(4, "pdp_type", &Self::_pdpType, 3, PdpType::names),
        contentField(5, "pdp_addr", &Self::_pdpAddr),
        enumerationField(6, "primary_dns_type", &Self::_primaryDnsType, 4, PdpType::names),
        contentField(7, "primary_dns_addr", &Self::_primaryDnsAddr),
        enumerationField(8, "secondary_dns_type", &Self::_secondaryDnsType, 5, PdpType::names),
        contentField(9, "secondary_dns_addr", &Self::_secondaryDnsAddr),
        numberField<NumberKind::boolean>(10, "is_addr_irat_mobile", &Self::_isAddrIratMobile, 1));
  }

 private:
  friend class Message<BearerContext>;

  std::shared_ptr<const std::string> _apn;
  std::shared_ptr<const Bytes> _pdpAddr;
  std::shared_ptr<const Bytes> _primaryDnsAddr;
  std::shared_ptr<const Bytes> _secondaryDnsAddr;
  std::uint32_t _cid = 0;
  std::uint32_t _nsapi = 0;
  std::int32_t _pdpType = 0;
  std::int32_t _primaryDnsType = 0;
  std::int32_t _secondaryDnsType = 0;
  bool _isAddrIratMobile = false;
  Presence<std::uint8_t> _has;
};

extern template class Message<BearerContext>;

}  // namespace vespscope
