// The latest log lines as a list model.
//
// Any thread may add lines, which wait in a bounded mailbox; the list takes them only while it is shown, so that a
// flood of lines does not slow the window.
#pragma once

#include <QAbstractListModel>
#include <QString>
#include <QTimer>
#include <cstddef>
#include <mutex>

#include <QtQml/qqmlregistration.h>

#include "platform/log/LastLines.h"
#include "platform/log/Log.h"

namespace vespscope::quick {

class LogModel : public QAbstractListModel {
  Q_OBJECT
  QML_ELEMENT
  QML_UNCREATABLE("made for the application")
  Q_PROPERTY(bool watched READ watched WRITE setWatched NOTIFY watchedChanged)
  Q_PROPERTY(int count READ count NOTIFY countChanged)

 public:
  enum Role { time = Qt::UserRole, text, isSystem };
  // Older lines are dropped.
  static constexpr std::size_t capacity = log::lastLinesCapacity;

  explicit LogModel(QObject* parent = nullptr);

  [[nodiscard]] int rowCount(const QModelIndex& parent = {}) const override;
  [[nodiscard]] QVariant data(const QModelIndex& index, int role) const override;
  [[nodiscard]] QHash<int, QByteArray> roleNames() const override;
  [[nodiscard]] int count() const { return static_cast<int>(lines_.size()); }

  [[nodiscard]] bool watched() const { return watched_; }
  void setWatched(bool watched);
  // Adds the lines logged since the last call.
  void takeOver();

  // Copies all lines to the clipboard; returns a message for the user.
  Q_INVOKABLE [[nodiscard]] QString copyAll() const;

 signals:
  void watchedChanged();
  void countChanged();

 private:
  struct LogLine {
    QString time;
    QString text;
    bool system = false;
  };
  using Lines = log::LastLines<LogLine>;

  void post(log::Channel channel, std::string_view line);

  std::mutex mutex_;
  Lines mailbox_;
  Lines lines_;
  bool watched_ = false;
  QTimer timer_;
  log::Observation observation_;
};

}  // namespace vespscope::quick
