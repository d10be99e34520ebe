#include "frontends/quick/StatusModel.h"

#include <QLocale>
#include <utility>

#include "values/Text.h"

namespace vespscope::quick {
namespace {

using namespace std::chrono_literals;

constexpr auto silence = 10s;

QString number(std::uint64_t count) { return QLocale().toString(static_cast<qulonglong>(count)); }

}  // namespace

QString ageText(std::chrono::system_clock::duration age) {
  const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(age).count();
  if (seconds < 1) return StatusModel::tr("now");
  if (seconds < 60) return StatusModel::tr("%1 s ago").arg(seconds);
  if (seconds < 3600) return StatusModel::tr("%1 min ago").arg(seconds / 60);
  if (seconds < 86400) return StatusModel::tr("%1 h ago").arg(seconds / 3600);
  return StatusModel::tr("%1 d ago").arg(seconds / 86400);
}

StatusModel::StatusModel(application::StatusProvider provider, QObject* parent)
    : QObject(parent), provider_(std::move(provider)) {
  refresh();
  connect(&timer_, &QTimer::timeout, this, &StatusModel::refresh);
  timer_.start(500ms);
}

void StatusModel::refresh() {
  if (provider_) status_ = provider_();
  // Words of a file's name, a modem or another machine.
  status_.source = printable(status_.source);
  status_.problem = printable(status_.problem);
  readAt_ = std::chrono::system_clock::now();
  emit changed();
}

StatusModel::Level StatusModel::level() const {
  if (!status_.connected) return Level::Disconnected;
  return status_.lastEvent && readAt_ - *status_.lastEvent < silence ? Level::Flowing : Level::Silent;
}

QString StatusModel::kind() const {
  switch (status_.kind) {
    case SourceKind::live:
      return tr("Live modem");
    case SourceKind::recorded:
      return tr("Recording");
    case SourceKind::simulated:
      return tr("Simulated drive");
    case SourceKind::unknown:
      break;
  }
  return tr("Unknown source");
}

QString StatusModel::connection() const { return status_.connected ? tr("connected") : tr("reconnecting"); }

QString StatusModel::lastEvent() const {
  return status_.lastEvent ? ageText(readAt_ - *status_.lastEvent) : tr("no event yet");
}

QString StatusModel::events() const { return number(status_.events); }
QString StatusModel::rate() const { return QLocale().toString(status_.eventsPerSecond, 'f', 1); }
QString StatusModel::failures() const { return number(status_.decodeFailures); }
QString StatusModel::lost() const { return number(status_.eventsLost); }

QString StatusModel::freshness() const {
  if (status_.connected) return lastEvent();
  return status_.lastEvent ? tr("%1 · %2").arg(connection(), lastEvent()) : connection();
}

QString StatusModel::trouble() const {
  QStringList parts;
  if (status_.eventsLost > 0) parts << tr("%1 lost").arg(lost());
  if (status_.interruptions > 0) {
    parts << (status_.interruptions == 1 ? tr("1 gap") : tr("%1 gaps").arg(number(status_.interruptions)));
  }
  if (status_.decodeFailures > 0) parts << tr("%1 not decoded").arg(failures());
  return parts.join(QStringLiteral(" · "));
}

QString StatusModel::waiting() const {
  if (!status_.connected) {
    const QString why = status_.problem.empty() ? QString() : " (" + QString::fromStdString(status_.problem) + ")";
    return tr("The baseband manager is not connected%1; the connection is being retried. Values appear here with the "
              "first report after that.")
        .arg(why);
  }
  if (status_.events == 0) {
    return tr(
        "Connected to the baseband manager, which has not sent any event yet. Values appear here with their "
        "first report.");
  }
  return tr("The modem has not reported these values yet. They appear here with their first report.");
}

}  // namespace vespscope::quick
