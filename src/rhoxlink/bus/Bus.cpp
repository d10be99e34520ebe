#include "rhoxlink/bus/Bus.h"

#include <fcntl.h>
#include <poll.h>
#include <sys/socket.h>
#include <systemd/sd-bus.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <utility>

#include <time.h>

#include "rhoxlink/bus/MessageCodec.h"

namespace vespscope::bus {
namespace {

// The bytes in a manager's socket that were sent and not read (the system allocates twice as much for its bookkeeping).
// sd-bus's default is 8 MB.
constexpr int sendBuffer = 128 * 1024;
constexpr std::size_t unsentMessageLimit = 64;       // unsent messages beyond the socket's buffer, for events
constexpr std::size_t unsentByteLimit = 128 * 1024;  // same, in bytes
constexpr std::size_t longestReplyMessage = 4096;    // bytes; longer messages are truncated
constexpr const char* daemonName = "org.freedesktop.DBus";

void boundSendBuffer(int descriptor) {
  // A pipe has its own limit.
  static_cast<void>(::setsockopt(descriptor, SOL_SOCKET, SO_SNDBUF, &sendBuffer, sizeof sendBuffer));
}

bool sendMessage(sd_bus* bus, const Message& message, int result) {
  return result >= 0 && sd_bus_send(bus, message.get(), nullptr) >= 0;
}

}  // namespace

void End::Closer::operator()(sd_bus* bus) const { sd_bus_close_unref(bus); }

End::End(Handle bus) : bus_(std::move(bus)) {}

End::End(Started started)
    : bus_(std::move(started.bus)), guard_(std::move(started.guard)), input_(started.input), output_(started.output) {}

End::~End() = default;

Result<End::Started> End::start(int input, int output, bool asServer, const WireLimits& limits,
                                std::shared_ptr<MemoryBudget> budget) {
  const auto refusal = [](const std::string& reason) { return Failure{"cannot use D-Bus on the socket: " + reason}; };
  const bool single = input == output;
  // The library closes the descriptor that it writes to, the guard the one that it reads.
  if (single) input = ::fcntl(output, F_DUPFD_CLOEXEC, 0);
  auto guard = GuardedInput::open(input, limits, std::move(budget));
  if (!guard) {
    ::close(output);
    return refusal(guard.reason());
  }
  sd_bus* raw = nullptr;
  int result = sd_bus_new(&raw);
  Handle bus(raw);
  const int checked = (*guard)->takeOutput();
  if (result >= 0) result = sd_bus_set_fd(raw, checked, output);
  if (result < 0) {  // not owned by the library yet
    ::close(checked);
    ::close(output);
  }
  if (result >= 0) result = sd_bus_negotiate_fds(raw, 0);
  if (result >= 0 && asServer) {
    sd_id128_t identifier;
    result = sd_id128_randomize(&identifier);
    if (result >= 0) result = sd_bus_set_server(raw, 1, identifier);
    // Access has been decided before, and the guard's pipe has no credentials.
    if (result >= 0) result = sd_bus_set_anonymous(raw, 1);
  }
  if (result >= 0) result = sd_bus_start(raw);
  if (result < 0) return refusal(std::strerror(-result));
  if (asServer) boundSendBuffer(output);
  // If both are the same socket it is polled once.
  return Started{std::move(bus), std::move(*guard), single ? output : input, output};
}

Result<End::Handle> End::startOnSystemBus(bool asServer) {
  sd_bus* raw = nullptr;
  const int result = sd_bus_open_system(&raw);
  Handle bus(raw);
  if (result < 0) return Failure{std::string("the system bus cannot be reached: ") + std::strerror(-result)};
  if (asServer) boundSendBuffer(sd_bus_get_fd(raw));
  return bus;
}

void End::end(std::string why) {
  over_ = true;
  if (ending_.empty()) ending_ = std::move(why);
}

Wait End::wait() const {
  Wait wait;
  const int descriptor = guard_ ? input_ : sd_bus_get_fd(bus_.get());
  const int events = over_ ? -1 : sd_bus_get_events(bus_.get());
  if (over_ || more_ || descriptor < 0 || events < 0) {
    wait.timeout = std::chrono::microseconds(0);  // process() has work, or the connection has ended
    return wait;
  }
  wait.descriptor = descriptor;
  wait.events = static_cast<short>(events);
  if (guard_) {
    const auto reading = static_cast<short>(guard_->wantsInput() ? POLLIN : 0);
    const auto writing = static_cast<short>(events & POLLOUT);
    wait.events = static_cast<short>(input_ == output_ ? reading | writing : reading);
    if (input_ != output_) wait.outputDescriptor = output_;
    wait.outputEvents = input_ == output_ ? short{0} : writing;
    wait.timeout = guard_->timeout();
  }
  std::uint64_t until = 0;  // CLOCK_MONOTONIC, µs
  if (sd_bus_get_timeout(bus_.get(), &until) > 0 && until != UINT64_MAX) {
    timespec now{};
    ::clock_gettime(CLOCK_MONOTONIC, &now);
    const std::uint64_t current =
        static_cast<std::uint64_t>(now.tv_sec) * 1'000'000 + static_cast<std::uint64_t>(now.tv_nsec) / 1000;
    const auto left = std::chrono::microseconds(until > current ? until - current : 0);
    wait.timeout = wait.timeout.count() < 0 ? left : std::min(wait.timeout, left);
  }
  return wait;
}

bool End::process(int limit) {
  const auto pump = [this] {
    const Result<bool> moved = guard_->pump(sd_bus_is_ready(bus_.get()) > 0);
    if (!moved) end(moved.reason());
    return moved && *moved;
  };
  int count = 0;
  // First read the messages that the limit left, then pass on more.
  if (guard_ && !more_ && !over_) pump();
  while (count < limit && !over_) {
    const int result = sd_bus_process(bus_.get(), nullptr);
    if (result < 0) return false;
    if (result == 0 && (!guard_ || !pump())) break;
    if (result > 0) ++count;
  }
  more_ = count == limit;
  return !over_;
}

std::size_t End::unsent() const {
  std::uint64_t count = 0;
  return sd_bus_get_n_queued_write(bus_.get(), &count) < 0 ? 0 : count;
}

struct ClientCallbacks {
  struct ReplySlot {
    ClientEnd* end;
    ClientEnd::ReplyHandler handler;
  };

