#include "rhoxlink/bus/BusClient.h"

#include <systemd/sd-bus.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <optional>
#include <string_view>
#include <utility>

#include "platform/dispatch/SignalWatch.h"
#include "rhoxlink/bus/MessageCodec.h"
#include "rhoxlink/bus/Waiting.h"

namespace vespscope::bus {
namespace {

using ipc::Object;

int readAny(sd_bus_message* message, Object& out, int depth);

template <class Wire, class Kept>
int readNumber(sd_bus_message* message, char type, Object& out) {
  Wire value{};
  const int result = sd_bus_message_read_basic(message, type, &value);
  if (result >= 0) out = Object(static_cast<Kept>(value));
  return result;
}

int readBasic(sd_bus_message* message, char type, Object& out) {
  switch (type) {
    case SD_BUS_TYPE_BOOLEAN:
      return readNumber<int, bool>(message, type, out);
    case SD_BUS_TYPE_BYTE:
      return readNumber<std::uint8_t, std::uint64_t>(message, type, out);
    case SD_BUS_TYPE_INT16:
      return readNumber<std::int16_t, std::int64_t>(message, type, out);
    case SD_BUS_TYPE_UINT16:
      return readNumber<std::uint16_t, std::uint64_t>(message, type, out);
    case SD_BUS_TYPE_INT32:
      return readNumber<std::int32_t, std::int64_t>(message, type, out);
    case SD_BUS_TYPE_UINT32:
      return readNumber<std::uint32_t, std::uint64_t>(message, type, out);
    case SD_BUS_TYPE_INT64:
      return readNumber<std::int64_t, std::int64_t>(message, type, out);
    case SD_BUS_TYPE_UINT64:
      return readNumber<std::uint64_t, std::uint64_t>(message, type, out);
    case SD_BUS_TYPE_DOUBLE:
      return readNumber<double, double>(message, type, out);
    case SD_BUS_TYPE_STRING:
    case SD_BUS_TYPE_OBJECT_PATH:
    case SD_BUS_TYPE_SIGNATURE: {
      const char* text = nullptr;
      const int result = sd_bus_message_read_basic(message, type, &text);
      if (result >= 0) out = Object(std::string(text));
      return result;
    }
    default:
      return -EBADMSG;
  }
}

std::string keyText(const Object& key) {
  if (const std::string* text = key.asString()) return *text;
  if (const std::int64_t* number = key.asInt64()) return std::to_string(*number);
  if (const auto* number = std::get_if<std::uint64_t>(&key.data())) return std::to_string(*number);
  return {};
}

int readEntries(sd_bus_message* message, const std::string& entry, Object& out, int depth) {
  ipc::Dictionary dictionary;
  int result = 0;
  while ((result = sd_bus_message_enter_container(message, SD_BUS_TYPE_DICT_ENTRY, entry.c_str())) > 0) {
    Object key;
    Object value;
    if (result = readAny(message, key, depth); result < 0) return result;
    if (result = readAny(message, value, depth); result < 0) return result;
    if (result = sd_bus_message_exit_container(message); result < 0) return result;
    dictionary.set(keyText(key), std::move(value));
  }
  out = Object(std::move(dictionary));
  return result;
}

int readElements(sd_bus_message* message, Object& out, int depth) {
  ipc::Array array;
  int result = 0;
  while ((result = sd_bus_message_at_end(message, 0)) == 0) {
    Object element;
    if (result = readAny(message, element, depth); result < 0) return result;
    array.push_back(std::move(element));
  }
  out = Object(std::move(array));
  return result;
}

int readBytes(sd_bus_message* message, Object& out) {
  const void* data = nullptr;
  std::size_t size = 0;
  const int result = sd_bus_message_read_array(message, SD_BUS_TYPE_BYTE, &data, &size);
  if (result < 0) return result;
  const auto* bytes = static_cast<const std::uint8_t*>(data);
  out = Object(size == 0 ? Bytes() : Bytes(bytes, bytes + size));
  return result;
}

int readContainer(sd_bus_message* message, char type, const std::string& contents, Object& out, int depth) {
  if (type == SD_BUS_TYPE_ARRAY && contents == "y") return readBytes(message, out);
  int result = sd_bus_message_enter_container(message, type, contents.c_str());
  if (result < 0) return result;
  if (type == SD_BUS_TYPE_VARIANT) {
    result = readAny(message, out, depth);
  } else if (type == SD_BUS_TYPE_ARRAY && contents.starts_with('{')) {
    result = readEntries(message, contents.substr(1, contents.size() - 2), out, depth);
  } else {
    result = readElements(message, out, depth);
  }
  return result < 0 ? result : sd_bus_message_exit_container(message);
}

int readAny(sd_bus_message* message, Object& out, int depth) {
  if (depth >= depthLimit) return -EBADMSG;
  char type = 0;
  const char* contents = nullptr;
  if (const int result = sd_bus_message_peek_type(message, &type, &contents); result <= 0) {
    return result < 0 ? result : -EBADMSG;
  }
  if (contents == nullptr) return readBasic(message, type, out);
  return readContainer(message, type, contents, out, depth + 1);
}

// Returns the message's contents, or an error if some of them cannot be read.
BusClient::Answer readContents(sd_bus_message* message) {
  Contents contents;
  while (sd_bus_message_at_end(message, 1) == 0) {
    Object object;
    if (readAny(message, object, 0) < 0)
      return Failure{BusError{SD_BUS_ERROR_INCONSISTENT_MESSAGE, "a message that cannot be read"}};
    contents.push_back(std::move(object));
  }
  return contents;
}

std::string textOrEmpty(const char* text) { return text == nullptr ? std::string() : std::string(text); }

int append(sd_bus_message* message, const BusArgument& argument) {
  if (const auto* text = std::get_if<std::string>(&argument)) return appendText(message, *text);
  if (const auto* number = std::get_if<std::uint32_t>(&argument)) {
    return sd_bus_message_append_basic(message, SD_BUS_TYPE_UINT32, number);
  }
  if (const auto* flag = std::get_if<bool>(&argument)) {
    const int number = *flag ? 1 : 0;
    return sd_bus_message_append_basic(message, SD_BUS_TYPE_BOOLEAN, &number);
  }
  int result = sd_bus_message_open_container(message, SD_BUS_TYPE_ARRAY, "s");
  for (const std::string& text : std::get<std::vector<std::string>>(argument)) {
    if (result >= 0) result = appendText(message, text);
  }
  return result < 0 ? result : sd_bus_message_close_container(message);
}

// A call to the bus daemon.
BusCall callOfBus(const std::string& member, std::vector<BusArgument> arguments = {}) {
  return {"org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus", member, std::move(arguments)};
}

// Whether the bus has `service` in the list that `method` returns.
bool lists(BusClient& client, const std::string& method, const std::string& service) {
  constexpr auto patience = std::chrono::seconds(1);
  const BusClient::Answer answer = client.ask(callOfBus(method), patience);
  const ipc::Array* names = answer && answer->size() == 1 ? answer->front().asArray() : nullptr;
  return names != nullptr && std::any_of(names->begin(), names->end(), [&service](const Object& name) {
           return name.asString() != nullptr && *name.asString() == service;
         });
}

}  // namespace

struct BusClientCallbacks {
  static int signal(sd_bus_message* message, void* userdata, sd_bus_error* /*error*/) {
    const BusClient::Answer contents = readContents(message);
    if (!contents) return 0;
    const auto& handler = *static_cast<BusClient::SignalHandler*>(userdata);
    handler({textOrEmpty(sd_bus_message_get_path(message)), textOrEmpty(sd_bus_message_get_interface(message)),
             textOrEmpty(sd_bus_message_get_member(message)), *contents});
    return 0;
  }

