#include "sources/modemmanager/ModemManagerSource.h"

#include <pthread.h>

#include <algorithm>
#include <utility>
#include <vector>

#include "platform/log/Log.h"
#include "rhoxlink/bus/Waiting.h"

namespace vespscope::sources::modemmanager {
namespace {

using Clock = Watcher::Clock;

std::chrono::nanoseconds wallClock() { return std::chrono::system_clock::now().time_since_epoch(); }

}  // namespace

ModemManagerSource::ModemManagerSource(Pace pace, std::chrono::milliseconds busRetry)
    : pace_(pace), busRetry_(busRetry) {}

ModemManagerSource::~ModemManagerSource() { stop(); }

std::string ModemManagerSource::label() const {
  const std::lock_guard lock(mutex_);
  return label_;
}

void ModemManagerSource::start(EventSink& sink) {
  thread_ = std::thread([this, &sink] { run(sink); });
  ::pthread_setname_np(thread_.native_handle(), "modemmanager");
}

void ModemManagerSource::stop() {
  stopping_ = true;
  wake_.wake();
  if (thread_.joinable()) thread_.join();
}

void ModemManagerSource::findSimCardFiles(SimCardFilesHandler found) {
  std::unique_lock lock(mutex_);
  std::optional<MetricEvent> files = reports_.simCardFiles(wallClock());
  lock.unlock();
  found(std::move(files));
}

void ModemManagerSource::run(EventSink& sink) {
  while (!stopping_) {
    work();
    publish(sink);
    waitForWork();
  }
  watcher_.reset();
}

void ModemManagerSource::work() {
  const Clock::time_point now = Clock::now();
  if (!watcher_ && now >= nextBus_) {
    Result<std::unique_ptr<bus::BusClient>> bus = bus::BusClient::openSystem();
    nextBus_ = now + busRetry_;
    if (bus) {
      watcher_ = std::make_unique<Watcher>(std::move(*bus), pace_);
    } else {
      problem_ = "ModemManager is unreachable (" + bus.reason() + ")";
    }
  }
  if (watcher_ && !watcher_->work(now)) {
    watcher_.reset();
    nextBus_ = now + busRetry_;
    problem_ = "ModemManager is unreachable (the system bus ended the connection)";
  }
}

// Delivers outside the lock: the manager requests the label and the SIM card's files while it holds locks of its own.
void ModemManagerSource::publish(EventSink& sink) {
  const ModemState state = watcher_ ? watcher_->state() : ModemState();
  const std::string label = watcher_ ? watcher_->situation() : problem_;
  std::vector<MetricEvent> events;
  {
    const std::lock_guard lock(mutex_);
    if (label != label_) log::system("modem: " + label);
    label_ = label;
    events = reports_.update(state, wallClock());
  }
  for (MetricEvent& event : events) sink.deliver(std::move(event));
}

void ModemManagerSource::waitForWork() {
  bus::Waiting waiting;
  waiting.add(wake_.descriptor(), POLLIN);
  if (watcher_) {
    waiting.add(watcher_->wait(Clock::now()));
  } else {
    waiting.until(nextBus_);
  }
  waiting.wait();
  wake_.clear();
}

}  // namespace vespscope::sources::modemmanager
