#include "platform/application/StatusText.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdio>

#include "platform/application/ClockText.h"
#include "values/Text.h"

namespace vespscope::application {

std::string_view sourceName(SourceKind kind) {
  switch (kind) {
    case SourceKind::live:
      return "Live modem";
    case SourceKind::recorded:
      return "Playback";
    case SourceKind::simulated:
      return "Simulated drive";
    case SourceKind::unknown:
      break;
  }
  return "Unknown source";
}

std::string_view sourceMark(SourceKind kind) {
  switch (kind) {
    case SourceKind::live:
      return "LIVE";
    case SourceKind::recorded:
      return "PLAYBACK";
    case SourceKind::simulated:
      return "SIMULATED";
    case SourceKind::unknown:
      break;
  }
  return "SOURCE UNKNOWN";
}

Flow flowOf(const Status& status, std::chrono::system_clock::time_point now) {
  if (!status.connected) return Flow::disconnected;
  if (status.playback && status.playback->ended) return Flow::ended;
  if (!status.notSubscribed.empty()) return Flow::notSubscribed;
  return status.lastEvent && now - *status.lastEvent < silenceAfter ? Flow::flowing : Flow::silent;
}

std::string_view connectionText(const Status& status) {
  switch (flowOf(status, {})) {
    case Flow::disconnected:
      if (status.everConnected) return "reconnecting";
      return status.problem.empty() ? "connecting" : "no manager";
    case Flow::notSubscribed:
      return "connected, not subscribed";
    case Flow::ended:
      return "end of recording";
    case Flow::silent:
    case Flow::flowing:
      break;
  }
  return "connected";
}

std::string reasonText(const Status& status) {
  return printable(status.connected ? status.notSubscribed : status.problem);
}

std::string countText(std::uint64_t count, std::string_view one, std::string_view many) {
  return std::to_string(count) + " " + std::string(count == 1 ? one : many);
}

std::string decodeFailuresText(std::uint64_t count) { return countText(count, "decode failure", "decode failures"); }

std::vector<std::string> troubleTexts(const Status& status) {
  std::vector<std::string> texts;
  if (status.decodeFailures != 0) texts.push_back(decodeFailuresText(status.decodeFailures));
  if (status.eventsLost != 0) texts.push_back(countText(status.eventsLost, "lost", "lost"));
  if (status.interruptions != 0) texts.push_back(countText(status.interruptions, "gap", "gaps"));
  return texts;
}

std::string playbackText(const PlaybackPosition& playback) {
  std::string text = positionText(playback.position);
  if (playback.length) text += "/" + positionText(*playback.length);
  if (std::isfinite(playback.speed) && playback.speed != 1) {
    std::array<char, 32> speed{};
    std::snprintf(speed.data(), speed.size(), " x%.4g", playback.speed);
    text += speed.data();
  }
  return text;
}

std::chrono::system_clock::time_point clockOf(const PlaybackPosition& playback) {
  return std::chrono::system_clock::time_point(
      std::chrono::duration_cast<std::chrono::system_clock::duration>(playback.clock));
}

std::string simText(const SimCards& sims) {
  if (!sims.shown || sims.others.empty()) return {};
  std::string text = "SIM " + std::to_string(*sims.shown) + " (also";
  for (const std::int32_t other : sims.others) {
    text += (other == sims.others.front() ? " SIM " : ", ") + std::to_string(other);
  }
  return text + ")";
}

std::optional<std::int32_t> nextSim(const SimCards& sims) {
  if (!sims.shown || sims.others.empty()) return std::nullopt;
  const auto next = std::upper_bound(sims.others.begin(), sims.others.end(), *sims.shown);
  return next == sims.others.end() ? sims.others.front() : *next;
}

std::string waitingText(const Status* status, bool reported) {
  const std::string reason = status == nullptr ? "" : reasonText(*status);
  if (status != nullptr && !status->connected) {
    return "The baseband manager is not connected" + (reason.empty() ? "" : " (" + reason + ")") +
           "; the viewer is trying again. Values appear here with the first report after that.";
  }
  if (status != nullptr && !status->notSubscribed.empty()) {
    return "The baseband manager is connected, but sends no events: " + reason;
  }
  if (reported) return "The latest report had no entries. They appear here when a report brings some.";
  if (status != nullptr && status->playback && status->playback->ended) {
    return "The recording has ended, and none of it reported these values.";
  }
  if (status != nullptr && status->events == 0) {
    return "Connected to the baseband manager, which has not sent any event yet. Values appear here with their first "
           "report.";
  }
  return "The modem has not reported these values yet. They appear here with their first report.";
}

}  // namespace vespscope::application
