// The reference decoders' results: insertion-ordered dictionaries with static keys, as a careful programmer would write
// them for this purpose only.
#pragma once

#include <cstdint>
#include <memory_resource>
#include <string>
#include <string_view>
#include <utility>
#include <variant>
#include <vector>

namespace peers {

enum class EnumerationText { own, view };

// Owns its texts and bytes; names of enumerations are copies, or views of the static names.
template <EnumerationText Names>
class OwningDictionary {
 public:
  struct Entry;
  struct Value;
  using List = std::vector<Value>;
  using Bytes = std::vector<std::uint8_t>;

  void reserve(std::size_t count) { entries_.reserve(count); }
  template <class Number>
  void number(std::string_view name, Number value) {
    entries_.emplace_back(name, value);
  }
  template <class Text>
  void text(std::string_view name, const Text& value) {
    entries_.emplace_back(name, std::string(value.data(), value.size()));
  }
  template <class Text>
  void bytes(std::string_view name, const Text& value) {
    entries_.emplace_back(name, Bytes(value.data(), value.data() + value.size()));
  }
  void enumeration(std::string_view name, std::string_view value, std::int32_t number) {
    if (value.empty()) return text(name, "(unknown: " + std::to_string(number) + ")");
    if constexpr (Names == EnumerationText::own) {
      text(name, value);
    } else {
      entries_.emplace_back(name, value);
    }
  }
  OwningDictionary& embedded(std::string_view name) {
    entries_.emplace_back(name, OwningDictionary());
    return std::get<OwningDictionary>(entries_.back().value.data);
  }
  OwningDictionary& element(std::string_view name) {
    if (entries_.empty() || entries_.back().name != name) entries_.emplace_back(name, List());
    List& list = std::get<List>(entries_.back().value.data);
    if (list.empty()) list.reserve(8);
    list.emplace_back(OwningDictionary());
    return std::get<OwningDictionary>(list.back().data);
  }
  template <class Range>
  void numbers(std::string_view name, const Range& range) {
    List list;
    for (const auto value : range) list.emplace_back(value);
    entries_.emplace_back(name, std::move(list));
  }
  [[nodiscard]] std::size_t size() const { return entries_.size(); }
  [[nodiscard]] const std::vector<Entry>& entries() const { return entries_; }

 private:
  std::vector<Entry> entries_;
};

template <EnumerationText Names>
struct OwningDictionary<Names>::Value {
  template <class Kind>
  explicit Value(Kind kind) : data(std::in_place_type<Kind>, std::move(kind)) {}
  std::variant<bool, std::uint32_t, std::int32_t, std::uint64_t, std::string, std::string_view, Bytes, List,
               OwningDictionary<Names>>
      data;
};
template <EnumerationText Names>
struct OwningDictionary<Names>::Entry {
  template <class Kind>
  Entry(std::string_view key, Kind kind) : name(key), value(std::move(kind)) {}
  std::string_view name;
  Value value;
};

// Everything in one arena, texts and bytes as views of the payload: valid while both exist.
class ArenaDictionary {
 public:
  struct Entry;
  struct Value;
  using List = std::pmr::vector<Value>;

  explicit ArenaDictionary(std::pmr::memory_resource* arena) : entries_(arena) {}

  void reserve(std::size_t count) { entries_.reserve(count); }
  template <class Number>
  void number(std::string_view name, Number value);
  template <class Text>
  void text(std::string_view name, const Text& value);
  template <class Text>
  void bytes(std::string_view name, const Text& value) {
    text(name, value);
  }
  void enumeration(std::string_view name, std::string_view value, std::int32_t number);
  ArenaDictionary& embedded(std::string_view name);
  ArenaDictionary& element(std::string_view name);
  template <class Range>
  void numbers(std::string_view name, const Range& range);
  [[nodiscard]] std::size_t size() const { return entries_.size(); }

 private:
  template <class Kind>
  Kind& create() {
    auto* arena = entries_.get_allocator().resource();
    return *new (arena->allocate(sizeof(Kind), alignof(Kind))) Kind(arena);  // freed with the arena
  }
  std::pmr::vector<Entry> entries_;
};

struct ArenaDictionary::Value {
  template <class Kind>
  explicit Value(Kind kind) : data(std::in_place_type<Kind>, kind) {}
  std::variant<bool, std::uint32_t, std::int32_t, std::uint64_t, std::string_view, List*, ArenaDictionary*> data;
};
struct ArenaDictionary::Entry {
  template <class Kind>
  Entry(std::string_view key, Kind kind) : name(key), value(kind) {}
  std::string_view name;
  Value value;
};

template <class Number>
void ArenaDictionary::number(std::string_view name, Number value) {
  entries_.emplace_back(name, value);
}
template <class Text>
void ArenaDictionary::text(std::string_view name, const Text& value) {
  entries_.emplace_back(name, std::string_view(value.data(), value.size()));
}
inline void ArenaDictionary::enumeration(std::string_view name, std::string_view value, std::int32_t number) {
  if (value.empty()) return this->number(name, number);
  entries_.emplace_back(name, value);
}
inline ArenaDictionary& ArenaDictionary::embedded(std::string_view name) {
  auto& dictionary = create<ArenaDictionary>();
  entries_.emplace_back(name, &dictionary);
  return dictionary;
}
inline ArenaDictionary& ArenaDictionary::element(std::string_view name) {
  if (entries_.empty() || entries_.back().name != name) entries_.emplace_back(name, &create<List>());
  auto& dictionary = create<ArenaDictionary>();
  std::get<List*>(entries_.back().value.data)->emplace_back(&dictionary);
  return dictionary;
}
template <class Range>
void ArenaDictionary::numbers(std::string_view name, const Range& range) {
  auto& list = create<List>();
  for (const auto value : range) list.emplace_back(value);
  entries_.emplace_back(name, &list);
}

}  // namespace peers
