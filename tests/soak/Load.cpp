#include "soak/Load.h"

#include <chrono>
#include <string>
#include <thread>
#include <utility>

#include "sources/scenario/ScenarioStream.h"

namespace vespscope::test {

using namespace std::chrono_literals;

class Load::FromLoad final : public sources::Source {
 public:
  explicit FromLoad(Load& load) : load_(load) {}
  ~FromLoad() override { stop(); }

  [[nodiscard]] std::string label() const override { return "soak"; }
  [[nodiscard]] SourceKind kind() const override { return SourceKind::simulated; }
  void findSimCardFiles(sources::SimCardFilesHandler found) override { found(std::nullopt); }

  void start(sources::EventSink& sink) override {
    thread_ = std::thread([this, &sink] { run(sink); });
  }

  void stop() override {
    {
      const std::lock_guard lock(load_.mutex_);
      stopping_ = true;
    }
    load_.changed_.notify_all();
    if (thread_.joinable()) thread_.join();
  }

 private:
  void run(sources::EventSink& sink) {
    std::unique_lock lock(load_.mutex_);
    while (true) {
      load_.changed_.wait(lock, [this] { return stopping_ || load_.mayGoOn(); });
      if (stopping_ || load_.sent_ >= load_.total_) return;
      std::optional<MetricEvent> event = load_.stream_->next();
      if (!event) return;
      load_.delivering_ = true;
      lock.unlock();
      sink.deliver(std::move(*event));
      lock.lock();
      ++load_.sent_;
      load_.delivering_ = false;
      if (load_.paused_) load_.changed_.notify_all();
    }
  }

  Load& load_;
  bool stopping_ = false;  // guarded by the load's mutex
  std::thread thread_;
};

// 2023-11-14 22:13:20 UTC.
Load::Load(std::uint64_t seed, std::uint64_t total)
    : total_(total), stream_(sources::makeScenarioStream(seed, 1'700'000'000s)) {}

std::unique_ptr<sources::Source> Load::makeSource() { return std::make_unique<FromLoad>(*this); }

void Load::pause() {
  std::unique_lock lock(mutex_);
  paused_ = true;
  changed_.wait(lock, [this] { return !delivering_; });
}

void Load::resume() {
  {
    const std::lock_guard lock(mutex_);
    paused_ = false;
  }
  changed_.notify_all();
}

void Load::setPaced(bool paced) {
  {
    const std::lock_guard lock(mutex_);
    paced_ = paced;
  }
  changed_.notify_all();
}

void Load::setTaken(std::uint64_t taken) {
  {
    const std::lock_guard lock(mutex_);
    taken_ = taken;
  }
  changed_.notify_all();
}

std::uint64_t Load::sent() const {
  const std::lock_guard lock(mutex_);
  return sent_;
}

}  // namespace vespscope::test
