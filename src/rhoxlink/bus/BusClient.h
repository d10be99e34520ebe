// A client of services on the system bus: calls that are answered later, signals, and who owns a name.
//
// Belongs to one thread and, but for ask(), never waits, as every end of a connection does.
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

// What a message carries, in order, as inter-process objects: signed numbers as int64, unsigned ones and bytes as
// uint64, texts, object paths and signatures as strings, byte arrays as data, other arrays and structures as arrays,
// dictionaries as dictionaries (a number as a key is written in decimal digits), variants as what they hold.
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

// Why a call was not answered: the error's D-Bus name and its words.
struct BusError {
  std::string name;
  std::string words;
};

class BusClient : public End {
 public:
  using Answer = Result<Contents, BusError>;
  using AnswerHandler = std::function<void(const Answer& answer)>;
  using SignalHandler = std::function<void(const BusSignal& signal)>;
  using OwnerHandler = std::function<void(const std::string& owner)>;  // empty: nobody owns the name

  // A connection to the system bus (DBUS_SYSTEM_BUS_ADDRESS, else the usual place), or why there is none. A bus that
  // is there but does not speak shows in process().
  static Result<std::unique_ptr<BusClient>> openSystem();
  ~BusClient() override;

  // Hands every signal that `service` sends to `onSignal`, from process(). False when it cannot be asked for.
  bool subscribe(const std::string& service, SignalHandler onSignal);
  // Reports the owner of `service` now and whenever it changes, from process(); the service is not started.
  bool watchOwner(const std::string& service, const OwnerHandler& onOwner);
  // Calls a method; a service that does not run is not started for it. `onAnswer` is called once from process(), with
  // the reply's contents or the error; when the connection ends before, perhaps not at all. False when it cannot be
  // sent.
  bool call(const BusCall& call, std::chrono::microseconds timeout, AnswerHandler onAnswer);
  // Calls a method and waits for its answer, at most `limit`.
  Answer ask(const BusCall& call, std::chrono::milliseconds limit);

 private:
  explicit BusClient(Handle bus) : End(std::move(bus)) {}
  friend struct BusClientCallbacks;

  bool match(const std::string& rule, SignalHandler onSignal);

  std::vector<std::unique_ptr<SignalHandler>> handlers_;  // outlive the matches that point to them
};

// Whether somebody has the name on the system bus, or the bus can start a service that takes it; false also without a
// system bus. Waits for the bus, at most two seconds.
[[nodiscard]] bool isOnSystemBus(const std::string& service);

}  // namespace vespscope::bus
