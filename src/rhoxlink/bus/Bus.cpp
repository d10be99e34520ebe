#include "rhoxlink/bus/Bus.h"

#include <systemd/sd-bus.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <type_traits>
#include <utility>

#include <time.h>

#include "values/Text.h"

namespace vespscope::bus {
namespace {

// Deeper objects are neither sent nor taken: nothing of ours nests more than a few levels, and a peer shall not choose
// our stack's depth.
constexpr int depthLimit = 16;

constexpr std::size_t dataLimit = std::size_t{1} << 26;  // bytes in an array, as D-Bus has it

struct Unref {
  void operator()(sd_bus_message* message) const { sd_bus_message_unref(message); }
};
using Message = std::unique_ptr<sd_bus_message, Unref>;

// The first failure of a run of calls; later calls are skipped.
class Steps {
 public:
  template <class Call>
  Steps& then(Call call) {
    if (result_ >= 0) result_ = call();
    return *this;
  }
  [[nodiscard]] int result() const { return result_; }

 private:
  int result_ = 0;
};

int appendText(sd_bus_message* message, const std::string& text) {
  // D-Bus text is UTF-8 without zero bytes; any other text is sent as people can read it.
  const bool hasZero = text.find('\0') != std::string::npos;
  if (!hasZero) {
    const int result = sd_bus_message_append_basic(message, SD_BUS_TYPE_STRING, text.c_str());
    if (result != -EINVAL) return result;
  }
  return sd_bus_message_append_basic(message, SD_BUS_TYPE_STRING, printable(text).c_str());
}

int appendDictionary(sd_bus_message* message, const ipc::Dictionary& dictionary, int depth);

int appendVariant(sd_bus_message* message, const char* signature, const auto& appendContents) {
  return Steps()
      .then([&] { return sd_bus_message_open_container(message, SD_BUS_TYPE_VARIANT, signature); })
      .then(appendContents)
      .then([&] { return sd_bus_message_close_container(message); })
      .result();
}

int appendObject(sd_bus_message* message, const ipc::Object& object, int depth) {
  if (depth >= depthLimit) return -EMSGSIZE;
  return std::visit(
      [message, depth](const auto& kind) {
        using Kind = std::decay_t<decltype(kind)>;
        if constexpr (std::is_same_v<Kind, std::monostate>) {
          return appendVariant(message, "g", [&] { return sd_bus_message_append_basic(message, 'g', ""); });
        } else if constexpr (std::is_same_v<Kind, bool>) {
          const int flag = kind ? 1 : 0;
          return appendVariant(message, "b", [&] { return sd_bus_message_append_basic(message, 'b', &flag); });
        } else if constexpr (std::is_same_v<Kind, std::int64_t>) {
          return appendVariant(message, "x", [&] { return sd_bus_message_append_basic(message, 'x', &kind); });
        } else if constexpr (std::is_same_v<Kind, std::uint64_t>) {
          return appendVariant(message, "t", [&] { return sd_bus_message_append_basic(message, 't', &kind); });
        } else if constexpr (std::is_same_v<Kind, double>) {
          return appendVariant(message, "d", [&] { return sd_bus_message_append_basic(message, 'd', &kind); });
        } else if constexpr (std::is_same_v<Kind, std::string>) {
          return appendVariant(message, "s", [&] { return appendText(message, kind); });
        } else if constexpr (std::is_same_v<Kind, Bytes>) {
          if (kind.size() > dataLimit) return -EMSGSIZE;
          return appendVariant(message, "ay",
                               [&] { return sd_bus_message_append_array(message, 'y', kind.data(), kind.size()); });
        } else if constexpr (std::is_same_v<Kind, ipc::Array>) {
          return appendVariant(message, "av", [&] {
            Steps steps;
            steps.then([&] { return sd_bus_message_open_container(message, SD_BUS_TYPE_ARRAY, "v"); });
            for (const ipc::Object& element : kind)
              steps.then([&] { return appendObject(message, element, depth + 1); });
            return steps.then([&] { return sd_bus_message_close_container(message); }).result();
          });
        } else {
          return appendVariant(message, "a{sv}", [&] { return appendDictionary(message, kind, depth + 1); });
        }
      },
      object.data());
}

int appendDictionary(sd_bus_message* message, const ipc::Dictionary& dictionary, int depth) {
  Steps steps;
  steps.then([&] { return sd_bus_message_open_container(message, SD_BUS_TYPE_ARRAY, "{sv}"); });
  for (const auto& [key, object] : dictionary.entries()) {
    steps.then([&] { return sd_bus_message_open_container(message, SD_BUS_TYPE_DICT_ENTRY, "sv"); })
        .then([&, &entryKey = key] { return appendText(message, entryKey); })
        .then([&, &entryObject = object] { return appendObject(message, entryObject, depth); })
        .then([&] { return sd_bus_message_close_container(message); });
  }
  return steps.then([&] { return sd_bus_message_close_container(message); }).result();
}

int readObject(sd_bus_message* message, ipc::Object& out, int depth);

template <class Kind>
int readBasic(sd_bus_message* message, char type, ipc::Object& out) {
  Kind value{};
  const int result = sd_bus_message_read_basic(message, type, &value);
  if (result >= 0) out = ipc::Object(value);
  return result;
}

int readBytes(sd_bus_message* message, ipc::Object& out) {
  const void* data = nullptr;
  std::size_t size = 0;
  const int result = sd_bus_message_read_array(message, 'y', &data, &size);
  if (result < 0) return result;
  const auto* bytes = static_cast<const std::uint8_t*>(data);
  out = ipc::Object(size == 0 ? Bytes() : Bytes(bytes, bytes + size));
  return result;
}

int readDictionary(sd_bus_message* message, ipc::Dictionary& out, int depth) {
  int result = sd_bus_message_enter_container(message, SD_BUS_TYPE_ARRAY, "{sv}");
  if (result < 0) return result;
  while ((result = sd_bus_message_enter_container(message, SD_BUS_TYPE_DICT_ENTRY, "sv")) > 0) {
    const char* key = nullptr;
    ipc::Object value;
    result = Steps()
                 .then([&] { return sd_bus_message_read_basic(message, SD_BUS_TYPE_STRING, &key); })
                 .then([&] { return readObject(message, value, depth); })
                 .then([&] { return sd_bus_message_exit_container(message); })
                 .result();
    if (result < 0) return result;
    out.set(key, std::move(value));
  }
  return result < 0 ? result : sd_bus_message_exit_container(message);
}

int readArray(sd_bus_message* message, ipc::Object& out, int depth) {
  ipc::Array array;
  int result = sd_bus_message_enter_container(message, SD_BUS_TYPE_ARRAY, "v");
  if (result < 0) return result;
  while ((result = sd_bus_message_at_end(message, 0)) == 0) {
    ipc::Object element;
    if (result = readObject(message, element, depth); result < 0) return result;
    array.push_back(std::move(element));
  }
  if (result < 0) return result;
  out = ipc::Object(std::move(array));
  return sd_bus_message_exit_container(message);
}

// Reads what a variant of signature `contents` holds.
int readContents(sd_bus_message* message, std::string_view contents, ipc::Object& out, int depth) {
  if (contents == "x") return readBasic<std::int64_t>(message, 'x', out);
  if (contents == "t") return readBasic<std::uint64_t>(message, 't', out);
  if (contents == "d") return readBasic<double>(message, 'd', out);
  if (contents == "ay") return readBytes(message, out);
  if (contents == "av") return readArray(message, out, depth);
  if (contents == "b") {
    int flag = 0;
    const int result = sd_bus_message_read_basic(message, 'b', &flag);
    out = ipc::Object(flag != 0);
    return result;
  }
  if (contents == "s") {
    const char* text = nullptr;
    const int result = sd_bus_message_read_basic(message, 's', &text);
    if (result >= 0) out = ipc::Object(std::string(text));
    return result;
  }
  if (contents == "a{sv}") {
    ipc::Dictionary dictionary;
    const int result = readDictionary(message, dictionary, depth);
    out = ipc::Object(std::move(dictionary));
    return result;
  }
  const char* signature = nullptr;
  if (contents != "g") return -EBADMSG;
  const int result = sd_bus_message_read_basic(message, 'g', &signature);
  return result >= 0 && *signature != '\0' ? -EBADMSG : result;
}

int readObject(sd_bus_message* message, ipc::Object& out, int depth) {
  if (depth >= depthLimit) return -EBADMSG;
  char type = 0;
  const char* contents = nullptr;
  const int result = sd_bus_message_peek_type(message, &type, &contents);
  if (result < 0 || type != SD_BUS_TYPE_VARIANT) return result < 0 ? result : -EBADMSG;
  return Steps()
      .then([&] { return sd_bus_message_enter_container(message, SD_BUS_TYPE_VARIANT, contents); })
      .then([&] { return readContents(message, contents, out, depth + 1); })
      .then([&] { return sd_bus_message_exit_container(message); })
      .result();
}

bool send(sd_bus* bus, const Message& message, int result) {
  return result >= 0 && sd_bus_send(bus, message.get(), nullptr) >= 0;
}

}  // namespace

void End::Closer::operator()(sd_bus* bus) const { sd_bus_close_unref(bus); }

End::~End() = default;

Result<End::Handle> End::start(int descriptor, bool asServer) {
  sd_bus* raw = nullptr;
  int result = sd_bus_new(&raw);
  Handle bus(raw);
  if (result >= 0) result = sd_bus_set_fd(raw, descriptor, descriptor);
  if (result < 0) ::close(descriptor);  // not taken over yet
  if (result >= 0 && asServer) {
    sd_id128_t identifier;
    result = sd_id128_randomize(&identifier);
    if (result >= 0) result = sd_bus_set_server(raw, 1, identifier);
  }
  if (result >= 0) result = sd_bus_start(raw);
  if (result < 0) return Failure{std::string("cannot speak D-Bus on the socket: ") + std::strerror(-result)};
  return bus;
}

Wait End::wait() const {
  Wait wait;
  const int descriptor = sd_bus_get_fd(bus_.get());
  const int events = sd_bus_get_events(bus_.get());
  if (descriptor < 0 || events < 0) {
    wait.timeout = std::chrono::microseconds(0);  // over: process() tells
    return wait;
  }
  wait.descriptor = descriptor;
  wait.events = static_cast<short>(events);
  std::uint64_t until = 0;  // CLOCK_MONOTONIC, µs
  if (sd_bus_get_timeout(bus_.get(), &until) > 0 && until != UINT64_MAX) {
    timespec now{};
    ::clock_gettime(CLOCK_MONOTONIC, &now);
    const std::uint64_t current =
        static_cast<std::uint64_t>(now.tv_sec) * 1'000'000 + static_cast<std::uint64_t>(now.tv_nsec) / 1000;
    wait.timeout = std::chrono::microseconds(until > current ? until - current : 0);
  }
  return wait;
}

bool End::process(int limit) {
  for (int count = 0; count < limit; ++count) {
    const int result = sd_bus_process(bus_.get(), nullptr);
    if (result < 0) return false;
    if (result == 0) return true;
  }
  return true;
}

std::size_t End::unsent() const {
  std::uint64_t count = 0;
  return sd_bus_get_n_queued_write(bus_.get(), &count) < 0 ? 0 : count;
}

struct ClientCallbacks {
  static int message(sd_bus_message* message, void* userdata, sd_bus_error* /*error*/) {
    auto* end = static_cast<ClientEnd*>(userdata);
    if (sd_bus_message_is_signal(message, interfaceName, "Event") <= 0) return 0;
    const char* kind = nullptr;
    std::uint64_t sequence = 0;
    ipc::Dictionary event;
    if (sd_bus_message_has_signature(message, "sta{sv}") <= 0 ||
        sd_bus_message_read(message, "st", &kind, &sequence) < 0 || readDictionary(message, event, 0) < 0) {
      ++end->malformedEvents_;
      return 1;
    }
    end->onEvent_(kind, sequence, std::move(event));
    return 1;
  }

