// Which of the viewer's screens a run of metric events gives values.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "metrics/MetricValidator.h"
#include "values/MetricEvent.h"

namespace vespscope {
struct ScreenSource;
}

namespace vespscope::tools {

struct CoveredScreen {
  std::string launch;  // "LTE"
  std::string row;     // "Serving Cell Info"
  const ScreenSource* source = nullptr;
  std::uint64_t reports = 0;  // events of the screen's metric
  bool filled = false;        // a value of one of them, other than the time, was on the screen

  [[nodiscard]] std::string key() const { return launch + " " + row; }
};

// Decodes as the viewer does, but only what may fill a screen that is still empty.
class ScreenCoverage {
 public:
  ScreenCoverage();

  void take(const MetricEvent& event);
  // The screens of the catalogue that reports can fill, in its order.
  [[nodiscard]] const std::vector<CoveredScreen>& screens() const { return screens_; }
  [[nodiscard]] std::size_t filled() const;

 private:
  MetricValidator decoder_{MetricValidator::LineSink()};
  std::vector<CoveredScreen> screens_;
};

}  // namespace vespscope::tools
