#include "tools/vespctl/Json.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <string_view>
#include <type_traits>
#include <variant>

#include <nlohmann/json.hpp>

#include "values/Text.h"

namespace vespscope::tools {
namespace {

void appendHexadecimal(std::string& text, const Bytes& bytes) {
  constexpr std::string_view digits = "0123456789abcdef";
  for (const std::uint8_t byte : bytes) {
    text += digits[byte >> 4];
    text += digits[byte & 15];
  }
}

std::string hexadecimal(const Bytes& bytes) {
  std::string text;
  text.reserve(2 * bytes.size());
  appendHexadecimal(text, bytes);
  return text;
}

// Returns the code point at `at` if JSON permits it unescaped but a terminal interprets it, or if it changes the
// direction of the rest of the line: DEL, C1 controls, line and paragraph separators, directional marks. Else returns
// 0. `json` is UTF-8.
unsigned disturbing(std::string_view json, std::size_t at) {
  const auto byte = [json, at](std::size_t index) {
    return at + index < json.size() ? static_cast<unsigned char>(json[at + index]) : 0U;
  };
  if (byte(0) == 0x7F) return 0x7F;
  if (byte(0) == 0xC2 && byte(1) < 0xA0) return byte(1);
  if (byte(0) == 0xD8 && byte(1) == 0x9C) return 0x061C;
  if (byte(0) != 0xE2) return 0;
  const unsigned point = 0x2000 | (byte(1) & 0x3F) << 6 | (byte(2) & 0x3F);
  const bool disturbs = point == 0x200E || point == 0x200F || (point >= 0x2028 && point <= 0x202E) ||
                        (point >= 0x2066 && point <= 0x2069);
  return disturbs ? point : 0;
}

// Such characters occur in strings only, where JSON can escape them.
std::string escaped(std::string json) {
  if (std::none_of(json.begin(), json.end(), [](char byte) { return static_cast<unsigned char>(byte) >= 0x7F; })) {
    return json;
  }
  std::string out;
  for (std::size_t at = 0; at < json.size();) {
    const unsigned point = disturbing(json, at);
    if (point == 0) {
      out += json[at++];
      continue;
    }
    constexpr std::string_view digits = "0123456789abcdef";
    out += "\\u";
    for (const unsigned shift : {12U, 8U, 4U, 0U}) out += digits[point >> shift & 15];
    at += point < 0x80 ? 1 : point < 0x800 ? 2 : 3;
  }
  return out;
}

void appendString(std::string& out, std::string_view text) {
  if (isPlain(text) && text.find_first_of("\"\\") == std::string_view::npos) {
    out += '"';
    out += text;
    out += '"';
  } else {
    out += write(Json(text));
  }
}

void appendValue(std::string& out, const Value& value) {
  value.visit([&out](const auto& kind) {
    using Kind = std::decay_t<decltype(kind)>;
    if constexpr (std::is_same_v<Kind, std::monostate>) {
      out += "null";
    } else if constexpr (std::is_same_v<Kind, bool>) {
      out += kind ? "true" : "false";
    } else if constexpr (std::is_integral_v<Kind>) {
      std::array<char, 24> digits;
      out.append(digits.data(), std::to_chars(digits.data(), digits.data() + digits.size(), kind).ptr);
    } else if constexpr (std::is_same_v<Kind, std::string_view>) {
      appendString(out, kind);
    } else if constexpr (std::is_same_v<Kind, Bytes>) {
      out += '"';
      appendHexadecimal(out, kind);
      out += '"';
    } else if constexpr (std::is_same_v<Kind, List>) {
      out += '[';
      for (const Value& element : kind) {
        if (&element != &kind.front()) out += ',';
        appendValue(out, element);
      }
      out += ']';
    } else if constexpr (std::is_same_v<Kind, Record>) {
      appendJson(out, kind);
    } else {
      out += write(toJson(Value(kind)));  // floating point
    }
  });
}

// The 64-bit number whose shortest text is that of the 32-bit one: 1.4 stays 1.4.
double widened(float number) {
  if (!std::isfinite(number)) return static_cast<double>(number);
  std::array<char, 32> text;
  const auto written = std::to_chars(text.data(), text.data() + text.size(), number);
  double wide = 0;
  std::from_chars(text.data(), written.ptr, wide);
  return wide;
}

}  // namespace

Json toJson(const Value& value) {
  return value.visit([](const auto& kind) -> Json {
    using Kind = std::decay_t<decltype(kind)>;
    if constexpr (std::is_same_v<Kind, std::monostate>) {
      return nullptr;
    } else if constexpr (std::is_same_v<Kind, float>) {
      return widened(kind);
    } else if constexpr (std::is_same_v<Kind, Bytes>) {
      return hexadecimal(kind);
    } else if constexpr (std::is_same_v<Kind, List>) {
      Json list = Json::array();
      for (const Value& element : kind) list.push_back(toJson(element));
      return list;
    } else if constexpr (std::is_same_v<Kind, Record>) {
      return toJson(kind);
    } else {
      return kind;
    }
  });
}

Json toJson(const Record& record) {
  // A record's keys are distinct, so each is appended without a search.
  Json::object_t object;
  for (const Entry& entry : record) object.Container::emplace_back(entry.key.view(), toJson(entry.value));
  return object;
}

void appendJson(std::string& out, const Record& record) {
  out += '{';
  bool first = true;
  for (const Entry& entry : record) {
    if (!first) out += ',';
    first = false;
    appendString(out, entry.key.view());
    out += ':';
    appendValue(out, entry.value);
  }
  out += '}';
}

Json toJson(const RecordList& list) {
  Json json = Json::array();
  for (const Record& record : list) json.push_back(toJson(record));
  return json;
}

Json toJson(const std::optional<Record>& record) { return record ? toJson(*record) : Json(nullptr); }

std::string write(const Json& json, int indentation) {
  return escaped(json.dump(indentation, ' ', false, Json::error_handler_t::replace));
}

}  // namespace vespscope::tools
