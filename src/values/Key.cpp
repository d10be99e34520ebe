#include "values/Key.h"

#include <algorithm>

namespace vespscope {

Key::Key(std::string_view text) : Key(text.empty() ? "" : text.data(), text.size(), false) {
  if (!text.empty()) copyText();
}

void Key::copyText() {
  char* copy = new char[size_];
  std::copy_n(data_, size_, copy);
  data_ = copy;
  owned_ = true;
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
