// The names of commands, request entries and events that clients and the baseband manager share.
#pragma once

#include <cstdint>
#include <string_view>

namespace rhox {

// The version of the protocol in this program (docs/bus.md lists what each version added). Client and manager exchange
// theirs with kCommandStatus and use the lower one; a peer that sends none has version 1.
inline constexpr std::int64_t kProtocol = 2;
inline constexpr std::int64_t kProtocolOfEventTimes = 2;  // from this version on kKeyEventTimes is supported
inline constexpr std::int64_t kProtocolOfPlayback = 2;    // from this version on a recording has kKeyPlayback

inline constexpr std::string_view kCommandAddConfiguration = "AddConfiguration";
inline constexpr std::string_view kCommandClearConfiguration = "ClearConfiguration";
inline constexpr std::string_view kCommandQueryMetric = "QueryMetric";
// Requests the manager's source; also sends the client's name and, with kKeyAppID, the application for which it
// listens.
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

// Entry of a metric event for clients that requested it: when the source reported it (integer, nanoseconds since
// 1970-01-01 00:00 UTC).
inline constexpr std::string_view kKeyTime = "kKeyTime";

// Entry of a request of kCommandStatus and of the reply to it (integer): the sender's kProtocol.
inline constexpr std::string_view kKeyProtocol = "kKeyProtocol";

// Entry of the replies to kCommandAddConfiguration and kCommandClearConfiguration if the manager stores configurations:
// boolean, whether the change is on the disk. If it is not, the status is still 0 and the message says why.
inline constexpr std::string_view kKeyKept = "kKeyKept";

// Entries of the reply to kCommandStatus.
inline constexpr std::string_view kKeySourceLabel = "kKeySourceLabel";  // text
inline constexpr std::string_view kKeySourceKind = "kKeySourceKind";    // text: "live", "recorded", "simulated"
inline constexpr std::string_view kKeyConfigured = "kKeyConfigured";    // boolean: the application has a configuration
inline constexpr std::string_view kKeyEventsLost = "kKeyEventsLost";    // integer: dropped from this client's queue
// The reply has kKeyProfileID too where the source names the SIM card that a viewer shows first.
// A dictionary, present only while the source plays a recording:
inline constexpr std::string_view kKeyPlayback = "kKeyPlayback";
inline constexpr std::string_view kKeyPosition = "kKeyPosition";  // integer: nanoseconds from the first event
inline constexpr std::string_view kKeyLength = "kKeyLength";      // integer: of the recording (ns), where it is known
inline constexpr std::string_view kKeyClock = "kKeyClock";  // integer: the recording's clock there (ns since 1970 UTC)
inline constexpr std::string_view kKeySpeed = "kKeySpeed";  // real: recorded seconds per second
inline constexpr std::string_view kKeyEnded = "kKeyEnded";  // boolean: the last event has been played
// Present only while the manager records:
inline constexpr std::string_view kKeyEventsRecorded = "kKeyEventsRecorded";      // integer
inline constexpr std::string_view kKeyRecordingLost = "kKeyRecordingLost";        // integer: events not recorded
inline constexpr std::string_view kKeyRecordingProblem = "kKeyRecordingProblem";  // text: why nothing is recorded; else
                                                                                  // absent

// Requests the state of the whole manager too, with kCommandStatus (boolean, true). The reply then also has:
inline constexpr std::string_view kKeyDetails = "kKeyDetails";
inline constexpr std::string_view kKeySeconds = "kKeySeconds";  // integer: how long the manager has run; for a client,
                                                                // how long it has been connected
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

// The status of every command while no place is free for the client.
inline constexpr std::int32_t kStatusNoPlace = 10;

// Statuses of commands that did not reach a manager or got no valid answer.
inline constexpr std::int32_t kStatusNotConnected = static_cast<std::int32_t>(0xE020E010);
inline constexpr std::int32_t kStatusTimedOut = static_cast<std::int32_t>(0xE020E011);
inline constexpr std::int32_t kStatusConnectionLost = static_cast<std::int32_t>(0xE020E012);
inline constexpr std::int32_t kStatusRefused = static_cast<std::int32_t>(0xE020E013);   // the peer does not know the
                                                                                        // call
inline constexpr std::int32_t kStatusBadReply = static_cast<std::int32_t>(0xE020E014);  // a reply that does not match
                                                                                        // the interface
inline constexpr std::int32_t kStatusCannotEncode =
    static_cast<std::int32_t>(0xE020E015);                                               // a request too large to send
inline constexpr std::int32_t kStatusNoManager = static_cast<std::int32_t>(0xE020E016);  // on the system bus
inline constexpr std::int32_t kStatusAccessDenied = static_cast<std::int32_t>(0xE020E017);  // by the system bus

}  // namespace rhox
