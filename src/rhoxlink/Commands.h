// Transfers commands from the threads that wait for their answers to the connection's thread, and replies back.
#pragma once

#include <chrono>
#include <condition_variable>
#include <deque>
#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "platform/ipc/IpcObject.h"
#include "rhoxlink/Rhoxlink.h"
#include "rhoxlink/bus/Bus.h"

namespace rhox::client {

class Commands {
 public:
  using Clock = std::chrono::steady_clock;

  // A pending command.
  struct Call {
    std::string command;
    vespscope::ipc::Dictionary request;
    Clock::time_point deadline;
    std::optional<vespscope::bus::Reply> reply;
    bool abandoned = false;  // no thread waits for the reply any more
  };
  // The connection's thread sends these in order.
  struct Operation {
    enum class Kind { call, eventsOn, eventsOff, askForTimes };
    Kind kind = Kind::call;
    std::shared_ptr<Call> call;  // for Kind::call only
  };

  // `wake` wakes the connection's thread. `startPatience` limits the wait for the first answer when a manager must be
  // started or a machine reached.
  Commands(std::function<void()> wake, std::chrono::milliseconds startPatience)
      : wake_(std::move(wake)), startPatience_(startPatience) {}

  // Safe from any thread. Waits at most `timeout` for the answer.
  Result perform(std::string_view command, const vespscope::ipc::Dictionary& request, vespscope::ipc::Object& reply,
                 std::chrono::milliseconds timeout);
  void setEvents(bool on);
  void askForTimes();
  // Whether event delivery is turned on, according to the operations sent so far.
  [[nodiscard]] bool delivering() const;
  [[nodiscard]] bool wantsTimes() const;

  // The following functions are for the connection's thread. Returns the operations to send now and removes them.
  [[nodiscard]] std::deque<Operation> take();
  // Records that a call has been sent; its reply goes to finish().
  void sent(std::shared_ptr<Call> call) { sent_.push_back(std::move(call)); }
  void finish(const std::shared_ptr<Call>& call, vespscope::bus::Reply reply);
  // Whether a sent call still waits for its reply.
  [[nodiscard]] bool awaited() const { return !sent_.empty(); }

  // Records that a connection is open.
  void opened();
  // Records that the connection's manager has answered.
  void answered();
  // Records that the connection has ended: every pending call fails with `problem`, and the delivery setting is kept
  // for the next connection.
  void closed(const std::string& problem);

 private:
  void post(Operation operation);
  // Waits for `condition` at most until a moment, or for a little while after a signal has asked the program to end.
  bool waitFor(std::unique_lock<std::mutex>& lock, Clock::time_point until, const std::function<bool()>& condition);

  const std::function<void()> wake_;
  const std::chrono::milliseconds startPatience_;
  std::vector<std::shared_ptr<Call>> sent_;  // used by the connection's thread only

  mutable std::mutex mutex_;
  std::condition_variable changed_;
  std::deque<Operation> operations_;
  std::string problem_;  // why there is no connection
  bool open_ = false;
  bool answered_ = false;
  bool delivering_ = false;
  bool wantsTimes_ = false;
};

}  // namespace rhox::client
