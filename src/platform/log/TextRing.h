// Texts one after the other in one block of memory, taken out in the order in which they were put in.
//
// Lines of a log come from several threads and go in another: each in memory of its own, they keep the allocator busy
// and leave it with gaps of every size.
#pragma once

#include <algorithm>
#include <cstddef>
#include <memory>
#include <string>
#include <string_view>

namespace vespscope::log {

class TextRing {
 public:
  // Puts a text behind the others.
  void push(std::string_view text) {
    if (size_ + text.size() > capacity_) grow(size_ + text.size());
    const std::size_t end = (begin_ + size_) % capacity_;
    const std::size_t first = std::min(text.size(), capacity_ - end);
    std::copy(text.begin(), text.begin() + first, block_.get() + end);
    std::copy(text.begin() + first, text.end(), block_.get());
    size_ += text.size();
  }
  // Takes out the oldest text, which has so many bytes.
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
  // Gives back memory beyond `limit`, where nothing needs it.
  void shrink(std::size_t limit) {
    if (size_ == 0 && capacity_ > limit) *this = {};
  }

  // Bytes of all texts.
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
