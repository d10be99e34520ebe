// A client that harms where it can: says nothing, leaves messages unfinished, sends what is no message, or floods.
#pragma once

#include <atomic>
#include <chrono>
#include <cstdint>
#include <string>
#include <thread>

namespace vespscope::test {

class Attack {
 public:
  // Attacks the manager at `path` for so long, in ways drawn from `seed`.
  Attack(std::string path, std::uint64_t seed, std::chrono::milliseconds length);
  Attack(const Attack&) = delete;
  Attack& operator=(const Attack&) = delete;
  // Ends at once.
  ~Attack();

  [[nodiscard]] bool isOver() const { return over_; }

 private:
  void run(const std::string& path, std::uint64_t seed, std::chrono::milliseconds length);

  std::atomic<bool> stopping_ = false;
  std::atomic<bool> over_ = false;
  std::thread thread_;
};

}  // namespace vespscope::test
