// Simulates a user: opens the window, sends it real mouse, touch and key events, and reads its contents.
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
  // Moves the finger in steps from one point of the window to another.
  void swipe(QPoint from, QPoint to);
  // Turns the mouse's wheel over a list, downwards if negative, and waits until the list stops moving.
  void wheel(QQuickItem* item, int notches);
  void key(Qt::Key key, Qt::KeyboardModifiers modifiers = Qt::NoModifier);
  void type(const QString& text);

  // Runs the window until the condition holds; returns false after five seconds.
  [[nodiscard]] static bool until(const std::function<bool()>& condition);
  // Waits until all pages have stopped sliding and the layout is complete.
  void settle();

  [[nodiscard]] int depth() { return main_->navigation().depth(); }
  // The page of the topmost screen, and its title.
  [[nodiscard]] QQuickItem* page();
  [[nodiscard]] std::vector<QQuickItem*> pages();
  [[nodiscard]] std::string title();
  // The list of a page's lines.
  [[nodiscard]] QQuickItem* list() { return list(page()); }
  [[nodiscard]] QQuickItem* list(QQuickItem* page);
  // The visible lines of a page, from top to bottom; the one with this label, null if it is not visible.
  [[nodiscard]] std::vector<QQuickItem*> lines(QQuickItem* page);
  [[nodiscard]] QQuickItem* line(const QString& label) { return line(page(), label); }
  [[nodiscard]] QQuickItem* line(QQuickItem* page, const QString& label);
  // The button with this name for screen readers; null if none is visible.
  [[nodiscard]] QQuickItem* button(const QString& name);
  // The whole contents of a page, read from its lines while the keys page from the first to the last.
  [[nodiscard]] application::TableSnapshot readPageByPage();

  // All visible items below `root` whose QML type is `type`, or that satisfy a condition.
  [[nodiscard]] static std::vector<QQuickItem*> itemsOfType(QQuickItem* root, const char* type);
  [[nodiscard]] static std::vector<QQuickItem*> itemsWhere(QQuickItem* root,
                                                           const std::function<bool(QQuickItem*)>& condition);
  [[nodiscard]] static bool isOfType(const QQuickItem* item, const char* type);
  // In the window's coordinates.
  [[nodiscard]] static QRectF placeOf(const QQuickItem* item);

 private:
  std::unique_ptr<quick::MainWindow> main_;
};

// Fails the test when the toolkit prints a warning.
class WindowTest : public ::testing::Test {
 protected:
  WindowTest();
  ~WindowTest() override;
  void TearDown() override;
};

}  // namespace vespscope::test
