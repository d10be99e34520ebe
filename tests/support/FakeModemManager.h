// A ModemManager controlled by a test, on the system bus: objects with properties, and scripted answers to calls.
#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <mutex>
#include <optional>
#include <string>
#include <thread>
#include <utility>
#include <vector>

struct sd_bus;
struct sd_bus_message;

namespace vespscope::test {

// A D-Bus value of any type, written when it is sent.
struct BusValue {
  std::string signature;
  std::function<void(sd_bus_message*)> append;
};

using BusProperties = std::map<std::string, BusValue>;

BusValue busNumber(std::uint32_t number);
BusValue busInteger(std::int32_t number);
BusValue busReal(double number);
BusValue busFlag(bool flag);
BusValue busText(std::string text);
BusValue busPath(std::string path);
BusValue busPaths(std::vector<std::string> paths);
BusValue busDictionary(BusProperties entries);
BusValue busDictionaries(std::vector<BusProperties> elements);
// Names, each with a kind, as a modem lists its ports: a(su).
BusValue busPorts(std::vector<std::string> names);
// A dictionary with numbers as keys, a{uv}.
BusValue busNumbered(std::uint32_t key, BusValue value);

class FakeModemManager {
 public:
  struct Answer {
    enum class Manner { reply, error, silence };
    Manner manner = Manner::reply;
    std::vector<BusValue> contents;  // of a reply
    std::string error;               // the error's name
  };
  using Interfaces = std::map<std::string, BusProperties>;

  // Takes ModemManager's name.
  FakeModemManager();
  FakeModemManager(const FakeModemManager&) = delete;
  FakeModemManager& operator=(const FakeModemManager&) = delete;
  ~FakeModemManager();

  // Adds an object; announces a modem.
  void add(const std::string& path, const Interfaces& interfaces);
  // Removes an object; announces the removal of a modem.
  void remove(const std::string& path);
  // Changes some properties of an object and signals it.
  void change(const std::string& path, const std::string& interface, const BusProperties& properties);
  // Announces that the value of a property is no longer valid.
  void invalidate(const std::string& path, const std::string& interface, const std::string& name);
  // Sets the answer to the method from here on; without one, the method is unknown. By default "GetManagedObjects" and
  // "GetAll" are answered with the objects, and "Setup" sets the rate of signal measurements or the sources of the
  // location.
  void answer(const std::string& method, Answer answer);
  void reply(const std::string& method, BusValue contents) {
    answer(method, {Answer::Manner::reply, {std::move(contents)}, {}});
  }
  void fail(const std::string& method, const std::string& error) { answer(method, {Answer::Manner::error, {}, error}); }

  // The argument of the last "Setup" of an interface; empty before.
  [[nodiscard]] std::optional<std::uint32_t> setUp(const std::string& interface) const;
  // The number of calls of a method.
  [[nodiscard]] int calls(const std::string& method) const;

 private:
  friend struct FakeModemManagerCallbacks;

  void run();
  void handle(sd_bus_message* call);
  void send(sd_bus_message* call, const Answer& answer);
  [[nodiscard]] BusValue interfacesOf(const std::string& path) const;

  mutable std::mutex mutex_;  // guards the members below
  sd_bus* bus_ = nullptr;
  int wake_ = -1;
  bool stopping_ = false;
  std::map<std::string, Interfaces> objects_;
  std::map<std::string, Answer> answers_;
  std::map<std::string, int> calls_;
  std::map<std::string, std::uint32_t> setUp_;

  std::thread thread_;
};

}  // namespace vespscope::test
