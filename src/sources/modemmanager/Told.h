// Typed access to a dictionary from the bus: an entry of another type counts as absent, and so do the values with which
// ModemManager reports "unknown".
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
  // Null: every entry is absent.
  explicit Told(const ipc::Dictionary* dictionary) : dictionary_(dictionary) {}

  // A text that is not empty.
  [[nodiscard]] std::optional<std::string> text(std::string_view name) const;
  // The path of another object; "/" means none.
  [[nodiscard]] std::optional<std::string> path(std::string_view name) const;
  [[nodiscard]] std::vector<std::string> paths(std::string_view name) const;
  // The first text of each structure in a list of structures.
  [[nodiscard]] std::vector<std::string> firstTexts(std::string_view name) const;
  // An unsigned number that is not all ones.
  [[nodiscard]] std::optional<std::uint32_t> number(std::string_view name) const;
  [[nodiscard]] std::optional<std::int32_t> integer(std::string_view name) const;
  // A measured quantity; -DBL_MAX, infinities and NaN count as not measured.
  [[nodiscard]] std::optional<double> quantity(std::string_view name) const;
  [[nodiscard]] std::optional<bool> flag(std::string_view name) const;
  // At least one byte.
  [[nodiscard]] std::optional<Bytes> bytes(std::string_view name) const;
  // A dictionary within this one.
  [[nodiscard]] Told within(std::string_view name) const;
  // A number written in hexadecimal digits, not above `highest`.
  [[nodiscard]] std::optional<std::uint32_t> hexadecimal(std::string_view name, std::uint32_t highest) const;

 private:
  [[nodiscard]] const ipc::Object* find(std::string_view name) const;

  const ipc::Dictionary* dictionary_;
};

// Parses a whole text of hexadecimal digits, not above `highest`.
[[nodiscard]] std::optional<std::uint32_t> parseHexadecimal(std::string_view digits, std::uint32_t highest);

}  // namespace vespscope::sources::modemmanager
