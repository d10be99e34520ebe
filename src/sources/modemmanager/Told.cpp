#include "sources/modemmanager/Told.h"

#include <charconv>
#include <cmath>
#include <limits>

namespace vespscope::sources::modemmanager {
namespace {

template <class Kind>
const Kind* as(const ipc::Object* object) {
  return object == nullptr ? nullptr : std::get_if<Kind>(&object->data());
}

}  // namespace

const ipc::Object* Told::find(std::string_view name) const {
  return dictionary_ == nullptr ? nullptr : dictionary_->find(name);
}

std::optional<std::string> Told::text(std::string_view name) const {
  const auto* text = as<std::string>(find(name));
  if (text == nullptr || text->empty()) return std::nullopt;
  return *text;
}

std::optional<std::string> Told::path(std::string_view name) const {
  std::optional<std::string> path = text(name);
  if (path == "/") return std::nullopt;
  return path;
}

std::vector<std::string> Told::paths(std::string_view name) const {
  std::vector<std::string> paths;
  const auto* array = as<ipc::Array>(find(name));
  if (array == nullptr) return paths;
  for (const ipc::Object& element : *array) {
    const std::string* path = element.asString();
    if (path != nullptr && !path->empty() && *path != "/") paths.push_back(*path);
  }
  return paths;
}

std::vector<std::string> Told::firstTexts(std::string_view name) const {
  std::vector<std::string> texts;
  const auto* array = as<ipc::Array>(find(name));
  if (array == nullptr) return texts;
  for (const ipc::Object& element : *array) {
    const ipc::Array* structure = element.asArray();
    const std::string* text = structure == nullptr || structure->empty() ? nullptr : structure->front().asString();
    if (text != nullptr) texts.push_back(*text);
  }
  return texts;
}

std::optional<std::uint32_t> Told::number(std::string_view name) const {
  const auto* number = as<std::uint64_t>(find(name));
  if (number == nullptr || *number >= std::numeric_limits<std::uint32_t>::max()) return std::nullopt;
  return static_cast<std::uint32_t>(*number);
}

std::optional<std::int32_t> Told::integer(std::string_view name) const {
  const auto* number = as<std::int64_t>(find(name));
  if (number == nullptr || *number < std::numeric_limits<std::int32_t>::min() ||
      *number > std::numeric_limits<std::int32_t>::max()) {
    return std::nullopt;
  }
  return static_cast<std::int32_t>(*number);
}

std::optional<double> Told::quantity(std::string_view name) const {
  const auto* number = as<double>(find(name));
  constexpr double beyondMeasure = 1e6;
  if (number == nullptr || !(std::abs(*number) < beyondMeasure)) return std::nullopt;
  return *number;
}

std::optional<bool> Told::flag(std::string_view name) const {
  const auto* flag = as<bool>(find(name));
  if (flag == nullptr) return std::nullopt;
  return *flag;
}

std::optional<Bytes> Told::bytes(std::string_view name) const {
  const ipc::Object* object = find(name);
  const Bytes* bytes = object == nullptr ? nullptr : object->asData();
  if (bytes == nullptr || bytes->empty()) return std::nullopt;
  return *bytes;
}

Told Told::within(std::string_view name) const { return Told(as<ipc::Dictionary>(find(name))); }

std::optional<std::uint32_t> Told::hexadecimal(std::string_view name, std::uint32_t highest) const {
  const auto* digits = as<std::string>(find(name));
  if (digits == nullptr) return std::nullopt;
  return parseHexadecimal(*digits, highest);
}

std::optional<std::uint32_t> parseHexadecimal(std::string_view digits, std::uint32_t highest) {
  std::uint32_t number = 0;
  const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), number, 16);
  if (digits.empty() || error != std::errc() || end != digits.data() + digits.size() || number > highest) {
    return std::nullopt;
  }
  return number;
}

}  // namespace vespscope::sources::modemmanager
