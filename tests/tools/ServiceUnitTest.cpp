// The manager's systemd unit: the service's restrictions and limits.
#include <unistd.h>

#include <fstream>
#include <iterator>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/Process.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using ::testing::HasSubstr;

// The installed unit.
std::string unit() {
  std::ifstream file(VESPSCOPE_SOURCE_DIR "/packaging/systemd/rhoxd.service.in");
  std::string text{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  const std::string place = "@RHOXD@";
  const std::size_t position = text.find(place);
  if (position != std::string::npos) text.replace(position, place.size(), "/bin/true");
  return text;
}

TEST(ServiceUnit, LimitsMemoryTasksAndStarts) {
  for (const char* line : {"\nMemoryMax=256M\n", "\nMemorySwapMax=0\n", "\nTasksMax=32\n", "\nLimitNOFILE=512\n",
                           "\nStartLimitIntervalSec=60\n", "\nStartLimitBurst=10\n"}) {
    EXPECT_THAT(unit(), HasSubstr(line));
  }
}

TEST(ServiceUnit, ExposesNoMoreThanSystemdRatesWithOnePointFive) {
  const std::string analyze = "/usr/bin/systemd-analyze";
  if (::access(analyze.c_str(), X_OK) != 0) GTEST_SKIP() << "systemd-analyze is not installed";
  const TemporaryFolder folder;
  const std::string file = folder.write("rhoxd.service", unit());
  Process rating(analyze, {"security", "--offline=true", "--threshold=15", "--no-pager", file});
  EXPECT_EQ(rating.wait(), (ProcessEnd{false, 0})) << rating.output() << rating.errors();
  Process verification(analyze, {"verify", "--man=no", file});
  EXPECT_TRUE(verification.wait().has_value());
  EXPECT_THAT(verification.errors(), ::testing::Not(HasSubstr("rhoxd.service:")));
}

}  // namespace
}  // namespace vespscope::test
