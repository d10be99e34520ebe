// The live log of a modem on its port: turned on when the port exists, turned off at the end. The port is retried while
// it is absent, silent or lost.
#pragma once

#include <atomic>
#include <chrono>
#include <deque>
#include <mutex>
#include <string>
#include <thread>

#include "platform/dispatch/WakeDescriptor.h"
#include "sources/diag/LogSession.h"
#include "sources/diag/PortConnection.h"
#include "sources/playback/Source.h"

namespace vespscope::sources::diag {

struct PortPace {
  std::chrono::milliseconds patience{3000};   // maximum wait for an answer
  std::chrono::milliseconds firstRetry{250};  // doubled after each failure
  std::chrono::milliseconds longestRetry{5000};
  std::chrono::milliseconds farewell{500};  // time limit for turning the log off
};

class DiagPortSource final : public Source {
 public:
  // `port` is a name that PortConnection opens.
  explicit DiagPortSource(std::string port, PortPace pace = {});
  DiagPortSource(const DiagPortSource&) = delete;
  DiagPortSource& operator=(const DiagPortSource&) = delete;
  ~DiagPortSource() override;

  // The port and its state: "/dev/ttyUSB0", "/dev/ttyUSB0: does not answer".
  [[nodiscard]] std::string label() const override;
  [[nodiscard]] SourceKind kind() const override { return SourceKind::live; }
  [[nodiscard]] std::optional<std::int32_t> simCard() const override { return simCard_; }
  // Makes `card` the one that viewers show first; before the start.
  void preferSimCard(std::optional<std::int32_t> card) { simCard_ = card; }
  void start(EventSink& sink) override;
  void stop() override;
  // The log has no SIM card files.
  void findSimCardFiles(SimCardFilesHandler found) override { found(std::nullopt); }

 private:
  using Clock = LogSession::Clock;

  void run(EventSink& sink);
  // Exchanges data on one connection until it ends or the source stops; returns why it ended.
  std::string talk(PortConnection& connection, EventSink& sink);
  void turnOff(PortConnection& connection);
  void setCondition(const std::string& condition);
  // Waits until the time, the descriptor (none when negative) or the source's end.
  void wait(int descriptor, bool forWriting, std::optional<Clock::time_point> until) const;

  const std::string port_;
  const PortPace pace_;
  std::optional<std::int32_t> simCard_;
  const dispatch::WakeDescriptor wake_;
  std::atomic<bool> stopping_ = false;
  bool answered_ = false;                       // used by the thread only: the modem answered on the last connection
  std::optional<std::string> loggedCondition_;  // used by the thread only
  std::thread thread_;

  mutable std::mutex mutex_;
  std::string condition_;
};

}  // namespace vespscope::sources::diag
