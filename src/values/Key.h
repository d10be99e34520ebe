// A record's key: a view of static text where the text is a literal, else a text of its own.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <utility>

namespace vespscope {

class Key {
 public:
  // From a literal: no memory is taken.
  template <std::size_t Size>
  consteval Key(const char (&literal)[Size]) noexcept : data_(literal), size_(Size - 1), owned_(false) {}
  // From text that outlives every record, such as a field table's names: no memory is taken.
  static constexpr Key ofStatic(std::string_view text) noexcept { return Key(text.data(), text.size(), false); }
  // From any other text: copied.
  Key(const std::string& text) : Key(std::string_view(text)) {}
  explicit Key(std::string_view text);

  Key(const Key& other) : Key(other.data_, other.size_, false) {
    if (other.owned_) copyText();
  }
  Key(Key&& other) noexcept : data_(std::exchange(other.data_, "")), size_(other.size_), owned_(other.owned_) {
    other.size_ = 0;
    other.owned_ = false;
  }
  Key& operator=(const Key& other);
  Key& operator=(Key&& other) noexcept;
  constexpr ~Key() {
    if (owned_) delete[] data_;
  }

  [[nodiscard]] constexpr std::string_view view() const noexcept { return {data_, size_}; }
  friend constexpr bool operator==(const Key& left, const Key& right) noexcept { return left.view() == right.view(); }

 private:
  constexpr Key(const char* data, std::size_t size, bool owned) noexcept
      : data_(data), size_(static_cast<std::uint32_t>(size)), owned_(owned) {}

  // Makes the text that is only looked at one of its own.
  void copyText();

  const char* data_;
  std::uint32_t size_;
  bool owned_;
};

}  // namespace vespscope
