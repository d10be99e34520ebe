// The manager's sources of events: a modem, a recording or a simulated drive.
#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <stop_token>
#include <string>

#include "values/MetricEvent.h"
#include "values/PlaybackPosition.h"
#include "values/SourceKind.h"

namespace vespscope::sources {

// Receives events from a source; safe from any thread.
class EventSink {
 public:
  virtual ~EventSink() = default;
  virtual void deliver(MetricEvent event) = 0;
};

// Receives the SIM card files as the metric event that answers a query; empty when the source has none.
using SimCardFilesHandler = std::function<void(std::optional<MetricEvent>)>;

// A running source of events.
class Source {
 public:
  virtual ~Source() = default;

  // The source's name for a user: "scenario seed=1", "lte-ca-drive.mi2log".
  [[nodiscard]] virtual std::string label() const = 0;
  [[nodiscard]] virtual SourceKind kind() const = 0;
  // The position in the playback of a recording; empty for any other source, and before the first event. Safe from any
  // thread.
  [[nodiscard]] virtual std::optional<PlaybackPosition> playback() const { return std::nullopt; }

  // The SIM card that a viewer shows first, by the profile of its events; empty if the source prefers none. All cards
  // are delivered.
  [[nodiscard]] virtual std::optional<std::int32_t> simCard() const { return std::nullopt; }

  // Starts delivery to `sink`, on the source's own thread, until `stop` or destruction.
  virtual void start(EventSink& sink) = 0;
  // Returns after the last delivery and the end of any search for SIM card files.
  virtual void stop() = 0;

  // Looks for the SIM card files, also before the start, and passes them to `found`: before it returns if they are
  // found quickly, else later on a thread of the source, unless the source is stopped first.
  virtual void findSimCardFiles(SimCardFilesHandler found) = 0;
};

// The number of bytes that a stream has read, and the size of its input; 0 if unknown.
struct InputProgress {
  std::uint64_t read = 0;
  std::uint64_t total = 0;
};

// A finite or endless sequence of events in time order, read as fast as the caller likes. `Player` makes a running
// `Source` of it.
class EventStream {
 public:
  virtual ~EventStream() = default;
  [[nodiscard]] virtual std::string label() const = 0;
  [[nodiscard]] virtual SourceKind kind() const = 0;
  // The next event; empty at the end.
  [[nodiscard]] virtual std::optional<MetricEvent> next() = 0;
  // Whether `rewind` can be called; false for a pipe.
  [[nodiscard]] virtual bool canRewind() const { return true; }
  // Goes back to the first event.
  virtual void rewind() = 0;
  // Ends a next() that waits for its input, now or later, which then returns empty. Safe from any thread.
  virtual void interrupt() {}
  // Why the stream ended before its input, such as a capture truncated in the middle of a packet; empty if it did not.
  [[nodiscard]] virtual std::optional<std::string> failure() const { return std::nullopt; }
  // Called on the thread that calls next().
  [[nodiscard]] virtual InputProgress progress() const { return {}; }
  // One line on the events read and skipped so far; empty when there is nothing to report.
  [[nodiscard]] virtual std::string summary() const { return {}; }
  // The same in detail, as lines that each end in a newline; empty for streams without such details.
  [[nodiscard]] virtual std::string report() const { return {}; }
  // The SIM card files as the metric event that answers a query; empty when the stream has none, or when `stop` was
  // requested before they were found. May take as long as reading the whole stream. Safe from any thread, in parallel
  // with the other functions.
  [[nodiscard]] virtual std::optional<MetricEvent> simCardFiles(std::stop_token stop) = 0;
  // The recorded time between the first and the last event, for which it reads all events again; empty when that is
  // impossible (a pipe, an endless stream) or when `stop` was requested before the end. Safe from any thread, in
  // parallel with the other functions.
  [[nodiscard]] virtual std::optional<std::chrono::nanoseconds> length(const std::stop_token& /*stop*/) {
    return std::nullopt;
  }
};

}  // namespace vespscope::sources
