// A user's hand and eye: opens the window, sends it real mouse, touch and key events, and reads what it shows.
#pragma once

#include <QPoint>
#include <QQuickItem>
#include <QQuickWindow>
#include <QString>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "frontends/quick/MainWindow.h"
#include "platform/application/TableSnapshot.h"

namespace vespscope::test {

class Hand {
 public:
  // Opens the application's window at this size.
  Hand(application::Application& application, QSize size);
  ~Hand();

  [[nodiscard]] quick::MainWindow& main() { return *main_; }
  [[nodiscard]] QQuickWindow* window() const { return main_->window(); }

  void resize(QSize size);
  void click(QQuickItem* item);
  void tap(QQuickItem* item);
  // With the finger, in steps, from one point of the window to another.
  void swipe(QPoint from, QPoint to);
  // Turns the mouse's wheel over a list, downwards if negative, and waits until it stands still.
  void wheel(QQuickItem* item, int notches);
  void key(Qt::Key key, Qt::KeyboardModifiers modifiers = Qt::NoModifier);
  void type(const QString& text);

  // Lets the window work until the condition holds; false if that takes longer than five seconds.
  [[nodiscard]] static bool until(const std::function<bool()>& condition);
  // Waits until no page slides and everything is laid out.
  void settle();

  [[nodiscard]] int depth() { return main_->navigation().depth(); }
  // The page of the topmost screen, and what it says at its top.
  [[nodiscard]] QQuickItem* page();
  [[nodiscard]] std::vector<QQuickItem*> pages();
  [[nodiscard]] std::string title();
  // The list of a page's lines.
  [[nodiscard]] QQuickItem* list() { return list(page()); }
  [[nodiscard]] QQuickItem* list(QQuickItem* page);
  // The lines of a page that are in view, from top to bottom; of one with this label, null if it is not in view.
  [[nodiscard]] std::vector<QQuickItem*> lines(QQuickItem* page);
  [[nodiscard]] QQuickItem* line(const QString& label) { return line(page(), label); }
  [[nodiscard]] QQuickItem* line(QQuickItem* page, const QString& label);
  // The button that screen readers know under this name, null if none is in view.
  [[nodiscard]] QQuickItem* button(const QString& name);
  // Everything that the page shows, read from its lines while the keys page from the first to the last.
  [[nodiscard]] application::TableSnapshot readPageByPage();

  // All items in view below `root` whose QML type is `type`, or that satisfy a condition.
  [[nodiscard]] static std::vector<QQuickItem*> itemsOfType(QQuickItem* root, const char* type);
  [[nodiscard]] static std::vector<QQuickItem*> itemsWhere(QQuickItem* root,
                                                           const std::function<bool(QQuickItem*)>& condition);
  [[nodiscard]] static bool isOfType(const QQuickItem* item, const char* type);
  // In the window's coordinates.
  [[nodiscard]] static QRectF placeOf(const QQuickItem* item);

 private:
  std::unique_ptr<quick::MainWindow> main_;
};

// Fails the test when the toolkit warns of anything.
class WindowTest : public ::testing::Test {
 protected:
  WindowTest();
  ~WindowTest() override;
  void TearDown() override;
};

}  // namespace vespscope::test
