// What decoding a record of the log returns where it is at fault.
#pragma once

#include <cstddef>
#include <variant>

#include <gtest/gtest.h>

#include "Bytes.h"
#include "sources/diag/Decoded.h"

namespace vespscope::test {

template <class Record>
sources::diag::RecordFault faultIn(const sources::diag::Decoded<Record>& decoded) {
  return std::get<sources::diag::RecordFault>(decoded);
}

// Every truncated record is too short, and no read goes past its end.
template <class Decode>
void expectTooShortWhenCut(const Bytes& whole, Decode decode) {
  for (std::size_t length = 0; length < whole.size(); ++length) {
    const Bytes cut(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length));
    EXPECT_EQ(faultIn(decode(cut)), sources::diag::RecordFault::tooShort) << length;
  }
}

}  // namespace vespscope::test