  static int message(sd_bus_message* message, void* userdata, sd_bus_error* /*error*/) {
    auto* end = static_cast<ClientEnd*>(userdata);
    if (sd_bus_message_is_signal(message, interfaceName, "Event") <= 0) return 0;
    if (end->destination_ != nullptr && end->owner_ != sd_bus_message_get_sender(message)) return 1;
    const char* kind = nullptr;
    std::uint64_t sequence = 0;
    ipc::Dictionary event;
    if (sd_bus_message_has_signature(message, "sta{sv}") <= 0 ||
        sd_bus_message_read(message, "st", &kind, &sequence) < 0 || readDictionary(message, event) < 0) {
      ++end->malformedEvents_;
      return 1;
    }
    end->onEvent_(kind, sequence, std::move(event));
    return 1;
  }

  static int reply(sd_bus_message* message, void* userdata, sd_bus_error* /*error*/) {
    const auto& [end, handler] = *static_cast<ReplySlot*>(userdata);
    Reply reply;
    const char* text = nullptr;
    // Only the manager can answer a call to its name: the first sender is its owner.
    if (const char* sender = sd_bus_message_get_sender(message);
        end->destination_ != nullptr && end->owner_.empty() && sender != nullptr && sender[0] == ':') {
      end->owner_ = sender;
    }
    if (const sd_bus_error* error = sd_bus_message_get_error(message); error != nullptr) {
      reply = failure(*error, sd_bus_is_open(sd_bus_message_get_bus(message)) > 0);
      end->absent_ = reply.status == rhox::kStatusNoManager;
    } else if (sd_bus_message_has_signature(message, "isa{sv}") <= 0 ||
               sd_bus_message_read(message, "is", &reply.status, &text) < 0 ||
               readDictionary(message, reply.values) < 0) {
      reply = {rhox::kStatusBadReply, "the manager's reply has an unknown form", {}};
    } else {
      reply.message = text;
    }
    handler(std::move(reply));
    return 1;
  }

  static int ownerChanged(sd_bus_message* message, void* userdata, sd_bus_error* /*error*/) {
    auto* end = static_cast<ClientEnd*>(userdata);
    const char* name = nullptr;
    const char* before = nullptr;
    const char* after = nullptr;
    if (sd_bus_message_read(message, "sss", &name, &before, &after) < 0) return 0;
    if (!end->owner_.empty() && end->owner_ == before) end->end("the manager left the system bus");
    if (end->absent_ && *after != '\0') end->end("a manager came to the system bus");
    return 0;
  }

  // The library reports "no reply" both for a late answer and for a connection that ended.
  static Reply failure(const sd_bus_error& error, bool open) {
    const bool missing = sd_bus_error_has_name(&error, SD_BUS_ERROR_NO_REPLY) > 0;
    if (!open) return {rhox::kStatusConnectionLost, "the connection to the manager ended", {}};
    if (missing) return {rhox::kStatusTimedOut, "the manager did not answer in time", {}};
    const std::string reason = error.message == nullptr ? error.name : error.message;
    if (sd_bus_error_has_name(&error, SD_BUS_ERROR_ACCESS_DENIED) > 0) {
      return {rhox::kStatusAccessDenied,
              "the system bus denies this user access to the manager (is the user in its group?): " + reason,
              {}};
    }
    if (absent(error)) return {rhox::kStatusNoManager, "no manager on the system bus: " + reason, {}};
    return {rhox::kStatusRefused, "the manager refused the call: " + reason, {}};
  }

