// The live source: ModemManager's reports of a modem, followed on the system bus while the source runs.
//
// Waits for a missing bus, ModemManager or modem. Values of a lost modem are withdrawn: a viewer that showed a
// registered modem then shows only the time of the loss.
#pragma once

#include <atomic>
#include <chrono>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <thread>

#include "platform/dispatch/WakeDescriptor.h"
#include "sources/modemmanager/Reports.h"
#include "sources/modemmanager/Watcher.h"
#include "sources/playback/Source.h"

namespace vespscope::sources::modemmanager {

class ModemManagerSource final : public Source {
 public:
  explicit ModemManagerSource(Pace pace = {}, std::chrono::milliseconds busRetry = std::chrono::seconds(2));
  ModemManagerSource(const ModemManagerSource&) = delete;
  ModemManagerSource& operator=(const ModemManagerSource&) = delete;
  ~ModemManagerSource() override;

  // The modem and its state, or what the source waits for.
  [[nodiscard]] std::string label() const override;
  [[nodiscard]] SourceKind kind() const override { return SourceKind::live; }
  void start(EventSink& sink) override;
  void stop() override;
  void findSimCardFiles(SimCardFilesHandler found) override;

 private:
  void run(EventSink& sink);
  void work();
  void publish(EventSink& sink);
  void waitForWork();

  const Pace pace_;
  const std::chrono::milliseconds busRetry_;
  const dispatch::WakeDescriptor wake_;
  std::atomic<bool> stopping_ = false;
  std::thread thread_;

  // Used by the thread only.
  std::unique_ptr<Watcher> watcher_;
  Watcher::Clock::time_point nextBus_;
  std::string problem_;  // with the bus

  mutable std::mutex mutex_;  // guards the members below
  std::string label_ = "ModemManager, not asked yet";
  Reports reports_;
};

}  // namespace vespscope::sources::modemmanager
