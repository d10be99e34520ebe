// Waits for an effect of another thread, instead of sleeping.
#pragma once

#include <chrono>
#include <functional>
#include <thread>

namespace vespscope::test {

// Returns true as soon as `condition` holds, checked every millisecond; false when it does not within `limit`.
inline bool eventually(const std::function<bool()>& condition,
                       std::chrono::milliseconds limit = std::chrono::seconds(30)) {
  const auto end = std::chrono::steady_clock::now() + limit;
  while (!condition()) {
    if (std::chrono::steady_clock::now() >= end) return condition();
    std::this_thread::sleep_for(std::chrono::milliseconds(1));
  }
  return true;
}

}  // namespace vespscope::test
