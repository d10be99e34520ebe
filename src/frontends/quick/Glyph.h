// A small line drawing on a 24 by 24 grid, for buttons: drawn as a path, so that it needs neither image files nor
// fonts.
#pragma once

#include <QColor>
#include <QQuickPaintedItem>
#include <QString>

#include <QtQml/qqmlregistration.h>

namespace vespscope::quick {

class Glyph : public QQuickPaintedItem {
  Q_OBJECT
  QML_ELEMENT
  Q_PROPERTY(QString name READ name WRITE setName NOTIFY nameChanged)
  Q_PROPERTY(QColor color READ color WRITE setColor NOTIFY colorChanged)

 public:
  explicit Glyph(QQuickItem* parent = nullptr);
  void paint(QPainter* painter) override;

  [[nodiscard]] const QString& name() const { return name_; }
  // "back", "forward", "search", "close", "more", "copy", "log", "sun", "moon", "mark"; any other name draws nothing.
  void setName(const QString& name);
  [[nodiscard]] QColor color() const { return color_; }
  void setColor(const QColor& color);

 signals:
  void nameChanged();
  void colorChanged();

 private:
  QString name_;
  QColor color_;
};

}  // namespace vespscope::quick
