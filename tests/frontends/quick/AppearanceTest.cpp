// Light, dark and the text size: chosen by the user, and reported by a desktop's portal over a separate message bus.
#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusVariant>
#include <QDBusVirtualObject>
#include <QSignalSpy>
#include <QTest>
#include <map>
#include <string>

#include <gtest/gtest.h>

#include "frontends/quick/Appearance.h"
#include "support/Process.h"

namespace vespscope::test {
namespace {

class Appearance : public ::testing::Test {
 protected:
  void colours(uint preference) {
    appearance_.settingChanged("org.freedesktop.appearance", "color-scheme",
                               QVariant::fromValue(QDBusVariant(QVariant::fromValue(QDBusVariant(preference)))));
  }

  quick::Appearance appearance_;
};

TEST_F(Appearance, DarkAndLightFollowTheDesktop) {
  EXPECT_FALSE(appearance_.dark());
  QSignalSpy changes(&appearance_, &quick::Appearance::changed);
  colours(1);
  EXPECT_TRUE(appearance_.dark());
  EXPECT_EQ(changes.size(), 1);
  colours(2);
  EXPECT_FALSE(appearance_.dark());
  colours(0);
  EXPECT_FALSE(appearance_.dark());
}

TEST_F(Appearance, TheUsersChoiceOverridesTheDesktops) {
  appearance_.setMode(quick::Appearance::Mode::Light);
  colours(1);
  EXPECT_FALSE(appearance_.dark());
  appearance_.setMode(quick::Appearance::Mode::System);
  EXPECT_TRUE(appearance_.dark());
  appearance_.toggle();
  EXPECT_FALSE(appearance_.dark());
}

TEST_F(Appearance, TheTextSizeFollowsUntilTheUserChangesIt) {
  const auto scale = [&](double factor) {
    appearance_.settingChanged("org.gnome.desktop.interface", "text-scaling-factor", factor);
  };
  scale(1.5);
  EXPECT_EQ(appearance_.textScale(), 1.5);
  appearance_.zoom(1);
  EXPECT_EQ(appearance_.textScale(), 1.625);
  scale(1.25);
  EXPECT_EQ(appearance_.textScale(), 1.625);
  appearance_.zoom(0);
  EXPECT_EQ(appearance_.textScale(), 1.25);
  for (int steps = 0; steps < 20; ++steps) appearance_.zoom(1);
  EXPECT_EQ(appearance_.textScale(), quick::Appearance::largestTextScale);
}

TEST_F(Appearance, NonsenseIsPassedOver) {
  appearance_.settingChanged("org.gnome.desktop.interface", "text-scaling-factor", "large");
  appearance_.settingChanged("org.gnome.desktop.interface", "text-scaling-factor", -1.0);
  appearance_.settingChanged("org.gnome.desktop.interface", "gtk-theme", "dark");
  EXPECT_EQ(appearance_.textScale(), 1);
  EXPECT_FALSE(appearance_.dark());
}

constexpr auto path = "/org/freedesktop/portal/desktop";
constexpr auto interface = "org.freedesktop.portal.Settings";

QVariant wrapped(const QVariant& value) { return QVariant::fromValue(QDBusVariant(value)); }

// Answers as a portal does: the method returns a value in a variant inside a variant.
class Portal : public QDBusVirtualObject {
 public:
  std::map<QString, QVariant> settings;

  [[nodiscard]] QString introspect(const QString& /*path*/) const override { return {}; }
  bool handleMessage(const QDBusMessage& call, const QDBusConnection& connection) override {
    if (call.interface() != QLatin1String(interface) || call.member() != QLatin1String("Read")) return false;
    const auto found = settings.find(call.arguments().at(0).toString() + ' ' + call.arguments().at(1).toString());
    return connection.send(found == settings.end() ? call.createErrorReply("org.freedesktop.portal.Error.NotFound", "")
                                                   : call.createReply(wrapped(wrapped(found->second))));
  }
};

class AppearanceOverPortal : public ::testing::Test {
 protected:
  void SetUp() override {
    ASSERT_TRUE(daemon_.waitForOutput("\n"));
    const QString address = QString::fromStdString(daemon_.output()).trimmed();
    desktop_ = QDBusConnection::connectToBus(address, "desktop");
    ASSERT_TRUE(desktop_.isConnected());
    viewer_ = QDBusConnection::connectToBus(address, "viewer");
  }
  ~AppearanceOverPortal() override {
    QDBusConnection::disconnectFromBus("desktop");
    QDBusConnection::disconnectFromBus("viewer");
  }

  void startPortal() {
    ASSERT_TRUE(desktop_.registerVirtualObject(path, &portal_));
    ASSERT_TRUE(desktop_.registerService("org.freedesktop.portal.Desktop"));
  }
  void change(const QString& group, const QString& key, const QVariant& value) {
    QDBusMessage signal = QDBusMessage::createSignal(path, interface, "SettingChanged");
    signal.setArguments({group, key, wrapped(value)});
    ASSERT_TRUE(desktop_.send(signal));
  }
  bool becomesDark(bool dark) {
    return QTest::qWaitFor([&] { return appearance_.dark() == dark; });
  }

  Portal portal_;
  quick::Appearance appearance_;
  QDBusConnection viewer_{QString()};

 private:
  Process daemon_{"/usr/bin/dbus-daemon", {"--session", "--nofork", "--print-address"}};
  QDBusConnection desktop_{QString()};
};

TEST_F(AppearanceOverPortal, WhatTheDesktopPrefersIsAskedForAtStart) {
  portal_.settings = {{"org.freedesktop.appearance color-scheme", 1U},
                      {"org.gnome.desktop.interface text-scaling-factor", 1.25}};
  startPortal();
  appearance_.followDesktop(viewer_);
  EXPECT_TRUE(becomesDark(true));
  EXPECT_TRUE(QTest::qWaitFor([&] { return appearance_.textScale() == 1.25; }));
}

TEST_F(AppearanceOverPortal, ChangesAreFollowed) {
  startPortal();
  appearance_.followDesktop(viewer_);
  change("org.freedesktop.appearance", "color-scheme", 1U);
  EXPECT_TRUE(becomesDark(true));
  change("org.gnome.desktop.interface", "text-scaling-factor", 1.5);
  EXPECT_TRUE(QTest::qWaitFor([&] { return appearance_.textScale() == 1.5; }));
  change("org.freedesktop.appearance", "color-scheme", 2U);
  EXPECT_TRUE(becomesDark(false));
}

TEST_F(AppearanceOverPortal, APortalThatComesLaterIsFollowed) {
  appearance_.followDesktop(viewer_);
  startPortal();
  // The viewer learns of the portal's name on its own connection, asynchronously.
  EXPECT_TRUE(QTest::qWaitFor([&] {
    change("org.freedesktop.appearance", "color-scheme", 1U);
    return appearance_.dark();
  }));
}

TEST_F(AppearanceOverPortal, WithoutABusNothingChanges) {
  appearance_.followDesktop(QDBusConnection("nobody"));
  EXPECT_FALSE(appearance_.dark());
  EXPECT_EQ(appearance_.textScale(), 1);
}

}  // namespace
}  // namespace vespscope::test
