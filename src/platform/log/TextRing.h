// Texts one after the other in one block of memory, removed in the order in which they were added.
//
// Log lines are allocated in several threads and freed in another. Separate allocations would keep the allocator busy
// and fragment its memory.
#pragma once

#include <algorithm>
#include <cstddef>
#include <memory>
#include <string>
#include <string_view>

namespace vespscope::log {

class TextRing {
 public:
  // Adds a text at the end.
  void push(std::string_view text) {
    if (size_ + text.size() > capacity_) grow(size_ + text.size());
    const std::size_t end = (begin_ + size_) % capacity_;
    const std::size_t first = std::min(text.size(), capacity_ - end);
    std::copy(text.begin(), text.begin() + first, block_.get() + end);
    std::copy(text.begin() + first, text.end(), block_.get());
    size_ += text.size();
  }
  // Removes the oldest text, which has `size` bytes.
  void drop(std::size_t size) {
    begin_ = (begin_ + size) % capacity_;
    size_ -= size;
  }
  [[nodiscard]] std::string pop(std::size_t size) {
    const std::size_t first = std::min(size, capacity_ - begin_);
    std::string text;
    text.reserve(size);
    text.append(block_.get() + begin_, first).append(block_.get(), size - first);
    drop(size);
    return text;
  }
  // Releases memory beyond `limit` that is not in use.
  void shrink(std::size_t limit) {
    if (size_ == 0 && capacity_ > limit) *this = {};
  }

  // The bytes of all texts.
  [[nodiscard]] std::size_t size() const { return size_; }
  [[nodiscard]] std::size_t capacity() const { return capacity_; }

 private:
  static constexpr std::size_t least = std::size_t{1} << 14;

  void grow(std::size_t wanted) {
    std::size_t capacity = std::max(capacity_, least);
    while (capacity < wanted) capacity *= 2;
    std::unique_ptr<char[]> block(new char[capacity]);
    const std::size_t first = std::min(size_, capacity_ - begin_);
    std::copy_n(block_.get() + begin_, first, block.get());
    std::copy_n(block_.get(), size_ - first, block.get() + first);
    block_ = std::move(block);
    capacity_ = capacity;
    begin_ = 0;
  }

  std::unique_ptr<char[]> block_ = std::make_unique<char[]>(least);
  std::size_t capacity_ = least;
  std::size_t begin_ = 0;
  std::size_t size_ = 0;
};

}  // namespace vespscope::log