  static int reply(sd_bus_message* message, void* userdata, sd_bus_error* /*error*/) {
    const auto& handler = *static_cast<ClientEnd::ReplyHandler*>(userdata);
    Reply reply;
    const char* text = nullptr;
    if (const sd_bus_error* error = sd_bus_message_get_error(message); error != nullptr) {
      reply = failure(*error, sd_bus_is_open(sd_bus_message_get_bus(message)) > 0);
    } else if (sd_bus_message_has_signature(message, "isa{sv}") <= 0 ||
               sd_bus_message_read(message, "is", &reply.status, &text) < 0 ||
               readDictionary(message, reply.values, 0) < 0) {
      reply = {rhox::kStatusBadReply, "the manager's reply has a form that is not known", {}};
    } else {
      reply.message = text;
    }
    handler(std::move(reply));
    return 1;
  }

  // The library says "no reply" for a late answer and for a connection that ended alike.
  static Reply failure(const sd_bus_error& error, bool open) {
    const bool missing = sd_bus_error_has_name(&error, SD_BUS_ERROR_NO_REPLY) > 0;
    if (!open) return {rhox::kStatusConnectionLost, "the connection to the manager ended", {}};
    if (missing) return {rhox::kStatusTimedOut, "the manager did not answer in time", {}};
    const std::string reason = error.message == nullptr ? error.name : error.message;
    return {rhox::kStatusRefused, "the manager refused the call: " + reason, {}};
  }
};

Result<std::unique_ptr<ClientEnd>> ClientEnd::overSocket(int descriptor, EventHandler onEvent) {
  Result<Handle> bus = start(descriptor, false);
  if (!bus) return Failure{bus.reason()};
  std::unique_ptr<ClientEnd> end(new ClientEnd(std::move(*bus), std::move(onEvent)));
  if (sd_bus_add_filter(end->bus_.get(), nullptr, &ClientCallbacks::message, end.get()) < 0) {
    return Failure{std::string("cannot listen for events")};
  }
  return end;
}

bool ClientEnd::performCommand(const std::string& command, const ipc::Dictionary& request,
                               std::chrono::microseconds timeout, ReplyHandler onReply) {
  sd_bus_message* raw = nullptr;
  int result = sd_bus_message_new_method_call(bus_.get(), &raw, nullptr, objectPath, interfaceName, "PerformCommand");
  const Message message(raw);
  if (result >= 0) result = appendText(raw, command);
  if (result >= 0) result = appendDictionary(raw, request, 0);
  if (result < 0) return false;
  auto handler = std::make_unique<ReplyHandler>(std::move(onReply));
  sd_bus_slot* slot = nullptr;
  if (sd_bus_call_async(bus_.get(), &slot, raw, &ClientCallbacks::reply, handler.get(),
                        static_cast<std::uint64_t>(timeout.count())) < 0) {
    return false;
  }
  static_cast<void>(handler.release());  // the slot's from here on
  sd_bus_slot_set_destroy_callback(slot, [](void* owned) { delete static_cast<ReplyHandler*>(owned); });
  sd_bus_slot_set_floating(slot, 1);
  sd_bus_slot_unref(slot);
  return true;
}

bool ClientEnd::setEvents(bool on) {
  sd_bus_message* raw = nullptr;
  int result = sd_bus_message_new_method_call(bus_.get(), &raw, nullptr, objectPath, interfaceName,
                                              on ? "EventsOn" : "EventsOff");
  const Message message(raw);
  if (result >= 0) result = sd_bus_message_set_expect_reply(raw, 0);
  return send(bus_.get(), message, result);
}

struct ServerCallbacks {
  static int performCommand(sd_bus_message* message, void* userdata, sd_bus_error* /*error*/) {
    auto* end = static_cast<ServerEnd*>(userdata);
    const char* command = nullptr;
    ipc::Dictionary request;
    int result = sd_bus_message_read(message, "s", &command);
    if (result >= 0) result = readDictionary(message, request, 0);
    if (result < 0) return result;
    const Reply reply = end->service_.performCommand(command, request);
    sd_bus_message* raw = nullptr;
    result = sd_bus_message_new_method_return(message, &raw);
    const Message answer(raw);
    if (result >= 0) result = sd_bus_message_append(raw, "i", reply.status);
    if (result >= 0) result = appendText(raw, reply.message);
    if (result >= 0) result = appendDictionary(raw, reply.values, 0);
    if (result < 0) return result;
    return sd_bus_send(end->bus_.get(), raw, nullptr);
  }

