#include "support/BusStranger.h"

#include <systemd/sd-bus.h>

#include <cstdint>
#include <cstdlib>
#include <cstring>

namespace vespscope::test {
namespace {

constexpr const char* managerName = "org.vespscope.BasebandManager1";
constexpr const char* managerObject = "/org/vespscope/BasebandManager1";

std::string nameOf(int result, sd_bus_error& error) {
  std::string name = result >= 0 ? "" : error.name == nullptr ? std::strerror(-result) : error.name;
  sd_bus_error_free(&error);
  return name;
}

}  // namespace

BusStranger::BusStranger() {
  if (sd_bus_open_system(&bus_) < 0) std::abort();
}

BusStranger::~BusStranger() { sd_bus_close_unref(bus_); }

std::string BusStranger::callManager(const std::string& method) {
  sd_bus_error error = SD_BUS_ERROR_NULL;
  const int result =
      method == "PerformCommand"
          ? sd_bus_call_method(bus_, managerName, managerObject, managerName, method.c_str(), &error, nullptr, "sa{sv}",
                               "Status", 0)
          : sd_bus_call_method(bus_, managerName, managerObject, managerName, method.c_str(), &error, nullptr, "");
  return nameOf(result, error);
}

std::string BusStranger::introspectManager() {
  sd_bus_error error = SD_BUS_ERROR_NULL;
  return nameOf(sd_bus_call_method(bus_, managerName, managerObject, "org.freedesktop.DBus.Introspectable",
                                   "Introspect", &error, nullptr, ""),
                error);
}

std::string BusStranger::takeName() {
  const int result = sd_bus_request_name(bus_, managerName, SD_BUS_NAME_REPLACE_EXISTING);
  return result >= 0 ? "" : std::strerror(-result);
}

std::string BusStranger::becomeMonitor() {
  sd_bus_error error = SD_BUS_ERROR_NULL;
  return nameOf(sd_bus_call_method(bus_, "org.freedesktop.DBus", "/org/freedesktop/DBus",
                                   "org.freedesktop.DBus.Monitoring", "BecomeMonitor", &error, nullptr, "asu", 0, 0U),
                error);
}

int BusStranger::overhear(std::chrono::milliseconds time) {
  int count = 0;
  const auto onEvent = [](sd_bus_message* message, void* userdata, sd_bus_error*) {
    if (sd_bus_message_is_signal(message, managerName, "Event") > 0) ++*static_cast<int*>(userdata);
    return 0;
  };
  sd_bus_add_filter(bus_, nullptr, onEvent, &count);
  for (const char* rule : {"eavesdrop='true',type='signal',interface='org.vespscope.BasebandManager1'",
                           "type='signal',interface='org.vespscope.BasebandManager1'", "eavesdrop='true'"}) {
    sd_bus_add_match(bus_, nullptr, rule, nullptr, nullptr);
  }
  const auto end = std::chrono::steady_clock::now() + time;
  while (std::chrono::steady_clock::now() < end) {
    while (sd_bus_process(bus_, nullptr) > 0) {
    }
    sd_bus_wait(bus_, 20'000);
  }
  return count;
}

bool BusStranger::forgeEvent(const std::string& client) {
  sd_bus_message* message = nullptr;
  const bool sent = sd_bus_message_new_signal(bus_, &message, managerObject, managerName, "Event") >= 0 &&
                    sd_bus_message_set_destination(message, client.c_str()) >= 0 &&
                    sd_bus_message_append(message, "sta{sv}", "Metric", std::uint64_t{1}, 1, "kKeyMetricID", "x",
                                          std::int64_t{666}) >= 0 &&
                    sd_bus_send(bus_, message, nullptr) >= 0 && sd_bus_flush(bus_) >= 0;
  sd_bus_message_unref(message);
  return sent;
}

}  // namespace vespscope::test
