#include "platform/ipc/IpcObject.h"

#include <type_traits>

namespace vespscope::ipc {

void Dictionary::set(std::string_view key, Object value) {
  for (auto& entry : entries_) {
    if (entry.first == key) {
      entry.second = std::move(value);
      return;
    }
  }
  entries_.emplace_back(std::string(key), std::move(value));
}

const Object* Dictionary::find(std::string_view key) const {
  for (const auto& entry : entries_) {
    if (entry.first == key) return &entry.second;
  }
  return nullptr;
}

std::size_t Dictionary::size() const { return entries_.size(); }

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
  for (const auto& [key, object] : dictionary.entries()) record.append(Key(key), toValue(object));
  return record;
}

}  // namespace vespscope::ipc
