// Checks whether a dictionary contains this program's application number.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "values/Value.h"

namespace vespscope {

class AppIDValidator {
 public:
  const std::int64_t myAppID = 2;
  const std::string appIDKey = "kKeyAppID";
  // The number found by the last check; empty if there was none.
  std::optional<std::int64_t> appID;

  // Returns true when `dictionary` has the integer 2 under `appIDKey`.
  bool check(const Record& dictionary);
};

}  // namespace vespscope
