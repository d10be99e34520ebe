// A D-Bus client that sends what no client library of ours would.
#pragma once

#include <cstdint>
#include <string>

#include "values/Value.h"

struct sd_bus;

namespace vespscope::test {

class RawBus {
 public:
  // Speaks over the connected socket `descriptor`, which it owns. Its calls wait for the answer.
  explicit RawBus(int descriptor);
  RawBus(const RawBus&) = delete;
  RawBus& operator=(const RawBus&) = delete;
  ~RawBus();

  // What the manager's object says of its interfaces, as XML; empty when it does not answer.
  [[nodiscard]] std::string introspect();

  // Calls PerformCommand with an empty request; the name of the D-Bus error, empty when it is answered.
  std::string performCommand(const std::string& command);
  // Calls PerformCommand with arguments of another signature; the name of the D-Bus error.
  std::string performCommandWithANumber();
  // Calls PerformCommand with a request whose only entry holds `depth` variants in each other; the error's name.
  std::string performCommandNested(int depth);
  // Calls PerformCommand with a request of so many entries; the error's name.
  std::string performCommandWithEntries(int count);
  // Calls PerformCommand with an entry of a type that the interface does not use; the error's name.
  std::string performCommandWithAnUnknownType();
  // Calls a method that the interface does not have; the error's name.
  std::string callUnknownMethod();

 private:
  sd_bus* bus_ = nullptr;
};

}  // namespace vespscope::test
