#include <algorithm>
#include <atomic>
#include <limits>
#include <memory>
#include <mutex>
#include <utility>

#include "capture/CaptureWriter.h"
#include "manager/embedded/EmbeddedManagers.h"
#include "platform/console/Console.h"
#include "platform/dispatch/MainLoop.h"
#include "platform/dispatch/SerialQueue.h"
#include "platform/dispatch/SignalWatch.h"
#include "registry/MetricRows.h"
#include "rhoxlink/MetricEvents.h"
#include "rhoxlink/Rhoxlink.h"
#include "sources/SourceInputs.h"
#include "sources/modemmanager/Probe.h"
#include "tools/vespctl/Commands.h"
#include "tools/vespctl/Progress.h"
#include "values/Text.h"

namespace vespscope::tools {
namespace {

using namespace std::chrono_literals;
using capture::CaptureWriter;
using rhox::client::ConnectionStatus;

// The viewer is application 2; a separate application keeps a recording from changing the viewer's configuration.
constexpr std::int64_t applicationNumber = 3;

// The query for the SIM card files, with the viewer's reference.
constexpr std::int64_t simCardFilesReference = 9999;
constexpr std::int64_t simCardFilesTrigger = 0x7F0013;

// A configuration that selects every event of every metric.
Bytes configuration() {
  std::string text = "[metrics]\n";
  for (const MetricRow& row : metricRows) text += std::string(row.identifierName) + " = { on = \"event\" }\n";
  return {text.begin(), text.end()};
}

ipc::Object integer(std::int64_t number) { return ipc::Object(number); }

class Recording {
 public:
  explicit Recording(Sim sim)
      : sim_(sim),
        queue_(std::make_shared<dispatch::SerialQueue>("org.vespscope.vespctl.record")),
        manager_(rhox::client::CreateManager("vespctl", queue_)) {
    rhox::client::RegisterEventObserver(
        manager_, rhox::kEventMetric,
        [this](const ipc::Object& event, const rhox::client::EventFacts& facts) { take(event, facts); });
  }
  Recording(const Recording&) = delete;
  Recording& operator=(const Recording&) = delete;
  ~Recording() { queue_->drain(); }

  // Requests every metric from the manager; like every function except `take`, runs on the main thread.
  Problem configure() {
    ipc::Dictionary request;
    request.set(rhox::kKeyAppID, integer(applicationNumber));
    request.set(rhox::kKeyPayload, ipc::Object(configuration()));
    request.set(rhox::kKeyPayloadType, integer(0));
    const rhox::client::Result added = perform(rhox::kCommandAddConfiguration, request);
    if (added.status != 0) return "baseband manager: " + added.message;
    // A manager that could not store the configuration reports it; the configuration is active nevertheless.
    if (!added.message.empty()) console::error("vespctl: " + added.message);
    return std::nullopt;
  }

  // Turns delivery on.
  void start(CaptureWriter writer) {
    {
      const std::lock_guard lock(mutex_);
      writer_.emplace(std::move(writer));
    }
    rhox::client::EventsOn(manager_);
  }

  // Some sources have no files.
  Problem askForSimCardFiles() {
    ipc::Dictionary request;
    request.set(rhox::kKeyAppID, integer(applicationNumber));
    request.set(rhox::kKeyPayloadType, integer(0));
    request.set(rhox::kKeyTriggerRef, integer(simCardFilesReference));
    request.set(rhox::kKeyTriggerType, integer(0));
    request.set(rhox::kKeyTriggerID, integer(simCardFilesTrigger));
    request.set(rhox::kKeyProfileID, integer(0));
    request.set(rhox::kKeyMetricID, integer(0));
    const rhox::client::Result asked = perform(rhox::kCommandQueryMetric, request);
    if (asked.status == 0) return std::nullopt;
    return asked.message;
  }

  // Stops delivery, writes the received events and gives the capture its name.
  Problem finish() {
    rhox::client::EventsOff(manager_);
    if (!othersRecord()) {
      ipc::Dictionary request;
      request.set(rhox::kKeyAppID, integer(applicationNumber));
      perform(rhox::kCommandClearConfiguration, request);
    }
    queue_->drain();
    const std::lock_guard lock(mutex_);
    if (!problem_) problem_ = writer_->finish();
    if (problem_) *problem_ += writer_->leavePartial();
    return problem_;
  }

  [[nodiscard]] ConnectionStatus status() const { return rhox::client::connectionStatus(manager_); }
  [[nodiscard]] std::uint64_t written() const { return written_; }
  [[nodiscard]] std::uint64_t skipped() const { return skipped_; }

 private:
  rhox::client::Result perform(std::string_view command, const ipc::Dictionary& request) {
    ipc::Object reply;
    return rhox::client::PerformCommand(manager_, command, request, reply);
  }

