#include "values/Key.h"

#include <algorithm>

namespace vespscope {

Key::Key(std::string_view text) : data_(""), size_(static_cast<std::uint32_t>(text.size())), owned_(!text.empty()) {
  if (text.empty()) return;
  char* copy = new char[text.size()];
  std::copy(text.begin(), text.end(), copy);
  data_ = copy;
}

Key::Key(const Key& other) : Key(other.data_, other.size_, false) {
  if (other.owned_) *this = Key(other.view());
}

Key& Key::operator=(const Key& other) {
  if (this != &other) *this = Key(other);
  return *this;
}

Key& Key::operator=(Key&& other) noexcept {
  if (this == &other) return *this;
  if (owned_) delete[] data_;
  data_ = std::exchange(other.data_, "");
  size_ = other.size_;
  owned_ = other.owned_;
  other.size_ = 0;
  other.owned_ = false;
  return *this;
}

}  // namespace vespscope
