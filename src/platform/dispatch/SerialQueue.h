// A serial queue with a label: runs tasks one at a time, in the order of submission, on its own thread.
#pragma once

#include <condition_variable>
#include <deque>
#include <functional>
#include <mutex>
#include <string>
#include <thread>

namespace vespscope::dispatch {

class SerialQueue {
 public:
  explicit SerialQueue(std::string label);
  SerialQueue(const SerialQueue&) = delete;
  SerialQueue& operator=(const SerialQueue&) = delete;
  // Runs the queued tasks, then stops.
  ~SerialQueue();

  [[nodiscard]] const std::string& label() const { return label_; }
  // Submits a task and returns at once. Safe from any thread.
  void async(std::function<void()> task);
  // Returns when every task submitted so far has run; must not be called from a task of this queue.
  void drain();
  // The number of waiting tasks.
  [[nodiscard]] std::size_t size() const;

 private:
  void run();

  std::string label_;
  mutable std::mutex mutex_;
  std::condition_variable changed_;
  std::deque<std::function<void()>> tasks_;
  bool stopping_ = false;
  std::thread thread_;
};

}  // namespace vespscope::dispatch
