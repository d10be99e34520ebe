#include "support/FakeManager.h"

#include <poll.h>
#include <sys/eventfd.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <systemd/sd-bus.h>
#include <unistd.h>

#include <array>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <future>
#include <utility>

namespace vespscope::test {
namespace {

constexpr const char* interfaceName = "org.vespscope.BasebandManager1";
constexpr const char* objectPath = "/org/vespscope/BasebandManager1";
constexpr auto patience = std::chrono::seconds(5);

// A test cannot continue without its fake.
int need(int result, const char* what) {
  if (result < 0) {
    std::fprintf(stderr, "fake manager: %s: %s\n", what, std::strerror(result == -1 ? errno : -result));
    std::abort();
  }
  return result;
}

ipc::Dictionary readRequest(sd_bus_message* message) {
  ipc::Dictionary request;
  need(sd_bus_message_enter_container(message, 'a', "{sv}"), "request");
  while (sd_bus_message_enter_container(message, 'e', "sv") > 0) {
    const char* key = nullptr;
    const char* type = nullptr;
    need(sd_bus_message_read(message, "s", &key), "key");
    need(sd_bus_message_peek_type(message, nullptr, &type), "type");
    const std::string kind = type;
    need(sd_bus_message_enter_container(message, 'v', kind.c_str()), "entry");
    if (kind == "x") {
      std::int64_t number = 0;
      need(sd_bus_message_read(message, "x", &number), "number");
      request.set(key, ipc::Object(number));
    } else if (kind == "s") {
      const char* text = nullptr;
      need(sd_bus_message_read(message, "s", &text), "text");
      request.set(key, ipc::Object(std::string(text)));
    } else if (kind == "ay") {
      const void* data = nullptr;
      std::size_t size = 0;
      need(sd_bus_message_read_array(message, 'y', &data, &size), "data");
      const auto* bytes = static_cast<const std::uint8_t*>(data);
      request.set(key, ipc::Object(Bytes(bytes, bytes + size)));
    } else {
      need(sd_bus_message_skip(message, kind.c_str()), "other entry");
      request.set(key, ipc::Object());
    }
    need(sd_bus_message_exit_container(message), "entry's end");
    need(sd_bus_message_exit_container(message), "pair's end");
  }
  need(sd_bus_message_exit_container(message), "request's end");
  return request;
}

}  // namespace

FakeManager::FakeManager(std::string path) : path_(std::move(path)) {
  sockaddr_un name{};
  name.sun_family = AF_UNIX;
  std::strncpy(name.sun_path, path_.c_str(), sizeof name.sun_path - 1);
  ::unlink(path_.c_str());
  listening_ = need(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0), "socket");
  need(::bind(listening_, reinterpret_cast<const sockaddr*>(&name), sizeof name), "bind");
  need(::listen(listening_, 4), "listen");
  wake_ = need(::eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK), "eventfd");
  thread_ = std::thread([this] { run(); });
}

FakeManager::~FakeManager() {
  {
    const std::lock_guard lock(mutex_);
    stopping_ = true;
  }
  post([] {});
  thread_.join();
  closeConnection();
  ::close(listening_);
  ::close(wake_);
  ::unlink(path_.c_str());
}

void FakeManager::answer(std::string_view command, Answer answer) {
  const std::lock_guard lock(mutex_);
  answers_.insert_or_assign(std::string(command), std::move(answer));
}

void FakeManager::setSource(std::string label, std::string kind) {
  const std::lock_guard lock(mutex_);
  sourceLabel_ = std::move(label);
  sourceKind_ = std::move(kind);
}

void FakeManager::setConfigured(bool configured) {
  const std::lock_guard lock(mutex_);
  configured_ = configured;
}

void FakeManager::setPlayback(std::int64_t position, bool ended) {
  const std::lock_guard lock(mutex_);
  playback_.emplace(position, ended);
}

std::vector<FakeManager::Call> FakeManager::calls() const {
  const std::lock_guard lock(mutex_);
  return calls_;
}

std::vector<std::string> FakeManager::callNames() const {
  std::vector<std::string> names;
  for (const Call& call : calls()) names.push_back(call.command.empty() ? call.method : call.command);
  return names;
}

bool FakeManager::waitForCalls(std::size_t count) const {
  std::unique_lock lock(mutex_);
  return changed_.wait_for(lock, patience, [this, count] { return calls_.size() >= count; });
}

bool FakeManager::waitForConnections(std::size_t count) const {
  std::unique_lock lock(mutex_);
  return changed_.wait_for(lock, patience, [this, count] { return greetings_.size() >= count; });
}

std::vector<ipc::Dictionary> FakeManager::greetings() const {
  const std::lock_guard lock(mutex_);
  return greetings_;
}

bool FakeManager::eventsOn() const {
  const std::lock_guard lock(mutex_);
  return eventsOn_;
}

