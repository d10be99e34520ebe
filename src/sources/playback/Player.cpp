#include "sources/playback/Player.h"

#include <pthread.h>
#include <sys/resource.h>

#include <algorithm>
#include <array>
#include <cstdio>
#include <utility>
#include <vector>

#include "platform/log/Log.h"

namespace vespscope::sources {
namespace {

using std::chrono::nanoseconds;

constexpr int measuringNiceness = 10;

// "12.3 s".
std::string secondsText(nanoseconds time) {
  std::array<char, 32> text{};
  std::snprintf(text.data(), text.size(), "%.1f s", std::chrono::duration<double>(time).count());
  return text.data();
}

}  // namespace

Player::Player(std::unique_ptr<EventStream> stream, const PlaybackOptions& options, std::unique_ptr<PlayerClock> clock)
    : label_(stream->label()),
      kind_(stream->kind()),
      options_(options),
      clock_(std::move(clock)),
      stream_(std::move(stream)),
      search_(*stream_),
      playback_(options) {}

Player::~Player() { stop(); }

std::string Player::label() const {
  const std::lock_guard lock(mutex_);
  return label_ + remark_;
}

std::optional<PlaybackPosition> Player::playback() const {
  const std::lock_guard lock(mutex_);
  std::optional<PlaybackPosition> position = position_;
  // The file may have grown since its length was measured.
  if (position && length_) position->length = std::max(*length_, position->position);
  return position;
}

void Player::start(EventSink& sink) {
  thread_ = std::thread([this, &sink] { run(sink); });
  ::pthread_setname_np(thread_.native_handle(), "player");
  if (kind_ != SourceKind::recorded || !stream_->canRewind()) return;
  measuring_ = std::jthread([this](const std::stop_token& stop) { measure(stop); });
}

void Player::stop() {
  stopping_ = true;
  clock_->interrupt();
  measuring_.request_stop();
  stream_->interrupt();
  if (thread_.joinable()) thread_.join();
  if (measuring_.joinable()) measuring_.join();
  search_.stop();
}

void Player::measure(const std::stop_token& stop) {
  ::pthread_setname_np(::pthread_self(), "measure");
  ::setpriority(PRIO_PROCESS, 0, measuringNiceness);  // of this thread only
  const std::optional<nanoseconds> length = stream_->length(stop);
  const std::lock_guard lock(mutex_);
  if (length) length_ = length;
}

void Player::moveTo(nanoseconds position, nanoseconds clock) {
  if (kind_ != SourceKind::recorded) return;
  const std::lock_guard lock(mutex_);
  position_ = PlaybackPosition{
      .position = position, .length = std::nullopt, .clock = clock, .speed = options_.speed, .ended = false};
}

void Player::deliverStateBefore(EventSink& sink) {
  if (const std::uint64_t leftOut = before_.leftOut(); leftOut != 0) {
    log::system(label_ + ": " + std::to_string(leftOut) + " events before the start are left out: too many metrics");
  }
  for (MetricEvent& event : before_.release()) sink.deliver(std::move(event));
}

void Player::explainStartBehindTheEnd() {
  const std::string reason = "start=" + secondsText(options_.start) + " is after the end of the recording at " +
                             secondsText(playback_.recorded().position());
  log::system(label_ + ": " + reason + ": its last values follow, and nothing is played");
  remark(reason);
}

void Player::remark(const std::string& remark) {
  const std::lock_guard lock(mutex_);
  remark_ = " (" + remark + ")";
}

bool Player::playRound(EventSink& sink) {
  bool played = false;
  while (std::optional<MetricEvent> event = stream_->next()) {
    if (stopping_) return false;
    const RecordedTime before = playback_.recorded();
    const std::optional<nanoseconds> moment = playback_.schedule(event->time);
    if (!moment) {
      before_.take(std::move(*event));
      continue;
    }
    if (!played && before.lastTime()) {
      moveTo(options_.start, saturatingSum(*before.lastTime(), options_.start - before.position()));
      deliverStateBefore(sink);
    }
    if (!std::exchange(begun_, true)) clock_->begin();
    if (!clock_->waitUntil(*moment)) return false;
    moveTo(playback_.recorded().position(), event->time);
    sink.deliver(std::move(*event));
    played = true;
  }
  return played;
}

void Player::run(EventSink& sink) {
  while (true) {
    const bool played = playRound(sink);
    if (stopping_) return;
    if (const std::optional<std::string> failure = stream_->failure()) {
      log::system(label_ + ": " + *failure);
      if (!playback_.recorded().lastTime()) remark(*failure);
    }
    if (!played || !options_.loop || !stream_->canRewind()) {
      end(sink, played);
      return;
    }
    stream_->rewind();
    playback_.restart();
  }
}

void Player::end(EventSink& sink, bool played) {
  const RecordedTime& recorded = playback_.recorded();
  if (!played && recorded.lastTime()) {
    explainStartBehindTheEnd();
    moveTo(recorded.position(), *recorded.lastTime());
    deliverStateBefore(sink);
  }
  if (kind_ != SourceKind::recorded) return;
  const std::lock_guard lock(mutex_);
  if (!position_) {
    position_.emplace();
    position_->speed = options_.speed;
  }
  position_->ended = true;
  if (stream_->canRewind()) length_ = recorded.position();
}

}  // namespace vespscope::sources
