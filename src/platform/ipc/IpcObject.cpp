#include "platform/ipc/IpcObject.h"

#include <algorithm>
#include <array>
#include <atomic>
#include <memory>
#include <type_traits>

namespace vespscope::ipc {
namespace {

constexpr std::size_t longestKeptName = 64;  // characters

// Returns the key of an entry's name. Names are few and come again with every event, so the first few are kept
// permanently, once for all records.
Key keyOf(std::string_view name) {
  static std::array<std::atomic<const std::string*>, 32> kept{};
  if (name.size() > longestKeptName) return Key(name);
  for (std::atomic<const std::string*>& place : kept) {
    const std::string* text = place.load(std::memory_order_acquire);
    if (text == nullptr) {
      auto made = std::make_unique<const std::string>(name);
      // Otherwise another thread was faster, and `text` is its name.
      if (place.compare_exchange_strong(text, made.get())) return Key::ofStatic(*made.release());
    }
    if (*text == name) return Key::ofStatic(*text);
  }
  return Key(name);
}

std::size_t contentSize(const Object& object) {
  return std::visit(
      [](const auto& kind) -> std::size_t {
        using Kind = std::decay_t<decltype(kind)>;
        if constexpr (std::is_same_v<Kind, std::string>) {
          return kind.size();
        } else if constexpr (std::is_same_v<Kind, SharedBytes>) {
          return kind->size();
        } else if constexpr (std::is_same_v<Kind, Array>) {
          std::size_t size = kind.size() * sizeof(Object);
          for (const Object& element : kind) size += contentSize(element);
          return size;
        } else if constexpr (std::is_same_v<Kind, Dictionary>) {
          return ipc::contentSize(kind);
        } else {
          return 0;
        }
      },
      object.data());
}

}  // namespace

void Dictionary::set(std::string_view key, Object value) {
  for (auto& entry : entries_) {
    if (entry.first == key) {
      entry.second = std::move(value);
      return;
    }
  }
  entries_.emplace_back(std::string(key), std::move(value));
}

void Dictionary::reserve(std::size_t count) { entries_.reserve(count); }

const Object* Dictionary::find(std::string_view key) const {
  for (const auto& entry : entries_) {
    if (entry.first == key) return &entry.second;
  }
  return nullptr;
}

std::optional<Object> Dictionary::take(std::string_view key) {
  const auto found =
      std::find_if(entries_.begin(), entries_.end(), [key](const auto& entry) { return entry.first == key; });
  if (found == entries_.end()) return std::nullopt;
  std::optional<Object> value = std::move(found->second);
  entries_.erase(found);
  return value;
}

std::size_t Dictionary::size() const { return entries_.size(); }

std::size_t contentSize(const Dictionary& dictionary) {
  std::size_t size = 0;
  for (const auto& [key, object] : dictionary.entries()) size += sizeof object + key.size() + contentSize(object);
  return size;
}

Value toValue(const Object& object) {
  return std::visit(
      [](const auto& kind) -> Value {
        using Kind = std::decay_t<decltype(kind)>;
        if constexpr (std::is_same_v<Kind, std::monostate>) {
          return Value();
        } else if constexpr (std::is_same_v<Kind, Array>) {
          List list;
          list.reserve(kind.size());
          for (const Object& element : kind) list.push_back(toValue(element));
          return Value(std::move(list));
        } else if constexpr (std::is_same_v<Kind, Dictionary>) {
          return Value(toRecord(kind));
        } else {
          return Value(kind);
        }
      },
      object.data());
}

Record toRecord(const Dictionary& dictionary) {
  Record record;
  record.reserve(dictionary.size());
  for (const auto& [key, object] : dictionary.entries()) record.append(keyOf(key), toValue(object));
  return record;
}

}  // namespace vespscope::ipc
