// How messages store what a plain number cannot say: presence bits, lists that know whether they were ever there.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <stdexcept>
#include <utility>
#include <vector>

#include "values/BlockCache.h"

namespace vespscope {

// Which optional numbers of a message are set, one bit each.
template <class Word>
class Presence {
 public:
  [[nodiscard]] constexpr bool test(unsigned bit) const noexcept { return (bits_ >> bit & 1) != 0; }
  constexpr void set(unsigned bit, bool present = true) noexcept {
    const auto mask = static_cast<Word>(Word{1} << bit);
    bits_ = static_cast<Word>(present ? bits_ | mask : bits_ & ~mask);
  }
  // How many are set. Added up in place: the plain x86-64 has no instruction for it, and the library's way is a call.
  [[nodiscard]] constexpr std::size_t count() const noexcept {
    std::uint64_t sums = bits_;
    sums -= (sums >> 1) & 0x5555555555555555;
    sums = (sums & 0x3333333333333333) + ((sums >> 2) & 0x3333333333333333);
    return (((sums + (sums >> 4)) & 0x0F0F0F0F0F0F0F0F) * 0x0101010101010101) >> 56;
  }

 private:
  Word bits_ = 0;
};

// An index at or beyond the count of a repeated field.
class RangeException : public std::out_of_range {
 public:
  RangeException(std::size_t index, std::size_t count);
};

// Stops the process: there are no absent elements in a list of messages.
[[noreturn]] void stopOnAbsentElement();

// A growable array of messages. It comes into being with the first element; emptying keeps it.
template <class Element>
class MessageList {
 public:
  [[nodiscard]] bool exists() const noexcept { return exists_; }
  [[nodiscard]] std::size_t size() const noexcept { return elements_.size(); }
  [[nodiscard]] auto begin() const noexcept { return elements_.begin(); }
  [[nodiscard]] auto end() const noexcept { return elements_.end(); }

  [[nodiscard]] const std::shared_ptr<Element>& at(std::size_t index) const {
    if (index >= elements_.size()) throw RangeException(index, elements_.size());
    return elements_[index];
  }
  void clear() noexcept { elements_.clear(); }
  void add(std::shared_ptr<Element> element) {
    if (element == nullptr) stopOnAbsentElement();
    if (elements_.capacity() == 0) elements_.reserve(usualSize);
    elements_.push_back(std::move(element));
    exists_ = true;
  }

 private:
  static constexpr std::size_t usualSize = 8;  // more neighbours than that are rarely heard

  std::vector<std::shared_ptr<Element>, CachedBlocks<std::shared_ptr<Element>>> elements_;
  bool exists_ = false;
};

// A growable array of numbers.
template <class Number>
class NumberList {
 public:
  using Values = std::vector<Number, CachedBlocks<Number>>;

  [[nodiscard]] const Values& values() const noexcept { return values_; }
  [[nodiscard]] std::size_t size() const noexcept { return values_.size(); }
  [[nodiscard]] Number at(std::size_t index) const {
    if (index >= values_.size()) throw RangeException(index, values_.size());
    return values_[index];
  }
  void clear() noexcept { values_.clear(); }
  void add(Number value) {
    if (values_.capacity() == 0) values_.reserve(usualSize);
    values_.push_back(value);
  }
  // `values` may lie in this very list.
  void assign(const Number* values, std::size_t count) { values_ = Values(values, values + count); }

 private:
  static constexpr std::size_t usualSize = 8;  // no more memory than the smallest block

  Values values_;
};

}  // namespace vespscope
