#include "rhoxlink/bus/SystemBusEnd.h"

#include <systemd/sd-bus.h>

#include <cerrno>
#include <cstring>
#include <utility>

#include "platform/log/Log.h"
#include "rhoxlink/bus/MessageCodec.h"

namespace vespscope::bus {
namespace {

// The bus between the manager and a client would store events that the client does not read. So a client is sent only a
// limited number of events after the last ping that it has answered (org.freedesktop.DBus.Peer.Ping, which every D-Bus
// library answers automatically when it reads on).
constexpr std::uint64_t windowEvents = 1024;
constexpr std::uint64_t windowBytes = 256 * 1024;
constexpr std::uint64_t questionEvery = 128;             // events
constexpr std::uint64_t questionEveryBytes = 32 * 1024;  // or bytes of payload
constexpr std::uint64_t driverPatience = 2'000'000;      // µs, for answers of the bus daemon

struct SlotUnref {
  void operator()(sd_bus_slot* slot) const { sd_bus_slot_unref(slot); }
};
using Slot = std::unique_ptr<sd_bus_slot, SlotUnref>;

struct TrackUnref {
  void operator()(sd_bus_track* track) const { sd_bus_track_unref(track); }
};
using Track = std::unique_ptr<sd_bus_track, TrackUnref>;

std::uint64_t payloadOf(const ipc::Dictionary& event) {
  const ipc::Object* payload = event.find(rhox::kKeyPayload);
  return payload == nullptr || payload->asData() == nullptr ? 0 : payload->asData()->size();
}

// Reads the "v" of a credentials entry, a list of numbers.
int readNumbers(sd_bus_message* message, std::vector<std::uint32_t>& out) {
  int result = sd_bus_message_enter_container(message, 'v', "au");
  const void* data = nullptr;
  std::size_t size = 0;
  if (result >= 0) result = sd_bus_message_read_array(message, 'u', &data, &size);
  if (result < 0) return result;
  const auto* numbers = static_cast<const std::uint32_t*>(data);
  out.assign(numbers, numbers + size / sizeof *numbers);
  return sd_bus_message_exit_container(message);
}

}  // namespace

class SystemBusEnd::Client final : public EventOutlet {
 public:
  Client(SystemBusEnd& end, std::string name) : end_(end), name_(std::move(name)) {}

  // Subscribes to the client's leaving the bus.
  bool track();

  [[nodiscard]] bool ready() const override {
    return end_.hasRoom() && openEvents_ < windowEvents && openBytes_ < windowBytes;
  }

  bool sendEvent(std::string_view kind, std::uint64_t sequence, const ipc::Dictionary& event) override {
    if (!end_.send(name_.c_str(), kind, sequence, event)) return false;
    ++openEvents_;
    openBytes_ += payloadOf(event);
    if (!question_ && !unaskable_ && (openEvents_ >= questionEvery || openBytes_ >= questionEveryBytes)) ask();
    return true;
  }

  Service* service = nullptr;

 private:
  friend struct SystemBusCallbacks;

  void ask();

  SystemBusEnd& end_;
  const std::string name_;
  Track track_;
  Slot question_;                  // while an answer is awaited
  std::uint64_t openEvents_ = 0;   // sent, not known to be read
  std::uint64_t openBytes_ = 0;    // of payload, same
  std::uint64_t askedEvents_ = 0;  // covered by the pending ping
  std::uint64_t askedBytes_ = 0;
  bool unaskable_ = false;
};

struct SystemBusCallbacks {
  static int left(sd_bus_track* /*track*/, void* userdata) {
    const auto* client = static_cast<SystemBusEnd::Client*>(userdata);
    SystemBusEnd& end = client->end_;
    const std::string name = client->name_;
    end.host_.forget(name);
    end.clients_.erase(name);
    return 0;
  }

