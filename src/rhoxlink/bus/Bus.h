// The two ends of a connection that speaks the baseband manager's D-Bus protocol, without a bus daemon between them.
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

#include "platform/ipc/IpcObject.h"
#include "rhoxlink/bus/Names.h"
#include "values/Result.h"

struct sd_bus;

namespace vespscope::bus {

inline constexpr const char* interfaceName = "org.vespscope.BasebandManager1";
inline constexpr const char* objectPath = "/org/vespscope/BasebandManager1";

// What a command gives back: status 0 is success, any other comes with a message.
struct Reply {
  std::int32_t status = 0;
  std::string message;
  ipc::Dictionary values;
};

// What an end waits for next.
struct Wait {
  int descriptor = -1;
  short events = 0;                       // as poll(2) takes them
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

 protected:
  struct Closer {
    void operator()(sd_bus* bus) const;
  };
  using Handle = std::unique_ptr<sd_bus, Closer>;

  explicit End(Handle bus) : bus_(std::move(bus)) {}
  // A started connection over `descriptor`, which it owns from here on, even when it fails.
  static Result<Handle> start(int descriptor, bool asServer);

  Handle bus_;
};

// The client's end.
class ClientEnd : public End {
 public:
  using ReplyHandler = std::function<void(Reply)>;
  using EventHandler = std::function<void(std::string_view kind, std::uint64_t sequence, ipc::Dictionary event)>;

  // Speaks over the connected socket `descriptor` and owns it. `onEvent` is called from process(); an event of
  // another form than the interface's is counted and skipped.
  static Result<std::unique_ptr<ClientEnd>> overSocket(int descriptor, EventHandler onEvent);

  // Sends a command; `onReply` is called from process(), unless the connection ends before. False when the command
  // cannot be sent.
  bool performCommand(const std::string& command, const ipc::Dictionary& request, std::chrono::microseconds timeout,
                      ReplyHandler onReply);
  // Turns delivery of events on or off.
  bool setEvents(bool on);

  [[nodiscard]] std::uint64_t malformedEvents() const { return malformedEvents_; }

 private:
  explicit ClientEnd(Handle bus, EventHandler onEvent) : End(std::move(bus)), onEvent_(std::move(onEvent)) {}
  friend struct ClientCallbacks;

  EventHandler onEvent_;
  std::uint64_t malformedEvents_ = 0;
};

// What a manager does for one client; called from the server end's process().
class Service {
 public:
  virtual ~Service() = default;
  virtual Reply performCommand(const std::string& command, const ipc::Dictionary& request) = 0;
  virtual void eventsOn() = 0;
  virtual void eventsOff() = 0;
};

// The manager's end.
class ServerEnd : public End {
 public:
  // Serves `service`, which outlives it, over the connected socket `descriptor` and owns that.
  static Result<std::unique_ptr<ServerEnd>> overSocket(int descriptor, Service& service);

  bool sendEvent(std::string_view kind, std::uint64_t sequence, const ipc::Dictionary& event);

 private:
  explicit ServerEnd(Handle bus, Service& service) : End(std::move(bus)), service_(service) {}
  friend struct ServerCallbacks;

  Service& service_;
};

}  // namespace vespscope::bus
