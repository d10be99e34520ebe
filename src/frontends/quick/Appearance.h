// Light or dark, and how large the text is: what the system prefers until the user says otherwise.
#pragma once

#include <QDBusConnection>
#include <QDBusVariant>
#include <QObject>
#include <QVariant>

#include <QtQml/qqmlregistration.h>

namespace vespscope::quick {

class Appearance : public QObject {
  Q_OBJECT
  QML_ELEMENT
  QML_UNCREATABLE("made for the application")
  Q_PROPERTY(Mode mode READ mode WRITE setMode NOTIFY changed)
  Q_PROPERTY(bool dark READ dark NOTIFY changed)
  Q_PROPERTY(double textScale READ textScale NOTIFY changed)

 public:
  enum class Mode { System, Light, Dark };
  Q_ENUM(Mode)

  static constexpr double smallestTextScale = 0.8;
  static constexpr double largestTextScale = 2.0;

  explicit Appearance(QObject* parent = nullptr);

  // Asks the desktop for its settings and follows them; the answer comes later through the event loop.
  void followDesktop(const QDBusConnection& desktop = QDBusConnection::sessionBus());

  [[nodiscard]] Mode mode() const { return mode_; }
  void setMode(Mode mode);
  [[nodiscard]] bool dark() const;
  [[nodiscard]] double textScale() const { return textScale_; }
  void setTextScale(double scale);

  // From whatever is shown to its opposite.
  Q_INVOKABLE void toggle();
  // By so many steps of an eighth; 0 returns to the system's size.
  Q_INVOKABLE void zoom(int steps);

  // What the desktop prefers, by the names of its settings; others are passed over.
  void settingChanged(const QString& group, const QString& key, const QVariant& value);

 signals:
  void changed();

 private:
  // Its parameters have the types in which the portal's signal arrives: with others it would not be connected.
  Q_SLOT void hear(const QString& group, const QString& key, const QDBusVariant& value);
  void ask(const QDBusConnection& desktop, const QString& group, const QString& key);

  Mode mode_ = Mode::System;
  bool systemDark_ = false;
  double systemTextScale_ = 1.0;
  double textScale_ = 1.0;
};

}  // namespace vespscope::quick
