#include "sources/playback/Player.h"

#include <pthread.h>

#include <utility>

#include "platform/log/Log.h"

namespace vespscope::sources {
namespace {

using namespace std::chrono_literals;

constexpr auto searchPatience = 20ms;  // for SIM card files; a query that takes longer is answered later

}  // namespace

bool SteadyPlayerClock::waitUntil(std::chrono::nanoseconds moment) {
  std::unique_lock lock(mutex_);
  const auto until = begin_ + std::chrono::duration_cast<std::chrono::steady_clock::duration>(moment);
  const auto now = std::chrono::steady_clock::now();
  if (until - now > tolerance) {
    changed_.wait_until(lock, until, [this] { return interrupted_; });
  } else {
    begin_ += std::chrono::duration_cast<std::chrono::steady_clock::duration>(notMadeUpFor(now - until));
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
  search_->stop.request_stop();
  std::unique_lock lock(search_->mutex);
  search_->ended.wait(lock, [this] { return !search_->goesOn; });
}

void Player::findSimCardFiles(SimCardFilesHandler found) {
  std::unique_lock lock(search_->mutex);
  search_->waiting.push_back(std::move(found));
  // Waited for once, or many queries would hold their caller up for long.
  if (search_->goesOn) return;
  search_->goesOn = true;
  std::thread([shared = search_, &stream = *stream_] { search(*shared, stream); }).detach();
  search_->ended.wait_for(lock, searchPatience, [this] { return !search_->goesOn; });
}

void Player::search(Search& search, EventStream& stream) {
  ::pthread_setname_np(::pthread_self(), "simsearch");
  const std::stop_token stop = search.stop.get_token();
  const std::optional<MetricEvent> files = stream.simCardFiles(stop);
  std::unique_lock lock(search.mutex);
  while (!search.waiting.empty() && !stop.stop_requested()) {
    const std::vector<SimCardFilesHandler> waiting = std::exchange(search.waiting, {});
    lock.unlock();
    for (const SimCardFilesHandler& found : waiting) found(files);
    lock.lock();
  }
  search.goesOn = false;
  search.ended.notify_all();
}

bool Player::rewind() {
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
    std::optional<MetricEvent> event = stream_->next();
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

}  // namespace vespscope::sources
