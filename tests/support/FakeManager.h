// A baseband manager controlled by a test: it implements the real protocol over a socket, records its calls and answers
// as scripted. It shares no code with the real manager's end, so that each tests the other.
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
      garbage,     // bytes that are not a D-Bus message
    };
    Manner manner = Manner::reply;
    std::int32_t status = 0;
    std::string message;
  };

  // Listens at `path`, on its own thread.
  explicit FakeManager(std::string path);
  FakeManager(const FakeManager&) = delete;
  FakeManager& operator=(const FakeManager&) = delete;
  ~FakeManager();

  // The address in words: "unix:path=…".
  [[nodiscard]] std::string address() const { return "unix:path=" + path_; }

  // Sets the answer to the command from here on; other commands are answered with status 0 and no message.
  void answer(std::string_view command, Answer answer);
  // Sets the answer to the client's status request, which is not part of calls().
  void setSource(std::string label, std::string kind);
  // From here on the answer reports whether the client's application is configured; before, it omits this.
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
  // Sends an Event signal with another signature.
  void sendMalformedEvent();
  // Writes invalid bytes into the connection.
  void sendGarbage();
  // Returns when everything requested so far has been sent; needs a connected client.
  void finishSending();
  // Closes the connection; the client may reconnect.
  void disconnect();

  [[nodiscard]] std::vector<Call> calls() const;
  // The calls in words: the command's name, or "EventsOn", "EventsOff".
  [[nodiscard]] std::vector<std::string> callNames() const;
  // Returns true when `count` calls have arrived; waits a few seconds.
  [[nodiscard]] bool waitForCalls(std::size_t count) const;
  // Returns true when clients have requested the status `count` times, which means that they are connected; waits a few
  // seconds.
  [[nodiscard]] bool waitForConnections(std::size_t count) const;
  // The status requests of clients.
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

  // Used by the thread only.
  sd_bus* bus_ = nullptr;
  int socket_ = -1;  // a duplicate, for writing invalid bytes
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
