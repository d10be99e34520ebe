// A D-Bus client that sends messages which our client library would never send.
#pragma once

#include <cstdint>
#include <string>

#include "values/Value.h"

struct sd_bus;

namespace vespscope::test {

class RawBus {
 public:
  // Uses the connected socket `descriptor`, which it owns. Its calls wait for the answer.
  explicit RawBus(int descriptor);
  RawBus(const RawBus&) = delete;
  RawBus& operator=(const RawBus&) = delete;
  ~RawBus();

  // The introspection of the manager's object as XML; empty without an answer.
  [[nodiscard]] std::string introspect();

  // Calls PerformCommand with an empty request; returns the name of the D-Bus error, empty when it is answered.
  std::string performCommand(const std::string& command);
  // Calls PerformCommand with arguments of another signature; returns the name of the D-Bus error.
  std::string performCommandWithANumber();
  // Calls PerformCommand with a request whose only entry has `depth` nested variants; returns the error's name.
  std::string performCommandNested(int depth);
  // Calls PerformCommand with a request of this many entries; returns the error's name.
  std::string performCommandWithEntries(int count);
  // Calls PerformCommand with an entry of a type that the interface does not use; returns the error's name.
  std::string performCommandWithAnUnknownType();
  // Calls a method that the interface does not have; returns the error's name.
  std::string callUnknownMethod();

 private:
  sd_bus* bus_ = nullptr;
};

}  // namespace vespscope::test