void FakeManager::post(std::function<void()> action) {
  {
    const std::lock_guard lock(mutex_);
    actions_.push_back(std::move(action));
  }
  const std::uint64_t one = 1;
  need(static_cast<int>(::write(wake_, &one, sizeof one)), "wake");
}

void FakeManager::run() {
  while (true) {
    std::deque<std::function<void()>> actions;
    {
      const std::lock_guard lock(mutex_);
      if (stopping_) return;
      // Actions that a test requests before the client has connected are kept.
      if (bus_ != nullptr) actions.swap(actions_);
    }
    for (const auto& action : actions) action();
    if (closing_) closeConnection();
    while (bus_ != nullptr) {
      sd_bus_message* message = nullptr;
      const int result = sd_bus_process(bus_, &message);
      if (message != nullptr) handle(message);
      sd_bus_message_unref(message);
      if (result < 0 || closing_) closeConnection();
      if (result == 0) break;
    }
    if (bus_ == nullptr) {
      const int connection = ::accept4(listening_, nullptr, nullptr, SOCK_CLOEXEC | SOCK_NONBLOCK);
      if (connection >= 0) {
        serve(connection);
        continue;
      }
    }
    std::array<pollfd, 2> ready{};
    ready[0] = {wake_, POLLIN, 0};
    ready[1] = {bus_ == nullptr ? listening_ : sd_bus_get_fd(bus_),
                static_cast<short>(bus_ == nullptr ? POLLIN : sd_bus_get_events(bus_)), 0};
    ::poll(ready.data(), ready.size(), 1000);
    std::uint64_t wakes = 0;
    [[maybe_unused]] const ssize_t ignored = ::read(wake_, &wakes, sizeof wakes);
  }
}

void FakeManager::serve(int descriptor) {
  socket_ = need(::dup(descriptor), "dup");
  sd_id128_t identifier;
  need(sd_id128_randomize(&identifier), "identifier");
  need(sd_bus_new(&bus_), "bus");
  need(sd_bus_set_fd(bus_, descriptor, descriptor), "socket");
  need(sd_bus_set_server(bus_, 1, identifier), "server");
  need(sd_bus_start(bus_), "start");
  sequence_ = 0;
  closing_ = false;
}

void FakeManager::closeConnection() {
  if (bus_ == nullptr) return;
  sd_bus_close_unref(bus_);
  bus_ = nullptr;
  ::close(socket_);
  socket_ = -1;
  closing_ = false;
  const std::lock_guard lock(mutex_);
  eventsOn_ = false;
}

void FakeManager::handle(sd_bus_message* message) {
  const bool on = sd_bus_message_is_method_call(message, interfaceName, "EventsOn") > 0;
  const bool off = sd_bus_message_is_method_call(message, interfaceName, "EventsOff") > 0;
  if (sd_bus_message_is_method_call(message, interfaceName, "PerformCommand") > 0) return handleCommand(message);
  if (!on && !off) return;
  need(sd_bus_reply_method_return(message, ""), "reply");
  {
    const std::lock_guard lock(mutex_);
    calls_.push_back({on ? "EventsOn" : "EventsOff", "", {}});
    eventsOn_ = on;
  }
  changed_.notify_all();
}

void FakeManager::handleCommand(sd_bus_message* message) {
  const char* command = nullptr;
  need(sd_bus_message_read(message, "s", &command), "command");
  Call call{"PerformCommand", command, readRequest(message)};
  Answer answer;
  const bool status = call.command == "Status";
  {
    const std::lock_guard lock(mutex_);
    if (const auto found = answers_.find(call.command); found != answers_.end()) answer = found->second;
    if (status) {
      greetings_.push_back(std::move(call.request));
    } else {
      calls_.push_back(std::move(call));
    }
  }
  switch (answer.manner) {
    case Answer::Manner::reply: {
      sd_bus_message* reply = nullptr;
      need(sd_bus_message_new_method_return(message, &reply), "reply");
      need(sd_bus_message_append(reply, "is", answer.status, answer.message.c_str()), "reply");
      if (status) {
        appendStatus(reply);
      } else {
        need(sd_bus_message_append(reply, "a{sv}", 0), "reply");
      }
      sd_bus_send(bus_, reply, nullptr);
      sd_bus_message_unref(reply);
      break;
    }
    case Answer::Manner::wrongForm:
      sd_bus_reply_method_return(message, "s", "what?");
      break;
    case Answer::Manner::error:
      sd_bus_reply_method_errorf(message, SD_BUS_ERROR_FAILED, "%s", answer.message.c_str());
      break;
    case Answer::Manner::silence:
      break;
    case Answer::Manner::disconnect:
      closing_ = true;
      break;
    case Answer::Manner::garbage: {
      const std::string noise(64, '\xA5');
      [[maybe_unused]] const ssize_t ignored = ::send(socket_, noise.data(), noise.size(), MSG_NOSIGNAL);
      break;
    }
  }
  changed_.notify_all();
}

