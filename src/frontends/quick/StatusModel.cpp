#include "frontends/quick/StatusModel.h"

#include <QLocale>
#include <utility>

#include "platform/application/ClockText.h"
#include "platform/application/StatusText.h"
#include "values/Text.h"

namespace vespscope::quick {
namespace {

using namespace std::chrono_literals;
using application::Flow;

QString text(std::string_view words) { return QString::fromUtf8(words.data(), static_cast<qsizetype>(words.size())); }

QString number(std::uint64_t count) { return QLocale().toString(static_cast<qulonglong>(count)); }

QString joined(const QStringList& parts) { return parts.join(QStringLiteral(" · ")); }

StatusModel::Tone toneOf(SourceKind kind) {
  switch (kind) {
    case SourceKind::live:
      return StatusModel::Tone::Live;
    case SourceKind::recorded:
      return StatusModel::Tone::Playback;
    case SourceKind::simulated:
      return StatusModel::Tone::Simulated;
    case SourceKind::unknown:
      break;
  }
  return StatusModel::Tone::Unknown;
}

}  // namespace

StatusModel::StatusModel(application::StatusProvider provider, QObject* parent)
    : QObject(parent), provider_(std::move(provider)) {
  refresh();
  connect(&timer_, &QTimer::timeout, this, &StatusModel::refresh);
  timer_.start(500ms);
}

void StatusModel::refresh() {
  if (provider_) status_ = provider_();
  // These words may come from a file's name, a modem or another machine.
  status_.source = printable(status_.source);
  readAt_ = std::chrono::system_clock::now();
  emit changed();
}

StatusModel::Tone StatusModel::tone() const {
  switch (application::flowOf(status_, readAt_)) {
    case Flow::disconnected:
      return Tone::Disconnected;
    case Flow::notSubscribed:
      return Tone::Waiting;
    case Flow::silent:
      // A recording's own clock shows whether it is playing.
      return status_.kind == SourceKind::recorded ? Tone::Playback : Tone::Waiting;
    case Flow::ended:
    case Flow::flowing:
      break;
  }
  return toneOf(status_.kind);
}

QString StatusModel::kind() const { return text(application::sourceName(status_.kind)); }

QString StatusModel::sim() const { return text(application::simText(status_.sims)); }

QString StatusModel::nextSim() const {
  const auto next = application::nextSim(status_.sims);
  return next ? tr("SIM %1").arg(*next) : QString();
}

QString StatusModel::flow() const {
  return tr("%1 events · %2 per second")
      .arg(number(status_.events), QLocale().toString(status_.eventsPerSecond, 'f', 1));
}

QString StatusModel::lastEvent() const {
  return status_.lastEvent ? text(application::agoText(readAt_ - *status_.lastEvent)) : tr("no event yet");
}

QString StatusModel::time() const {
  const Flow flow = application::flowOf(status_, readAt_);
  const bool well = flow == Flow::flowing || flow == Flow::silent;
  QStringList parts;
  if (!well) parts << text(application::connectionText(status_));
  if (status_.playback) {
    if (flow != Flow::ended) parts << text(application::timeOfDay(application::clockOf(*status_.playback)));
    parts << text(application::playbackText(*status_.playback));
  } else if (status_.kind == SourceKind::recorded) {
    // The position is unknown, and a recording's age by today's clock is meaningless.
    if (well) parts << text(application::connectionText(status_));
  } else if (well || status_.lastEvent) {
    parts << lastEvent();
  }
  return joined(parts);
}

QString StatusModel::trouble() const {
  QStringList parts;
  for (const std::string& part : application::troubleTexts(status_)) parts << text(part);
  return joined(parts);
}

QString StatusModel::reason() const { return text(application::reasonText(status_)); }

QString StatusModel::summary() const {
  QStringList parts{kind() + QLatin1Char(' ') + source()};
  for (const QString& part : {sim(), time(), reason(), trouble()}) {
    if (!part.isEmpty()) parts << part;
  }
  return parts.join(QStringLiteral(", "));
}

QList<StatusModel::Fact> StatusModel::facts() const {
  application::Status manager = status_;
  manager.playback.reset();  // the end of a recording is not a problem of the connection
  QList<Fact> facts{{kind(), source()}, {tr("Baseband manager"), text(application::connectionText(manager))}};
  if (!reason().isEmpty()) facts << Fact{tr("Reason"), reason()};
  if (!sim().isEmpty()) facts << Fact{tr("SIM card shown"), sim()};
  if (status_.playback) {
    const QString position = text(application::playbackText(*status_.playback));
    facts << Fact{tr("Position"), status_.playback->ended ? joined({position, tr("end of recording")}) : position};
    facts << Fact{tr("Recording's clock"), text(application::dateAndTime(application::clockOf(*status_.playback)))};
  } else if (status_.kind != SourceKind::recorded) {
    facts << Fact{tr("Last event"), lastEvent()};
  }
  facts << Fact{tr("Events"), number(status_.events)}
        << Fact{tr("Events per second"), QLocale().toString(status_.eventsPerSecond, 'f', 1)}
        << Fact{tr("Decode failures"), number(status_.decodeFailures)} << Fact{tr("Lost"), number(status_.eventsLost)};
  if (status_.interruptions > 0) facts << Fact{tr("Gaps"), number(status_.interruptions)};
  return facts;
}

QStringList StatusModel::factNames() const {
  QStringList names;
  for (const Fact& fact : facts()) names << fact.name;
  return names;
}

QStringList StatusModel::factValues() const {
  QStringList values;
  for (const Fact& fact : facts()) values << fact.value;
  return values;
}

QString StatusModel::waiting() const { return text(application::waitingText(&status_, false)); }
QString StatusModel::waitingForEntries() const { return text(application::waitingText(&status_, true)); }

}  // namespace vespscope::quick
