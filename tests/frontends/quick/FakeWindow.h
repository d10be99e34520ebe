// A window with screens whose contents a test sets.
#pragma once

#include <QAccessible>
#include <QClipboard>
#include <QGuiApplication>
#include <QString>
#include <string>
#include <tuple>

#include "frontends/quick/Hand.h"
#include "frontends/terminal/FakeScreens.h"

namespace vespscope::test {

inline constexpr QSize phone(360, 720);
inline constexpr QSize smallPhone(320, 568);
inline constexpr QSize turned(720, 360);
inline constexpr QSize wide(1280, 800);

class FakeWindow : public WindowTest {
 protected:
  FakeWindow() {
    fake_.root->table = leadingRows({"Red", "Green", "Blue"});
    fake_.detail->table = {{valueSection("Light 1", {{"wavelength", "532"}, {"unit", "nm"}}),
                            valueSection("Light 2", {{"wavelength", "633"}, {"unit", "nm"}})}};
    fake_.application.status = [this] { return status_; };
  }

  static QString clipboard() { return QGuiApplication::clipboard()->text(); }
  // The message that the window shows for a moment, empty if there is none.
  static QString toast(Hand& hand) {
    const auto shown = Hand::itemsOfType(hand.window()->contentItem(), "Toast");
    return shown.empty() ? QString() : QAccessible::queryAccessibleInterface(shown.front())->text(QAccessible::Name);
  }
  static bool shows(Hand& hand, const char* type) {
    return !Hand::itemsOfType(hand.window()->contentItem(), type).empty();
  }
  static QQuickItem* header(Hand& hand) { return Hand::itemsOfType(hand.window()->contentItem(), "StatusBar").front(); }

  application::Status status_;
  FakeApplication fake_;
};

// Sizes and text scales that every function must support.
using Fit = std::tuple<QSize, double>;
inline const auto fits =
    ::testing::Combine(::testing::Values(smallPhone, phone, turned, wide), ::testing::Values(1.0, 1.5));

inline std::string nameOfFit(const ::testing::TestParamInfo<Fit>& fit) {
  const QSize size = std::get<0>(fit.param);
  return std::to_string(size.width()) + "x" + std::to_string(size.height()) +
         (std::get<1>(fit.param) > 1 ? "Large" : "");
}

}  // namespace vespscope::test
