// Records events on a thread of its own, so that a slow or full disk delays nobody.
#pragma once

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <mutex>
#include <optional>
#include <span>
#include <string>
#include <thread>
#include <vector>

#include "manager/DeliveryQueue.h"
#include "manager/EventRecorder.h"

namespace vespscope::manager {

// How some events were handled.
struct RecordingOutcome {
  std::size_t taken = 0;               // events, the first ones, that need not be given again
  std::uint64_t refused = 0;           // of these, events that cannot be recorded at all
  std::uint64_t removed = 0;           // events recorded earlier that another program has removed from the file
  std::optional<std::string> problem;  // why the others were not taken
};

// Where a recorder writes to.
class RecordingTarget {
 public:
  virtual ~RecordingTarget() = default;
  // May take its time.
  virtual RecordingOutcome write(std::span<const SharedEvent> events) = 0;
};

class Recorder final : public EventRecorder {
 public:
  struct Options {
    // What waits while the disk does not take it; beyond, the oldest is lost.
    DeliveryQueue::Bounds bounds{.events = 32'768, .bytes = std::size_t{8} << 20};
    std::chrono::milliseconds pause{1000};  // after a problem, before the next attempt
  };

  explicit Recorder(std::unique_ptr<RecordingTarget> target) : Recorder(std::move(target), Options()) {}
  Recorder(std::unique_ptr<RecordingTarget> target, const Options& options);
  Recorder(const Recorder&) = delete;
  Recorder& operator=(const Recorder&) = delete;
  // Records what waits, unless that fails.
  ~Recorder() override;

  void record(SharedEvent event) override;
  [[nodiscard]] RecordingStatus status() const override;

 private:
  void run();
  bool takeWaiting();
  bool writeTaken();

  const std::unique_ptr<RecordingTarget> target_;
  const Options options_;

  mutable std::mutex mutex_;
  std::condition_variable changed_;
  DeliveryQueue waiting_;
  RecordingStatus status_;  // without the losses of waiting_
  bool stopping_ = false;

  std::vector<SharedEvent> taken_;  // the thread's own: given to the target until it takes them
  std::uint64_t lostBefore_ = 0;    // the thread's own: when the present problem began

  std::thread thread_;
};

}  // namespace vespscope::manager