  // Whether another client of the manager uses the same configuration, which has to stay then.
  bool othersRecord() {
    ipc::Dictionary request;
    request.set(rhox::kKeyDetails, ipc::Object(true));
    ipc::Object reply;
    PerformCommand(manager_, rhox::kCommandStatus, request, reply);
    const ipc::Dictionary* values = reply.asDictionary();
    const ipc::Object* clients = values == nullptr ? nullptr : values->find(rhox::kKeyClients);
    if (clients == nullptr || clients->asArray() == nullptr) return false;
    const auto uses = [](const ipc::Object& client) {
      const ipc::Object* number =
          client.asDictionary() == nullptr ? nullptr : client.asDictionary()->find(rhox::kKeyAppID);
      return number != nullptr && number->asInt64() != nullptr && *number->asInt64() == applicationNumber;
    };
    // This one is among them.
    return std::count_if(clients->asArray()->begin(), clients->asArray()->end(), uses) > 1;
  }

  // Runs on the serial queue.
  void take(const ipc::Object& object, const rhox::client::EventFacts& facts) {
    // If a manager reports no times, events are stamped on arrival, and record() prints a warning.
    const std::optional<MetricEvent> event =
        rhox::client::metricEventOf(object, facts.time.value_or(std::chrono::system_clock::now().time_since_epoch()));
    if (!event) {
      ++skipped_;
      return;
    }
    if (sim_ && event->profileID != 0 && event->profileID != *sim_) return;
    const std::lock_guard lock(mutex_);
    if (problem_ || !writer_) return;
    problem_ = writer_->write(*event);
    if (problem_) {
      dispatch::MainLoop::main().async([] { dispatch::MainLoop::main().stop(0); });
    } else {
      ++written_;
    }
  }

  const Sim sim_;
  std::mutex mutex_;  // for the two members below
  std::optional<CaptureWriter> writer_;
  Problem problem_;
  std::atomic<std::uint64_t> written_ = 0;
  std::atomic<std::uint64_t> skipped_ = 0;
  std::shared_ptr<dispatch::SerialQueue> queue_;
  std::shared_ptr<rhox::client::Manager> manager_;
};

// Whether the address means a manager in this process whose source reads `output`.
bool readsOutput(const rhox::client::Address& address, const std::string& output) {
  if (address.kind != rhox::client::Address::Kind::embedded) return false;
  const auto spec = sources::SourceSpec::parse(address.detail);
  return spec && sources::readsOutput(*spec, output);
}

Result<rhox::client::Address> addressOf(const RecordingWish& wish) {
  return wish.address ? rhox::client::Address::parse(*wish.address) : rhox::client::address();
}

}  // namespace

Problem record(const RecordingWish& wish) {
  const Result<rhox::client::Address> address = addressOf(wish);
  if (!address) return address.reason();
  if (readsOutput(*address, wish.output)) return wish.output + ": is the source itself";
  manager::EmbeddedManagers embedded;
  if (address->kind == rhox::client::Address::Kind::embedded) {
    // Here a signal still ends the process at once, in case standard input blocks.
    if (Problem problem = embedded.open(address->detail)) return problem;
  }
  rhox::client::setAddress(*address);
  rhox::client::setEmbeddedFactory(embedded.factory());
  rhox::client::setModemProbe([] { return sources::modemmanager::modemManagerHasModem(); });
  dispatch::MainLoop& loop = dispatch::MainLoop::main();
  const dispatch::SignalWatch watch(loop, [&loop] { loop.stop(0); });
  Recording recording(wish.sim);
  if (Problem problem = recording.configure()) return problem;
  // Created only now, so that no file is left when there is no manager.
  Result<CaptureWriter> writer =
      CaptureWriter::createWhole(wish.output, capture::Flushing::eachPacket,
                                 wish.force ? CaptureWriter::Existing::replace : CaptureWriter::Existing::refuse);
  if (!writer) return writer.reason();
  recording.start(std::move(*writer));

  Progress progress;
  const ConnectionStatus status = recording.status();
  progress.say("recording " + status.sourceLabel + " (" + std::string(wordOf(status.sourceKind)) +
               "), until interrupted");
  if (status.protocol < rhox::kProtocolOfEventTimes) {
    progress.say("this manager does not report the times of events: each event gets the time of its arrival");
  }
  if (const Problem without = recording.askForSimCardFiles()) progress.say("no SIM card files: " + *without);
  loop.scheduleRepeating(1s, [&recording, &progress, problem = std::string()]() mutable {
    const ConnectionStatus now = recording.status();
    if (now.connected && now.notSubscribed != std::exchange(problem, now.notSubscribed) && !problem.empty()) {
      progress.say("no events: " + problem);
    }
    if (progress.due()) progress.show(std::to_string(recording.written()) + " events");
  });
  loop.run();

  Problem problem = recording.finish();
  progress.say(std::to_string(recording.written()) + " events");
  // Gaps in a recording are reported even if no progress is shown.
  const std::uint64_t lost = recording.status().eventsLost + recording.skipped();
  if (lost != 0) console::error("vespctl: " + std::to_string(lost) + " events were lost");
  return problem;
}

}  // namespace vespscope::tools
