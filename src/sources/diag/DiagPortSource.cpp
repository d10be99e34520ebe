#include "sources/diag/DiagPortSource.h"

#include <poll.h>
#include <pthread.h>

#include <algorithm>
#include <array>
#include <utility>

#include "platform/log/Log.h"

namespace vespscope::sources::diag {
namespace {

std::string wordsFor(LogSession::State state) {
  switch (state) {
    case LogSession::State::asking:
      return "asked for its log";
    case LogSession::State::logging:
      return {};
    case LogSession::State::silent:
      return "does not answer";
    case LogSession::State::garbled:
      return "sends data that no modem sends";
    case LogSession::State::refused:
      return "rejects the command to turn its log on";
  }
  return {};
}

bool isFailure(LogSession::State state) {
  return state != LogSession::State::asking && state != LogSession::State::logging;
}

}  // namespace

DiagPortSource::DiagPortSource(std::string port, PortPace pace)
    : port_(std::move(port)), pace_(pace), condition_("not opened yet") {}

DiagPortSource::~DiagPortSource() { stop(); }

std::string DiagPortSource::label() const {
  const std::lock_guard lock(mutex_);
  return condition_.empty() ? port_ : port_ + ": " + condition_;
}

void DiagPortSource::start(EventSink& sink) {
  thread_ = std::thread([this, &sink] { run(sink); });
  ::pthread_setname_np(thread_.native_handle(), "diagport");
}

void DiagPortSource::stop() {
  stopping_ = true;
  wake_.wake();
  if (thread_.joinable()) thread_.join();
}

void DiagPortSource::run(EventSink& sink) {
  std::chrono::milliseconds pause = pace_.firstRetry;
  while (!stopping_) {
    answered_ = false;
    Result<PortConnection> connection = PortConnection::open(port_);
    const std::string reason = connection ? talk(*connection, sink) : connection.reason();
    if (stopping_) break;
    setCondition(reason + "; trying again");
    if (answered_) pause = pace_.firstRetry;
    const Clock::time_point until = Clock::now() + pause;
    while (!stopping_ && Clock::now() < until) wait(-1, false, until);
    pause = std::min(pause * 2, pace_.longestRetry);
  }
}

std::string DiagPortSource::talk(PortConnection& connection, EventSink& sink) {
  constexpr std::size_t bufferLength = 65'536;
  LogSession session(Clock::now(), pace_.patience);
  Bytes buffer(bufferLength);
  Bytes output;
  std::deque<MetricEvent> events;
  while (!stopping_) {
    const Bytes more = session.takeOutput();
    output.insert(output.end(), more.begin(), more.end());
    if (!output.empty()) {
      if (const auto written = connection.write(output); !written) return written.reason();
    }
    wait(connection.descriptor(), !output.empty(), session.deadline());
    const auto count = connection.read(buffer);
    if (!count) return count.reason();
    session.take({buffer.data(), *count}, Clock::now(), events);
    session.tick(Clock::now());
    for (MetricEvent& event : events) sink.deliver(std::move(event));
    events.clear();
    if (isFailure(session.state())) return wordsFor(session.state());
    answered_ = session.state() == LogSession::State::logging;
    setCondition(wordsFor(session.state()));
  }
  turnOff(connection);
  return {};
}

// Otherwise the modem would continue to fill its buffers. Its answer is not awaited.
void DiagPortSource::turnOff(PortConnection& connection) {
  Bytes output = turnAllOff();
  const Clock::time_point end = Clock::now() + pace_.farewell;
  while (!output.empty() && Clock::now() < end) {
    if (!connection.write(output)) return;
    if (output.empty()) return;
    pollfd ready{connection.descriptor(), POLLOUT, 0};
    const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(end - Clock::now()).count();
    ::poll(&ready, 1, static_cast<int>(std::max<std::chrono::milliseconds::rep>(left, 0)));
  }
}

void DiagPortSource::setCondition(const std::string& condition) {
  {
    const std::lock_guard lock(mutex_);
    if (condition_ == condition) return;
    condition_ = condition;
  }
  // A port that is retried repeatedly is logged once.
  if (condition == wordsFor(LogSession::State::asking) || condition == loggedCondition_) return;
  loggedCondition_ = condition;
  log::system(label());
}

void DiagPortSource::wait(int descriptor, bool forWriting, std::optional<Clock::time_point> until) const {
  const auto events = static_cast<short>(forWriting ? POLLIN | POLLOUT : POLLIN);
  std::array<pollfd, 2> waits = {{{wake_.descriptor(), POLLIN, 0}, {descriptor, events, 0}}};
  int milliseconds = -1;
  if (until) {
    const auto left = std::chrono::ceil<std::chrono::milliseconds>(*until - Clock::now()).count();
    milliseconds = static_cast<int>(std::max<std::chrono::milliseconds::rep>(left, 0));
  }
  ::poll(waits.data(), waits.size(), milliseconds);
}

}  // namespace vespscope::sources::diag
