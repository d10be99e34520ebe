// Writes lines of one kind to the system log at a limited rate, so that a client cannot fill the log.
#pragma once

#include <chrono>
#include <cstddef>
#include <mutex>
#include <optional>
#include <string>

namespace vespscope::manager {

// Safe from any thread.
class LogRate {
 public:
  using Clock = std::chrono::steady_clock;

  static constexpr std::size_t lineLimit = 8;        // lines
  static constexpr std::chrono::seconds period{10};  // from the first line

  // `kind` names what the lines report: "refused connections".
  explicit LogRate(std::string kind) : kind_(std::move(kind)) {}

  // Writes the line, or counts it if the period has reached its limit.
  void write(const std::string& line, Clock::time_point now = Clock::now());
  // Logs how many lines the last period left out, if it is over; returns when to call it again.
  std::optional<Clock::time_point> report(Clock::time_point now);

 private:
  void finishPeriod(Clock::time_point now);

  const std::string kind_;
  std::mutex mutex_;
  Clock::time_point begin_;
  std::size_t written_ = 0;
  std::size_t omitted_ = 0;
};

}  // namespace vespscope::manager
