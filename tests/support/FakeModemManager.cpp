#include "support/FakeModemManager.h"

#include <poll.h>
#include <sys/eventfd.h>
#include <systemd/sd-bus.h>
#include <unistd.h>

#include <array>
#include <stdexcept>

namespace vespscope::test {
namespace {

constexpr const char* serviceName = "org.freedesktop.ModemManager1";
constexpr const char* rootPath = "/org/freedesktop/ModemManager1";
constexpr const char* objectManager = "org.freedesktop.DBus.ObjectManager";
constexpr const char* properties = "org.freedesktop.DBus.Properties";

bool isModem(const std::string& path) { return path.find("/Modem/") != std::string::npos; }

template <class Kind>
BusValue basic(char type, Kind value) {
  return {std::string(1, type),
          [type, value](sd_bus_message* message) { sd_bus_message_append_basic(message, type, &value); }};
}

BusValue text(char type, std::string value) {
  return {std::string(1, type), [type, value = std::move(value)](sd_bus_message* message) {
            sd_bus_message_append_basic(message, type, value.c_str());
          }};
}

// A container with the values that `contents` writes.
BusValue container(char type, const std::string& inner, std::function<void(sd_bus_message*)> contents) {
  std::string signature;
  if (type == SD_BUS_TYPE_ARRAY) signature = "a" + inner;
  if (type == SD_BUS_TYPE_VARIANT) signature = "v";
  if (type == SD_BUS_TYPE_DICT_ENTRY) signature = "{" + inner + "}";
  return {signature, [type, inner, contents = std::move(contents)](sd_bus_message* message) {
            sd_bus_message_open_container(message, type, inner.c_str());
            contents(message);
            sd_bus_message_close_container(message);
          }};
}

BusValue variant(const BusValue& value) { return container(SD_BUS_TYPE_VARIANT, value.signature, value.append); }

BusValue entry(const BusValue& key, const BusValue& value) {
  return container(SD_BUS_TYPE_DICT_ENTRY, key.signature + value.signature, [key, value](sd_bus_message* message) {
    key.append(message);
    value.append(message);
  });
}

BusValue array(const std::string& inner, std::vector<BusValue> elements) {
  return container(SD_BUS_TYPE_ARRAY, inner, [elements = std::move(elements)](sd_bus_message* message) {
    for (const BusValue& element : elements) element.append(message);
  });
}

struct Unref {
  void operator()(sd_bus_message* message) const { sd_bus_message_unref(message); }
};
using Message = std::unique_ptr<sd_bus_message, Unref>;

Message signalOf(sd_bus* bus, const std::string& path, const char* interface, const char* member) {
  sd_bus_message* raw = nullptr;
  sd_bus_message_new_signal(bus, &raw, path.c_str(), interface, member);
  return Message(raw);
}

}  // namespace

BusValue busNumber(std::uint32_t number) { return basic('u', number); }
BusValue busInteger(std::int32_t number) { return basic('i', number); }
BusValue busReal(double number) { return basic('d', number); }
BusValue busFlag(bool flag) { return basic('b', flag ? 1 : 0); }
BusValue busText(std::string value) { return text('s', std::move(value)); }
BusValue busPath(std::string path) { return text('o', std::move(path)); }

BusValue busPaths(std::vector<std::string> paths) {
  std::vector<BusValue> elements;
  for (std::string& path : paths) elements.push_back(busPath(std::move(path)));
  return array("o", std::move(elements));
}

BusValue busDictionary(BusProperties entries) {
  std::vector<BusValue> elements;
  for (const auto& [name, value] : entries) elements.push_back(entry(busText(name), variant(value)));
  return array("{sv}", std::move(elements));
}

BusValue busDictionaries(std::vector<BusProperties> dictionaries) {
  std::vector<BusValue> elements;
  for (BusProperties& each : dictionaries) elements.push_back(busDictionary(std::move(each)));
  return array("a{sv}", std::move(elements));
}

BusValue busPorts(std::vector<std::string> names) {
  std::vector<BusValue> elements;
  for (std::string& name : names) {
    elements.push_back({"(su)", [name = std::move(name)](sd_bus_message* message) {
                          constexpr std::uint32_t serial = 3;
                          sd_bus_message_append(message, "(su)", name.c_str(), serial);
                        }});
  }
  return array("(su)", std::move(elements));
}

BusValue busNumbered(std::uint32_t key, BusValue value) {
  return array("{uv}", {entry(busNumber(key), variant(value))});
}

struct FakeModemManagerCallbacks {
  static int message(sd_bus_message* message, void* userdata, sd_bus_error* /*error*/) {
    if (sd_bus_message_is_method_call(message, nullptr, nullptr) <= 0) return 0;
    static_cast<FakeModemManager*>(userdata)->handle(message);
    return 1;
  }
};

FakeModemManager::FakeModemManager() : wake_(::eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK)) {
  if (sd_bus_open_system(&bus_) < 0 ||
      sd_bus_add_filter(bus_, nullptr, &FakeModemManagerCallbacks::message, this) < 0 ||
      sd_bus_request_name(bus_, serviceName, 0) < 0) {
    throw std::runtime_error("no name on the bus for the fake ModemManager");
  }
  thread_ = std::thread([this] { run(); });
}

FakeModemManager::~FakeModemManager() {
  {
    const std::lock_guard lock(mutex_);
    stopping_ = true;
  }
  const std::uint64_t one = 1;
  [[maybe_unused]] const ssize_t ignored = ::write(wake_, &one, sizeof one);
  thread_.join();
  sd_bus_flush_close_unref(bus_);
  ::close(wake_);
}

