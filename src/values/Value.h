// The plain values every subsystem speaks: numbers, texts, byte strings, lists and records.
#pragma once

#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <memory>
#include <new>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <variant>
#include <vector>

#include "values/BlockCache.h"
#include "values/Key.h"

namespace vespscope {

using Bytes = std::vector<std::uint8_t, CachedBlocks<std::uint8_t>>;

class Value;
using List = std::vector<Value, CachedBlocks<Value>>;

struct Entry;

// A dictionary from text keys to values that keeps insertion order, so that rows have a stable order.
// Two records are equal when they hold the same keys with equal values, in whatever order.
class Record {
 public:
  Record() noexcept = default;
  Record(std::initializer_list<Entry> entries);
  Record(const Record& other);
  Record(Record&& other) noexcept
      : entries_(std::exchange(other.entries_, nullptr)),
        size_(std::exchange(other.size_, 0)),
        capacity_(std::exchange(other.capacity_, 0)) {}
  Record& operator=(const Record& other);
  Record& operator=(Record&& other) noexcept;
  inline ~Record();

  [[nodiscard]] std::size_t size() const noexcept { return size_; }
  [[nodiscard]] bool empty() const noexcept { return size_ == 0; }
  void reserve(std::size_t count);
  // Becomes a copy of `other`, which must not lie in this record, with room for `more` entries besides. Memory that is
  // there is used again.
  void assign(const Record& other, std::size_t more);

  // The value under `key`, or null when the record has no such key.
  [[nodiscard]] inline const Value* find(std::string_view key) const noexcept;
  [[nodiscard]] inline Value* find(std::string_view key) noexcept;

  // Replaces the value under `key` in its place, or adds the pair at the end.
  void set(Key key, Value value);
  // Adds a pair whose key the caller knows to be new (no search is made). The value is made in its place from
  // `contents`, which must not lie in this record.
  template <class... Contents>
  inline Value& append(Key key, Contents&&... contents);
  // Removes the pair under `key`; false when there was none.
  bool remove(std::string_view key);

  // The pair at `position` in insertion order; a position at or beyond size() is a programming error.
  [[nodiscard]] const Entry& at(std::size_t position) const;

  [[nodiscard]] const Entry* begin() const noexcept { return entries_; }
  [[nodiscard]] inline const Entry* end() const noexcept;
  [[nodiscard]] Entry* begin() noexcept { return entries_; }
  [[nodiscard]] inline Entry* end() noexcept;

  friend bool operator==(const Record& left, const Record& right);

 private:
  void release() noexcept;
  // Into room that is there, in an empty record.
  void copyEntries(const Record& other);

  // Not a vector: adding a number to room that is there has to be a few stores.
  Entry* entries_ = nullptr;
  std::uint32_t size_ = 0;
  std::uint32_t capacity_ = 0;
};

// A whole number of any kind.
struct Integer {
  std::uint64_t magnitude;
  bool negative;
};

// One value. Numbers keep their width and signedness; equality between numbers is numeric.
//
// Made for being made: a dictionary of twenty numbers is made for every event, so a value is a tag and a union whose
// numbers cost nothing to copy or destroy. Texts and bytes cannot be changed in place; copies share them.
class Value {
 public:
  Value() noexcept : number_{.uint64 = 0} {}  // null
  Value(bool value) noexcept : number_{.boolean = value}, tag_(Tag::boolean) {}
  Value(std::int32_t value) noexcept : number_{.int64 = value}, tag_(Tag::int32) {}
  Value(std::uint32_t value) noexcept : number_{.uint64 = value}, tag_(Tag::uint32) {}
  Value(std::int64_t value) noexcept : number_{.int64 = value}, tag_(Tag::int64) {}
  Value(std::uint64_t value) noexcept : number_{.uint64 = value}, tag_(Tag::uint64) {}
  Value(float value) noexcept : number_{.float32 = value}, tag_(Tag::float32) {}
  Value(double value) noexcept : number_{.float64 = value}, tag_(Tag::float64) {}
  Value(std::string value) : Value(makeCached<const std::string>(std::move(value))) {}
  Value(std::string_view value) : Value(std::string(value)) {}
  Value(const char* value) : Value(std::string(value)) {}
  Value(Bytes value) : Value(makeCached<const Bytes>(std::move(value))) {}
  Value(List value) noexcept : tag_(Tag::list) { new (&list_) List(std::move(value)); }
  inline Value(Record value) noexcept;
  // Shared with other values; not null.
  Value(std::shared_ptr<const std::string> value) noexcept : tag_(Tag::text) {
    new (&text_) std::shared_ptr<const std::string>(std::move(value));
  }
  Value(std::shared_ptr<const Bytes> value) noexcept : tag_(Tag::bytes) {
    new (&bytes_) std::shared_ptr<const Bytes>(std::move(value));
  }
  // From text that outlives every value, such as an enumeration's names: no memory is taken.
  static Value ofStatic(std::string_view text) noexcept {
    Value value;
    value.tag_ = Tag::staticText;
    value.staticText_ = {text.data(), text.size()};
    return value;
  }

