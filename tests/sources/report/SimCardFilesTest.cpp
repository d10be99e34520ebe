// The SIM card's files keep their order in an event.
#include <gtest/gtest.h>

#include "sources/report/SimCardFiles.h"
#include "values/Text.h"

namespace vespscope::test {
namespace {

TEST(SimCardFiles, KeepTheirOrderAndContents) {
  const auto message = sources::simCardFilesMessage({{0x2FE2, {0x98, 0x10}}, {0x6F07, {}}});
  EXPECT_EQ(toText(message.dictionaryRepresentation()),
            "[ef_list: [[ef_id: 12258, content: <98 10>], [ef_id: 28423, content: <>]]]");
}

}  // namespace
}  // namespace vespscope::test
