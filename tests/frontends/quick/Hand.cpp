#include "frontends/quick/Hand.h"

#include <QAccessible>
#include <QPointingDevice>
#include <QTest>
#include <QWheelEvent>
#include <algorithm>
#include <cmath>
#include <cstdio>

namespace vespscope::test {
namespace {

std::vector<std::string>& warnings() {
  static std::vector<std::string> texts;
  return texts;
}

void note(QtMsgType type, const QMessageLogContext& /*context*/, const QString& text) {
  if (type == QtDebugMsg || type == QtInfoMsg) return;
  // The offscreen platform prints this for any window with a minimum size.
  if (text == QLatin1String("This plugin does not support propagateSizeHints()")) return;
  std::fprintf(stderr, "%s\n", text.toStdString().c_str());
  warnings().push_back(text.toStdString());
}

QPoint middleOf(const QQuickItem* item) { return Hand::placeOf(item).center().toPoint(); }

QPointingDevice* finger() {
  static QPointingDevice* device = QTest::createTouchDevice();
  return device;
}

void collect(QQuickItem* item, const std::function<bool(QQuickItem*)>& condition, std::vector<QQuickItem*>& found) {
  if (!item->isVisible()) return;
  if (condition(item)) found.push_back(item);
  for (QQuickItem* child : item->childItems()) collect(child, condition, found);
}

}  // namespace

Hand::Hand(application::Application& application, QSize size)
    : main_(std::make_unique<quick::MainWindow>(application)) {
  resize(size);
  EXPECT_TRUE(QTest::qWaitForWindowExposed(window()));
  window()->requestActivate();
  EXPECT_TRUE(QTest::qWaitForWindowActive(window()));
  settle();
}

Hand::~Hand() = default;

void Hand::resize(QSize size) {
  window()->resize(size);
  EXPECT_TRUE(until([&] { return window()->contentItem()->size().toSize() == size; }));
  settle();
}

void Hand::click(QQuickItem* item) {
  ASSERT_NE(item, nullptr);
  QTest::mouseClick(window(), Qt::LeftButton, Qt::NoModifier, middleOf(item));
  settle();
}

void Hand::tap(QQuickItem* item) {
  ASSERT_NE(item, nullptr);
  const QPoint point = middleOf(item);
  QTest::touchEvent(window(), finger()).press(0, point, window());
  QTest::touchEvent(window(), finger()).release(0, point, window());
  settle();
}

void Hand::swipe(QPoint from, QPoint to) {
  constexpr int steps = 12;
  QTest::touchEvent(window(), finger()).press(0, from, window());
  for (int step = 1; step <= steps; ++step) {
    QTest::qWait(8);
    QTest::touchEvent(window(), finger()).move(0, from + (to - from) * step / steps, window());
  }
  // A finger that rests before it is lifted does not flick.
  QTest::qWait(120);
  QTest::touchEvent(window(), finger()).move(0, to, window());
  QTest::touchEvent(window(), finger()).release(0, to, window());
  settle();
}

void Hand::wheel(QQuickItem* item, int notches) {
  const QPointF point = placeOf(item).center();
  QWheelEvent event(point, window()->mapToGlobal(point), QPoint(), QPoint(0, 120 * notches), Qt::NoButton,
                    Qt::NoModifier, Qt::NoScrollPhase, false);
  // An event at the same time as the previous one is ignored.
  static quint64 time = 0;
  time += 16;
  event.setTimestamp(time);
  QCoreApplication::sendEvent(window(), &event);
  EXPECT_TRUE(until([&] { return !item->property("moving").toBool(); }));
  settle();
}

void Hand::key(Qt::Key key, Qt::KeyboardModifiers modifiers) {
  QTest::keyClick(window(), key, modifiers);
  settle();
}

void Hand::type(const QString& text) {
  for (const QChar letter : text) QTest::keyClick(window(), letter.toLatin1());
  settle();
}

bool Hand::until(const std::function<bool()>& condition) { return QTest::qWaitFor(condition, 5000); }

void Hand::settle() {
  QCoreApplication::processEvents();
  const auto all = itemsOfType(window()->contentItem(), "Pages");
  ASSERT_EQ(all.size(), 1U);
  QQuickItem* pages = all.front();
  EXPECT_TRUE(until([&] {
    const double goal = std::max(0, depth() - pages->property("columns").toInt());
    return !pages->property("sliding").toBool() && pages->property("shift").toDouble() == goal;
  })) << "pages keep sliding";
  QTest::qWait(0);
  window()->grabWindow();  // completes pending layout and drawing
  QCoreApplication::processEvents();
}

QQuickItem* Hand::page() {
  for (QQuickItem* each : pages()) {
    if (each->property("topmost").toBool()) return each;
  }
  ADD_FAILURE() << "no topmost page";
  return nullptr;
}

std::vector<QQuickItem*> Hand::pages() { return itemsOfType(window()->contentItem(), "TablePage"); }

std::string Hand::title() {
  return QAccessible::queryAccessibleInterface(page())->text(QAccessible::Name).toStdString();
}

QQuickItem* Hand::list(QQuickItem* page) {
  const auto found = itemsWhere(page, [](QQuickItem* item) { return item->objectName() == QLatin1String("lines"); });
  EXPECT_EQ(found.size(), 1U);
  return found.front();
}

std::vector<QQuickItem*> Hand::lines(QQuickItem* page) {
  const QRectF view = placeOf(list(page));
  auto found =
      itemsWhere(page, [&](QQuickItem* item) { return isOfType(item, "TableLine") && placeOf(item).intersects(view); });
  std::sort(found.begin(), found.end(), [](const QQuickItem* one, const QQuickItem* other) {
    return one->property("index").toInt() < other->property("index").toInt();
  });
  return found;
}

QQuickItem* Hand::line(QQuickItem* page, const QString& label) {
  for (QQuickItem* each : lines(page)) {
    if (each->property("label").toString() == label) return each;
  }
  return nullptr;
}

QQuickItem* Hand::button(const QString& name) {
  const auto found = itemsWhere(window()->contentItem(), [&](QQuickItem* item) {
    const QAccessibleInterface* reader = QAccessible::queryAccessibleInterface(item);
    return reader != nullptr && (reader->role() == QAccessible::Button || reader->role() == QAccessible::MenuItem) &&
           reader->text(QAccessible::Name) == name;
  });
  return found.empty() ? nullptr : found.front();
}

application::TableSnapshot Hand::readPageByPage() {
  application::TableSnapshot table;
  int read = 0;
  // Paging through a list can show another page next to it.
  QQuickItem* const whole = page();
  const auto take = [&] {
    for (const QQuickItem* line : lines(whole)) {
      if (line->property("index").toInt() != read) continue;
      ++read;
      const std::string label = line->property("label").toString().toStdString();
      if (line->property("header").toBool()) {
        table.sections.push_back({label, {}});
        continue;
      }
      if (table.sections.empty() || line->property("apart").toBool()) table.sections.emplace_back();
      application::RowSnapshot row{label, std::nullopt, line->property("disclosure").toBool()};
      if (line->property("hasValue").toBool()) row.value = line->property("value").toString().toStdString();
      table.sections.back().rows.push_back(std::move(row));
    }
  };
  take();
  while (!list(whole)->property("atYEnd").toBool()) {
    const double before = list(whole)->property("contentY").toDouble();
    key(Qt::Key_PageDown);
    take();
    if (list(whole)->property("contentY").toDouble() == before) break;
  }
  EXPECT_EQ(read, main_->navigation().tableAt(whole->property("level").toInt())->count())
      << "not every line came into view";
  return table;
}

std::vector<QQuickItem*> Hand::itemsOfType(QQuickItem* root, const char* type) {
  return itemsWhere(root, [&](QQuickItem* item) { return isOfType(item, type); });
}

std::vector<QQuickItem*> Hand::itemsWhere(QQuickItem* root, const std::function<bool(QQuickItem*)>& condition) {
  std::vector<QQuickItem*> found;
  collect(root, condition, found);
  return found;
}

bool Hand::isOfType(const QQuickItem* item, const char* type) {
  const std::string name = item->metaObject()->className();
  return name.starts_with(std::string(type) + "_QML");
}

QRectF Hand::placeOf(const QQuickItem* item) { return item->mapRectToScene(item->boundingRect()); }

WindowTest::WindowTest() {
  warnings().clear();
  qInstallMessageHandler(note);
}

WindowTest::~WindowTest() { qInstallMessageHandler(nullptr); }

void WindowTest::TearDown() { EXPECT_EQ(warnings(), std::vector<std::string>()); }

}  // namespace vespscope::test
