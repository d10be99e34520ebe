#include "values/Value.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <stdexcept>
#include <type_traits>

namespace vespscope {
namespace {

template <class Kind>
constexpr bool isIntegerKind = std::is_integral_v<Kind> && !std::is_same_v<Kind, bool>;
template <class Kind>
constexpr bool isNumberKind = std::is_arithmetic_v<Kind> && !std::is_same_v<Kind, bool>;

}  // namespace

Record::Record() = default;
Record::Record(std::initializer_list<Entry> entries) : entries_(entries) {}
Record::Record(const Record&) = default;
Record::Record(Record&&) noexcept = default;
Record& Record::operator=(const Record&) = default;
Record& Record::operator=(Record&&) noexcept = default;
Record::~Record() = default;

std::size_t Record::size() const noexcept { return entries_.size(); }
bool Record::empty() const noexcept { return entries_.empty(); }
void Record::reserve(std::size_t count) { entries_.reserve(count); }

const Value* Record::find(std::string_view key) const noexcept {
  for (const Entry& entry : entries_) {
    if (entry.key.view() == key) return &entry.value;
  }
  return nullptr;
}

Value* Record::find(std::string_view key) noexcept {
  return const_cast<Value*>(static_cast<const Record*>(this)->find(key));
}

void Record::set(Key key, Value value) {
  if (Value* present = find(key.view())) {
    *present = std::move(value);
  } else {
    append(std::move(key), std::move(value));
  }
}

void Record::append(Key key, Value value) { entries_.push_back({std::move(key), std::move(value)}); }

bool Record::remove(std::string_view key) {
  const auto found =
      std::find_if(entries_.begin(), entries_.end(), [key](const Entry& entry) { return entry.key.view() == key; });
  if (found == entries_.end()) return false;
  entries_.erase(found);
  return true;
}

const Entry& Record::at(std::size_t position) const { return entries_.at(position); }

const Entry* Record::begin() const noexcept { return entries_.data(); }
const Entry* Record::end() const noexcept { return entries_.data() + entries_.size(); }
Entry* Record::begin() noexcept { return entries_.data(); }
Entry* Record::end() noexcept { return entries_.data() + entries_.size(); }

bool operator==(const Record& left, const Record& right) {
  if (left.size() != right.size()) return false;
  return std::all_of(left.begin(), left.end(), [&right](const Entry& entry) {
    const Value* other = right.find(entry.key.view());
    return other != nullptr && *other == entry.value;
  });
}

bool Value::isNull() const noexcept { return std::holds_alternative<std::monostate>(data_); }

bool Value::isNumber() const noexcept {
  return std::visit([](const auto& kind) { return isNumberKind<std::decay_t<decltype(kind)>>; }, data_);
}

std::optional<bool> Value::asBool() const noexcept {
  if (const bool* value = std::get_if<bool>(&data_)) return *value;
  return std::nullopt;
}

std::optional<std::int64_t> Value::asInteger() const noexcept {
  return std::visit(
      [](const auto& kind) -> std::optional<std::int64_t> {
        if constexpr (isIntegerKind<std::decay_t<decltype(kind)>>) {
          if (std::in_range<std::int64_t>(kind)) return static_cast<std::int64_t>(kind);
        }
        return std::nullopt;
      },
      data_);
}

std::optional<std::int32_t> Value::asInt32() const noexcept {
  const std::optional<std::int64_t> value = asInteger();
  if (value && std::in_range<std::int32_t>(*value)) return static_cast<std::int32_t>(*value);
  return std::nullopt;
}

std::optional<float> Value::asFloat() const noexcept {
  return std::visit(
      [](const auto& kind) -> std::optional<float> {
        using Kind = std::decay_t<decltype(kind)>;
        if constexpr (isNumberKind<Kind>) {
          if constexpr (std::is_floating_point_v<Kind>) {
            if (std::isfinite(kind) && std::abs(kind) > static_cast<Kind>(std::numeric_limits<float>::max())) {
              return std::nullopt;
            }
            const float narrowed = static_cast<float>(kind);
            if (static_cast<Kind>(narrowed) == kind || std::isnan(kind)) return narrowed;
          } else {
            // Doubles hold every 32-bit integer; a 64-bit integer is exact when it comes back unchanged, and
            // the comparison with two to the 63rd or 64th keeps that conversion in range.
            const float narrowed = static_cast<float>(kind);
            const double limit = std::ldexp(1.0, std::numeric_limits<Kind>::digits);
            if (static_cast<double>(narrowed) < limit && static_cast<Kind>(narrowed) == kind) return narrowed;
          }
        }
        return std::nullopt;
      },
      data_);
}

std::optional<double> Value::asDouble() const noexcept {
  return std::visit(
      [](const auto& kind) -> std::optional<double> {
        if constexpr (isNumberKind<std::decay_t<decltype(kind)>>) {
          return static_cast<double>(kind);
        } else {
          return std::nullopt;
        }
      },
      data_);
}

const std::string* Value::asText() const noexcept { return std::get_if<std::string>(&data_); }
const Bytes* Value::asBytes() const noexcept { return std::get_if<Bytes>(&data_); }
const List* Value::asList() const noexcept { return std::get_if<List>(&data_); }
const Record* Value::asRecord() const noexcept { return std::get_if<Record>(&data_); }
List* Value::asList() noexcept { return std::get_if<List>(&data_); }
Record* Value::asRecord() noexcept { return std::get_if<Record>(&data_); }

bool operator==(const Value& left, const Value& right) {
  return std::visit(
      [](const auto& one, const auto& other) {
        using One = std::decay_t<decltype(one)>;
        using Other = std::decay_t<decltype(other)>;
        if constexpr (std::is_same_v<One, Other>) {
          return one == other;
        } else if constexpr (isIntegerKind<One> && isIntegerKind<Other>) {
          return std::cmp_equal(one, other);
        } else if constexpr (isNumberKind<One> && isNumberKind<Other>) {
          return static_cast<long double>(one) == static_cast<long double>(other);
        } else {
          return false;
        }
      },
      left.data(), right.data());
}

std::optional<RecordList> recordListOf(const Value& value) {
  const List* list = value.asList();
  if (list == nullptr) return std::nullopt;
  RecordList records;
  records.reserve(list->size());
  for (const Value& element : *list) {
    const Record* record = element.asRecord();
    if (record == nullptr) return std::nullopt;
    records.push_back(*record);
  }
  return records;
}

}  // namespace vespscope
