#include "values/Value.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <memory>
#include <mutex>
#include <stdexcept>
#include <type_traits>
#include <unordered_map>

namespace vespscope {
namespace {

template <class Kind>
constexpr bool isIntegerKind = std::is_integral_v<Kind> && !std::is_same_v<Kind, bool>;
template <class Kind>
constexpr bool isNumberKind = std::is_arithmetic_v<Kind> && !std::is_same_v<Kind, bool>;

template <class One, class Other>
bool equalContents(const One& one, const Other& other) {
  if constexpr (std::is_same_v<One, Other>) {
    return one == other;
  } else if constexpr (isIntegerKind<One> && isIntegerKind<Other>) {
    return std::cmp_equal(one, other);
  } else if constexpr (isNumberKind<One> && isNumberKind<Other>) {
    return static_cast<long double>(one) == static_cast<long double>(other);
  } else {
    return false;
  }
}

}  // namespace

Record::Record(std::initializer_list<Entry> entries) {
  reserve(entries.size());
  for (const Entry& entry : entries) append(entry.key, entry.value);
}

Record::Record(const Record& other) {
  reserve(other.size_);
  copyEntries(other);
}

Record& Record::operator=(const Record& other) {
  if (this != &other) *this = Record(other);
  return *this;
}

Record& Record::operator=(Record&& other) noexcept {
  Record taken(std::move(other));  // which may lie within this one
  std::swap(entries_, taken.entries_);
  std::swap(size_, taken.size_);
  std::swap(capacity_, taken.capacity_);
  return *this;
}

void Record::assign(const Record& other, std::size_t more) {
  std::destroy(begin(), end());
  size_ = 0;
  reserve(other.size_ + more);
  copyEntries(other);
}

void Record::copyEntries(const Record& other) {
  // The size grows with the entries, so that those that are there go if one cannot be copied.
  for (const Entry* entry = other.begin(); size_ < other.size_; ++entry, ++size_) new (entries_ + size_) Entry(*entry);
}

void Record::release() noexcept {
  std::destroy(begin(), end());
  BlockCache::release(entries_, capacity_ * sizeof(Entry));
}

void Record::reserve(std::size_t count) {
  if (count <= capacity_) return;
  if (count > std::numeric_limits<std::uint32_t>::max()) throw std::length_error("a record of too many entries");
  auto* entries = static_cast<Entry*>(BlockCache::allocate(count * sizeof(Entry)));
  std::uninitialized_move(begin(), end(), entries);
  if (entries_ != nullptr) release();
  entries_ = entries;
  capacity_ = static_cast<std::uint32_t>(count);
}

void Record::set(Key key, Value value) {
  if (Value* present = find(key.view())) {
    *present = std::move(value);
  } else {
    append(std::move(key), std::move(value));
  }
}

bool Record::remove(std::string_view key) {
  Entry* found = std::find_if(begin(), end(), [key](const Entry& entry) { return entry.key.view() == key; });
  if (found == end()) return false;
  std::move(found + 1, end(), found);
  --size_;
  std::destroy_at(end());
  return true;
}

const Entry& Record::at(std::size_t position) const {
  if (position >= size_) throw std::out_of_range("a record has no entry " + std::to_string(position));
  return entries_[position];
}

bool operator==(const Record& left, const Record& right) {
  if (left.size() != right.size()) return false;
  return std::all_of(left.begin(), left.end(), [&right](const Entry& entry) {
    const Value* other = right.find(entry.key.view());
    return other != nullptr && *other == entry.value;
  });
}

void Value::copyOwned(const Value& other) {
  // The kind comes last: until then there is nothing to destroy.
  switch (other.tag_) {
    case Tag::text:
      new (&text_) std::shared_ptr<const std::string>(other.text_);
      break;
    case Tag::bytes:
      new (&bytes_) std::shared_ptr<const Bytes>(other.bytes_);
      break;
    case Tag::list:
      new (&list_) List(other.list_);
      break;
    default:
      new (&record_) Record(other.record_);
  }
  tag_ = other.tag_;
}

void Value::moveOwned(Value&& other) noexcept {
  tag_ = other.tag_;
  switch (tag_) {
    case Tag::text:
      new (&text_) std::shared_ptr<const std::string>(std::move(other.text_));
      break;
    case Tag::bytes:
      new (&bytes_) std::shared_ptr<const Bytes>(std::move(other.bytes_));
      break;
    case Tag::list:
      new (&list_) List(std::move(other.list_));
      return;
    default:
      new (&record_) Record(std::move(other.record_));
      return;
  }
  // A text or bytes that were moved from are no longer any.
  other.destroyOwned();
  other.tag_ = Tag::null;
  other.number_.uint64 = 0;
}

Value& Value::assignOwned(Value&& other) noexcept {
  Value taken(std::move(other));  // which may lie within this one
  this->~Value();
  new (this) Value(std::move(taken));
  return *this;
}

void Value::destroyOwned() noexcept {
  switch (tag_) {
    case Tag::text:
      std::destroy_at(&text_);
      break;
    case Tag::bytes:
      std::destroy_at(&bytes_);
      break;
    case Tag::list:
      std::destroy_at(&list_);
      break;
    default:
      std::destroy_at(&record_);
  }
}

Value::Data Value::data() const noexcept {
  return visit([](const auto& held) -> Data {
    if constexpr (std::is_class_v<std::decay_t<decltype(held)>> &&
                  !std::is_same_v<std::decay_t<decltype(held)>, std::string_view> &&
                  !std::is_same_v<std::decay_t<decltype(held)>, std::monostate>) {
      return &held;
    } else {
      return held;
    }
  });
}

std::optional<bool> Value::asBool() const noexcept {
  if (tag_ == Tag::boolean) return number_.boolean;
  return std::nullopt;
}

std::optional<std::int32_t> Value::asInt32() const noexcept {
  const std::optional<std::int64_t> value = asInteger();
  if (value && std::in_range<std::int32_t>(*value)) return static_cast<std::int32_t>(*value);
  return std::nullopt;
}

std::optional<float> Value::asFloat() const noexcept {
  return visit([](const auto& kind) -> std::optional<float> {
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
  });
}

std::optional<double> Value::asDouble() const noexcept {
  return visit([](const auto& kind) -> std::optional<double> {
    if constexpr (isNumberKind<std::decay_t<decltype(kind)>>) {
      return static_cast<double>(kind);
    } else {
      return std::nullopt;
    }
  });
}

const std::string* Value::asText() const {
  if (tag_ == Tag::text) return text_.get();
  if (tag_ != Tag::staticText) return nullptr;
  // As many strings as there are static texts, all of which the program brought along.
  static std::mutex mutex;
  static auto* texts = new std::unordered_map<const char*, std::string>;  // never destroyed: pointers are out
  const std::lock_guard lock(mutex);
  return &texts->try_emplace(staticText_.data, staticText_.data, staticText_.size).first->second;
}

bool operator==(const Value& left, const Value& right) {
  return left.visit([&right](const auto& one) {
    return right.visit([&one](const auto& other) { return equalContents(one, other); });
  });
}

bool isRecordList(const Value& value) noexcept {
  const List* list = value.asList();
  return list != nullptr &&
         std::all_of(list->begin(), list->end(), [](const Value& element) { return element.asRecord() != nullptr; });
}

}  // namespace vespscope
