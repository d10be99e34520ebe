#include "manager/Player.h"

#include <pthread.h>

#include <utility>

#include "platform/log/Log.h"

namespace vespscope::manager {

bool SteadyPlayerClock::waitUntil(std::chrono::nanoseconds moment) {
  std::unique_lock lock(mutex_);
  const auto until = begin_ + std::chrono::duration_cast<std::chrono::steady_clock::duration>(moment);
  if (until - std::chrono::steady_clock::now() > tolerance) {
    changed_.wait_until(lock, until, [this] { return interrupted_; });
  }
  return !interrupted_;
}

void SteadyPlayerClock::interrupt() {
  {
    const std::lock_guard lock(mutex_);
    interrupted_ = true;
  }
  changed_.notify_all();
}

Player::Player(std::unique_ptr<EventStream> stream, const PlaybackOptions& options, std::unique_ptr<PlayerClock> clock)
    : label_(stream->label()),
      kind_(stream->kind()),
      options_(options),
      clock_(std::move(clock)),
      stream_(std::move(stream)) {}

Player::~Player() { stop(); }

void Player::start(EventSink& sink) {
  thread_ = std::thread([this, &sink] { run(sink); });
  ::pthread_setname_np(thread_.native_handle(), "player");
}

void Player::stop() {
  clock_->interrupt();
  if (thread_.joinable()) thread_.join();
}

std::optional<MetricEvent> Player::simCardFiles() {
  const std::lock_guard lock(mutex_);
  return stream_->simCardFiles();
}

std::optional<MetricEvent> Player::nextEvent() {
  const std::lock_guard lock(mutex_);
  return stream_->next();
}

bool Player::rewind() {
  const std::lock_guard lock(mutex_);
  if (const std::optional<std::string> failure = stream_->failure()) log::system(label_ + ": " + *failure);
  if (!options_.loop || !stream_->canRewind()) return false;
  stream_->rewind();
  return true;
}

void Player::run(EventSink& sink) {
  Playback playback(options_);
  clock_->begin();
  bool played = false;  // in this round: a round without events is the last
  while (true) {
    std::optional<MetricEvent> event = nextEvent();
    if (!event) {
      if (!played || !rewind()) return;
      playback.restart();
      played = false;
      continue;
    }
    const std::optional<std::chrono::nanoseconds> moment = playback.schedule(event->time);
    // What is left out is not waited for, but a stop is heeded there too.
    if (!clock_->waitUntil(moment.value_or(std::chrono::nanoseconds(0)))) return;
    if (!moment) continue;
    sink.deliver(std::move(*event));
    played = true;
  }
}

}  // namespace vespscope::manager
