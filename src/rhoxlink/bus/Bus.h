// The two ends of a connection with the baseband manager's D-Bus protocol: without a bus daemon between them, or
// the client's end on the system bus (SystemBusEnd.h has the manager's).
//
// An end is used by one thread at a time and never blocks: its owner polls `wait()` and calls `process()`.
#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "platform/ipc/IpcObject.h"
#include "rhoxlink/bus/FrameChecker.h"
#include "rhoxlink/bus/GuardedInput.h"
#include "rhoxlink/bus/Names.h"
#include "values/Result.h"

struct sd_bus;
struct sd_bus_message;

namespace vespscope::bus {

inline constexpr const char* interfaceName = "org.vespscope.BasebandManager1";
inline constexpr const char* objectPath = "/org/vespscope/BasebandManager1";
inline constexpr const char* serviceName = "org.vespscope.BasebandManager1";  // on the system bus

// The result of a command: status 0 is success; any other has a message.
struct Reply {
  std::int32_t status = 0;
  std::string message;
  ipc::Dictionary values;
};

// The condition that an end waits for.
struct Wait {
  int descriptor = -1;
  short events = 0;           // in the form of poll(2)
  int outputDescriptor = -1;  // if output uses a different descriptor than input
  short outputEvents = 0;
  std::chrono::microseconds timeout{-1};  // negative: none
};

class End {
 public:
  End(const End&) = delete;
  End& operator=(const End&) = delete;
  virtual ~End();

  [[nodiscard]] Wait wait() const;
  // Reads, dispatches and writes without blocking, at most `limit` messages. Returns false when the connection has
  // ended.
  bool process(int limit = 256);
  // The number of messages that the socket has not accepted yet.
  [[nodiscard]] std::size_t unsent() const;
  // Why the connection has ended, if more is known than that.
  [[nodiscard]] const std::string& ending() const { return ending_; }

 protected:
  struct Closer {
    void operator()(sd_bus* bus) const;
  };
  using Handle = std::unique_ptr<sd_bus, Closer>;

  // A started connection, and the guard that checks its input unless the bus does.
  struct Started {
    Handle bus;
    std::unique_ptr<GuardedInput> guard;
    int input = -1;  // the descriptors that the guard reads and the connection writes
    int output = -1;
  };

  explicit End(Handle bus);
  explicit End(Started started);
  // Starts a connection that reads from one descriptor and writes to the other, or to the same. Takes ownership of
  // both, even on failure.
  static Result<Started> start(int input, int output, bool asServer, const WireLimits& limits,
                               std::shared_ptr<MemoryBudget> budget);
  // Starts a connection to the system bus at DBUS_SYSTEM_BUS_ADDRESS, else at the system's default address.
  static Result<Handle> startOnSystemBus(bool asServer);
  // Ends the connection: the next process() returns false.
  void end(std::string why);

  Handle bus_;

 private:
  std::unique_ptr<GuardedInput> guard_;  // null on the system bus, which has its own limits
  int input_ = -1;
  int output_ = -1;
  bool more_ = false;  // process() stopped at its limit
  bool over_ = false;
  std::string ending_;
};

// The client's end.
class ClientEnd : public End {
 public:
  using ReplyHandler = std::function<void(Reply)>;
  using EventHandler = std::function<void(std::string_view kind, std::uint64_t sequence, ipc::Dictionary event)>;

  // Uses the connected socket `descriptor` and owns it. `onEvent` is called from process(); an event that does not
  // match the interface is counted and skipped.
  static Result<std::unique_ptr<ClientEnd>> overSocket(int descriptor, EventHandler onEvent);
  // Connects to the manager that has its name on the system bus; the bus starts it if it is not running. The connection
  // ends when that manager leaves the bus, or when one appears after there was none.
  static Result<std::unique_ptr<ClientEnd>> onSystemBus(EventHandler onEvent);

  // Sends a command; `onReply` is called from process(), unless the connection ends first. Returns false when the
  // command cannot be sent.
  bool performCommand(const std::string& command, const ipc::Dictionary& request, std::chrono::microseconds timeout,
                      ReplyHandler onReply);
  // Turns delivery of events on or off.
  bool setEvents(bool on);