  Value(const Value& other) {
    if (other.owning()) {
      copyOwned(other);
    } else {
      takePlain(other);
    }
  }
  Value(Value&& other) noexcept {
    if (other.owning()) {
      moveOwned(std::move(other));
    } else {
      takePlain(other);
    }
  }
  Value& operator=(const Value& other) {
    if (this != &other) *this = Value(other);
    return *this;
  }
  Value& operator=(Value&& other) noexcept {
    if (this == &other) return *this;
    if (owning() || other.owning()) return assignOwned(std::move(other));
    takePlain(other);
    return *this;
  }
  ~Value() {
    if (owning()) destroyOwned();
  }

  [[nodiscard]] bool isNull() const noexcept { return tag_ == Tag::null; }
  // Any number kind, booleans excluded.
  [[nodiscard]] bool isNumber() const noexcept { return tag_ >= Tag::int32 && tag_ <= Tag::float64; }

  // Any integer kind, booleans excluded.
  [[nodiscard]] bool isInteger() const noexcept { return tag_ >= Tag::int32 && tag_ <= Tag::uint64; }

  [[nodiscard]] std::optional<bool> asBool() const noexcept;
  // The value of an integer kind, for which isInteger() holds.
  [[nodiscard]] Integer integer() const noexcept {
    const bool negative = tag_ != Tag::uint64 && number_.int64 < 0;
    return {negative ? 0 - number_.uint64 : number_.uint64, negative};
  }
  // The value when it is of an integer kind (booleans excluded) and in range, else empty.
  [[nodiscard]] std::optional<std::int64_t> asInteger() const noexcept {
    if (!isInteger() || (tag_ == Tag::uint64 && number_.int64 < 0)) return std::nullopt;
    return number_.int64;
  }
  [[nodiscard]] std::optional<std::int32_t> asInt32() const noexcept;
  // The value when it is a number that a 32-bit float holds exactly, else empty.
  [[nodiscard]] std::optional<float> asFloat() const noexcept;
  // The value of any number kind (64-bit integers are rounded), else empty.
  [[nodiscard]] std::optional<double> asDouble() const noexcept;
  // A static text is kept as a string for good once it was asked for; to look at texts, visit().
  [[nodiscard]] const std::string* asText() const;
  [[nodiscard]] const Bytes* asBytes() const noexcept { return tag_ == Tag::bytes ? bytes_.get() : nullptr; }
  [[nodiscard]] const List* asList() const noexcept { return tag_ == Tag::list ? &list_ : nullptr; }
  [[nodiscard]] const Record* asRecord() const noexcept { return tag_ == Tag::record ? &record_ : nullptr; }
  [[nodiscard]] List* asList() noexcept { return tag_ == Tag::list ? &list_ : nullptr; }
  [[nodiscard]] Record* asRecord() noexcept { return tag_ == Tag::record ? &record_ : nullptr; }

  // Calls `visitor` with what the value holds: std::monostate for null, a number, std::string_view, const Bytes&,
  // const List& or const Record&.
  template <class Visitor>
  inline decltype(auto) visit(Visitor&& visitor) const;

