// Commands on their way from the threads that wait for their answers to the connection's thread and back.
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

  // A command under way.
  struct Call {
    std::string command;
    vespscope::ipc::Dictionary request;
    Clock::time_point deadline;
    std::optional<vespscope::bus::Reply> reply;
    bool abandoned = false;  // nobody waits for the reply any more
  };
  // What the connection's thread sends, in order.
  struct Operation {
    enum class Kind { call, eventsOn, eventsOff, askForTimes };
    Kind kind = Kind::call;
    std::shared_ptr<Call> call;  // of Kind::call only
  };

  // `wake` wakes the connection's thread. `startPatience` is how long the first answer may take where a manager is
  // started or a machine reached first.
  Commands(std::function<void()> wake, std::chrono::milliseconds startPatience)
      : wake_(std::move(wake)), startPatience_(startPatience) {}

  // Safe from any thread. Waits for the answer, at most `timeout`.
  Result perform(std::string_view command, const vespscope::ipc::Dictionary& request, vespscope::ipc::Object& reply,
                 std::chrono::milliseconds timeout);
  void setEvents(bool on);
  void askForTimes();
  // Whether delivery is wanted, as of the operations sent so far.
  [[nodiscard]] bool delivering() const;
  [[nodiscard]] bool wantsTimes() const;

  // The rest belongs to the connection's thread.
  // The operations to send now, which are gone from here then.
  [[nodiscard]] std::deque<Operation> take();
  // Notes that a call has been sent; its reply goes to finish().
  void sent(std::shared_ptr<Call> call) { sent_.push_back(std::move(call)); }
  void finish(const std::shared_ptr<Call>& call, vespscope::bus::Reply reply);
  // Whether a sent call has no reply yet.
  [[nodiscard]] bool awaited() const { return !sent_.empty(); }

  // There is a connection to send through.
  void opened();
  // Its manager has answered.
  void answered();
  // The connection is over: every call under way ends with that, and what was asked of delivery is kept for the next
  // one.
  void closed(const std::string& problem);

 private:
  void post(Operation operation);

  const std::function<void()> wake_;
  const std::chrono::milliseconds startPatience_;
  std::vector<std::shared_ptr<Call>> sent_;  // the connection's thread's own

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