  static int answered(sd_bus_message* message, void* userdata, sd_bus_error* /*error*/) {
    auto* client = static_cast<SystemBusEnd::Client*>(userdata);
    client->question_.reset();
    if (const sd_bus_error* error = sd_bus_message_get_error(message);
        error != nullptr && sd_bus_error_has_name(error, SD_BUS_ERROR_UNKNOWN_METHOD) <= 0) {
      // A client that has left is forgotten anyway; one that cannot be pinged gets no more events.
      if (sd_bus_error_has_name(error, SD_BUS_ERROR_ACCESS_DENIED) > 0) {
        client->unaskable_ = true;
        log::system("the bus policy does not allow the manager to ping " + client->name_);
      }
      return 1;
    }
    client->openEvents_ -= std::exchange(client->askedEvents_, 0);
    client->openBytes_ -= std::exchange(client->askedBytes_, 0);
    return 1;
  }
};

bool SystemBusEnd::Client::track() {
  sd_bus_track* raw = nullptr;
  const int result = sd_bus_track_new(end_.bus_.get(), &raw, &SystemBusCallbacks::left, this);
  track_.reset(raw);
  return result >= 0 && sd_bus_track_add_name(raw, name_.c_str()) >= 0;
}

void SystemBusEnd::Client::ask() {
  sd_bus_message* raw = nullptr;
  sd_bus_slot* slot = nullptr;
  int result =
      sd_bus_message_new_method_call(end_.bus_.get(), &raw, name_.c_str(), "/", "org.freedesktop.DBus.Peer", "Ping");
  const Message message(raw);
  if (result >= 0) result = sd_bus_message_set_auto_start(raw, 0);
  // The ping has no timeout: a client may stop reading for any time.
  if (result >= 0) {
    result = sd_bus_call_async(end_.bus_.get(), &slot, raw, &SystemBusCallbacks::answered, this, UINT64_MAX);
  }
  if (result < 0) return;  // pinged again after the next event
  question_.reset(slot);
  askedEvents_ = openEvents_;
  askedBytes_ = openBytes_;
}

SystemBusEnd::SystemBusEnd(Handle bus, Host& host) : ServingEnd(std::move(bus)), host_(host) {}

SystemBusEnd::~SystemBusEnd() {
  while (!clients_.empty()) {
    host_.forget(clients_.begin()->first);
    clients_.erase(clients_.begin());
  }
}

Result<std::unique_ptr<SystemBusEnd>> SystemBusEnd::open(Host& host) {
  Result<Handle> bus = startOnSystemBus(true);
  if (!bus) return Failure{bus.reason()};
  std::unique_ptr<SystemBusEnd> end(new SystemBusEnd(std::move(*bus), host));
  if (const Result<bool> served = end->serve(); !served) return Failure{served.reason()};
  const std::string name = serviceName;
  const int result = sd_bus_request_name(end->bus_.get(), serviceName, 0);
  if (result == -EEXIST) return Failure{"another manager has the name " + name + " on the system bus"};
  if (result == -EACCES || result == -EPERM) {
    return Failure{"the system bus does not allow this user to own the name " + name +
                   " (is the bus policy installed?)"};
  }
  if (result < 0) return Failure{"cannot get the name " + name + " on the system bus: " + std::strerror(-result)};
  return end;
}

Result<ClientIdentity> SystemBusEnd::identify(const std::string& busName) {
  const Failure unknown{"the bus does not report the user of " + busName};
  sd_bus_message* raw = nullptr;
  int result = sd_bus_message_new_method_call(bus_.get(), &raw, "org.freedesktop.DBus", "/org/freedesktop/DBus",
                                              "org.freedesktop.DBus", "GetConnectionCredentials");
  const Message question(raw);
  if (result >= 0) result = sd_bus_message_append(raw, "s", busName.c_str());
  sd_bus_message* answer = nullptr;
  if (result >= 0) result = sd_bus_call(bus_.get(), raw, driverPatience, nullptr, &answer);
  const Message credentials(answer);
  if (result >= 0) result = sd_bus_message_enter_container(answer, 'a', "{sv}");
  if (result < 0) return unknown;
  ClientIdentity identity;
  identity.busName = busName;
  bool hasUser = false;
  while ((result = sd_bus_message_enter_container(answer, 'e', "sv")) > 0) {
    const char* key = nullptr;
    std::uint32_t number = 0;
    if (sd_bus_message_read(answer, "s", &key) < 0) return unknown;
    const std::string_view entry = key;
    if (entry == "UnixUserID" || entry == "ProcessID") {
      if (sd_bus_message_read(answer, "v", "u", &number) < 0) return unknown;
      if (entry == "ProcessID") identity.process = number;
      if (entry == "UnixUserID") identity.user = number;
      hasUser = hasUser || entry == "UnixUserID";
    } else if (entry == "UnixGroupIDs") {
      if (readNumbers(answer, identity.groups) < 0) return unknown;
    } else if (sd_bus_message_skip(answer, "v") < 0) {
      return unknown;
    }
    if (sd_bus_message_exit_container(answer) < 0) return unknown;
  }
  if (result < 0 || !hasUser) return unknown;
  return identity;
}

Result<Service*> SystemBusEnd::serviceFor(sd_bus_message* call) {
  const char* sender = sd_bus_message_get_sender(call);
  if (sender == nullptr) return Failure{std::string("a call without a sender")};
  if (const auto known = clients_.find(std::string_view(sender)); known != clients_.end()) {
    return known->second->service;
  }
  const std::string name = sender;
  const Result<ClientIdentity> identity = identify(name);
  if (!identity) return Failure{identity.reason()};
  auto client = std::make_unique<Client>(*this, name);
  // Tracked first: a client that leaves meanwhile is not admitted.
  if (!client->track()) return Failure{name + " has left the bus"};
  const Result<Service*> service = host_.admit(*identity, *client);
  if (!service) return Failure{service.reason()};
  client->service = *service;
  clients_.emplace(name, std::move(client));
  return *service;
}

}  // namespace vespscope::bus
