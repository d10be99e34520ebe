// Memory blocks for what is made and dropped with every event: kept by the thread that drops them, for its next event.
//
// The general allocator took a third of an event's time; a block from the cache costs a few instructions. What a
// thread keeps is bounded, and goes back when the thread ends.
#pragma once

#include <array>
#include <cstddef>
#include <memory>
#include <new>
#include <type_traits>
#include <utility>

#include "values/Sanitized.h"

namespace vespscope {

class BlockCache {
 public:
  // Larger blocks are not kept.
  static constexpr std::size_t largest = 2048;

  [[nodiscard]] static void* allocate(std::size_t size) {
    if (enabled && size <= largest) {
      Block*& shelf = shelves[shelfOf(size)];
      if (Block* block = shelf) {
        shelf = block->next;
        kept -= roundedUp(size);
        return block;
      }
    }
    return allocateSlowly(size);
  }

  static void release(void* memory, std::size_t size) noexcept {
    if (enabled && size <= largest) {
      if (kept < limit) {
        Block*& shelf = shelves[shelfOf(size)];
        shelf = new (memory) Block{shelf};
        kept += roundedUp(size);
        return;
      }
    }
    releaseSlowly(memory, size);
  }

 private:
  // Kept blocks would hide from a sanitizer that they are used after their release, and rounded sizes that their end is
  // passed.
  static constexpr bool enabled = !sanitized;
  static constexpr std::size_t step = 32;  // sizes are rounded up to a multiple of it
  // Enough for an event with a list of a thousand elements, so that long lists cost no more than short ones.
  static constexpr std::size_t usualLimit = std::size_t{1} << 20;

  struct Block {
    Block* next;
  };

  static constexpr std::size_t shelfOf(std::size_t size) { return (size + step - 1) / step; }
  static constexpr std::size_t roundedUp(std::size_t size) { return shelfOf(size) * step; }
  static void* allocateSlowly(std::size_t size);
  static void releaseSlowly(void* memory, std::size_t size) noexcept;

  friend struct BlockCacheKeeper;
  static thread_local constinit std::array<Block*, largest / step + 1> shelves;
  static thread_local constinit std::size_t kept;   // bytes on the shelves
  static thread_local constinit std::size_t limit;  // none before the thread's first slow allocation and after its end
};

// An allocator over it, for containers and shared objects.
template <class Element>
class CachedBlocks {
 public:
  using value_type = Element;

  CachedBlocks() noexcept = default;
  template <class Other>
  CachedBlocks(const CachedBlocks<Other>&) noexcept {}

  [[nodiscard]] Element* allocate(std::size_t count) {
    if (count > static_cast<std::size_t>(-1) / sizeof(Element)) throw std::bad_array_new_length();
    return static_cast<Element*>(BlockCache::allocate(count * sizeof(Element)));
  }
  void deallocate(Element* memory, std::size_t count) noexcept { BlockCache::release(memory, count * sizeof(Element)); }

  friend bool operator==(const CachedBlocks&, const CachedBlocks&) noexcept { return true; }
};

// A new object whose memory comes from the cache.
template <class Object, class... Arguments>
std::shared_ptr<Object> makeCached(Arguments&&... arguments) {
  return std::allocate_shared<Object>(CachedBlocks<std::remove_const_t<Object>>(),
                                      std::forward<Arguments>(arguments)...);
}

}  // namespace vespscope