void FakeModemManager::run() {
  while (true) {
    pollfd connection{};
    {
      const std::lock_guard lock(mutex_);
      if (stopping_) return;
      while (sd_bus_process(bus_, nullptr) > 0) {
      }
      connection = {sd_bus_get_fd(bus_), static_cast<short>(sd_bus_get_events(bus_)), 0};
    }
    std::array<pollfd, 2> ready = {connection, {wake_, POLLIN, 0}};
    ::poll(ready.data(), ready.size(), -1);
  }
}

BusValue FakeModemManager::interfacesOf(const std::string& path) const {
  std::vector<BusValue> interfaces;
  for (const auto& [interface, values] : objects_.at(path)) {
    interfaces.push_back(entry(busText(interface), busDictionary(values)));
  }
  return array("{sa{sv}}", std::move(interfaces));
}

void FakeModemManager::handle(sd_bus_message* call) {
  const std::string member = sd_bus_message_get_member(call);
  const std::string path = sd_bus_message_get_path(call);
  ++calls_[member];
  if (const auto scripted = answers_.find(member); scripted != answers_.end()) return send(call, scripted->second);
  if (member == "GetManagedObjects") {
    std::vector<BusValue> objects;
    for (const auto& [each, interfaces] : objects_) {
      if (isModem(each)) objects.push_back(entry(busPath(each), interfacesOf(each)));
    }
    return send(call, {Answer::Manner::reply, {array("{oa{sa{sv}}}", std::move(objects))}, {}});
  }
  const auto object = objects_.find(path);
  if (member == "GetAll" && object != objects_.end()) {
    const char* interface = nullptr;
    sd_bus_message_read(call, "s", &interface);
    return send(call, {Answer::Manner::reply, {busDictionary(object->second[interface])}, {}});
  }
  if (member == "Setup" && object != objects_.end()) {
    const std::string interface = sd_bus_message_get_interface(call);
    const char* property = interface.ends_with(".Location") ? "Enabled" : "Rate";
    std::uint32_t number = 0;
    sd_bus_message_read(call, "u", &number);
    object->second[interface][property] = busNumber(number);
    setUp_[interface] = number;
    const Message changed = signalOf(bus_, path, properties, "PropertiesChanged");
    busText(interface).append(changed.get());
    busDictionary({{property, busNumber(number)}}).append(changed.get());
    array("s", {}).append(changed.get());
    sd_bus_send(bus_, changed.get(), nullptr);
    return send(call, {});
  }
  send(call, {Answer::Manner::error, {}, "org.freedesktop.DBus.Error.UnknownMethod"});
}

void FakeModemManager::send(sd_bus_message* call, const Answer& answer) {
  if (answer.manner == Answer::Manner::silence) return;
  if (answer.manner == Answer::Manner::error) {
    sd_bus_reply_method_errorf(call, answer.error.c_str(), "as the test wants it");
    return;
  }
  sd_bus_message* raw = nullptr;
  sd_bus_message_new_method_return(call, &raw);
  const Message message(raw);
  for (const BusValue& value : answer.contents) value.append(raw);
  sd_bus_send(bus_, raw, nullptr);
}

void FakeModemManager::add(const std::string& path, const Interfaces& interfaces) {
  const std::lock_guard lock(mutex_);
  objects_[path] = interfaces;
  if (!isModem(path)) return;
  const Message message = signalOf(bus_, rootPath, objectManager, "InterfacesAdded");
  busPath(path).append(message.get());
  interfacesOf(path).append(message.get());
  sd_bus_send(bus_, message.get(), nullptr);
}

void FakeModemManager::remove(const std::string& path) {
  const std::lock_guard lock(mutex_);
  std::vector<BusValue> names;
  for (const auto& [interface, values] : objects_.at(path)) names.push_back(busText(interface));
  objects_.erase(path);
  if (!isModem(path)) return;
  const Message message = signalOf(bus_, rootPath, objectManager, "InterfacesRemoved");
  busPath(path).append(message.get());
  array("s", std::move(names)).append(message.get());
  sd_bus_send(bus_, message.get(), nullptr);
}

void FakeModemManager::change(const std::string& path, const std::string& interface, const BusProperties& changed) {
  const std::lock_guard lock(mutex_);
  for (const auto& [name, value] : changed) objects_.at(path)[interface][name] = value;
  const Message message = signalOf(bus_, path, properties, "PropertiesChanged");
  busText(interface).append(message.get());
  busDictionary(changed).append(message.get());
  array("s", {}).append(message.get());
  sd_bus_send(bus_, message.get(), nullptr);
}

void FakeModemManager::invalidate(const std::string& path, const std::string& interface, const std::string& name) {
  const std::lock_guard lock(mutex_);
  objects_.at(path)[interface].erase(name);
  const Message message = signalOf(bus_, path, properties, "PropertiesChanged");
  busText(interface).append(message.get());
  busDictionary({}).append(message.get());
  array("s", {busText(name)}).append(message.get());
  sd_bus_send(bus_, message.get(), nullptr);
}

void FakeModemManager::answer(const std::string& method, Answer answer) {
  const std::lock_guard lock(mutex_);
  answers_[method] = std::move(answer);
}

std::optional<std::uint32_t> FakeModemManager::setUp(const std::string& interface) const {
  const std::lock_guard lock(mutex_);
  const auto found = setUp_.find(interface);
  return found == setUp_.end() ? std::nullopt : std::optional(found->second);
}

int FakeModemManager::calls(const std::string& method) const {
  const std::lock_guard lock(mutex_);
  const auto found = calls_.find(method);
  return found == calls_.end() ? 0 : found->second;
}

}  // namespace vespscope::test
