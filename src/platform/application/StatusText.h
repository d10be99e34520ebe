// The words for the data's source and its state, the same in every frontend.
#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "platform/application/Status.h"

namespace vespscope::application {

// "Live modem", "Playback", "Simulated drive", "Unknown source".
[[nodiscard]] std::string_view sourceName(SourceKind kind);
// The same for places with room for a mark only: "LIVE", "PLAYBACK", "SIMULATED", "SOURCE UNKNOWN".
[[nodiscard]] std::string_view sourceMark(SourceKind kind);

enum class Flow {
  disconnected,   // from the baseband manager
  notSubscribed,  // connected, but no events are expected
  ended,          // the recording has been played to its end
  silent,         // no event for `silenceAfter`
  flowing,
};
inline constexpr std::chrono::seconds silenceAfter{10};
[[nodiscard]] Flow flowOf(const Status& status, std::chrono::system_clock::time_point now);

// "connecting" until the first attempt fails, "no manager" until one succeeds, "reconnecting", "connected, not
// subscribed", "end of recording", else "connected".
[[nodiscard]] std::string_view connectionText(const Status& status);
// Why there is no connection or no subscription; empty when there are both or the reason is unknown.
[[nodiscard]] std::string reasonText(const Status& status);

// "1 gap", "2 gaps".
[[nodiscard]] std::string countText(std::uint64_t count, std::string_view one, std::string_view many);
// "1 decode failure", "2 decode failures".
[[nodiscard]] std::string decodeFailuresText(std::uint64_t count);
// The problems so far, each only if it occurred: "7 lost", "1 gap", "2 decode failures".
[[nodiscard]] std::vector<std::string> troubleTexts(const Status& status);

// The position in a recording: "01:37/02:03", or "01:37" while its length is unknown; with its speed unless that is 1:
// "01:37/02:03 x10".
[[nodiscard]] std::string playbackText(const PlaybackPosition& playback);
// The time of the recording's own clock at this position.
[[nodiscard]] std::chrono::system_clock::time_point clockOf(const PlaybackPosition& playback);

// "SIM 1 (also SIM 2)"; empty while at most one card reports.
[[nodiscard]] std::string simText(const SimCards& sims);
// The card to show after this one; empty while there is no other.
[[nodiscard]] std::optional<std::int32_t> nextSim(const SimCards& sims);

// The text shown in a table without rows: what it is waiting for. `reported`: its metric has arrived, without entries.
// `status` is null when nothing is known about the source.
[[nodiscard]] std::string waitingText(const Status* status, bool reported);

}  // namespace vespscope::application
