#include "rhoxlink/bus/ServiceLookup.h"

#include <systemd/sd-bus.h>

#include <cstdint>
#include <memory>
#include <string_view>

#include "rhoxlink/bus/Bus.h"
#include "rhoxlink/bus/MessageCodec.h"

namespace vespscope::bus {
namespace {

constexpr std::uint64_t patience = 2'000'000;  // µs

struct Close {
  void operator()(sd_bus* bus) const { sd_bus_close_unref(bus); }
};

// The daemon's list of names.
bool lists(sd_bus* bus, const char* method, std::string_view wanted) {
  sd_bus_message* raw = nullptr;
  const int result = sd_bus_call_method(bus, "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus",
                                        method, nullptr, &raw, "");
  const Message answer(raw);
  if (result < 0 || sd_bus_message_enter_container(raw, 'a', "s") < 0) return false;
  const char* name = nullptr;
  while (sd_bus_message_read(raw, "s", &name) > 0) {
    if (wanted == name) return true;
  }
  return false;
}

}  // namespace

bool isManagerOnSystemBus() {
  sd_bus* raw = nullptr;
  const int result = sd_bus_open_system(&raw);
  const std::unique_ptr<sd_bus, Close> bus(raw);
  if (result < 0 || sd_bus_set_method_call_timeout(raw, patience) < 0) return false;
  return lists(raw, "ListNames", serviceName) || lists(raw, "ListActivatableNames", serviceName);
}

}  // namespace vespscope::bus