  // The errors by which a bus reports that no process has the name, or that the service cannot be started.
  static bool absent(const sd_bus_error& error) {
    const std::string_view name = error.name;
    return name == SD_BUS_ERROR_SERVICE_UNKNOWN || name == SD_BUS_ERROR_NAME_HAS_NO_OWNER ||
           name == SD_BUS_ERROR_TIMEOUT || name == "org.freedesktop.DBus.Error.TimedOut" ||
           name.starts_with("org.freedesktop.DBus.Error.Spawn.") || name.starts_with("org.freedesktop.systemd1.");
  }
};

Result<std::unique_ptr<ClientEnd>> ClientEnd::overSocket(int descriptor, EventHandler onEvent) {
  Result<Started> bus = start(descriptor, descriptor, false, WireLimits::ofClient(), nullptr);
  if (!bus) return Failure{bus.reason()};
  std::unique_ptr<ClientEnd> end(new ClientEnd(std::move(*bus), std::move(onEvent)));
  if (sd_bus_add_filter(end->bus_.get(), nullptr, &ClientCallbacks::message, end.get()) < 0) {
    return Failure{std::string("cannot listen for events")};
  }
  return end;
}

Result<std::unique_ptr<ClientEnd>> ClientEnd::onSystemBus(EventHandler onEvent) {
  Result<Handle> bus = startOnSystemBus(false);
  if (!bus) return Failure{bus.reason()};
  std::unique_ptr<ClientEnd> end(new ClientEnd(std::move(*bus), std::move(onEvent)));
  end->destination_ = serviceName;
  const std::string rule =
      std::string("type='signal',sender='") + daemonName + "',member='NameOwnerChanged',arg0='" + serviceName + "'";
  // Subscribed before the first call, so that no change of the name's owner is missed.
  if (sd_bus_add_filter(end->bus_.get(), nullptr, &ClientCallbacks::message, end.get()) < 0 ||
      sd_bus_add_match_async(end->bus_.get(), nullptr, rule.c_str(), &ClientCallbacks::ownerChanged, nullptr,
                             end.get()) < 0) {
    return Failure{std::string("cannot listen for events on the system bus")};
  }
  return end;
}

bool ClientEnd::performCommand(const std::string& command, const ipc::Dictionary& request,
                               std::chrono::microseconds timeout, ReplyHandler onReply) {
  sd_bus_message* raw = nullptr;
  int result =
      sd_bus_message_new_method_call(bus_.get(), &raw, destination_, objectPath, interfaceName, "PerformCommand");
  const Message message(raw);
  if (result >= 0) result = appendText(raw, command);
  if (result >= 0) result = appendDictionary(raw, request);
  if (result < 0) return false;
  auto handler = std::make_unique<ClientCallbacks::ReplySlot>(this, std::move(onReply));
  sd_bus_slot* slot = nullptr;
  if (sd_bus_call_async(bus_.get(), &slot, raw, &ClientCallbacks::reply, handler.get(),
                        static_cast<std::uint64_t>(timeout.count())) < 0) {
    return false;
  }
  static_cast<void>(handler.release());  // owned by the slot from here on
  sd_bus_slot_set_destroy_callback(slot, [](void* owned) { delete static_cast<ClientCallbacks::ReplySlot*>(owned); });
  sd_bus_slot_set_floating(slot, 1);
  sd_bus_slot_unref(slot);
  return true;
}

bool ClientEnd::setEvents(bool on) {
  sd_bus_message* raw = nullptr;
  int result = sd_bus_message_new_method_call(bus_.get(), &raw, destination_, objectPath, interfaceName,
                                              on ? "EventsOn" : "EventsOff");
  const Message message(raw);
  if (result >= 0) result = sd_bus_message_set_expect_reply(raw, 0);
  return sendMessage(bus_.get(), message, result);
}

struct ServerCallbacks {
  static int performCommand(sd_bus_message* message, void* userdata, sd_bus_error* error) {
    const char* command = nullptr;
    ipc::Dictionary request;
    int result = sd_bus_message_read(message, "s", &command);
    if (result >= 0) result = readDictionary(message, request);
    if (result < 0) return result;
    const Result<Service*> service = static_cast<ServingEnd*>(userdata)->serviceFor(message);
    if (!service) return sd_bus_error_set(error, SD_BUS_ERROR_ACCESS_DENIED, service.reason().c_str());
    const std::shared_ptr<sd_bus_message> call(sd_bus_message_ref(message), MessageUnref());
    (*service)->performCommand(command, request, [call](const Reply& reply) { answer(call.get(), reply); });
    return 1;
  }

