#include "sources/diag/UtraBand.h"

#include <algorithm>
#include <array>

namespace vespscope::sources::diag {
namespace {

struct Band {
  std::uint32_t number;
  std::uint32_t first;  // downlink UARFCN
  std::uint32_t last;
};

constexpr std::array<Band, 17> bands = {{
    {1, 10562, 10838},
    {2, 9662, 9938},
    {3, 1162, 1513},
    {4, 1537, 1738},
    {5, 4357, 4458},
    {6, 4387, 4413},
    {7, 2237, 2563},
    {8, 2937, 3088},
    {9, 9237, 9387},
    {10, 3112, 3388},
    {11, 3712, 3787},
    {12, 3842, 3903},
    {13, 4017, 4043},
    {14, 4117, 4143},
    {19, 712, 763},
    {20, 4512, 4638},
    {21, 862, 912},
}};

}  // namespace

std::optional<std::uint32_t> utraBandOfDownlink(std::uint32_t uarfcn) {
  const auto holds = [uarfcn](const Band& band) { return band.first <= uarfcn && uarfcn <= band.last; };
  if (std::count_if(bands.begin(), bands.end(), holds) != 1) return std::nullopt;
  return std::find_if(bands.begin(), bands.end(), holds)->number;
}

}  // namespace vespscope::sources::diag
