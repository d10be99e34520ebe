// Turns a modem's state into metric events, one for each metric whose content has changed.
//
// Values that become unknown are withdrawn: the metric is sent again with the remaining ones, in the end with its
// timestamp only. An empty list cannot be distinguished from one that is not sent, so it is sent as one element without
// content.
#pragma once

#include <array>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <utility>
#include <vector>

#include "sources/modemmanager/CardFiles.h"
#include "sources/modemmanager/ModemState.h"
#include "sources/report/StampedEvent.h"
#include "values/MetricEvent.h"

namespace vespscope::sources::modemmanager {

class Reports {
 public:
  // Returns the events that update a viewer to `state`, at `time` since 1970-01-01 00:00 UTC.
  [[nodiscard]] std::vector<MetricEvent> update(const ModemState& state, std::chrono::nanoseconds time);

  // The last known SIM card files, as the event that answers a query; empty when none are known.
  [[nodiscard]] std::optional<MetricEvent> simCardFiles(std::chrono::nanoseconds time) const;

 private:
  enum class ListName {
    lteNeighbours,
    lteUtraNeighbours,
    lteGeranNeighbours,
    lteInstants,
    umtsReceivers,
    umtsUtraNeighbours,
    umtsGeranNeighbours,
    umtsEutraNeighbours,
    gsmGeranNeighbours,
    gsmUtraNeighbours,
    gsmEutraNeighbours,
    bearers,
    files,
    count
  };

  void tellRegistration(const ModemState& state);
  void tellServingCell(const ModemState& state);
  void tellSignal(const ModemState& state);
  void tellNeighbours(const ModemState& state);
  void tellBearers(const ModemState& state);
  void tellSim(const ModemState& state);

  // Adds an event when `message`, still without timestamp, differs from the last one.
  template <class Message>
  void tell(std::int32_t metricID, Message& message) {
    Bytes content = message.encoded();
    Bytes& before = told_[metricID];
    if (content == before) return;
    before = std::move(content);
    events_.push_back(stampedEvent(metricID, message, time_));
  }

  // Whether a list of `size` elements must be sent with one element without content, because it had some before.
  bool emptied(ListName name, std::size_t size) {
    bool& filled = filled_[static_cast<std::size_t>(name)];
    filled = filled || size > 0;
    return filled && size == 0;
  }

  std::map<std::int32_t, Bytes> told_;  // by metric, without timestamps
  std::array<bool, static_cast<std::size_t>(ListName::count)> filled_{};
  std::vector<CardFile> files_;
  std::vector<MetricEvent> events_;  // of the current update
  std::chrono::nanoseconds time_{0};
};

}  // namespace vespscope::sources::modemmanager
