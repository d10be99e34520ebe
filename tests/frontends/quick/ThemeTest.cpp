// The colours: every text is readable on its background, in light and in dark.
#include <QColor>
#include <QQmlComponent>
#include <QQmlEngine>
#include <QTest>
#include <cmath>

#include <gtest/gtest.h>

#include "frontends/quick/FakeWindow.h"

namespace vespscope::test {
namespace {

double linear(double channel) {
  return channel <= 0.04045 ? channel / 12.92 : std::pow((channel + 0.055) / 1.055, 2.4);
}

// Relative luminance and contrast as defined in the web's accessibility guidelines (WCAG 2.1).
double luminance(const QColor& color) {
  return 0.2126 * linear(color.redF()) + 0.7152 * linear(color.greenF()) + 0.0722 * linear(color.blueF());
}

double contrast(const QColor& one, const QColor& other) {
  const double brighter = std::max(luminance(one), luminance(other));
  const double darker = std::min(luminance(one), luminance(other));
  return (brighter + 0.05) / (darker + 0.05);
}

class Theme : public FakeWindow {
 protected:
  static QObject* themeOf(Hand& hand) {
    QQmlComponent component(qmlEngine(hand.window()));
    component.setData("import QtQuick; import Vespscope.Quick; QtObject { property QtObject theme: Theme }", QUrl());
    const std::unique_ptr<QObject> holder(component.create());
    return holder ? holder->property("theme").value<QObject*>() : nullptr;
  }
};

TEST_F(Theme, ContrastOfWhiteAndBlackIsTwentyOne) {
  EXPECT_NEAR(contrast(QColor("#ffffff"), QColor("#000000")), 21, 0.01);
  EXPECT_NEAR(contrast(QColor("#777777"), QColor("#ffffff")), 4.48, 0.01);
}

TEST_F(Theme, EveryTextIsReadableOnItsSurface) {
  Hand hand(fake_.application, {360, 720});
  QObject* theme = themeOf(hand);
  ASSERT_NE(theme, nullptr);
  const std::vector<std::pair<const char*, std::vector<const char*>>> pairs = {
      {"text", {"window", "bar", "card", "hovered", "pressed", "changed"}},
      {"secondaryText", {"window", "bar", "card", "hovered", "pressed", "changed"}},
      {"accentText", {"window", "bar", "card", "hovered", "pressed", "changed"}},
      {"goodText", {"bar"}},
      {"playbackText", {"bar"}},
      {"simulatedText", {"bar"}},
      {"badText", {"bar"}},
      {"accentInk", {"accent"}},
      {"toastInk", {"toast"}},
  };
  for (const auto mode : {quick::Appearance::Mode::Light, quick::Appearance::Mode::Dark}) {
    hand.main().appearance().setMode(mode);
    for (const auto& [ink, surfaces] : pairs) {
      for (const char* surface : surfaces) {
        const QVariant above = theme->property(ink);
        const QVariant below = theme->property(surface);
        ASSERT_TRUE(above.isValid() && below.isValid()) << ink << " on " << surface;
        EXPECT_GE(contrast(above.value<QColor>(), below.value<QColor>()), 4.5) << ink << " on " << surface;
      }
    }
    EXPECT_GE(contrast(theme->property("border").value<QColor>(), theme->property("card").value<QColor>()), 3)
        << "the edge of a field";
  }
}

TEST_F(Theme, DarkAndLightAreDrawn) {
  Hand hand(fake_.application, {360, 720});
  hand.main().appearance().setMode(quick::Appearance::Mode::Dark);
  hand.settle();
  EXPECT_LT(hand.window()->grabWindow().pixelColor(5, 700).lightness(), 50);
  hand.key(Qt::Key_D, Qt::ControlModifier);
  EXPECT_GT(hand.window()->grabWindow().pixelColor(5, 700).lightness(), 220);
  EXPECT_EQ(hand.main().appearance().mode(), quick::Appearance::Mode::Light);
}

}  // namespace
}  // namespace vespscope::test
