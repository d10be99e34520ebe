// Lets storms of faults over the programs, one after the other; `./dev storm` builds and starts it.
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>

#include <stdlib.h>

#include "storm/Storm.h"

namespace vespscope::test {
namespace {

namespace fs = std::filesystem;

// Whether everything held.
bool runStorm(std::uint64_t seed, std::chrono::seconds length) {
  std::printf("storm: seed %llu, %lld s\n", static_cast<unsigned long long>(seed),
              static_cast<long long>(length.count()));
  std::fflush(stdout);
  std::string folder = (fs::temp_directory_path() / "vespscope-storm-XXXXXX").string();
  if (::mkdtemp(folder.data()) == nullptr) std::abort();
  std::string finding;
  {
    // The programs beside this one.
    Storm storm({fs::read_symlink("/proc/self/exe").parent_path(), folder}, seed, length);
    finding = storm.run();
    for (const auto& [what, count] : storm.figures()) {
      std::printf("storm:   %-42s %12llu\n", what.c_str(), static_cast<unsigned long long>(count));
    }
  }
  if (!finding.empty()) {
    std::printf("storm: FINDING: %s\nstorm: again with: storm %lld %llu; what was there is in %s\n", finding.c_str(),
                static_cast<long long>(length.count()), static_cast<unsigned long long>(seed), folder.c_str());
  } else {
    fs::remove_all(folder);
  }
  std::fflush(stdout);
  return finding.empty();
}

}  // namespace
}  // namespace vespscope::test

int main(int count, char** arguments) {
  const auto number = [&](int index, unsigned long long usual) {
    return count > index ? std::strtoull(arguments[index], nullptr, 10) : usual;
  };
  const unsigned long long length = number(1, 60);
  const unsigned long long seed = number(2, 1);
  const unsigned long long storms = number(3, 1);
  if (length == 0) {
    std::fprintf(stderr, "usage: storm [SECONDS [SEED [STORMS]]]; each storm has the next seed\n");
    return 2;
  }
  for (unsigned long long storm = 0; storm < storms; ++storm) {
    if (!vespscope::test::runStorm(seed + storm, std::chrono::seconds(length))) return 1;
  }
  return 0;
}
