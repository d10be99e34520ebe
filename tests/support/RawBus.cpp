#include "support/RawBus.h"

#include <systemd/sd-bus.h>

#include <cstdlib>
#include <functional>

namespace vespscope::test {
namespace {

constexpr const char* interfaceName = "org.vespscope.BasebandManager1";
constexpr const char* objectPath = "/org/vespscope/BasebandManager1";
constexpr std::uint64_t patience = 5'000'000;  // µs

std::string call(sd_bus* bus, const char* member, const std::function<void(sd_bus_message*)>& fill) {
  sd_bus_message* message = nullptr;
  sd_bus_message* reply = nullptr;
  sd_bus_error error = SD_BUS_ERROR_NULL;
  if (sd_bus_message_new_method_call(bus, &message, nullptr, objectPath, interfaceName, member) < 0) std::abort();
  fill(message);
  const int result = sd_bus_call(bus, message, patience, &error, &reply);
  const std::string name = result >= 0 ? "" : error.name == nullptr ? "no error name" : error.name;
  sd_bus_error_free(&error);
  sd_bus_message_unref(reply);
  sd_bus_message_unref(message);
  return name;
}

void appendNested(sd_bus_message* message, int depth) {
  if (depth == 0) {
    sd_bus_message_append(message, "v", "x", std::int64_t{1});
    return;
  }
  sd_bus_message_open_container(message, 'v', "av");
  sd_bus_message_open_container(message, 'a', "v");
  appendNested(message, depth - 1);
  sd_bus_message_close_container(message);
  sd_bus_message_close_container(message);
}

}  // namespace

RawBus::RawBus(int descriptor) {
  if (sd_bus_new(&bus_) < 0 || sd_bus_set_fd(bus_, descriptor, descriptor) < 0 || sd_bus_start(bus_) < 0) std::abort();
}

RawBus::~RawBus() { sd_bus_close_unref(bus_); }

std::string RawBus::introspect() {
  sd_bus_message* reply = nullptr;
  std::string xml;
  if (sd_bus_call_method(bus_, nullptr, objectPath, "org.freedesktop.DBus.Introspectable", "Introspect", nullptr,
                         &reply, "") >= 0) {
    const char* text = nullptr;
    if (sd_bus_message_read(reply, "s", &text) >= 0) xml = text;
  }
  sd_bus_message_unref(reply);
  return xml;
}

std::string RawBus::performCommand(const std::string& command) {
  return call(bus_, "PerformCommand",
              [&](sd_bus_message* message) { sd_bus_message_append(message, "sa{sv}", command.c_str(), 0); });
}

std::string RawBus::performCommandWithANumber() {
  return call(bus_, "PerformCommand", [](sd_bus_message* message) { sd_bus_message_append(message, "u", 1U); });
}

std::string RawBus::performCommandNested(int depth) {
  return call(bus_, "PerformCommand", [depth](sd_bus_message* message) {
    sd_bus_message_append(message, "s", "Status");
    sd_bus_message_open_container(message, 'a', "{sv}");
    sd_bus_message_open_container(message, 'e', "sv");
    sd_bus_message_append(message, "s", "nested");
    appendNested(message, depth);
    sd_bus_message_close_container(message);
    sd_bus_message_close_container(message);
  });
}

std::string RawBus::performCommandWithEntries(int count) {
  return call(bus_, "PerformCommand", [count](sd_bus_message* message) {
    sd_bus_message_append(message, "s", "Status");
    sd_bus_message_open_container(message, 'a', "{sv}");
    for (int number = 0; number < count; ++number) {
      sd_bus_message_append(message, "{sv}", std::to_string(number).c_str(), "x", std::int64_t{number});
    }
    sd_bus_message_close_container(message);
  });
}

std::string RawBus::performCommandWithAnUnknownType() {
  return call(bus_, "PerformCommand", [](sd_bus_message* message) {
    sd_bus_message_append(message, "sa{sv}", "Status", 1, "kKeyAppID", "(ss)", "a", "pair");
  });
}

std::string RawBus::callUnknownMethod() {
  return call(bus_, "MakeCoffee", [](sd_bus_message*) {});
}

}  // namespace vespscope::test
