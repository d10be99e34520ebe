// The client library of the baseband manager: commands to it, and its events on a serial queue.
//
// Every operation is safe from any thread and takes its own reference to the manager's handle. A connection that is
// lost is made again in the background. The new manager is given the configurations that the earlier one accepted, for
// it may have been restarted without them, and delivery of events is turned on again if it was on.
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

// How a command ended: status 0 is success, any other comes with a message.
struct Result {
  std::int32_t status = 0;
  std::string message;
};

// Stands for the delivery of one event; a handler that goes on elsewhere may keep it until it is done.
using DispatchGroup = std::shared_ptr<void>;
using EventHandler = std::function<void(const vespscope::ipc::Object& event, DispatchGroup group)>;

// A new connection under the client name `name`, to the manager at the process's address. Events arrive on `queue`, one
// at a time and in order; without a queue none do. Returns at once, whether or not there is a manager.
std::shared_ptr<Manager> CreateManager(const std::string& name,
                                       std::shared_ptr<vespscope::dispatch::SerialQueue> queue);

// Sends one command and waits for its answer, at most commandTimeout(). The answer's entries go to `reply`.
// Without a manager, or when it is late, the status is one of the kStatus… constants.
Result PerformCommand(std::shared_ptr<Manager> manager, std::string_view command,
                      const vespscope::ipc::Dictionary& request, vespscope::ipc::Object& reply);

// Makes `handler` the receiver of the events of one kind, in place of the one registered before.
void RegisterEventHandler(std::shared_ptr<Manager> manager, std::string_view event, EventHandler handler);

// What comes with an event beside its entries.
struct EventFacts {
  // When the source reported it, since 1970-01-01 00:00 UTC; unavailable from a manager of protocol version 1.
  std::optional<std::chrono::nanoseconds> time;
};
using EventObserver = std::function<void(const vespscope::ipc::Object& event, const EventFacts& facts)>;

// Makes `observer` the one that receives the events of one kind with their facts, before the handler of that kind does.
// Asks the manager for the events' times: register it before EventsOn(), and every event has its time.
void RegisterEventObserver(std::shared_ptr<Manager> manager, std::string_view event, EventObserver observer);

// Starts and stops delivery. Events that had arrived before a stop are still handed to the handlers.
void EventsOn(std::shared_ptr<Manager> manager);
void EventsOff(std::shared_ptr<Manager> manager);

// The address of managers created from here on. Not set, it is the environment's RHOX_ADDRESS, else "auto".
void setAddress(Address address);
// The address that CreateManager uses, or why the environment's words are none.
vespscope::Result<Address> address();

// Makes the managers of embedded addresses. A program without one refuses such addresses.
void setEmbeddedFactory(vespscope::bus::EmbeddedFactory factory);

// Tells the address "auto" whether the embedded source "modemmanager" would have a modem.
void setModemProbe(std::function<bool()> probe);

// Runs `task` behind everything that the handlers of events have handed on so far; called from any thread.
using Afterwards = std::function<void(std::function<void()> task)>;
// For programs whose handlers hand events on to another queue: managers created from here on let only a window of
// events be under way there, and leave what does not fit to the baseband manager, which keeps the newest and counts the
// others.
void setAfterwards(Afterwards afterwards);

// How long PerformCommand waits; 2 seconds unless set. While the manager is being started by the system bus, or reached
// through ssh, it waits longer.
void setCommandTimeout(std::chrono::milliseconds timeout);
std::chrono::milliseconds commandTimeout();

struct ConnectionStatus {
  bool connected = false;     // a manager has answered on this connection
  std::int64_t protocol = 0;  // the version of the protocol on which both agree; 0 until a manager has answered
  std::string problem;        // why there is no connection, while there is none
  std::string sourceLabel;
  vespscope::SourceKind sourceKind = vespscope::SourceKind::unknown;
  std::string notSubscribed;                            // why no events are due although connected; empty when some are
  std::optional<vespscope::PlaybackPosition> playback;  // of a recording; empty for any other source
  std::uint64_t eventsReceived = 0;
  std::uint64_t eventsLost = 0;   // gaps in the manager's sequence numbers, events dropped here, and too large ones
  std::uint64_t malformed = 0;    // events of a form that is not known
  std::uint64_t connections = 0;  // made so far
  std::optional<std::chrono::system_clock::time_point> lastEvent;  // when it was received
};
ConnectionStatus connectionStatus(std::shared_ptr<Manager> manager);

}  // namespace rhox::client