  static void answer(sd_bus_message* call, const Reply& reply) {
    sd_bus_message* raw = nullptr;
    int result = sd_bus_message_new_method_return(call, &raw);
    const Message message(raw);
    if (result >= 0) result = sd_bus_message_append(raw, "i", reply.status);
    if (result >= 0) result = appendText(raw, reply.message.substr(0, longestReplyMessage));
    if (result >= 0) result = appendDictionary(raw, reply.values);
    if (result >= 0) result = sd_bus_send(sd_bus_message_get_bus(call), raw, nullptr);
    // A caller that has disconnected needs no answer.
    if (result < 0) sd_bus_reply_method_errno(call, result, nullptr);
  }

  template <void (Service::*Operation)()>
  static int turn(sd_bus_message* message, void* userdata, sd_bus_error* error) {
    const Result<Service*> service = static_cast<ServingEnd*>(userdata)->serviceFor(message);
    if (!service) return sd_bus_error_set(error, SD_BUS_ERROR_ACCESS_DENIED, service.reason().c_str());
    ((*service)->*Operation)();
    return sd_bus_reply_method_return(message, "");
  }

  static const sd_bus_vtable interface[];
};

// Access is decided earlier: every client that holds the socket, or that the bus and serviceFor() admit, may call every
// method.
const sd_bus_vtable ServerCallbacks::interface[] = {
    SD_BUS_VTABLE_START(0),
    SD_BUS_METHOD_WITH_ARGS("PerformCommand", SD_BUS_ARGS("s", command, "a{sv}", request),
                            SD_BUS_RESULT("i", status, "s", message, "a{sv}", reply), &ServerCallbacks::performCommand,
                            SD_BUS_VTABLE_UNPRIVILEGED),
    SD_BUS_METHOD_WITH_ARGS("EventsOn", SD_BUS_NO_ARGS, SD_BUS_NO_RESULT, &ServerCallbacks::turn<&Service::eventsOn>,
                            SD_BUS_VTABLE_UNPRIVILEGED),
    SD_BUS_METHOD_WITH_ARGS("EventsOff", SD_BUS_NO_ARGS, SD_BUS_NO_RESULT, &ServerCallbacks::turn<&Service::eventsOff>,
                            SD_BUS_VTABLE_UNPRIVILEGED),
    SD_BUS_SIGNAL_WITH_ARGS("Event", SD_BUS_ARGS("s", kind, "t", sequence, "a{sv}", event), 0),
    SD_BUS_VTABLE_END,
};

Result<bool> ServingEnd::serve() {
  const int result =
      sd_bus_add_object_vtable(bus_.get(), nullptr, objectPath, interfaceName, ServerCallbacks::interface, this);
  if (result < 0) return Failure{std::string("cannot serve the interface: ") + std::strerror(-result)};
  return true;
}

bool ServingEnd::hasRoom() const {
  const std::size_t waiting = unsent();
  return waiting == 0 || (waiting < unsentMessageLimit && unsentBytes_ < unsentByteLimit);
}

bool ServingEnd::send(const char* destination, std::string_view kind, std::uint64_t sequence,
                      const ipc::Dictionary& event) {
  sd_bus_message* raw = nullptr;
  int result = sd_bus_message_new_signal(bus_.get(), &raw, objectPath, interfaceName, "Event");
  const Message message(raw);
  if (result >= 0 && destination != nullptr) result = sd_bus_message_set_destination(raw, destination);
  if (result >= 0) result = appendText(raw, std::string(kind));
  if (result >= 0) result = sd_bus_message_append_basic(raw, 't', &sequence);
  if (result >= 0) result = appendDictionary(raw, event);
  if (!sendMessage(bus_.get(), message, result)) return false;
  unsentBytes_ = unsent() == 0 ? 0 : unsentBytes_ + ipc::contentSize(event);
  return true;
}

Result<std::unique_ptr<ServerEnd>> ServerEnd::overSocket(int descriptor, Service& service,
                                                         std::shared_ptr<MemoryBudget> budget,
                                                         const WireLimits& limits) {
  return overPipes(descriptor, descriptor, service, std::move(budget), limits);
}

Result<std::unique_ptr<ServerEnd>> ServerEnd::overPipes(int input, int output, Service& service,
                                                        std::shared_ptr<MemoryBudget> budget,
                                                        const WireLimits& limits) {
  Result<Started> bus = start(input, output, true, limits, std::move(budget));
  if (!bus) return Failure{bus.reason()};
  std::unique_ptr<ServerEnd> end(new ServerEnd(std::move(*bus), service));
  if (const Result<bool> served = end->serve(); !served) return Failure{served.reason()};
  return end;
}

}  // namespace vespscope::bus
