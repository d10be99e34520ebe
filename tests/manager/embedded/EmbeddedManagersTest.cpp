// Managers inside the process of their client.
#include <unistd.h>

#include <filesystem>
#include <optional>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "capture/CaptureWriter.h"
#include "manager/embedded/EmbeddedManagers.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using manager::EmbeddedManagers;
using testing::HasSubstr;

TEST(EmbeddedManagers, OpenTheirSourceOnceForAllConnections) {
  const TemporaryFolder folder;
  const std::filesystem::path file = folder.path() / "drive.pcap";
  {
    auto writer = capture::CaptureWriter::create(file.string(), capture::Flushing::inBlocks);
    ASSERT_TRUE(writer) << writer.reason();
    ASSERT_EQ(writer->write({0x3C4E04, 0, {0x10, 1}, std::chrono::seconds(1)}), std::nullopt);
  }
  EmbeddedManagers managers;
  ASSERT_EQ(managers.open("replay:" + file.string()), std::nullopt);
  std::filesystem::remove(file);
  const bus::EmbeddedFactory connect = managers.factory();
  auto first = connect("replay:" + file.string());
  ASSERT_TRUE(first) << first.reason();
  auto second = connect("replay:" + file.string());
  ASSERT_TRUE(second) << second.reason();
  EXPECT_EQ(first->keeper, second->keeper);
  EXPECT_NE(first->descriptor, second->descriptor);
  ::close(first->descriptor);
  ::close(second->descriptor);
}

TEST(EmbeddedManagers, SayWhyASourceCannotBeOpened) {
  EmbeddedManagers managers;
  EXPECT_THAT(managers.open("radio").value_or(""), HasSubstr("a source is scenario"));
  EXPECT_THAT(managers.factory()("radio").reason(), HasSubstr("a source is scenario"));
}

TEST(EmbeddedManagers, KeepAManagerAsLongAsItsConnectionAndMakeNoOtherWhenGone) {
  std::optional<EmbeddedManagers> managers(std::in_place);
  const bus::EmbeddedFactory connect = managers->factory();
  auto connection = connect("scenario");
  ASSERT_TRUE(connection) << connection.reason();
  managers.reset();
  EXPECT_EQ(connection->keeper.use_count(), 1);
  EXPECT_EQ(connect("scenario").reason(), "the program is ending");
  ::close(connection->descriptor);
}

}  // namespace
}  // namespace vespscope::test
