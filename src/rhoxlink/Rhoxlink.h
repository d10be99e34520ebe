// The client library of the baseband manager: commands to it, and its events on a serial queue.
//
// Every operation is safe from any thread and takes its own reference to the manager's handle. The library restores a
// lost connection in the background. It sends the configurations that were accepted earlier to the new manager, which
// may have restarted without them, and turns delivery of events on again if it was on.
#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include "platform/ipc/IpcObject.h"
#include "rhoxlink/Address.h"
#include "rhoxlink/bus/Embedded.h"
#include "rhoxlink/bus/Names.h"
#include "values/PlaybackPosition.h"
#include "values/SourceKind.h"

namespace vespscope::dispatch {
class SerialQueue;
}

namespace rhox::client {

class Manager;

// The result of a command: status 0 is success; any other has a message.
struct Result {
  std::int32_t status = 0;
  std::string message;
};

// Represents the delivery of one event; a handler that continues elsewhere may keep it until it is done.
using DispatchGroup = std::shared_ptr<void>;
using EventHandler = std::function<void(const vespscope::ipc::Object& event, DispatchGroup group)>;

// Creates a connection with the client name `name` to the manager at the process's address. Events arrive on `queue`,
// one at a time and in order; without a queue there are none. Returns at once, whether or not there is a manager.
std::shared_ptr<Manager> CreateManager(const std::string& name,
                                       std::shared_ptr<vespscope::dispatch::SerialQueue> queue);

// Sends one command and waits for its answer, at most commandTimeout(). Stores the answer's entries in `reply`. If
// there is no manager, or its answer is late, the status is one of the kStatus… constants.
Result PerformCommand(std::shared_ptr<Manager> manager, std::string_view command,
                      const vespscope::ipc::Dictionary& request, vespscope::ipc::Object& reply);

// Sets the handler of events of one kind, replacing an earlier one.
void RegisterEventHandler(std::shared_ptr<Manager> manager, std::string_view event, EventHandler handler);

// The facts of an event other than its entries.
struct EventFacts {
  // When the source reported the event, since 1970-01-01 00:00 UTC; unavailable from a manager of protocol version 1.
  std::optional<std::chrono::nanoseconds> time;
};
using EventObserver = std::function<void(const vespscope::ipc::Object& event, const EventFacts& facts)>;

// Sets the observer of events of one kind, which receives each event with its facts before the handler does. The
// library then requests the events' times: if the observer is set before EventsOn(), every event has its time.
void RegisterEventObserver(std::shared_ptr<Manager> manager, std::string_view event, EventObserver observer);

// Start and stop delivery. Events that arrived before a stop are still passed to the handlers.
void EventsOn(std::shared_ptr<Manager> manager);
void EventsOff(std::shared_ptr<Manager> manager);

// Sets the address of managers created from here on. Default: the environment's RHOX_ADDRESS, else "auto".
void setAddress(Address address);
// Returns the address that CreateManager uses, or why the words in the environment are invalid.
vespscope::Result<Address> address();

// Sets the function that makes the managers of embedded addresses. In a program without one such addresses fail.
void setEmbeddedFactory(vespscope::bus::EmbeddedFactory factory);

// Sets the function that decides for the address "auto" whether the embedded source "modemmanager" has a modem.
void setModemProbe(std::function<bool()> probe);

// Runs `task` after everything that the handlers of events have submitted so far; called from any thread.
using Afterwards = std::function<void(std::function<void()> task)>;
// For programs whose handlers pass events to another queue: in managers created from here on only a window of events is
// in progress there. Further events stay with the baseband manager, which keeps the newest and counts the dropped ones.
void setAfterwards(Afterwards afterwards);

// Sets how long PerformCommand waits (default: 2 seconds). It waits longer while the system bus starts the manager, or
// while ssh connects.
void setCommandTimeout(std::chrono::milliseconds timeout);
std::chrono::milliseconds commandTimeout();

struct ConnectionStatus {
  bool connected = false;     // a manager has answered on this connection
  std::int64_t protocol = 0;  // the protocol version in use; 0 until a manager has answered
  std::string problem;        // why there is no connection; empty while there is one
  std::string sourceLabel;
  vespscope::SourceKind sourceKind = vespscope::SourceKind::unknown;
  std::string notSubscribed;                            // why no events are expected although connected; empty when
                                                        // some are
  std::optional<vespscope::PlaybackPosition> playback;  // of a recording; empty for any other source
  // Of several SIM cards, the profile that the source names to be shown first; empty when it names none.
  std::optional<std::int32_t> simCard;
  std::uint64_t eventsReceived = 0;
  std::uint64_t eventsLost = 0;   // gaps in the manager's sequence numbers, events dropped here, and too large ones
  std::uint64_t malformed = 0;    // events of an unknown form
  std::uint64_t connections = 0;  // connections made so far
  std::optional<std::chrono::system_clock::time_point> lastEvent;  // when it was received
};
ConnectionStatus connectionStatus(std::shared_ptr<Manager> manager);

}  // namespace rhox::client
