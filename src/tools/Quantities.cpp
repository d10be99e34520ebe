#include "tools/Quantities.h"

#include <charconv>
#include <memory>
#include <span>
#include <utility>

namespace vespscope {
namespace {

using Unit = std::pair<std::string_view, std::uint64_t>;

// Parses a positive whole number of one of the units, at most `limit` in total.
std::optional<std::uint64_t> parse(std::string_view words, std::span<const Unit> units, std::uint64_t limit) {
  std::uint64_t number = 0;
  const char* end = std::to_address(words.end());
  const auto [rest, error] = std::from_chars(std::to_address(words.begin()), end, number);
  if (error != std::errc() || number == 0) return std::nullopt;
  const std::string_view unit(rest, static_cast<std::size_t>(end - rest));
  for (const auto& [name, size] : units) {
    if (unit == name) return number <= limit / size ? std::optional(number * size) : std::nullopt;
  }
  return std::nullopt;
}

}  // namespace

std::optional<std::uint64_t> parseSize(std::string_view words) {
  static constexpr Unit units[] = {{"", 1}, {"K", 1 << 10}, {"M", 1 << 20}, {"G", 1 << 30}};
  return parse(words, units, std::uint64_t{1} << 50);
}

std::optional<std::chrono::seconds> parseDuration(std::string_view words) {
  static constexpr Unit units[] = {{"s", 1}, {"m", 60}, {"h", 3600}, {"d", 86'400}};
  const auto seconds = parse(words, units, std::uint64_t{86'400} * 36'500);
  if (!seconds) return std::nullopt;
  return std::chrono::seconds(*seconds);
}

}  // namespace vespscope
