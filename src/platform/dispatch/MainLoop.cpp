#include "platform/dispatch/MainLoop.h"

#include <sys/epoll.h>
#include <sys/timerfd.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstring>
#include <iterator>
#include <string>
#include <utility>

#include "platform/log/Log.h"

namespace vespscope::dispatch {
namespace {

int checked(int result, const char* call) {
  if (result < 0) log::fatal(std::string(call) + ": " + std::strerror(errno));
  return result;
}

void addReadable(int epoll, int descriptor) {
  epoll_event event{};
  event.events = EPOLLIN;
  event.data.fd = descriptor;
  checked(::epoll_ctl(epoll, EPOLL_CTL_ADD, descriptor, &event), "epoll_ctl");
}

void clearCounter(int descriptor) {
  std::uint64_t count = 0;
  [[maybe_unused]] const ssize_t ignored = ::read(descriptor, &count, sizeof count);  // already empty: nothing to read
}

// However many tasks are queued, timers and descriptors are checked this often.
constexpr std::chrono::milliseconds turn{20};

constexpr std::size_t usualBatch = 64;  // tasks

}  // namespace

MainLoop::MainLoop()
    : epoll_(checked(::epoll_create1(EPOLL_CLOEXEC), "epoll_create1")),
      alarm_(checked(::timerfd_create(CLOCK_MONOTONIC, TFD_CLOEXEC | TFD_NONBLOCK), "timerfd_create")) {
  addReadable(epoll_, wake_.descriptor());
  addReadable(epoll_, alarm_);
}

MainLoop::~MainLoop() {
  ::close(alarm_);
  ::close(epoll_);
}

MainLoop& MainLoop::main() {
  // Never destroyed: the serial queue may submit a last delivery while the process exits.
  static MainLoop* shared = new MainLoop;
  return *shared;
}

void MainLoop::async(Task task) {
  if (TaskBatch* batch = TaskBatch::current; batch != nullptr && &batch->loop_ == this) {
    if (batch->tasks_.empty()) batch->tasks_.reserve(usualBatch);
    batch->tasks_.push_back(std::move(task));
    return;
  }
  bool first = false;
  {
    const std::lock_guard lock(mutex_);
    first = tasks_.empty();
    tasks_.push_back(std::move(task));
  }
  if (first) wake_.wake();  // otherwise the loop is already awake and takes all tasks at once
}

void MainLoop::asyncAll(std::vector<Task>& tasks) {
  if (tasks.empty()) return;
  bool first = false;
  {
    const std::lock_guard lock(mutex_);
    first = tasks_.empty();
    std::move(tasks.begin(), tasks.end(), std::back_inserter(tasks_));
  }
  if (first) wake_.wake();
}

thread_local constinit TaskBatch* TaskBatch::current = nullptr;

TaskBatch::TaskBatch(MainLoop& loop) : loop_(loop) {
  if (current != nullptr) log::fatal("a second batch of tasks on one thread");
  current = this;
}

TaskBatch::~TaskBatch() {
  current = nullptr;
  loop_.asyncAll(tasks_);
}

int MainLoop::run() {
  stopped_ = false;
  while (!stopped_) runOnce(std::chrono::milliseconds(-1));
  return code_;
}

void MainLoop::stop(int code) {
  code_ = code;
  stopped_ = true;
  async([] {});
}

bool MainLoop::runOnce(std::chrono::milliseconds limit) {
  std::array<epoll_event, 16> events;
  const int count =
      ::epoll_wait(epoll_, events.data(), static_cast<int>(events.size()), static_cast<int>(limit.count()));
  if (count < 0 && errno != EINTR) log::fatal(std::string("epoll_wait: ") + std::strerror(errno));
  bool worked = false;
  for (int index = 0; index < count; ++index) {
    const int ready = events.at(static_cast<std::size_t>(index)).data.fd;
    if (ready == wake_.descriptor()) {
      wake_.clear();
      continue;
    }
    if (ready == alarm_) {
      clearCounter(ready);
      continue;
    }
    // An earlier callback may have removed this one; the copy keeps a callback that removes itself alive.
    if (const auto found = watched_.find(ready); found != watched_.end()) {
      const Task readable = found->second;
      readable();
      worked = true;
    }
  }
  takeTasks();
  worked |= runTasks(turn);
  worked |= runTimers();
  if (!taken_.empty()) wake_.wake();
  return worked;
}

void MainLoop::drain() {
  takeTasks();
  runTasks(Clock::duration::max());
}

void MainLoop::takeTasks() {
  if (taken_.empty()) {
    const std::lock_guard lock(mutex_);
    taken_.swap(tasks_);
    return;
  }
  std::deque<Task> tasks;
  {
    const std::lock_guard lock(mutex_);
    tasks.swap(tasks_);
  }
  std::move(tasks.begin(), tasks.end(), std::back_inserter(taken_));
}

bool MainLoop::runTasks(Clock::duration budget) {
  if (taken_.empty()) return false;
  const log::OutputBatch batch;
  const Clock::time_point start = Clock::now();
  const std::size_t count = taken_.size();
  for (std::size_t done = 0; done < count && !taken_.empty(); ++done) {
    const Task task = std::move(taken_.front());
    taken_.pop_front();
    task();
    if (Clock::now() - start > budget) break;
  }
  return true;
}

MainLoop::TimerIdentifier MainLoop::scheduleRepeating(std::chrono::milliseconds interval, Task action) {
  timers_.emplace(++lastTimer_, Timer{now() + interval, interval, std::move(action)});
  armTimer();
  return lastTimer_;
}

void MainLoop::cancel(TimerIdentifier timer) {
  timers_.erase(timer);
  armTimer();
}

bool MainLoop::runTimers() {
  const Clock::time_point instant = now();
  std::vector<TimerIdentifier> due;
  for (const auto& [identifier, timer] : timers_) {
    if (timer.due <= instant) due.push_back(identifier);
  }
  for (const TimerIdentifier identifier : due) {
    const auto found = timers_.find(identifier);
    if (found == timers_.end()) continue;  // cancelled by another timer's action
    // A delayed loop fires once, not once for every missed interval.
    Timer& timer = found->second;
    while (timer.due <= instant) timer.due += timer.interval;
    const Task action = timer.action;
    action();
  }
  if (!due.empty()) armTimer();
  return !due.empty();
}

void MainLoop::armTimer() {
  itimerspec setting{};
  const auto next = std::min_element(timers_.begin(), timers_.end(), [](const auto& one, const auto& other) {
    return one.second.due < other.second.due;
  });
  if (next != timers_.end()) {
    const auto wait = std::max(std::chrono::nanoseconds(1), std::chrono::nanoseconds(next->second.due - now()));
    setting.it_value.tv_sec = static_cast<time_t>(wait.count() / 1'000'000'000);
    setting.it_value.tv_nsec = static_cast<long>(wait.count() % 1'000'000'000);
  }
  checked(::timerfd_settime(alarm_, 0, &setting, nullptr), "timerfd_settime");
}

void MainLoop::watch(int descriptor, Task readable) {
  const bool known = watched_.contains(descriptor);
  watched_[descriptor] = std::move(readable);
  if (!known) addReadable(epoll_, descriptor);
}

void MainLoop::unwatch(int descriptor) {
  if (watched_.erase(descriptor) != 0) ::epoll_ctl(epoll_, EPOLL_CTL_DEL, descriptor, nullptr);
}

void MainLoop::advance(std::chrono::milliseconds step) {
  advanced_ += step;
  armTimer();
}

}  // namespace vespscope::dispatch
