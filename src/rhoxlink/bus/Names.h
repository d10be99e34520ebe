// The texts by which clients and the baseband manager know commands, request entries and events.
#pragma once

#include <cstdint>
#include <string_view>

namespace rhox {

// The version of the protocol that this program speaks (docs/bus.md has what each version added). Client and manager
// exchange theirs with kCommandStatus and use what the lower one has; a peer that gives none speaks version 1.
inline constexpr std::int64_t kProtocol = 2;
inline constexpr std::int64_t kProtocolOfEventTimes = 2;  // from here on kKeyEventTimes is heeded
inline constexpr std::int64_t kProtocolOfPlayback = 2;    // from here on a recording has kKeyPlayback

inline constexpr std::string_view kCommandAddConfiguration = "AddConfiguration";
inline constexpr std::string_view kCommandClearConfiguration = "ClearConfiguration";
inline constexpr std::string_view kCommandQueryMetric = "QueryMetric";
// Asks what the manager's source is; also gives the manager the client's name and, with kKeyAppID, the application for
// which it listens.
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

// Entries of requests of kCommandStatus.
inline constexpr std::string_view kKeyClientName = "kKeyClientName";  // text
inline constexpr std::string_view kKeyEventTimes = "kKeyEventTimes";  // boolean: events from here on have kKeyTime

// Entry of a metric event for clients that asked for it: when the source reported it (integer, nanoseconds since
// 1970-01-01 00:00 UTC).
inline constexpr std::string_view kKeyTime = "kKeyTime";

// Entry of a request of kCommandStatus and of the reply to it (integer): the sender's kProtocol.
inline constexpr std::string_view kKeyProtocol = "kKeyProtocol";

// Entry of the replies to kCommandAddConfiguration and kCommandClearConfiguration, where the manager keeps
// configurations: boolean, whether the disk has what the command said. If not, the status is 0 all the same and the
// message says why.
inline constexpr std::string_view kKeyKept = "kKeyKept";

// Entries of the reply to kCommandStatus.
inline constexpr std::string_view kKeySourceLabel = "kKeySourceLabel";  // text
inline constexpr std::string_view kKeySourceKind = "kKeySourceKind";    // text: "live", "recorded", "simulated"
inline constexpr std::string_view kKeyConfigured = "kKeyConfigured";    // boolean: the application has a configuration
inline constexpr std::string_view kKeyEventsLost = "kKeyEventsLost";    // integer: dropped from this client's queue
// Only while the source plays a recording: a dictionary of
inline constexpr std::string_view kKeyPlayback = "kKeyPlayback";
inline constexpr std::string_view kKeyPosition = "kKeyPosition";  // integer: nanoseconds from the first event
inline constexpr std::string_view kKeyLength = "kKeyLength";      // integer: of the recording (ns), where it is known
inline constexpr std::string_view kKeyClock = "kKeyClock";  // integer: the recording's clock there (ns since 1970 UTC)
inline constexpr std::string_view kKeySpeed = "kKeySpeed";  // real: recorded seconds for each second
inline constexpr std::string_view kKeyEnded = "kKeyEnded";  // boolean: the last event has been played
// Only while the manager records.
inline constexpr std::string_view kKeyEventsRecorded = "kKeyEventsRecorded";      // integer
inline constexpr std::string_view kKeyRecordingLost = "kKeyRecordingLost";        // integer: events not recorded
inline constexpr std::string_view kKeyRecordingProblem = "kKeyRecordingProblem";  // text: why nothing is; else absent

// Asks kCommandStatus for the manager as a whole too (boolean, true). The reply then also has
inline constexpr std::string_view kKeyDetails = "kKeyDetails";
inline constexpr std::string_view kKeySeconds = "kKeySeconds";  // integer: how long the manager has run; with a client,
                                                                // how long that has been connected
inline constexpr std::string_view kKeyConfigurations = "kKeyConfigurations";  // array: kKeyAppID and
inline constexpr std::string_view kKeyMetrics = "kKeyMetrics";                // integer: metrics it names
inline constexpr std::string_view kKeyClients = "kKeyClients";  // array: kKeyClientName, kKeyAppID, kKeyEventsLost and
inline constexpr std::string_view kKeyUser = "kKeyUser";        // integer: user number
inline constexpr std::string_view kKeyProcess = "kKeyProcess";  // integer, where it is known
inline constexpr std::string_view kKeyBusName = "kKeyBusName";  // text, on the system bus
inline constexpr std::string_view kKeyListening = "kKeyListening";              // boolean: delivery is on
inline constexpr std::string_view kKeyEventsDelivered = "kKeyEventsDelivered";  // integer
inline constexpr std::string_view kKeyEventsQueued = "kKeyEventsQueued";        // integer: waiting for the client

inline constexpr std::string_view kEventTrigger = "Trigger";
inline constexpr std::string_view kEventMetric = "Metric";

// The status of every command while the manager has no free place for the client.
inline constexpr std::int32_t kStatusNoPlace = 10;

// Statuses of commands that never reached a manager or came back without its answer.
inline constexpr std::int32_t kStatusNotConnected = static_cast<std::int32_t>(0xE020E010);
inline constexpr std::int32_t kStatusTimedOut = static_cast<std::int32_t>(0xE020E011);
inline constexpr std::int32_t kStatusConnectionLost = static_cast<std::int32_t>(0xE020E012);
inline constexpr std::int32_t kStatusRefused = static_cast<std::int32_t>(0xE020E013);   // the peer knows no such call
inline constexpr std::int32_t kStatusBadReply = static_cast<std::int32_t>(0xE020E014);  // a reply of another form
inline constexpr std::int32_t kStatusCannotEncode =
    static_cast<std::int32_t>(0xE020E015);                                               // a request too large to send
inline constexpr std::int32_t kStatusNoManager = static_cast<std::int32_t>(0xE020E016);  // on the system bus
inline constexpr std::int32_t kStatusAccessDenied = static_cast<std::int32_t>(0xE020E017);  // by the system bus

}  // namespace rhox