  [[nodiscard]] std::uint64_t malformedEvents() const { return malformedEvents_; }

 private:
  explicit ClientEnd(Handle bus, EventHandler onEvent) : End(std::move(bus)), onEvent_(std::move(onEvent)) {}
  explicit ClientEnd(Started bus, EventHandler onEvent) : End(std::move(bus)), onEvent_(std::move(onEvent)) {}
  friend struct ClientCallbacks;

  EventHandler onEvent_;
  std::uint64_t malformedEvents_ = 0;
  const char* destination_ = nullptr;  // on a bus: the manager's name
  std::string owner_;                  // and its owner; events from other senders are ignored
  bool absent_ = false;                // no process owns the name, according to the bus's last answer
};

// A client's identity, as reported by the system.
struct ClientIdentity {
  std::uint32_t user = 0;
  std::vector<std::uint32_t> groups;  // known for clients on a bus only
  std::int64_t process = 0;           // 0: unknown
  std::string busName;                // such as ":1.42"; empty for a connection without a bus
};

// The manager's operations for one client; called from the server end's process().
class Service {
 public:
  // Sends the reply to the caller: at once or later, from the end's thread, while the end exists.
  using Answer = std::function<void(const Reply&)>;

  virtual ~Service() = default;
  virtual void performCommand(const std::string& command, const ipc::Dictionary& request, const Answer& answer) = 0;
  virtual void eventsOn() = 0;
  virtual void eventsOff() = 0;
};

// Sends events to one client.
class EventOutlet {
 public:
  virtual ~EventOutlet() = default;
  // Whether it accepts another event now. The number of accepted events not yet sent is bounded.
  [[nodiscard]] virtual bool ready() const = 0;
  // Returns false when the event cannot be sent now or later.
  virtual bool sendEvent(std::string_view kind, std::uint64_t sequence, const ipc::Dictionary& event) = 0;
};

// The manager's side of a connection, whatever its transport.
class ServingEnd : public End {
 public:
  // Whether the connection accepts another event: the amount that its socket has not accepted stays small.
  [[nodiscard]] bool hasRoom() const;

 protected:
  using End::End;
  // Returns the service for the sender of this call, or why it is rejected.
  virtual Result<Service*> serviceFor(sd_bus_message* call) = 0;
  // Registers the interface on the connection.
  Result<bool> serve();
  bool send(const char* destination, std::string_view kind, std::uint64_t sequence, const ipc::Dictionary& event);

 private:
  friend struct ServerCallbacks;
  std::size_t unsentBytes_ = 0;  // of events, since the socket last accepted everything
};

// The manager's end of a connection with one client.
class ServerEnd final : public ServingEnd, public EventOutlet {
 public:
  // Serves `service`, which must outlive it, over the connected socket `descriptor`, which it owns. The client's
  // messages are checked against `limits`; its large messages share `budget` with those of others.
  static Result<std::unique_ptr<ServerEnd>> overSocket(int descriptor, Service& service,
                                                       std::shared_ptr<MemoryBudget> budget = nullptr,
                                                       const WireLimits& limits = {});
  // The same over two pipes, or over standard input and output of any kind.
  static Result<std::unique_ptr<ServerEnd>> overPipes(int input, int output, Service& service,
                                                      std::shared_ptr<MemoryBudget> budget = nullptr,
                                                      const WireLimits& limits = {});

  [[nodiscard]] bool ready() const override { return hasRoom(); }
  bool sendEvent(std::string_view kind, std::uint64_t sequence, const ipc::Dictionary& event) override {
    return send(nullptr, kind, sequence, event);
  }

 private:
  explicit ServerEnd(Started bus, Service& service) : ServingEnd(std::move(bus)), service_(service) {}
  Result<Service*> serviceFor(sd_bus_message* /*call*/) override { return &service_; }

  Service& service_;
};

}  // namespace vespscope::bus
