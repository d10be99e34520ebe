// What a dictionary from the bus tells, each entry by the type it must have: any other type tells nothing, and neither
// do the values by which ModemManager says "unknown".
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "platform/ipc/IpcObject.h"

namespace vespscope::sources::modemmanager {

class Told {
 public:
  // Tells nothing of what is not there.
  explicit Told(const ipc::Dictionary* dictionary) : dictionary_(dictionary) {}

  // A text that is not empty.
  [[nodiscard]] std::optional<std::string> text(std::string_view name) const;
  // The path of another object; "/" stands for none.
  [[nodiscard]] std::optional<std::string> path(std::string_view name) const;
  [[nodiscard]] std::vector<std::string> paths(std::string_view name) const;
  // An unsigned number that is not all ones.
  [[nodiscard]] std::optional<std::uint32_t> number(std::string_view name) const;
  [[nodiscard]] std::optional<std::int32_t> integer(std::string_view name) const;
  // A measured quantity; -DBL_MAX, infinities and what is no number are not measured.
  [[nodiscard]] std::optional<double> quantity(std::string_view name) const;
  [[nodiscard]] std::optional<bool> flag(std::string_view name) const;
  // Bytes, at least one.
  [[nodiscard]] std::optional<Bytes> bytes(std::string_view name) const;
  // A dictionary within this one.
  [[nodiscard]] Told within(std::string_view name) const;
  // A number written in hexadecimal digits, not above `highest`.
  [[nodiscard]] std::optional<std::uint32_t> hexadecimal(std::string_view name, std::uint32_t highest) const;

 private:
  [[nodiscard]] const ipc::Object* find(std::string_view name) const;

  const ipc::Dictionary* dictionary_;
};

// A whole text of hexadecimal digits as a number, not above `highest`.
[[nodiscard]] std::optional<std::uint32_t> parseHexadecimal(std::string_view digits, std::uint32_t highest);

}  // namespace vespscope::sources::modemmanager
