// Records events on its own thread, so that a slow or full disk delays nothing else.
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

// The result of writing some events.
struct RecordingOutcome {
  std::size_t taken = 0;               // how many of the first events need not be written again
  std::uint64_t refused = 0;           // of these, events that cannot be recorded at all
  std::uint64_t removed = 0;           // events recorded earlier that another program has removed from the file
  std::optional<std::string> problem;  // why the other events were not taken
};

// Where a recorder writes.
class RecordingTarget {
 public:
  virtual ~RecordingTarget() = default;
  // May block.
  virtual RecordingOutcome write(std::span<const SharedEvent> events) = 0;
};

class Recorder final : public EventRecorder {
 public:
  struct Options {
    // Events waiting for the disk; beyond these bounds the oldest are lost.
    DeliveryQueue::Bounds bounds{.events = 32'768, .bytes = std::size_t{8} << 20};
    std::chrono::milliseconds pause{1000};  // between a problem and the next attempt
  };

  explicit Recorder(std::unique_ptr<RecordingTarget> target) : Recorder(std::move(target), Options()) {}
  Recorder(std::unique_ptr<RecordingTarget> target, const Options& options);
  Recorder(const Recorder&) = delete;
  Recorder& operator=(const Recorder&) = delete;
  // Records the waiting events unless that fails.
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

  std::vector<SharedEvent> taken_;  // used by the thread only: written again until the target takes them
  std::uint64_t lostBefore_ = 0;    // used by the thread only: when the current problem began

  std::thread thread_;
};

}  // namespace vespscope::manager
