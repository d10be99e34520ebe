// Fuzzes the programs as their users start them; `./dev fuzz programs` builds and starts it.
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <random>
#include <string>

#include "programs/Trial.h"

namespace vespscope::fuzz {
namespace {

using Clock = std::chrono::steady_clock;

// Whether the trial broke a rule. On a busy machine a process may be late once; only what happens twice is a finding.
bool fails(const Ground& ground, const std::filesystem::path& bin, std::uint64_t seed) {
  const Trial trial = Trial::draw(ground, seed);
  std::string fault = run(trial, bin, ground);
  if (fault.starts_with("does not end")) {
    std::printf("fuzz programs: trial %llu took long, and is run again\n", static_cast<unsigned long long>(seed));
    fault = run(trial, bin, ground);
  }
  if (fault.empty()) return false;
  std::printf("fuzz programs: FINDING in trial %llu: %s\n%s\nagain with: program_fuzz 0 %llu\n",
              static_cast<unsigned long long>(seed), fault.c_str(), trial.words().c_str(),
              static_cast<unsigned long long>(seed));
  return true;
}

int runFor(std::chrono::seconds length, std::uint64_t seed) {
  std::printf("fuzz programs: from seed %llu on, %lld s\n", static_cast<unsigned long long>(seed),
              static_cast<long long>(length.count()));
  std::fflush(stdout);
  const Ground ground(VESPSCOPE_CORPUS);
  const std::filesystem::path bin = std::filesystem::read_symlink("/proc/self/exe").parent_path();
  const Clock::time_point begin = Clock::now();
  std::uint64_t trials = 0;
  Clock::time_point said = begin;
  do {
    if (fails(ground, bin, seed + trials)) return 1;
    ++trials;
    if (Clock::now() - said > std::chrono::minutes(1)) {
      said = Clock::now();
      std::printf("fuzz programs: %llu trials\n", static_cast<unsigned long long>(trials));
      std::fflush(stdout);
    }
  } while (Clock::now() - begin < length);
  std::printf("fuzz programs: %llu trials, no finding\n", static_cast<unsigned long long>(trials));
  return 0;
}

}  // namespace
}  // namespace vespscope::fuzz

// Seconds, and the first trial's seed; 0 seconds run this one alone.
int main(int count, char** arguments) {
  const unsigned long long length = count > 1 ? std::strtoull(arguments[1], nullptr, 10) : 60;
  const unsigned long long seed = count > 2 ? std::strtoull(arguments[2], nullptr, 10) : std::random_device()();
  return vespscope::fuzz::runFor(std::chrono::seconds(length), seed);
}
