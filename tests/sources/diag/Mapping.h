// A mapper for records from a test, which returns the events as text.
#pragma once

#include <concepts>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "Bytes.h"
#include "sources/diag/DecodedMetrics.h"
#include "sources/diag/RecordMapper.h"

namespace vespscope::test {

class MappingTest : public testing::Test {
 protected:
  // Times are milliseconds since 1970.
  std::vector<std::string> take(std::uint16_t code, const Bytes& payload, std::int64_t time) {
    sources::diag::LogRecord record;
    record.code = code;
    record.time = std::chrono::milliseconds(time);
    record.payload = payload;
    return textsOf(mapper_.take(record, report_));
  }
  template <std::convertible_to<std::string_view> Dump>
  std::vector<std::string> take(std::uint16_t code, const Dump& dump, std::int64_t time = 1000) {
    return take(code, bytesOf(dump), time);
  }

  sources::diag::RecordMapper mapper_;
  sources::diag::DiagReport report_;
};

}  // namespace vespscope::test