  static int answer(sd_bus_message* message, void* userdata, sd_bus_error* /*error*/) {
    const auto& handler = *static_cast<BusClient::AnswerHandler*>(userdata);
    if (const sd_bus_error* error = sd_bus_message_get_error(message); error != nullptr) {
      handler(Failure{BusError{textOrEmpty(error->name), textOrEmpty(error->message)}});
    } else {
      handler(readContents(message));
    }
    return 1;
  }
};

BusClient::~BusClient() = default;

Result<std::unique_ptr<BusClient>> BusClient::openSystem() {
  sd_bus* raw = nullptr;
  const int result = sd_bus_open_system(&raw);
  if (result < 0) return Failure{std::string("no system bus: ") + std::strerror(-result)};
  return std::unique_ptr<BusClient>(new BusClient(Handle(raw)));
}

bool BusClient::match(const std::string& rule, SignalHandler onSignal) {
  auto handler = std::make_unique<SignalHandler>(std::move(onSignal));
  if (sd_bus_add_match_async(bus_.get(), nullptr, rule.c_str(), &BusClientCallbacks::signal, nullptr, handler.get()) <
      0) {
    return false;
  }
  handlers_.push_back(std::move(handler));
  return true;
}

bool BusClient::subscribe(const std::string& service, SignalHandler onSignal) {
  return match("type='signal',sender='" + service + "'", std::move(onSignal));
}

bool BusClient::watchOwner(const std::string& service, const OwnerHandler& onOwner) {
  const auto changed = [onOwner](const BusSignal& signal) {
    if (signal.contents.size() != 3) return;
    if (const std::string* owner = signal.contents[2].asString()) onOwner(*owner);
  };
  if (!match("type='signal',sender='org.freedesktop.DBus',interface='org.freedesktop.DBus',"
             "member='NameOwnerChanged',arg0='" +
                 service + "'",
             changed)) {
    return false;
  }
  return call(callOfBus("GetNameOwner", {service}), std::chrono::seconds(25), [onOwner](const Answer& answer) {
    const std::string* owner = answer && answer->size() == 1 ? answer->front().asString() : nullptr;
    onOwner(owner == nullptr ? std::string() : *owner);
  });
}

bool BusClient::call(const BusCall& call, std::chrono::microseconds timeout, AnswerHandler onAnswer) {
  sd_bus_message* raw = nullptr;
  int result = sd_bus_message_new_method_call(bus_.get(), &raw, call.service.c_str(), call.path.c_str(),
                                              call.interface.c_str(), call.member.c_str());
  const Message message(raw);
  if (result >= 0) result = sd_bus_message_set_auto_start(raw, 0);
  for (const auto& argument : call.arguments) {
    if (result >= 0) result = append(raw, argument);
  }
  if (result < 0) return false;
  auto handler = std::make_unique<AnswerHandler>(std::move(onAnswer));
  sd_bus_slot* slot = nullptr;
  if (sd_bus_call_async(bus_.get(), &slot, raw, &BusClientCallbacks::answer, handler.get(),
                        static_cast<std::uint64_t>(timeout.count())) < 0) {
    return false;
  }
  static_cast<void>(handler.release());  // owned by the slot from here on
  sd_bus_slot_set_destroy_callback(slot, [](void* owned) { delete static_cast<AnswerHandler*>(owned); });
  sd_bus_slot_set_floating(slot, 1);
  sd_bus_slot_unref(slot);
  return true;
}

BusClient::Answer BusClient::ask(const BusCall& question, std::chrono::milliseconds limit) {
  using Clock = std::chrono::steady_clock;
  const Clock::time_point until = Clock::now() + limit;
  const auto given = std::make_shared<std::optional<Answer>>();
  call(question, limit, [given](const Answer& answer) { *given = answer; });
  // A signal that asks the program to end may reach another thread.
  constexpr std::chrono::milliseconds lookEvery(50);
  while (process() && !*given && !dispatch::endWasRequested()) {
    if (Clock::now() >= until) break;
    Waiting waiting;
    waiting.add(wait());
    waiting.atMost(lookEvery);
    waiting.until(until);
    waiting.wait();
  }
  return given->value_or(Failure{BusError{SD_BUS_ERROR_NO_REPLY, "no answer in time"}});
}

bool isOnSystemBus(const std::string& service) {
  const auto client = BusClient::openSystem();
  return client && (lists(**client, "ListNames", service) || lists(**client, "ListActivatableNames", service));
}

}  // namespace vespscope::bus
