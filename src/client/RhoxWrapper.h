// The program's one connection to the baseband manager: configuration, queries and the stream of events.
#pragma once

#include <cstdint>
#include <memory>
#include <mutex>
#include <string>
#include <string_view>

#include "client/MetricGate.h"
#include "client/RhoxWrapperDelegate.h"

namespace rhox::client {
class Manager;
}
namespace vespscope::dispatch {
class SerialQueue;
}

namespace vespscope {

// A weak reference to the delegate that any thread may load while the main thread changes it.
class DelegateSlot {
 public:
  [[nodiscard]] std::shared_ptr<RhoxWrapperDelegate> load() const {
    const std::lock_guard lock(mutex_);
    return delegate_.lock();
  }
  void store(const std::shared_ptr<RhoxWrapperDelegate>& delegate) {
    const std::lock_guard lock(mutex_);
    delegate_ = delegate;
  }

 private:
  mutable std::mutex mutex_;
  std::weak_ptr<RhoxWrapperDelegate> delegate_;
};

// All operations are for the main thread.
class RhoxWrapper {
 public:
  // Returns the shared wrapper, which exists until the process ends; the first call creates it and opens the
  // connection.
  static std::shared_ptr<RhoxWrapper> sharedInstance();

  RhoxWrapper();
  RhoxWrapper(const RhoxWrapper&) = delete;
  RhoxWrapper& operator=(const RhoxWrapper&) = delete;
  ~RhoxWrapper();

  // The serial queue on which events arrive, created once per process by the first wrapper that needs it; any other
  // wrapper has none.
  std::shared_ptr<dispatch::SerialQueue> queue();

  // The commands return true when the service answered with status 0. An `appId` other than "vespscope" sends
  // nothing and returns false.
  bool addOrblConfigForAppId(std::string_view appId, const std::string& protofFilePath);
  bool removeOrblConfigForAppid(std::string_view appId);
  bool querySpecificMetric(std::string_view appId, std::int32_t triggerRef, std::int32_t triggerType,
                           std::int32_t triggerID, std::int32_t profileID, std::int32_t metricID);

  // Registers the event handlers and turns delivery off and on again.
  void listen();

  // The receiver of events, held weakly.
  [[nodiscard]] std::shared_ptr<RhoxWrapperDelegate> delegate() const;
  void setDelegate(const std::shared_ptr<RhoxWrapperDelegate>& delegate);

  // Metric events reach the delegate through `gate`, for wrappers that listen from here on; null: directly.
  static void setMetricGate(std::shared_ptr<MetricGate> gate);

  // The connection, for the status line.
  [[nodiscard]] std::shared_ptr<rhox::client::Manager> manager() const { return rhoxManager_; }

 private:
  std::shared_ptr<rhox::client::Manager> rhoxManager_;
  std::shared_ptr<dispatch::SerialQueue> queue_;
  std::shared_ptr<DelegateSlot> delegate_;  // shared with the event handlers
};

}  // namespace vespscope