  // What the value holds, as a variant of views of it.
  using Data = std::variant<std::monostate, bool, std::int32_t, std::uint32_t, std::int64_t, std::uint64_t, float,
                            double, std::string_view, const Bytes*, const List*, const Record*>;
  [[nodiscard]] Data data() const noexcept;

  friend bool operator==(const Value& left, const Value& right);

 private:
  // From `text` on, the value owns something.
  enum class Tag : std::uint8_t {
    null,
    boolean,
    int32,
    uint32,
    int64,
    uint64,
    float32,
    float64,
    staticText,
    text,
    bytes,
    list,
    record
  };
  // Integers take all 64 bits whatever their width, so that most questions need not ask for it.
  union Number {
    bool boolean;
    std::int64_t int64;
    std::uint64_t uint64;
    float float32;
    double float64;
  };
  struct StaticText {
    const char* data;
    std::size_t size;
  };

  [[nodiscard]] bool owning() const noexcept { return tag_ >= Tag::text; }
  // From a value that owns nothing to one that owns nothing.
  void takePlain(const Value& other) noexcept {
    tag_ = other.tag_;
    if (tag_ == Tag::staticText) {
      staticText_ = other.staticText_;
    } else {
      number_ = other.number_;
    }
  }
  void copyOwned(const Value& other);
  void moveOwned(Value&& other) noexcept;
  Value& assignOwned(Value&& other) noexcept;
  void destroyOwned() noexcept;

  union {
    Number number_;
    StaticText staticText_;
    std::shared_ptr<const std::string> text_;
    std::shared_ptr<const Bytes> bytes_;
    List list_;
    Record record_;
  };
  Tag tag_ = Tag::null;
};

struct Entry {
  Key key;
  Value value;
};

using RecordList = std::vector<Record>;

// True for a list whose elements are all records.
[[nodiscard]] bool isRecordList(const Value& value) noexcept;

// Below: what needs the types to be complete.

inline Record::~Record() {
  if (entries_ != nullptr) release();
}

inline const Value* Record::find(std::string_view key) const noexcept {
  for (const Entry& entry : *this) {
    if (entry.key.view() == key) return &entry.value;
  }
  return nullptr;
}
inline Value* Record::find(std::string_view key) noexcept {
  return const_cast<Value*>(static_cast<const Record*>(this)->find(key));
}

template <class... Contents>
[[gnu::always_inline]] inline Value& Record::append(Key key, Contents&&... contents) {
  if (size_ == capacity_) reserve(capacity_ == 0 ? 4 : 2 * std::size_t{capacity_});
  Entry* entry = new (entries_ + size_) Entry{std::move(key), Value(std::forward<Contents>(contents)...)};
  ++size_;
  return entry->value;
}

inline const Entry* Record::end() const noexcept { return entries_ + size_; }
inline Entry* Record::end() noexcept { return entries_ + size_; }

inline Value::Value(Record value) noexcept : tag_(Tag::record) { new (&record_) Record(std::move(value)); }

template <class Visitor>
decltype(auto) Value::visit(Visitor&& visitor) const {
  switch (tag_) {
    case Tag::null:
      break;
    case Tag::boolean:
      return visitor(number_.boolean);
    case Tag::int32:
      return visitor(static_cast<std::int32_t>(number_.int64));
    case Tag::uint32:
      return visitor(static_cast<std::uint32_t>(number_.uint64));
    case Tag::int64:
      return visitor(number_.int64);
    case Tag::uint64:
      return visitor(number_.uint64);
    case Tag::float32:
      return visitor(number_.float32);
    case Tag::float64:
      return visitor(number_.float64);
    case Tag::staticText:
      return visitor(std::string_view(staticText_.data, staticText_.size));
    case Tag::text:
      return visitor(std::string_view(*text_));
    case Tag::bytes:
      return visitor(std::as_const(*bytes_));
    case Tag::list:
      return visitor(std::as_const(list_));
    case Tag::record:
      return visitor(std::as_const(record_));
  }
  return visitor(std::monostate());
}

}  // namespace vespscope
