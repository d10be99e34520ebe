// Displays that open and displays that do not.
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <cstdlib>
#include <cstring>
#include <map>
#include <optional>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "frontends/quick/Display.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using ::testing::EndsWith;
using ::testing::StartsWith;

// Sets the variables that name a display, and restores them afterwards.
class Display : public ::testing::Test {
 protected:
  Display() {
    for (const char* name : {"QT_QPA_PLATFORM", "DISPLAY", "WAYLAND_DISPLAY", "WAYLAND_SOCKET", "XDG_RUNTIME_DIR"}) {
      if (const char* value = std::getenv(name))
        before_[name] = value;
      else
        before_[name] = std::nullopt;
      ::unsetenv(name);
    }
    ::setenv("XDG_RUNTIME_DIR", folder_.path().c_str(), 1);
  }
  ~Display() override {
    for (const auto& [name, value] : before_) {
      if (value)
        ::setenv(name.c_str(), value->c_str(), 1);
      else
        ::unsetenv(name.c_str());
    }
    if (listener_ >= 0) ::close(listener_);
  }

  // Opens a listening socket in the runtime folder.
  void listen(const std::string& name) {
    listener_ = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    std::strncpy(address.sun_path, (folder_ / name).c_str(), sizeof address.sun_path - 1);
    ASSERT_EQ(::bind(listener_, reinterpret_cast<const sockaddr*>(&address), sizeof address), 0);
    ASSERT_EQ(::listen(listener_, 1), 0);
  }

  TemporaryFolder folder_;

 private:
  std::map<std::string, std::optional<std::string>> before_;
  int listener_ = -1;
};

TEST_F(Display, WithoutAnyNameThereIsNone) {
  const quick::DisplayCheck check = quick::checkDisplay();
  EXPECT_FALSE(check.opens);
  EXPECT_FALSE(check.named);
  EXPECT_EQ(check.reason, "there is no display: neither WAYLAND_DISPLAY nor DISPLAY is set");
}

TEST_F(Display, AServerThatIsGoneIsNamed) {
  ::setenv("DISPLAY", ":77", 1);
  const quick::DisplayCheck check = quick::checkDisplay();
  EXPECT_FALSE(check.opens);
  EXPECT_TRUE(check.named);
  EXPECT_EQ(check.reason, "there is no display: DISPLAY=:77 does not open");
}

TEST_F(Display, NonsenseIsNoDisplay) {
  ::setenv("DISPLAY", "nonsense", 1);
  EXPECT_EQ(quick::checkDisplay().reason, "there is no display: DISPLAY=nonsense does not open");
  ::setenv("DISPLAY", "", 1);
  ::setenv("WAYLAND_DISPLAY", std::string(200, 'w').c_str(), 1);
  EXPECT_THAT(quick::checkDisplay().reason, EndsWith("(its path is too long)"));
}

TEST_F(Display, ACompositorThatListensOpens) {
  ::setenv("WAYLAND_DISPLAY", "wayland-5", 1);
  EXPECT_THAT(quick::checkDisplay().reason,
              StartsWith("there is no display: WAYLAND_DISPLAY=wayland-5 does not open ("));
  listen("wayland-5");
  EXPECT_TRUE(quick::checkDisplay().opens);
  ::setenv("WAYLAND_DISPLAY", (folder_ / "wayland-5").c_str(), 1);
  EXPECT_TRUE(quick::checkDisplay().opens);
}

TEST_F(Display, OneThatOpensIsEnough) {
  ::setenv("DISPLAY", ":77", 1);
  ::setenv("WAYLAND_DISPLAY", "wayland-5", 1);
  EXPECT_THAT(quick::checkDisplay().reason, EndsWith(", DISPLAY=:77 does not open"));
  listen("wayland-5");
  EXPECT_TRUE(quick::checkDisplay().opens);
}

TEST_F(Display, ThePlatformThatWasAskedForDecides) {
  ::setenv("WAYLAND_DISPLAY", "wayland-5", 1);
  listen("wayland-5");
  ::setenv("QT_QPA_PLATFORM", "xcb", 1);
  EXPECT_EQ(quick::checkDisplay().reason, "there is no display: DISPLAY is not set");
  ::setenv("QT_QPA_PLATFORM", "xcb;wayland", 1);
  EXPECT_TRUE(quick::checkDisplay().opens);
  ::setenv("QT_QPA_PLATFORM", "offscreen", 1);
  EXPECT_TRUE(quick::checkDisplay().opens);
}

}  // namespace
}  // namespace vespscope::test
