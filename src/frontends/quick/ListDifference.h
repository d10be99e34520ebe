// The insertions and removals that turn one list into another, so that a view keeps unchanged items.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace vespscope::quick {

// Edits are applied in order, each to the list that the previous ones produced.
struct Edit {
  enum class Kind { remove, insert };
  Kind kind = Kind::insert;
  std::size_t at = 0;     // index in the list being edited
  std::size_t count = 0;  // of items
  std::size_t from = 0;   // for an insertion: index of its first item in the new list
  friend bool operator==(const Edit&, const Edit&) = default;
};

// If the differing middle needs more comparisons than this, it is replaced as a whole.
inline constexpr std::size_t comparisonLimit = 1'000'000;

// `same(i, j)` returns whether item i of the old list is item j of the new one.
template <class Same>
[[nodiscard]] std::vector<Edit> differenceOf(std::size_t oldSize, std::size_t newSize, Same same) {
  std::size_t head = 0;
  while (head < oldSize && head < newSize && same(head, head)) ++head;
  std::size_t tail = 0;
  while (tail < oldSize - head && tail < newSize - head && same(oldSize - tail - 1, newSize - tail - 1)) ++tail;
  const std::size_t olds = oldSize - head - tail;
  const std::size_t news = newSize - head - tail;

  std::vector<Edit> edits;
  std::size_t at = head;
  const auto remove = [&] {
    if (!edits.empty() && edits.back().kind == Edit::Kind::remove && edits.back().at == at) {
      ++edits.back().count;
    } else {
      edits.push_back({Edit::Kind::remove, at, 1, 0});
    }
  };
  const auto insert = [&](std::size_t from) {
    if (!edits.empty() && edits.back().kind == Edit::Kind::insert && edits.back().at + edits.back().count == at) {
      ++edits.back().count;
    } else {
      edits.push_back({Edit::Kind::insert, at, 1, from});
    }
    ++at;
  };

  if (olds == 0 || news == 0 || olds > comparisonLimit / news) {
    for (std::size_t index = 0; index < olds; ++index) remove();
    for (std::size_t index = 0; index < news; ++index) insert(head + index);
    return edits;
  }

  // The longest common subsequence between head and tail: common[i][j] is that of the lists from i and j on.
  const std::size_t stride = news + 1;
  std::vector<std::uint32_t> common((olds + 1) * stride, 0);
  for (std::size_t i = olds; i-- > 0;) {
    for (std::size_t j = news; j-- > 0;) {
      common[i * stride + j] = same(head + i, head + j)
                                   ? common[(i + 1) * stride + j + 1] + 1
                                   : std::max(common[(i + 1) * stride + j], common[i * stride + j + 1]);
    }
  }
  std::size_t i = 0;
  std::size_t j = 0;
  while (i < olds || j < news) {
    if (i < olds && j < news && same(head + i, head + j)) {
      ++i;
      ++j;
      ++at;
    } else if (j == news || (i < olds && common[(i + 1) * stride + j] >= common[i * stride + j + 1])) {
      remove();
      ++i;
    } else {
      insert(head + j);
      ++j;
    }
  }
  return edits;
}

}  // namespace vespscope::quick