void FakeManager::appendStatus(sd_bus_message* reply) {
  const std::lock_guard lock(mutex_);
  need(sd_bus_message_open_container(reply, 'a', "{sv}"), "status");
  need(sd_bus_message_append(reply, "{sv}", "kKeySourceLabel", "s", sourceLabel_.c_str()), "status");
  need(sd_bus_message_append(reply, "{sv}", "kKeySourceKind", "s", sourceKind_.c_str()), "status");
  if (configured_) need(sd_bus_message_append(reply, "{sv}", "kKeyConfigured", "b", *configured_ ? 1 : 0), "status");
  if (playback_) {
    constexpr std::int64_t length = 10'000'000'000;            // ns
    constexpr std::int64_t begin = 1'700'000'000'000'000'000;  // ns since 1970
    need(sd_bus_message_append(reply, "{sv}", "kKeyProtocol", "x", std::int64_t{2}), "status");
    need(sd_bus_message_append(reply, "{sv}", "kKeyPlayback", "a{sv}", 5, "kKeyPosition", "x", playback_->first,
                               "kKeyLength", "x", length, "kKeyClock", "x", begin + playback_->first, "kKeySpeed", "d",
                               2.0, "kKeyEnded", "b", playback_->second ? 1 : 0),
         "status");
  }
  need(sd_bus_message_close_container(reply), "status");
}

void FakeManager::sendEvent(const std::string& kind, std::uint64_t skipped,
                            const std::function<void(sd_bus_message*)>& fill) {
  sequence_ += 1 + skipped;
  sd_bus_message* event = nullptr;
  need(sd_bus_message_new_signal(bus_, &event, objectPath, interfaceName, "Event"), "event");
  need(sd_bus_message_append(event, "st", kind.c_str(), sequence_), "event");
  need(sd_bus_message_open_container(event, 'a', "{sv}"), "event");
  fill(event);
  need(sd_bus_message_close_container(event), "event");
  sd_bus_send(bus_, event, nullptr);
  sd_bus_message_unref(event);
}

void FakeManager::sendMetric(std::int64_t metricID, const Bytes& payload, std::int64_t profileID,
                             std::uint64_t skipped) {
  sendMetric(metricID, payload, profileID, skipped, std::nullopt);
}

void FakeManager::sendMetricAt(std::int64_t time, std::int64_t metricID, const Bytes& payload) {
  sendMetric(metricID, payload, 0, 0, time);
}

void FakeManager::sendMetric(std::int64_t metricID, const Bytes& payload, std::int64_t profileID, std::uint64_t skipped,
                             std::optional<std::int64_t> time) {
  post([this, metricID, payload, profileID, skipped, time] {
    sendEvent("Metric", skipped, [&](sd_bus_message* event) {
      need(sd_bus_message_append(event, "{sv}", "kKeyMetricID", "x", metricID), "metric");
      need(sd_bus_message_open_container(event, 'e', "sv"), "payload");
      need(sd_bus_message_append(event, "s", "kKeyPayload"), "payload");
      need(sd_bus_message_open_container(event, 'v', "ay"), "payload");
      need(sd_bus_message_append_array(event, 'y', payload.data(), payload.size()), "payload");
      need(sd_bus_message_close_container(event), "payload");
      need(sd_bus_message_close_container(event), "payload");
      need(sd_bus_message_append(event, "{sv}", "kKeyProfileID", "x", profileID), "profile");
      if (time) need(sd_bus_message_append(event, "{sv}", "kKeyTime", "x", *time), "time");
    });
  });
}

void FakeManager::finishSending() {
  std::promise<void> done;
  post([&done] { done.set_value(); });
  done.get_future().wait();
}

void FakeManager::sendMetricWithoutIdentifier() {
  post([this] {
    sendEvent("Metric", 0, [](sd_bus_message* event) {
      need(sd_bus_message_append(event, "{sv}", "kKeyProfileID", "x", std::int64_t{0}), "profile");
    });
  });
}

void FakeManager::sendMetricWithTextIdentifier(const std::string& metricID) {
  post([this, metricID] {
    sendEvent("Metric", 0, [&](sd_bus_message* event) {
      need(sd_bus_message_append(event, "{sv}", "kKeyMetricID", "s", metricID.c_str()), "metric");
    });
  });
}

void FakeManager::sendTrigger(const std::string& text) {
  post([this, text] {
    sendEvent("Trigger", 0, [&](sd_bus_message* event) {
      need(sd_bus_message_append(event, "{sv}", "text", "s", text.c_str()), "trigger");
    });
  });
}

void FakeManager::sendMalformedEvent() {
  post([this] { sd_bus_emit_signal(bus_, objectPath, interfaceName, "Event", "us", 1U, "not an event"); });
}

void FakeManager::sendGarbage() {
  post([this] {
    const std::string noise(64, '\xA5');
    [[maybe_unused]] const ssize_t ignored = ::send(socket_, noise.data(), noise.size(), MSG_NOSIGNAL);
  });
}

void FakeManager::disconnect() {
  post([this] { closing_ = true; });
}

}  // namespace vespscope::test
