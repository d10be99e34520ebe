// The texts by which clients and the baseband manager know commands, request entries and events.
#pragma once

#include <cstdint>
#include <string_view>

namespace rhox {

inline constexpr std::string_view kCommandAddConfiguration = "AddConfiguration";
inline constexpr std::string_view kCommandClearConfiguration = "ClearConfiguration";
inline constexpr std::string_view kCommandQueryMetric = "QueryMetric";
// Asks what the manager's source is; also tells the manager the client's name and, with kKeyAppID, for which
// application it listens.
inline constexpr std::string_view kCommandStatus = "Status";

// Entries of requests and of metric events.
inline constexpr std::string_view kKeyAppID = "kKeyAppID";              // integer
inline constexpr std::string_view kKeyPayload = "kKeyPayload";          // data
inline constexpr std::string_view kKeyPayloadType = "kKeyPayloadType";  // integer, 0
inline constexpr std::string_view kKeyTriggerRef = "kKeyTriggerRef";    // integer
inline constexpr std::string_view kKeyTriggerType = "kKeyTriggerType";  // integer
inline constexpr std::string_view kKeyTriggerID = "kKeyTriggerID";      // integer
inline constexpr std::string_view kKeyProfileID = "kKeyProfileID";      // integer
inline constexpr std::string_view kKeyMetricID = "kKeyMetricID";        // integer
inline constexpr std::string_view kKeyClientName = "kKeyClientName";    // text

// Entries of the reply to kCommandStatus.
inline constexpr std::string_view kKeySourceLabel = "kKeySourceLabel";  // text
inline constexpr std::string_view kKeySourceKind = "kKeySourceKind";    // text: "live", "recorded", "simulated"
inline constexpr std::string_view kKeyConfigured = "kKeyConfigured";    // boolean: the application has a configuration
inline constexpr std::string_view kKeyEventsLost = "kKeyEventsLost";    // integer: dropped from this client's queue
// Only while the manager records.
inline constexpr std::string_view kKeyEventsRecorded = "kKeyEventsRecorded";      // integer
inline constexpr std::string_view kKeyRecordingLost = "kKeyRecordingLost";        // integer: events not recorded
inline constexpr std::string_view kKeyRecordingProblem = "kKeyRecordingProblem";  // text: why nothing is; else absent

inline constexpr std::string_view kEventTrigger = "Trigger";
inline constexpr std::string_view kEventMetric = "Metric";

// Statuses of commands that never reached a manager or came back without its answer.
inline constexpr std::int32_t kStatusNotConnected = static_cast<std::int32_t>(0xE020E010);
inline constexpr std::int32_t kStatusTimedOut = static_cast<std::int32_t>(0xE020E011);
inline constexpr std::int32_t kStatusConnectionLost = static_cast<std::int32_t>(0xE020E012);
inline constexpr std::int32_t kStatusRefused = static_cast<std::int32_t>(0xE020E013);   // the peer knows no such call
inline constexpr std::int32_t kStatusBadReply = static_cast<std::int32_t>(0xE020E014);  // a reply of another form
inline constexpr std::int32_t kStatusCannotEncode =
    static_cast<std::int32_t>(0xE020E015);  // a request too large to send

}  // namespace rhox
