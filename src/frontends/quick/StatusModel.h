// The window's texts about the source of the data, kept current.
#pragma once

#include <QObject>
#include <QString>
#include <QStringList>
#include <QTimer>
#include <chrono>

#include <QtQml/qqmlregistration.h>

#include "platform/application/Status.h"

namespace vespscope::quick {

class StatusModel : public QObject {
  Q_OBJECT
  QML_ELEMENT
  QML_UNCREATABLE("made for the application")
  Q_PROPERTY(Tone tone READ tone NOTIFY changed)
  Q_PROPERTY(QString kind READ kind NOTIFY changed)
  Q_PROPERTY(QString source READ source NOTIFY changed)
  Q_PROPERTY(QString sim READ sim NOTIFY changed)
  Q_PROPERTY(QString nextSim READ nextSim NOTIFY changed)
  Q_PROPERTY(QString flow READ flow NOTIFY changed)
  Q_PROPERTY(QString time READ time NOTIFY changed)
  Q_PROPERTY(QString trouble READ trouble NOTIFY changed)
  Q_PROPERTY(QString reason READ reason NOTIFY changed)
  Q_PROPERTY(QString summary READ summary NOTIFY changed)
  Q_PROPERTY(QStringList factNames READ factNames NOTIFY changed)
  Q_PROPERTY(QStringList factValues READ factValues NOTIFY changed)
  Q_PROPERTY(QString waiting READ waiting NOTIFY changed)
  Q_PROPERTY(QString waitingForEntries READ waitingForEntries NOTIFY changed)

 public:
  // The source's colour: by its problem, else by its kind.
  enum class Tone { Disconnected, Waiting, Live, Playback, Simulated, Unknown };
  Q_ENUM(Tone)

  // Without a provider the source is unknown.
  explicit StatusModel(application::StatusProvider provider, QObject* parent = nullptr);

  [[nodiscard]] Tone tone() const;
  [[nodiscard]] QString kind() const;
  [[nodiscard]] QString source() const { return QString::fromStdString(status_.source); }
  // "SIM 1 (also SIM 2)", and "SIM 2", which comes next; empty while one card reports at most.
  [[nodiscard]] QString sim() const;
  [[nodiscard]] QString nextSim() const;
  // "1,234 events · 5.0 per second".
  [[nodiscard]] QString flow() const;
  // The connection if it has a problem, and the age of the last event; for a recording its own clock and its position.
  [[nodiscard]] QString time() const;
  // The problems with events; empty if there are none.
  [[nodiscard]] QString trouble() const;
  // Why there is no connection or no subscription; empty when there are both.
  [[nodiscard]] QString reason() const;
  // All of the header in one sentence, for screen readers.
  [[nodiscard]] QString summary() const;
  // The facts about the source and their names, in the same order; both lists have the same length.
  [[nodiscard]] QStringList factNames() const;
  [[nodiscard]] QStringList factValues() const;
  // What a table without rows waits for, before its metric has arrived and after.
  [[nodiscard]] QString waiting() const;
  [[nodiscard]] QString waitingForEntries() const;

  // Reads the provider again.
  Q_INVOKABLE void refresh();

 signals:
  void changed();

 private:
  struct Fact {
    QString name;
    QString value;
  };
  [[nodiscard]] QList<Fact> facts() const;
  [[nodiscard]] QString lastEvent() const;

  application::StatusProvider provider_;
  application::Status status_;
  std::chrono::system_clock::time_point readAt_;
  QTimer timer_;
};

}  // namespace vespscope::quick
