// The platform's inter-process objects: what commands carry to the baseband manager and events carry back.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <variant>
#include <vector>

#include "values/Value.h"

namespace vespscope::ipc {

enum class Type { null, boolean, int64, uint64, real, string, data, array, dictionary };

class Object;
using Array = std::vector<Object>;
using SharedBytes = std::shared_ptr<const Bytes>;  // not null

// Entries in the order in which they were set; setting an existing key replaces its value in place.
class Dictionary {
 public:
  void set(std::string_view key, Object value);
  void reserve(std::size_t count);
  [[nodiscard]] const Object* find(std::string_view key) const;
  // Removes the entry and returns its value; empty when there is no such entry.
  std::optional<Object> take(std::string_view key);
  [[nodiscard]] std::size_t size() const;
  [[nodiscard]] const std::vector<std::pair<std::string, Object>>& entries() const { return entries_; }

 private:
  std::vector<std::pair<std::string, Object>> entries_;
};

// Data is shared, for instance with a record made from the object, and never changed.
class Object {
 public:
  Object() = default;  // the null object
  explicit Object(bool value) : data_(value) {}
  explicit Object(std::int64_t value) : data_(value) {}
  explicit Object(std::uint64_t value) : data_(value) {}
  explicit Object(double value) : data_(value) {}
  explicit Object(std::string value) : data_(std::move(value)) {}
  explicit Object(Bytes value) : data_(std::make_shared<const Bytes>(std::move(value))) {}
  explicit Object(SharedBytes value) : data_(std::move(value)) {}
  explicit Object(Array value) : data_(std::move(value)) {}
  explicit Object(Dictionary value) : data_(std::move(value)) {}

  [[nodiscard]] Type type() const { return static_cast<Type>(data_.index()); }
  [[nodiscard]] const bool* asBool() const { return std::get_if<bool>(&data_); }
  [[nodiscard]] const std::int64_t* asInt64() const { return std::get_if<std::int64_t>(&data_); }
  [[nodiscard]] const std::string* asString() const { return std::get_if<std::string>(&data_); }
  [[nodiscard]] const Bytes* asData() const {
    const SharedBytes* bytes = std::get_if<SharedBytes>(&data_);
    return bytes == nullptr ? nullptr : bytes->get();
  }
  [[nodiscard]] const Array* asArray() const { return std::get_if<Array>(&data_); }
  [[nodiscard]] const Dictionary* asDictionary() const { return std::get_if<Dictionary>(&data_); }

  // In the order of `Type`.
  using Data = std::variant<std::monostate, bool, std::int64_t, std::uint64_t, double, std::string, SharedBytes, Array,
                            Dictionary>;
  [[nodiscard]] const Data& data() const { return data_; }

 private:
  Data data_;
};

// The approximate memory in bytes: the entries and their keys, texts and data.
[[nodiscard]] std::size_t contentSize(const Dictionary& dictionary);

// Returns the plain value of the same kind: null, numbers, text, bytes, lists and records, nested ones converted alike.
[[nodiscard]] Value toValue(const Object& object);
[[nodiscard]] Record toRecord(const Dictionary& dictionary);

}  // namespace vespscope::ipc
