// The words for where the data comes from and how it flows, the same in every frontend.
#pragma once

#include <chrono>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "platform/application/Status.h"

namespace vespscope::application {

// "Live modem", "Playback", "Simulated drive", "Unknown source".
[[nodiscard]] std::string_view sourceName(SourceKind kind);
// The same where there is room for a mark only: "LIVE", "PLAYBACK", "SIMULATED", "SOURCE UNKNOWN".
[[nodiscard]] std::string_view sourceMark(SourceKind kind);

enum class Flow {
  disconnected,   // from the baseband manager
  notSubscribed,  // connected, but no events are due
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
// What went wrong so far: "7 lost", "1 gap", "2 decode failures"; nothing that did not happen.
[[nodiscard]] std::vector<std::string> troubleTexts(const Status& status);

// Where a recording stands: "01:37/02:03", or "01:37" while its length is unknown; and its speed unless it is 1:
// "01:37/02:03 x10".
[[nodiscard]] std::string playbackText(const PlaybackPosition& playback);
// The recording's own clock there.
[[nodiscard]] std::chrono::system_clock::time_point clockOf(const PlaybackPosition& playback);

// What a table without rows waits for. `reported`: its metric has come, without entries. `status` is null when nothing
// is known about the source.
[[nodiscard]] std::string waitingText(const Status* status, bool reported);

}  // namespace vespscope::application
