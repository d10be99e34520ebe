// Values of an enumeration that several messages share.
//
// Written by messagegen from schema/lte.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

#include "messages/Enumeration.h"

namespace vespscope {

// State of the LTE RRC layer.
struct LteRrcState {
  enum : std::int32_t {
    KLTE_RRC_STATE_NULL = 0,
    KLTE_RRC_STATE_IDLE = 1,
    KLTE_RRC_STATE_ATMPT_CONNECTION = 2,
    KLTE_RRC_STATE_CONNECTED = 3,
    KLTE_RRC_STATE_ENDING = 4,
    KLTE_RRC_STATE_ATMPT_OUTBND_MOBILITY = 5,
    KLTE_RRC_STATE_ATMPT_INBND_MOBILITY = 6,
  };
  // What a field that is not set reads as.
  static constexpr std::int32_t firstDeclared = KLTE_RRC_STATE_NULL;
  static constexpr EnumerationName names[] = {
    {KLTE_RRC_STATE_NULL, "KLTE_RRC_STATE_NULL"},
    {KLTE_RRC_STATE_IDLE, "KLTE_RRC_STATE_IDLE"},
    {KLTE_RRC_STATE_ATMPT_CONNECTION, "KLTE_RRC_STATE_ATMPT_CONNECTION"},
    {KLTE_RRC_STATE_CONNECTED, "KLTE_RRC_STATE_CONNECTED"},
    {KLTE_RRC_STATE_ENDING, "KLTE_RRC_STATE_ENDING"},
    {KLTE_RRC_STATE_ATMPT_OUTBND_MOBILITY, "KLTE_RRC_STATE_ATMPT_OUTBND_MOBILITY"},
    {KLTE_RRC_STATE_ATMPT_INBND_MOBILITY, "KLTE_RRC_STATE_ATMPT_INBND_MOBILITY"},
  };
  // The name of `number`, if it has one.
  [[nodiscard]] static std::optional<std::string_view> nameOf(std::int32_t number) { return enumerationName(names, number); }
};

}  // namespace vespscope
