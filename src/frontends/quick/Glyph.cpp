#include "frontends/quick/Glyph.h"

#include <QPainter>
#include <QPainterPath>
#include <cmath>
#include <numbers>

namespace vespscope::quick {
namespace {

constexpr double grid = 24;

void polyline(QPainterPath& path, std::initializer_list<QPointF> points) {
  path.moveTo(*points.begin());
  for (const QPointF* point = points.begin() + 1; point != points.end(); ++point) path.lineTo(*point);
}

QPointF around(double radius, double degrees) {
  const double angle = degrees * std::numbers::pi / 180;
  return {12 + radius * std::cos(angle), 12 + radius * std::sin(angle)};
}

QPainterPath moon() {
  QPainterPath disc;
  disc.addEllipse(QPointF(11.5, 12.5), 8, 8);
  QPainterPath bite;
  bite.addEllipse(QPointF(16, 8.5), 7, 7);
  return disc.subtracted(bite);
}

QPainterPath outline(const QString& name) {
  QPainterPath path;
  if (name == QLatin1String("back")) {
    polyline(path, {{15, 5}, {8, 12}, {15, 19}});
  } else if (name == QLatin1String("forward")) {
    polyline(path, {{9, 5}, {16, 12}, {9, 19}});
  } else if (name == QLatin1String("search")) {
    path.addEllipse(QPointF(10.5, 10.5), 6, 6);
    polyline(path, {{15, 15}, {20, 20}});
  } else if (name == QLatin1String("close")) {
    polyline(path, {{6, 6}, {18, 18}});
    polyline(path, {{18, 6}, {6, 18}});
  } else if (name == QLatin1String("copy")) {
    path.addRoundedRect(QRectF(8.5, 8.5, 11, 11), 2, 2);
    polyline(path, {{15.5, 4.5}, {6.5, 4.5}, {4.5, 6.5}, {4.5, 15.5}});
  } else if (name == QLatin1String("log")) {
    for (const double y : {6.0, 12.0, 18.0}) polyline(path, {{9, y}, {20, y}});
    for (const double y : {6.0, 12.0, 18.0}) polyline(path, {{4.5, y}, {5, y}});
  } else if (name == QLatin1String("sun")) {
    path.addEllipse(QPointF(12, 12), 4, 4);
    for (int ray = 0; ray < 8; ++ray) polyline(path, {around(7.2, ray * 45), around(9, ray * 45)});
  } else if (name == QLatin1String("moon")) {
    path = moon();
  } else if (name == QLatin1String("more")) {
    for (const double y : {5.5, 12.0, 18.5}) path.addEllipse(QPointF(12, y), 0.7, 0.7);
  } else if (name == QLatin1String("mark")) {
    // The program's mark: a hexagonal cell with signal bars.
    polyline(path, {around(10, -90), around(10, -30), around(10, 30), around(10, 90), around(10, 150), around(10, 210),
                    around(10, -90)});
    for (const int bar : {0, 1, 2, 3}) polyline(path, {{7.5 + 3 * bar, 16}, {7.5 + 3 * bar, 14.2 - 2 * bar}});
  }
  return path;
}

}  // namespace

Glyph::Glyph(QQuickItem* parent) : QQuickPaintedItem(parent) {
  setImplicitSize(grid, grid);
  setAntialiasing(true);
}

void Glyph::setName(const QString& name) {
  if (name == name_) return;
  name_ = name;
  emit nameChanged();
  update();
}

void Glyph::setColor(const QColor& color) {
  if (color == color_) return;
  color_ = color;
  emit colorChanged();
  update();
}

void Glyph::paint(QPainter* painter) {
  const double side = std::min(width(), height());
  painter->setRenderHint(QPainter::Antialiasing);
  painter->translate((width() - side) / 2, (height() - side) / 2);
  painter->scale(side / grid, side / grid);
  painter->setPen(QPen(color_, 1.8, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
  painter->drawPath(outline(name_));
}

}  // namespace vespscope::quick
