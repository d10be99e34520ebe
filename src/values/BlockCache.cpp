#include "values/BlockCache.h"

#include <algorithm>

namespace vespscope {

thread_local constinit std::array<BlockCache::Block*, BlockCache::largest / BlockCache::step + 1> BlockCache::shelves{};
thread_local constinit std::size_t BlockCache::kept = 0;
thread_local constinit std::size_t BlockCache::limit = 0;

// Lets its thread keep blocks, and gives them back when the thread ends.
struct BlockCacheKeeper {
  BlockCacheKeeper() noexcept { BlockCache::limit = BlockCache::usualLimit; }
  BlockCacheKeeper(const BlockCacheKeeper&) = delete;
  BlockCacheKeeper& operator=(const BlockCacheKeeper&) = delete;
  ~BlockCacheKeeper() {
    BlockCache::limit = 0;
    for (BlockCache::Block*& shelf : BlockCache::shelves) {
      while (BlockCache::Block* block = shelf) {
        shelf = block->next;
        ::operator delete(block);
      }
    }
    BlockCache::kept = 0;
  }
};

void* BlockCache::allocateSlowly(std::size_t size) {
  if (!enabled || size > largest) return ::operator new(size);
  thread_local const BlockCacheKeeper keeper;
  // As large as any block of its shelf, since it may come back as one.
  return ::operator new(std::max(roundedUp(size), step));
}

void BlockCache::releaseSlowly(void* memory, std::size_t /*size*/) noexcept { ::operator delete(memory); }

}  // namespace vespscope
