// The plain values every subsystem speaks: numbers, texts, byte strings, lists and records.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "values/Key.h"

namespace vespscope {

using Bytes = std::vector<std::uint8_t>;

class Value;
using List = std::vector<Value>;

struct Entry;

// A dictionary from text keys to values that keeps insertion order, so that rows have a stable order.
// Two records are equal when they hold the same keys with equal values, in whatever order.
class Record {
 public:
  Record();
  Record(std::initializer_list<Entry> entries);
  Record(const Record&);
  Record(Record&&) noexcept;
  Record& operator=(const Record&);
  Record& operator=(Record&&) noexcept;
  ~Record();

  [[nodiscard]] std::size_t size() const noexcept;
  [[nodiscard]] bool empty() const noexcept;
  void reserve(std::size_t count);

  // The value under `key`, or null when the record has no such key.
  [[nodiscard]] const Value* find(std::string_view key) const noexcept;
  [[nodiscard]] Value* find(std::string_view key) noexcept;

  // Replaces the value under `key` in its place, or adds the pair at the end.
  void set(Key key, Value value);
  // Adds a pair whose key the caller knows to be new (no search is made).
  void append(Key key, Value value);
  // Removes the pair under `key`; false when there was none.
  bool remove(std::string_view key);

  // The pair at `position` in insertion order; a position at or beyond size() is a programming error.
  [[nodiscard]] const Entry& at(std::size_t position) const;

  [[nodiscard]] const Entry* begin() const noexcept;
  [[nodiscard]] const Entry* end() const noexcept;
  [[nodiscard]] Entry* begin() noexcept;
  [[nodiscard]] Entry* end() noexcept;

  friend bool operator==(const Record& left, const Record& right);

 private:
  std::vector<Entry> entries_;
};

// One value. Numbers keep their width and signedness; equality between numbers is numeric.
class Value {
 public:
  Value() noexcept = default;  // null
  Value(bool value) noexcept : data_(value) {}
  Value(std::int32_t value) noexcept : data_(value) {}
  Value(std::uint32_t value) noexcept : data_(value) {}
  Value(std::int64_t value) noexcept : data_(value) {}
  Value(std::uint64_t value) noexcept : data_(value) {}
  Value(float value) noexcept : data_(value) {}
  Value(double value) noexcept : data_(value) {}
  Value(std::string value) noexcept : data_(std::move(value)) {}
  Value(std::string_view value) : data_(std::string(value)) {}
  Value(const char* value) : data_(std::string(value)) {}
  Value(Bytes value) noexcept : data_(std::move(value)) {}
  Value(List value) noexcept : data_(std::move(value)) {}
  Value(Record value) noexcept : data_(std::move(value)) {}

  [[nodiscard]] bool isNull() const noexcept;
  [[nodiscard]] bool isNumber() const noexcept;  // any number kind, booleans excluded

  [[nodiscard]] std::optional<bool> asBool() const noexcept;
  // The value when it is of an integer kind (booleans excluded) and in range, else empty.
  [[nodiscard]] std::optional<std::int64_t> asInteger() const noexcept;
  [[nodiscard]] std::optional<std::int32_t> asInt32() const noexcept;
  // The value when it is a number that a 32-bit float holds exactly, else empty.
  [[nodiscard]] std::optional<float> asFloat() const noexcept;
  // The value of any number kind (64-bit integers are rounded), else empty.
  [[nodiscard]] std::optional<double> asDouble() const noexcept;
  [[nodiscard]] const std::string* asText() const noexcept;
  [[nodiscard]] const Bytes* asBytes() const noexcept;
  [[nodiscard]] const List* asList() const noexcept;
  [[nodiscard]] const Record* asRecord() const noexcept;
  [[nodiscard]] List* asList() noexcept;
  [[nodiscard]] Record* asRecord() noexcept;

  using Data = std::variant<std::monostate, bool, std::int32_t, std::uint32_t, std::int64_t, std::uint64_t, float,
                            double, std::string, Bytes, List, Record>;
  [[nodiscard]] const Data& data() const noexcept { return data_; }

  friend bool operator==(const Value& left, const Value& right);

 private:
  Data data_;
};

struct Entry {
  Key key;
  Value value;
};

using RecordList = std::vector<Record>;

// The records of a list whose elements are all records; empty when `value` is anything else.
[[nodiscard]] std::optional<RecordList> recordListOf(const Value& value);

}  // namespace vespscope
