// The names of recordings: "vespscope-20261121T132501.042Z.pcap", the UTC time at which the file was begun, so that
// names sort as the files were written.
#pragma once

#include <chrono>
#include <optional>
#include <string>
#include <string_view>

namespace vespscope::manager {

using RecordingTime = std::chrono::sys_time<std::chrono::milliseconds>;

// From year 0 to 9999; a time beyond is brought to the nearer end.
[[nodiscard]] std::string recordingName(RecordingTime time);
// The time in a name; empty when it is not exactly one that recordingName() gives.
[[nodiscard]] std::optional<RecordingTime> recordingTime(std::string_view name);

}  // namespace vespscope::manager
