#include "sources/playback/SimCardSearch.h"

#include <pthread.h>

#include <chrono>
#include <optional>
#include <thread>
#include <utility>

namespace vespscope::sources {
namespace {

// If the search takes no longer than this, a query is answered before find() returns.
constexpr std::chrono::milliseconds patience{20};

}  // namespace

void SimCardSearch::find(SimCardFilesHandler found) {
  std::unique_lock lock(shared_->mutex);
  shared_->waiting.push_back(std::move(found));
  // Only the first query waits for the search, to limit the caller's delay.
  if (shared_->running) return;
  shared_->running = true;
  std::thread([shared = shared_, &stream = stream_] { run(*shared, stream); }).detach();
  shared_->ended.wait_for(lock, patience, [this] { return !shared_->running; });
}

void SimCardSearch::stop() {
  shared_->stop.request_stop();
  std::unique_lock lock(shared_->mutex);
  shared_->ended.wait(lock, [this] { return !shared_->running; });
}

void SimCardSearch::run(Shared& shared, EventStream& stream) {
  ::pthread_setname_np(::pthread_self(), "simsearch");
  const std::stop_token stop = shared.stop.get_token();
  const std::optional<MetricEvent> files = stream.simCardFiles(stop);
  std::unique_lock lock(shared.mutex);
  while (!shared.waiting.empty() && !stop.stop_requested()) {
    const std::vector<SimCardFilesHandler> waiting = std::exchange(shared.waiting, {});
    lock.unlock();
    for (const SimCardFilesHandler& found : waiting) found(files);
    lock.lock();
  }
  shared.running = false;
  shared.ended.notify_all();
}

}  // namespace vespscope::sources
