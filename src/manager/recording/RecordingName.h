// The names of recordings: "vespscope-20261121T132501.042Z.pcap", the UTC time at which the file began, so that names
// sort as the files were written.
#pragma once

#include <chrono>
#include <optional>
#include <string>
#include <string_view>

namespace vespscope::manager {

using RecordingTime = std::chrono::sys_time<std::chrono::milliseconds>;

// Covers the years 0 to 9999; a time outside is clamped.
[[nodiscard]] std::string recordingName(RecordingTime time);
// The time in a name; empty unless recordingName() could have made the name.
[[nodiscard]] std::optional<RecordingTime> recordingTime(std::string_view name);

}  // namespace vespscope::manager
