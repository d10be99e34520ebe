#include "frontends/terminal/StatusLine.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <optional>
#include <utility>

#include "frontends/terminal/ClockText.h"

namespace vespscope::terminal {
namespace {

using application::Status;

// How far the line has been made to fit.
struct Fitting {
  bool shortLast = false;
  bool shortFailures = false;
  bool shortRate = false;
  bool total = true;
  std::optional<int> sourceWidth;  // empty: as wide as it is
  bool connected = true;
  bool narrow = false;  // blanks alone between the parts
  bool age = true;
  bool zeroFailures = true;
  bool rate = true;
  bool last = true;
};

// In the order in which they are taken.
constexpr std::array<void (*)(Fitting&), 13> steps = {
    [](Fitting& fitting) { fitting.shortLast = true; },     [](Fitting& fitting) { fitting.shortFailures = true; },
    [](Fitting& fitting) { fitting.shortRate = true; },     [](Fitting& fitting) { fitting.total = false; },
    [](Fitting& fitting) { fitting.sourceWidth = 24; },     [](Fitting& fitting) { fitting.sourceWidth = 12; },
    [](Fitting& fitting) { fitting.connected = false; },    [](Fitting& fitting) { fitting.sourceWidth = 0; },
    [](Fitting& fitting) { fitting.narrow = true; },        [](Fitting& fitting) { fitting.age = false; },
    [](Fitting& fitting) { fitting.zeroFailures = false; }, [](Fitting& fitting) { fitting.rate = false; },
    [](Fitting& fitting) { fitting.last = false; },
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

std::string lastText(const Status& status, std::chrono::system_clock::time_point now, const Fitting& fitting) {
  if (!status.lastEvent) return fitting.shortLast ? "no event" : "no event yet";
  std::string time = timeOfDay(*status.lastEvent);
  const std::string age = ageText(now - *status.lastEvent);
  if (!fitting.age) return time;
  return fitting.shortLast ? time + " " + withoutBlanks(age) : "last " + time + ", " + age + " ago";
}

std::vector<StatusPart> partsWith(const Status& status, std::chrono::system_clock::time_point now,
                                  const Fitting& fitting, bool utf8) {
  std::vector<StatusPart> parts{sourceKindPart(status.kind)};
  const auto separate = [&] { parts.push_back({fitting.narrow ? "  " : utf8 ? " · " : " | ", Role::faint}); };
  const auto add = [&](std::string text, Role role) {
    separate();
    parts.push_back({std::move(text), role});
  };
  std::string source;
  for (const Glyph& glyph : elided(glyphsOf(status.source, utf8), fitting.sourceWidth.value_or(1000), utf8)) {
    source += glyph.bytes.view();
  }
  if (!source.empty()) parts.push_back({" " + source, Role::text});
  if (!status.connected) add("reconnecting", Role::warning);
  if (status.connected && fitting.connected) add("connected", Role::text);
  if (fitting.rate) add(rateText(status.eventsPerSecond) + (fitting.shortRate ? "/s" : " events/s"), Role::text);
  if (fitting.total) add(counted(status.events, "events"), Role::text);
  if (status.decodeFailures != 0 || fitting.zeroFailures) {
    add(counted(status.decodeFailures, fitting.shortFailures ? "failed" : "decode failures"),
        status.decodeFailures != 0 ? Role::warning : Role::text);
  }
  if (status.eventsLost != 0) add(counted(status.eventsLost, "lost"), Role::warning);
  if (status.interruptions != 0)
    add(counted(status.interruptions, status.interruptions == 1 ? "gap" : "gaps"), Role::warning);
  if (fitting.last) add(lastText(status, now, fitting), Role::text);
  return parts;
}

int widthOf(const std::vector<StatusPart>& parts, bool utf8) {
  int width = 0;
  for (const StatusPart& part : parts) width += terminal::widthOf(part.text, utf8);
  return width;
}

// The status with numbers as long as they are going to get soon, so that parts do not come and go every second.
Status grown(Status status, std::chrono::system_clock::time_point now) {
  status.events = std::max<std::uint64_t>(status.events, 99'999);
  status.eventsPerSecond = std::max(status.eventsPerSecond, 999.0);
  if (status.lastEvent) status.lastEvent = std::min(*status.lastEvent, now - std::chrono::seconds(59));
  return status;
}

}  // namespace

StatusPart sourceKindPart(SourceKind kind) {
  switch (kind) {
    case SourceKind::live:
      return {"LIVE", Role::live};
    case SourceKind::recorded:
      return {"RECORDED", Role::recorded};
    case SourceKind::simulated:
      return {"SIMULATED", Role::simulated};
    case SourceKind::unknown:
      break;
  }
  return {"SOURCE UNKNOWN", Role::unknownSource};
}

std::vector<StatusPart> statusParts(const Status& status, std::chrono::system_clock::time_point now, int width,
                                    bool utf8) {
  const Status longest = grown(status, now);
  Fitting fitting;
  for (const auto& step : steps) {
    if (widthOf(partsWith(longest, now, fitting, utf8), utf8) <= width) break;
    step(fitting);
  }
  return partsWith(status, now, fitting, utf8);
}

void drawStatus(Grid& grid, int line, const Status& status, std::chrono::system_clock::time_point now) {
  int column = 0;
  for (const StatusPart& part : statusParts(status, now, grid.size().width, grid.utf8())) {
    column = grid.put(column, line, part.text, {part.role});
  }
}

}  // namespace vespscope::terminal