  static int eventsOn(sd_bus_message* message, void* userdata, sd_bus_error* /*error*/) {
    static_cast<ServerEnd*>(userdata)->service_.eventsOn();
    return sd_bus_reply_method_return(message, "");
  }

  static int eventsOff(sd_bus_message* message, void* userdata, sd_bus_error* /*error*/) {
    static_cast<ServerEnd*>(userdata)->service_.eventsOff();
    return sd_bus_reply_method_return(message, "");
  }

  static const sd_bus_vtable interface[];
};

// Access is the transport's matter: whoever holds the socket may call everything.
const sd_bus_vtable ServerCallbacks::interface[] = {
    SD_BUS_VTABLE_START(0),
    SD_BUS_METHOD_WITH_ARGS("PerformCommand", SD_BUS_ARGS("s", command, "a{sv}", request),
                            SD_BUS_RESULT("i", status, "s", message, "a{sv}", reply), &ServerCallbacks::performCommand,
                            SD_BUS_VTABLE_UNPRIVILEGED),
    SD_BUS_METHOD_WITH_ARGS("EventsOn", SD_BUS_NO_ARGS, SD_BUS_NO_RESULT, &ServerCallbacks::eventsOn,
                            SD_BUS_VTABLE_UNPRIVILEGED),
    SD_BUS_METHOD_WITH_ARGS("EventsOff", SD_BUS_NO_ARGS, SD_BUS_NO_RESULT, &ServerCallbacks::eventsOff,
                            SD_BUS_VTABLE_UNPRIVILEGED),
    SD_BUS_SIGNAL_WITH_ARGS("Event", SD_BUS_ARGS("s", kind, "t", sequence, "a{sv}", event), 0),
    SD_BUS_VTABLE_END,
};

Result<std::unique_ptr<ServerEnd>> ServerEnd::overSocket(int descriptor, Service& service) {
  Result<Handle> bus = start(descriptor, true);
  if (!bus) return Failure{bus.reason()};
  std::unique_ptr<ServerEnd> end(new ServerEnd(std::move(*bus), service));
  const int result = sd_bus_add_object_vtable(end->bus_.get(), nullptr, objectPath, interfaceName,
                                              ServerCallbacks::interface, end.get());
  if (result < 0) return Failure{std::string("cannot serve the interface: ") + std::strerror(-result)};
  return end;
}

bool ServerEnd::sendEvent(std::string_view kind, std::uint64_t sequence, const ipc::Dictionary& event) {
  sd_bus_message* raw = nullptr;
  int result = sd_bus_message_new_signal(bus_.get(), &raw, objectPath, interfaceName, "Event");
  const Message message(raw);
  if (result >= 0) result = appendText(raw, std::string(kind));
  if (result >= 0) result = sd_bus_message_append_basic(raw, 't', &sequence);
  if (result >= 0) result = appendDictionary(raw, event, 0);
  return send(bus_.get(), message, result);
}

}  // namespace vespscope::bus
