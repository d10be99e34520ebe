// A client of services on the system bus: calls with asynchronous answers, signals, and the owners of names.
//
// Used by one thread. Only ask() blocks.
#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <variant>
#include <vector>

#include "platform/ipc/IpcObject.h"
#include "rhoxlink/bus/Bus.h"
#include "values/Result.h"

namespace vespscope::bus {

// A message's contents, in order, as inter-process objects: signed numbers as int64, unsigned ones and bytes as uint64,
// texts, object paths and signatures as strings, byte arrays as data, other arrays and structures as arrays,
// dictionaries as dictionaries (a number as a key is written in decimal digits), variants as their contents.
using Contents = ipc::Array;

struct BusSignal {
  std::string path;
  std::string interface;
  std::string member;
  Contents contents;
};

// Of the D-Bus types s, u, b and as.
using BusArgument = std::variant<std::string, std::uint32_t, bool, std::vector<std::string>>;

struct BusCall {
  std::string service;
  std::string path;
  std::string interface;
  std::string member;
  std::vector<BusArgument> arguments;
};

// Why a call failed: the error's D-Bus name and its message.
struct BusError {
  std::string name;
  std::string words;
};

class BusClient : public End {
 public:
  using Answer = Result<Contents, BusError>;
  using AnswerHandler = std::function<void(const Answer& answer)>;
  using SignalHandler = std::function<void(const BusSignal& signal)>;
  using OwnerHandler = std::function<void(const std::string& owner)>;  // empty: the name has no owner

  // Returns a connection to the system bus (DBUS_SYSTEM_BUS_ADDRESS, else the default address), or why there is none. A
  // bus that does not respond is reported by process().
  static Result<std::unique_ptr<BusClient>> openSystem();
  ~BusClient() override;

  // Passes every signal that `service` sends to `onSignal`, from process(). Returns false when the subscription cannot
  // be sent.
  bool subscribe(const std::string& service, SignalHandler onSignal);
  // Reports the owner of `service` now and after every change, from process(); does not start the service.
  bool watchOwner(const std::string& service, const OwnerHandler& onOwner);
  // Calls a method; does not start a service that is not running. `onAnswer` is called once from process(), with the
  // reply's contents or the error, unless the connection ends first. Returns false when the call cannot be sent.
  bool call(const BusCall& call, std::chrono::microseconds timeout, AnswerHandler onAnswer);
  // Calls a method and waits at most `limit` for its answer, and no longer once a signal asks the program to end.
  Answer ask(const BusCall& call, std::chrono::milliseconds limit);

 private:
  explicit BusClient(Handle bus) : End(std::move(bus)) {}
  friend struct BusClientCallbacks;

  bool match(const std::string& rule, SignalHandler onSignal);

  std::vector<std::unique_ptr<SignalHandler>> handlers_;  // must outlive the matches that point to them
};

// Whether the name has an owner on the system bus, or the bus can start a service that takes it; false if there is no
// system bus. Waits for the bus at most two seconds.
[[nodiscard]] bool isOnSystemBus(const std::string& service);

}  // namespace vespscope::bus
