#include "frontends/quick/LogModel.h"

#include <QClipboard>
#include <QGuiApplication>
#include <QStringList>
#include <QTime>
#include <deque>
#include <utility>

namespace vespscope::quick {

LogModel::LogModel(QObject* parent)
    : QAbstractListModel(parent),
      observation_([this](log::Channel channel, std::string_view line) { post(channel, line); }) {
  timer_.setInterval(200);
  connect(&timer_, &QTimer::timeout, this, &LogModel::takeOver);
}

void LogModel::post(log::Channel channel, std::string_view line) {
  LogLine entry{QTime::currentTime().toString(QStringLiteral("HH:mm:ss.zzz")),
                QString::fromUtf8(line.data(), static_cast<qsizetype>(line.size())),
                channel == log::Channel::systemLog};
  const std::lock_guard lock(mutex_);
  mailbox_.push(std::move(entry));
}

int LogModel::rowCount(const QModelIndex& parent) const { return parent.isValid() ? 0 : count(); }

QHash<int, QByteArray> LogModel::roleNames() const { return {{time, "time"}, {text, "text"}, {isSystem, "isSystem"}}; }

QVariant LogModel::data(const QModelIndex& index, int role) const {
  if (!checkIndex(index, CheckIndexOption::IndexIsValid)) return {};
  const LogLine& line = lines_[static_cast<std::size_t>(index.row())];
  switch (role) {
    case time:
      return line.time;
    case Qt::DisplayRole:
    case text:
      return line.text;
    case isSystem:
      return line.system;
    default:
      return {};
  }
}

void LogModel::setWatched(bool watched) {
  if (watched == watched_) return;
  watched_ = watched;
  if (watched) {
    takeOver();
    timer_.start();
  } else {
    timer_.stop();
  }
  emit watchedChanged();
}

void LogModel::takeOver() {
  std::deque<LogLine> taken;
  {
    const std::lock_guard lock(mutex_);
    taken = mailbox_.take();
  }
  if (taken.empty()) return;
  beginInsertRows({}, count(), count() + static_cast<int>(taken.size()) - 1);
  for (LogLine& line : taken) lines_.add(std::move(line));
  endInsertRows();
  if (const std::size_t dropped = lines_.excess(); dropped > 0) {
    beginRemoveRows({}, 0, static_cast<int>(dropped) - 1);
    lines_.removeOldest(dropped);
    endRemoveRows();
  }
  emit countChanged();
}

QString LogModel::copyAll() const {
  QStringList all;
  for (const LogLine& line : lines_) all << line.time + QLatin1Char(' ') + line.text;
  QGuiApplication::clipboard()->setText(all.join(QLatin1Char('\n')));
  return count() == 1 ? tr("Copied 1 line") : tr("Copied %1 lines").arg(count());
}

}  // namespace vespscope::quick
