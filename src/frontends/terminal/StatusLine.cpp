#include "frontends/terminal/StatusLine.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <optional>
#include <utility>

#include "platform/application/ClockText.h"
#include "platform/application/StatusText.h"

namespace vespscope::terminal {
namespace {

using application::Flow;
using application::Status;
using TimePoint = std::chrono::system_clock::time_point;

// The degree to which the line is shortened.
struct Fitting {
  bool reason = true;
  bool shortLast = false;
  bool shortRate = false;
  bool total = true;
  std::optional<int> sourceWidth;  // empty: full width
  bool zeroFailures = true;
  bool connected = true;
  bool otherSims = true;
  bool narrow = false;  // only blanks between the parts
  bool age = true;      // in playback the recording's clock
  bool rate = true;
  bool last = true;
};

// In the order in which they are applied.
constexpr std::array<void (*)(Fitting&), 14> steps = {
    [](Fitting& fitting) { fitting.reason = false; },   [](Fitting& fitting) { fitting.shortLast = true; },
    [](Fitting& fitting) { fitting.shortRate = true; }, [](Fitting& fitting) { fitting.total = false; },
    [](Fitting& fitting) { fitting.sourceWidth = 24; }, [](Fitting& fitting) { fitting.zeroFailures = false; },
    [](Fitting& fitting) { fitting.sourceWidth = 12; }, [](Fitting& fitting) { fitting.connected = false; },
    [](Fitting& fitting) { fitting.sourceWidth = 0; },  [](Fitting& fitting) { fitting.narrow = true; },
    [](Fitting& fitting) { fitting.age = false; },      [](Fitting& fitting) { fitting.rate = false; },
    [](Fitting& fitting) { fitting.last = false; },     [](Fitting& fitting) { fitting.otherSims = false; },
};

std::string withoutBlanks(std::string text) {
  std::erase(text, ' ');
  return text;
}

std::string rateText(double perSecond) {
  const double tenths = std::round(perSecond * 10);
  if (tenths >= 100 || tenths == 0) return std::to_string(std::llround(perSecond));
  const auto whole = static_cast<long long>(tenths);
  return std::to_string(whole / 10) + "." + std::to_string(whole % 10);
}

std::string counted(std::uint64_t count, const char* what) { return std::to_string(count) + " " + what; }

// The time of the last event; empty in playback, which shows the recording's clock and position instead.
std::string lastText(const Status& status, TimePoint now, const Fitting& fitting) {
  if (!status.lastEvent) return fitting.shortLast ? "no event" : "no event yet";
  std::string time = application::timeOfDay(*status.lastEvent);
  if (!fitting.age) return time;
  const std::string age = application::ageText(now - *status.lastEvent);
  return fitting.shortLast ? time + " " + withoutBlanks(age) : "last " + time + ", " + age + " ago";
}

std::string recordingClock(const PlaybackPosition& playback, const Fitting& fitting) {
  const TimePoint clock = application::clockOf(playback);
  return fitting.shortLast ? application::timeOfDay(clock) : application::dateAndTime(clock);
}

// The connection, if it has a problem.
StatusPart connectionPart(const Status& status, Flow flow, const Fitting& fitting) {
  StatusPart part{std::string(application::connectionText(status)), Role::warning};
  if (flow == Flow::ended) part.role = Role::title;
  const std::string reason = application::reasonText(status);
  if (fitting.reason && !reason.empty() && flow != Flow::ended) part.text += " (" + reason + ")";
  return part;
}

std::vector<StatusPart> partsWith(const Status& status, TimePoint now, const Fitting& fitting, bool utf8) {
  std::vector<StatusPart> parts{sourceKindPart(status.kind)};
  const auto add = [&](std::string text, Role role) {
    parts.push_back({fitting.narrow ? "  " : utf8 ? " · " : " | ", Role::faint});
    parts.push_back({std::move(text), role});
  };
  std::string source;
  for (const Glyph& glyph : elided(glyphsOf(status.source, utf8), fitting.sourceWidth.value_or(1000), utf8)) {
    source += glyph.bytes.view();
  }
  if (!source.empty()) parts.push_back({" " + source, Role::text});
  if (const std::string sim = application::simText(status.sims); !sim.empty()) {
    // Short, the number alone is the card that is shown.
    add(fitting.otherSims ? sim : sim.substr(0, sim.find(" (")), Role::title);
  }
  const Flow flow = application::flowOf(status, now);
  const bool flows = flow == Flow::flowing || flow == Flow::silent;
  if (!flows) {
    const StatusPart connection = connectionPart(status, flow, fitting);
    add(connection.text, connection.role);
  } else if (fitting.connected) {
    add("connected", Role::text);
  }
  if (fitting.rate && flows)
    add(rateText(status.eventsPerSecond) + (fitting.shortRate ? "/s" : " events/s"), Role::text);
  if (fitting.total) add(counted(status.events, "events"), Role::text);
  if (status.decodeFailures == 0 && fitting.zeroFailures) add(application::decodeFailuresText(0), Role::text);
  for (const std::string& trouble : application::troubleTexts(status)) add(trouble, Role::warning);
  if (status.playback) {
    if (fitting.age) add(recordingClock(*status.playback, fitting), Role::text);
    if (fitting.last) add(application::playbackText(*status.playback), Role::text);
  } else if (fitting.last) {
    add(lastText(status, now, fitting), Role::text);
  }
  return parts;
}

int widthOf(const std::vector<StatusPart>& parts, bool utf8) {
  int width = 0;
  for (const StatusPart& part : parts) width += terminal::widthOf(part.text, utf8);
  return width;
}

// The status with numbers as long as they will soon be, so that parts do not appear and disappear every second.
Status grown(Status status, TimePoint now) {
  status.events = std::max<std::uint64_t>(status.events, 99'999);
  status.eventsPerSecond = std::max(status.eventsPerSecond, 999.0);
  if (status.lastEvent) status.lastEvent = std::min(*status.lastEvent, now - std::chrono::seconds(59));
  if (status.playback && status.playback->length) status.playback->position = *status.playback->length;
  return status;
}

}  // namespace

StatusPart sourceKindPart(SourceKind kind) {
  Role role = Role::unknownSource;
  if (kind == SourceKind::live) role = Role::live;
  if (kind == SourceKind::recorded) role = Role::recorded;
  if (kind == SourceKind::simulated) role = Role::simulated;
  return {std::string(application::sourceMark(kind)), role};
}

std::vector<StatusPart> statusParts(const Status& status, TimePoint now, int width, bool utf8) {
  const Status longest = grown(status, now);
  Fitting fitting;
  for (const auto& step : steps) {
    if (widthOf(partsWith(longest, now, fitting, utf8), utf8) <= width) break;
    step(fitting);
  }
  return partsWith(status, now, fitting, utf8);
}

void drawStatus(Grid& grid, int line, const Status& status, TimePoint now) {
  int column = 0;
  for (const StatusPart& part : statusParts(status, now, grid.size().width, grid.utf8())) {
    column = grid.put(column, line, part.text, {part.role});
  }
}

}  // namespace vespscope::terminal
