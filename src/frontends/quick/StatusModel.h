// What the window says about the source of the data, as texts that are kept current.
#pragma once

#include <QObject>
#include <QString>
#include <QTimer>
#include <chrono>

#include <QtQml/qqmlregistration.h>

#include "platform/application/Status.h"

namespace vespscope::quick {

class StatusModel : public QObject {
  Q_OBJECT
  QML_ELEMENT
  QML_UNCREATABLE("made for the application")
  Q_PROPERTY(Level level READ level NOTIFY changed)
  Q_PROPERTY(QString kind READ kind NOTIFY changed)
  Q_PROPERTY(QString source READ source NOTIFY changed)
  Q_PROPERTY(QString connection READ connection NOTIFY changed)
  Q_PROPERTY(QString lastEvent READ lastEvent NOTIFY changed)
  Q_PROPERTY(QString events READ events NOTIFY changed)
  Q_PROPERTY(QString rate READ rate NOTIFY changed)
  Q_PROPERTY(QString failures READ failures NOTIFY changed)
  Q_PROPERTY(QString lost READ lost NOTIFY changed)
  Q_PROPERTY(QString freshness READ freshness NOTIFY changed)
  Q_PROPERTY(QString trouble READ trouble NOTIFY changed)
  Q_PROPERTY(QString waiting READ waiting NOTIFY changed)

 public:
  // How well the data flows: not connected, nothing lately, or current.
  enum class Level { Disconnected, Silent, Flowing };
  Q_ENUM(Level)

  // An empty provider says that the source is unknown.
  explicit StatusModel(application::StatusProvider provider, QObject* parent = nullptr);

  [[nodiscard]] Level level() const;
  [[nodiscard]] QString kind() const;
  [[nodiscard]] QString source() const { return QString::fromStdString(status_.source); }
  [[nodiscard]] QString connection() const;
  [[nodiscard]] QString lastEvent() const;
  [[nodiscard]] QString events() const;
  [[nodiscard]] QString rate() const;
  [[nodiscard]] QString failures() const;
  [[nodiscard]] QString lost() const;
  // How current the data is: the age of the last event, and whether the connection is being made again.
  [[nodiscard]] QString freshness() const;
  // Events that were lost or could not be decoded, empty if there are none.
  [[nodiscard]] QString trouble() const;
  // What a table without rows waits for.
  [[nodiscard]] QString waiting() const;

  // Asks the provider again.
  Q_INVOKABLE void refresh();

 signals:
  void changed();

 private:
  application::StatusProvider provider_;
  application::Status status_;
  std::chrono::system_clock::time_point readAt_;
  QTimer timer_;
};

// "now" below a second, then "3 s ago", "4 min ago", "5 h ago", "6 d ago".
[[nodiscard]] QString ageText(std::chrono::system_clock::duration age);

}  // namespace vespscope::quick
