// The two ends of a connection that speaks the baseband manager's D-Bus protocol: without a bus daemon between them, or
// the client's end on the system bus (SystemBusEnd.h has the manager's).
//
// An end belongs to one thread at a time and never waits: its owner polls `wait()` and calls `process()`.
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

// What a command gives back: status 0 is success, any other comes with a message.
struct Reply {
  std::int32_t status = 0;
  std::string message;
  ipc::Dictionary values;
};

// What an end waits for next.
struct Wait {
  int descriptor = -1;
  short events = 0;           // as poll(2) takes them
  int outputDescriptor = -1;  // where what is written goes another way than what is read
  short outputEvents = 0;
  std::chrono::microseconds timeout{-1};  // negative: none
};

class End {
 public:
  End(const End&) = delete;
  End& operator=(const End&) = delete;
  virtual ~End();

  [[nodiscard]] Wait wait() const;
  // Reads, dispatches and writes what can be done without waiting, at most `limit` messages. False when the
  // connection is over.
  bool process(int limit = 256);
  // Messages that the socket has not taken yet.
  [[nodiscard]] std::size_t unsent() const;
  // Why the connection is over, where more is known than that.
  [[nodiscard]] const std::string& ending() const { return ending_; }

 protected:
  struct Closer {
    void operator()(sd_bus* bus) const;
  };
  using Handle = std::unique_ptr<sd_bus, Closer>;

  // A started connection, and what checks its input where nobody else does.
  struct Started {
    Handle bus;
    std::unique_ptr<GuardedInput> guard;
    int input = -1;  // where the guard reads, and where the connection writes
    int output = -1;
  };

  explicit End(Handle bus);
  explicit End(Started started);
  // A started connection that reads from one descriptor and writes to the other, or to the same, and owns both from
  // here on, even when it fails.
  static Result<Started> start(int input, int output, bool asServer, const WireLimits& limits,
                               std::shared_ptr<MemoryBudget> budget);
  // A started connection to the system bus: DBUS_SYSTEM_BUS_ADDRESS, else where the system has it.
  static Result<Handle> startOnSystemBus(bool asServer);
  // Ends the connection: the next process() returns false.
  void end(std::string why);

  Handle bus_;

 private:
  std::unique_ptr<GuardedInput> guard_;  // null on the system bus, which has bounds of its own
  int input_ = -1;
  int output_ = -1;
  bool more_ = false;  // process() ended with its limit
  bool over_ = false;
  std::string ending_;
};

// The client's end.
class ClientEnd : public End {
 public:
  using ReplyHandler = std::function<void(Reply)>;
  using EventHandler = std::function<void(std::string_view kind, std::uint64_t sequence, ipc::Dictionary event)>;

  // Speaks over the connected socket `descriptor` and owns it. `onEvent` is called from process(); an event of
  // another form than the interface's is counted and skipped.
  static Result<std::unique_ptr<ClientEnd>> overSocket(int descriptor, EventHandler onEvent);
  // Speaks to the manager that has its name on the system bus, which starts it when it does not run. The connection is
  // over when that manager leaves the bus, or one comes after there was none.
  static Result<std::unique_ptr<ClientEnd>> onSystemBus(EventHandler onEvent);

  // Sends a command; `onReply` is called from process(), unless the connection ends before. False when the command
  // cannot be sent.
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
  const char* destination_ = nullptr;  // on a bus: the manager's name,
  std::string owner_;                  // and who has it; nobody else's events count
  bool absent_ = false;                // nobody has it, as the bus said to the last call
};

// Who a client is, as the system tells.
struct ClientIdentity {
  std::uint32_t user = 0;
  std::vector<std::uint32_t> groups;  // known of clients on a bus only
  std::int64_t process = 0;           // 0: not known
  std::string busName;                // such as ":1.42"; empty on a connection of its own
};

// What a manager does for one client; called from the server end's process().
class Service {
 public:
  // Sends the reply to the caller; at once or later, from the end's thread, while there is the end.
  using Answer = std::function<void(const Reply&)>;

  virtual ~Service() = default;
  virtual void performCommand(const std::string& command, const ipc::Dictionary& request, const Answer& answer) = 0;
  virtual void eventsOn() = 0;
  virtual void eventsOff() = 0;
};

// Where one client's events go.
class EventOutlet {
 public:
  virtual ~EventOutlet() = default;
  // Whether it takes another event now. What it has taken and not got rid of is bounded.
  [[nodiscard]] virtual bool ready() const = 0;
  // False when the event cannot be sent, now or ever.
  virtual bool sendEvent(std::string_view kind, std::uint64_t sequence, const ipc::Dictionary& event) = 0;
};

// The manager's side of a connection, whoever its callers are.
class ServingEnd : public End {
 public:
  // Whether the connection takes another event: what its socket has not taken stays small.
  [[nodiscard]] bool hasRoom() const;

 protected:
  using End::End;
  // Who serves the sender of this call, or why nobody does.
  virtual Result<Service*> serviceFor(sd_bus_message* call) = 0;
  // Puts the interface on the connection.
  Result<bool> serve();
  bool send(const char* destination, std::string_view kind, std::uint64_t sequence, const ipc::Dictionary& event);

 private:
  friend struct ServerCallbacks;
  std::size_t unsentBytes_ = 0;  // of events, since the socket had taken all
};

// The manager's end of a connection with one client.
class ServerEnd final : public ServingEnd, public EventOutlet {
 public:
  // Serves `service`, which outlives it, over the connected socket `descriptor` and owns that. What the client sends is
  // held within `limits`; its large messages share `budget` with those of others.
  static Result<std::unique_ptr<ServerEnd>> overSocket(int descriptor, Service& service,
                                                       std::shared_ptr<MemoryBudget> budget = nullptr,
                                                       const WireLimits& limits = {});
  // The same over two pipes, or whatever standard input and output are.
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
