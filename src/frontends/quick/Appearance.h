// Light or dark, and the text size: the system's preference until the user changes it.
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

  // Requests the desktop's settings and follows their changes; the answer arrives through the event loop.
  void followDesktop(const QDBusConnection& desktop = QDBusConnection::sessionBus());

  [[nodiscard]] Mode mode() const { return mode_; }
  void setMode(Mode mode);
  [[nodiscard]] bool dark() const;
  [[nodiscard]] double textScale() const { return textScale_; }
  void setTextScale(double scale);

  // Switches from the scheme shown to the other one.
  Q_INVOKABLE void toggle();
  // Changes the text size by this many steps of an eighth; 0 restores the system's size.
  Q_INVOKABLE void zoom(int steps);

  // Applies a desktop setting by its name; unknown settings are ignored.
  void settingChanged(const QString& group, const QString& key, const QVariant& value);

 signals:
  void changed();

 private:
  // Receives the portal's signal, so its parameters must have the signal's types.
  Q_SLOT void hear(const QString& group, const QString& key, const QDBusVariant& value);
  void ask(const QDBusConnection& desktop, const QString& group, const QString& key);

  Mode mode_ = Mode::System;
  bool systemDark_ = false;
  double systemTextScale_ = 1.0;
  double textScale_ = 1.0;
};

}  // namespace vespscope::quick
