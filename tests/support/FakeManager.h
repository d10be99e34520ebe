// A baseband manager under a test's control: it speaks the real protocol over a socket, records what it is asked and
// answers as scripted. It shares no code with the real manager's end, so that each checks the other.
#pragma once

#include <condition_variable>
#include <cstdint>
#include <deque>
#include <functional>
#include <map>
#include <mutex>
#include <optional>
#include <string>
#include <string_view>
#include <thread>
#include <utility>
#include <vector>

#include "platform/ipc/IpcObject.h"

struct sd_bus;
struct sd_bus_message;

namespace vespscope::test {

class FakeManager {
 public:
  // One call from the client: "PerformCommand", "EventsOn" or "EventsOff".
  struct Call {
    std::string method;
    std::string command;      // of PerformCommand
    ipc::Dictionary request;  // of PerformCommand; integers, data and texts
  };

  struct Answer {
    enum class Manner {
      reply,       // status and message
      wrongForm,   // a reply of another signature
      error,       // a D-Bus error
      silence,     // none at all
      disconnect,  // the connection is closed
      garbage,     // bytes that are no D-Bus message
    };
    Manner manner = Manner::reply;
    std::int32_t status = 0;
    std::string message;
  };

  // Listens at `path`, on a thread of its own.
  explicit FakeManager(std::string path);
  FakeManager(const FakeManager&) = delete;
  FakeManager& operator=(const FakeManager&) = delete;
  ~FakeManager();

  // The words of its address: "unix:path=…".
  [[nodiscard]] std::string address() const { return "unix:path=" + path_; }

  // Answers the command from here on so; each other command is answered with status 0 and no message.
  void answer(std::string_view command, Answer answer);
  // What the client's question for the status is answered; it is no part of calls().
  void setSource(std::string label, std::string kind);
  // From here on the answer reports the client's application as configured, or not; until then it says nothing of it.
  void setConfigured(bool configured);
  // From here on the answer reports protocol version 2 and a playback at this position (nanoseconds) of ten seconds.
  void setPlayback(std::int64_t position, bool ended);

  // Sends an event to the client, with the next sequence number plus `skipped`; needs a connected client.
  void sendMetric(std::int64_t metricID, const Bytes& payload, std::int64_t profileID = 0, std::uint64_t skipped = 0);
  // The same with the time at which the source reported it (nanoseconds since 1970), for profile 0.
  void sendMetricAt(std::int64_t time, std::int64_t metricID, const Bytes& payload);
  // Sends a metric event without an identifier, and one whose identifier is a text.
  void sendMetricWithoutIdentifier();
  void sendMetricWithTextIdentifier(const std::string& metricID);
  void sendTrigger(const std::string& text);
  // Sends an Event signal of another signature.
  void sendMalformedEvent();
  // Writes bytes past the protocol into the connection.
  void sendGarbage();
  // Returns when all that was to be sent so far is on its way; needs a connected client.
  void finishSending();
  // Closes the connection; the client may come again.
  void disconnect();

  [[nodiscard]] std::vector<Call> calls() const;
  // The calls as words: the command's name, or "EventsOn", "EventsOff".
  [[nodiscard]] std::vector<std::string> callNames() const;
  // True when `count` calls have come, waiting a few seconds for them.
  [[nodiscard]] bool waitForCalls(std::size_t count) const;
  // True when a client has asked for the status `count` times, waiting a few seconds: it is connected.
  [[nodiscard]] bool waitForConnections(std::size_t count) const;
  // The requests with which clients asked for the status.
  [[nodiscard]] std::vector<ipc::Dictionary> greetings() const;
  [[nodiscard]] bool eventsOn() const;

 private:
  void run();
  void serve(int descriptor);
  void handle(sd_bus_message* message);
  void handleCommand(sd_bus_message* message);
  void appendStatus(sd_bus_message* reply);
  void sendMetric(std::int64_t metricID, const Bytes& payload, std::int64_t profileID, std::uint64_t skipped,
                  std::optional<std::int64_t> time);
  void post(std::function<void()> action);
  void sendEvent(const std::string& kind, std::uint64_t skipped, const std::function<void(sd_bus_message*)>& fill);
  void closeConnection();

  const std::string path_;
  int listening_ = -1;
  int wake_ = -1;

  // The thread's own.
  sd_bus* bus_ = nullptr;
  int socket_ = -1;  // a duplicate, to write past the protocol
  std::uint64_t sequence_ = 0;
  bool closing_ = false;

  mutable std::mutex mutex_;
  mutable std::condition_variable changed_;
  std::deque<std::function<void()>> actions_;
  std::map<std::string, Answer, std::less<>> answers_;
  std::string sourceLabel_ = "fake";
  std::string sourceKind_ = "simulated";
  std::vector<Call> calls_;
  std::vector<ipc::Dictionary> greetings_;
  std::optional<bool> configured_;
  std::optional<std::pair<std::int64_t, bool>> playback_;  // position, and whether it has ended
  bool eventsOn_ = false;
  bool stopping_ = false;

  std::thread thread_;
};

}  // namespace vespscope::test
