// The main thread's loop: the main queue, repeating timers and descriptors that become readable.
//
// One descriptor, `descriptor()`, becomes readable whenever `runOnce` has something to do, so that the loop also
// runs inside another toolkit's loop.
#pragma once

#include <chrono>
#include <cstdint>
#include <deque>
#include <functional>
#include <map>
#include <mutex>
#include <optional>
#include <vector>

#include "platform/dispatch/WakeDescriptor.h"

namespace vespscope::dispatch {

class MainLoop {
 public:
  using Clock = std::chrono::steady_clock;
  using Task = std::function<void()>;

  MainLoop();
  MainLoop(const MainLoop&) = delete;
  MainLoop& operator=(const MainLoop&) = delete;
  ~MainLoop();

  // The process's main loop, which runs the main queue.
  static MainLoop& main();

  // Submits a task to the main queue and returns at once. Safe from any thread; every other operation belongs to
  // the main thread.
  void async(Task task);

  // Runs until `stop`; returns the code passed to it.
  int run();
  void stop(int code);
  // The code of a `stop` since the last `run` began, for callers that run the loop step by step.
  [[nodiscard]] std::optional<int> stopCode() const { return stopped_ ? std::optional(code_) : std::nullopt; }
  // Waits at most `limit` for something to do and does it: readable descriptors, queued tasks, due timers. Returns true
  // when anything was done. When very many tasks are queued, some are left for the next call, so that timers and
  // descriptors do not wait.
  bool runOnce(std::chrono::milliseconds limit);
  // Runs the tasks that are queued now, without waiting.
  void drain();

  using TimerIdentifier = std::uint64_t;
  // Calls `action` every `interval`, first after one interval, until cancelled.
  TimerIdentifier scheduleRepeating(std::chrono::milliseconds interval, Task action);
  void cancel(TimerIdentifier timer);
  [[nodiscard]] std::size_t timerCount() const { return timers_.size(); }

  // Calls `readable` whenever `descriptor` has something to read or is hung up, until removed.
  void watch(int descriptor, Task readable);
  void unwatch(int descriptor);

  [[nodiscard]] int descriptor() const { return epoll_; }

  // Moves the timers' clock forward, so that tests need not wait: timers that have expired by then fire at the next
  // run.
  void advance(std::chrono::milliseconds step);

 private:
  struct Timer {
    Clock::time_point due;
    std::chrono::milliseconds interval;
    Task action;
  };

  friend class TaskBatch;

  void asyncAll(std::vector<Task>& tasks);
  [[nodiscard]] Clock::time_point now() const { return Clock::now() + advanced_; }
  void takeTasks();
  // Runs the tasks that were taken, at least one, until they are done or `budget` is spent.
  bool runTasks(Clock::duration budget);
  bool runTimers();
  void armTimer();

  int epoll_ = -1;
  WakeDescriptor wake_;
  int alarm_ = -1;
  std::mutex mutex_;
  std::deque<Task> tasks_;
  std::deque<Task> taken_;  // from tasks_, not yet run; the main thread's own
  std::map<TimerIdentifier, Timer> timers_;
  TimerIdentifier lastTimer_ = 0;
  std::map<int, Task> watched_;
  std::chrono::milliseconds advanced_{0};
  bool stopped_ = false;
  int code_ = 0;
};

// While this object lives, tasks that its thread submits to the loop are gathered; its destructor submits them
// together, in order, with one lock and one wake. At most one per thread at a time.
class TaskBatch {
 public:
  explicit TaskBatch(MainLoop& loop);
  TaskBatch(const TaskBatch&) = delete;
  TaskBatch& operator=(const TaskBatch&) = delete;
  ~TaskBatch();

 private:
  friend class MainLoop;
  static thread_local constinit TaskBatch* current;

  MainLoop& loop_;
  std::vector<MainLoop::Task> tasks_;
};

}  // namespace vespscope::dispatch
