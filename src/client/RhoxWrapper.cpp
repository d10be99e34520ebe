#include "client/RhoxWrapper.h"

#include <array>
#include <cstdio>
#include <memory>
#include <mutex>
#include <utility>

#include "platform/dispatch/MainLoop.h"
#include "platform/dispatch/SerialQueue.h"
#include "platform/log/Log.h"
#include "rhoxlink/Rhoxlink.h"
#include "values/Text.h"

namespace vespscope {
namespace {

constexpr std::string_view applicationIdentifier = "vespscope";
constexpr std::int64_t applicationNumber = 2;
constexpr const char* queueLabel = "org.vespscope.VespMode.serialQ.queue";
constexpr std::int32_t statusBeforeAnswer = -534716414;  // 0xE020E002
constexpr std::string_view triggerLine = "-[RhoxWrapper listen]_block_invoke: EventTrigger dict=";
constexpr std::string_view metricLine = "-[RhoxWrapper listen]_block_invoke: MetricsTrigger dict=";

ipc::Object integer(std::int64_t number) { return ipc::Object(number); }

// Returns the file's contents, empty if it cannot be read.
Bytes contentsOf(const std::string& path) {
  struct Closer {
    void operator()(std::FILE* file) const { std::fclose(file); }
  };
  const std::unique_ptr<std::FILE, Closer> file(std::fopen(path.c_str(), "rbe"));
  Bytes contents;
  if (!file) return contents;
  std::array<std::uint8_t, 4096> piece{};
  std::size_t size = 0;
  do {
    size = std::fread(piece.data(), 1, piece.size(), file.get());
    contents.insert(contents.end(), piece.begin(), piece.begin() + static_cast<std::ptrdiff_t>(size));
  } while (size == piece.size());
  return std::ferror(file.get()) == 0 ? contents : Bytes();
}

bool perform(const std::shared_ptr<rhox::client::Manager>& manager, std::string_view command,
             const ipc::Dictionary& request, std::string_view operation) {
  rhox::client::Result result{statusBeforeAnswer, ""};
  ipc::Object reply;
  result = rhox::client::PerformCommand(manager, command, request, reply);
  log::system(std::string(operation) + ": error=" + std::to_string(result.status) + " msg=" + result.message);
  return result.status == 0;
}

using Delivery = void (RhoxWrapperDelegate::*)(std::shared_ptr<const Record>);
using Event = std::shared_ptr<const Record>;

// Runs on the serial queue, as does `forward`.
Event logged(const ipc::Object& event, std::string_view lineStart) {
  const ipc::Dictionary* dictionary = event.asDictionary();
  auto record = std::make_shared<const Record>(dictionary == nullptr ? Record() : ipc::toRecord(*dictionary));
  std::string line(lineStart);
  appendText(line, *record);
  log::system(line);
  return record;
}

// Passes the event to the delegate on the main queue.
void forward(const Event& record, Delivery deliver, const std::shared_ptr<DelegateSlot>& slot) {
  if (!slot->load()) return;
  dispatch::MainLoop::main().async([slot, record, deliver] {
    if (const auto delegate = slot->load()) ((*delegate).*deliver)(record);
  });
}

std::shared_ptr<MetricGate>& sharedGate() {
  static std::shared_ptr<MetricGate> gate;
  return gate;
}

}  // namespace

void RhoxWrapper::setMetricGate(std::shared_ptr<MetricGate> gate) { sharedGate() = std::move(gate); }

std::shared_ptr<RhoxWrapper> RhoxWrapper::sharedInstance() {
  static std::shared_ptr<RhoxWrapper> shared;
  if (!shared) shared = std::make_shared<RhoxWrapper>();
  return shared;
}

RhoxWrapper::RhoxWrapper() : delegate_(std::make_shared<DelegateSlot>()) {
  const std::string name(applicationIdentifier);
  rhoxManager_ = rhox::client::CreateManager(name, queue());
}

RhoxWrapper::~RhoxWrapper() = default;

std::shared_ptr<dispatch::SerialQueue> RhoxWrapper::queue() {
  static std::once_flag once;
  std::call_once(once, [this] { queue_ = std::make_shared<dispatch::SerialQueue>(queueLabel); });
  return queue_;
}

bool RhoxWrapper::addOrblConfigForAppId(std::string_view appId, const std::string& protofFilePath) {
  if (appId != applicationIdentifier) return false;
  const ipc::Object payload(contentsOf(protofFilePath));
  if (payload.type() == ipc::Type::null) return false;
  ipc::Dictionary request;
  request.set(rhox::kKeyAppID, integer(applicationNumber));
  request.set(rhox::kKeyPayload, payload);
  request.set(rhox::kKeyPayloadType, integer(0));
  return perform(rhoxManager_, rhox::kCommandAddConfiguration, request,
                 "-[RhoxWrapper addOrblConfigForAppId:andProtofFilePath:]");
}

bool RhoxWrapper::removeOrblConfigForAppid(std::string_view appId) {
  if (appId != applicationIdentifier) return false;
  ipc::Dictionary request;
  request.set(rhox::kKeyAppID, integer(applicationNumber));
  return perform(rhoxManager_, rhox::kCommandClearConfiguration, request, "-[RhoxWrapper removeOrblConfigForAppid:]");
}

bool RhoxWrapper::querySpecificMetric(std::string_view appId, std::int32_t triggerRef, std::int32_t triggerType,
                                      std::int32_t triggerID, std::int32_t profileID, std::int32_t metricID) {
  if (appId != applicationIdentifier) return false;
  ipc::Dictionary request;
  request.set(rhox::kKeyAppID, integer(applicationNumber));
  request.set(rhox::kKeyPayloadType, integer(0));
  request.set(rhox::kKeyTriggerRef, integer(triggerRef));
  request.set(rhox::kKeyTriggerType, integer(triggerType));
  request.set(rhox::kKeyTriggerID, integer(triggerID));
  request.set(rhox::kKeyProfileID, integer(profileID));
  request.set(rhox::kKeyMetricID, integer(metricID));
  return perform(rhoxManager_, rhox::kCommandQueryMetric, request,
                 "-[RhoxWrapper querySpecificMetric:triggerRef:triggerType:triggerID:profileID:metricID:]");
}

void RhoxWrapper::listen() {
  rhox::client::RegisterEventHandler(rhoxManager_, rhox::kEventTrigger,
                                     [slot = delegate_](const ipc::Object& event, const rhox::client::DispatchGroup&) {
                                       forward(logged(event, triggerLine), &RhoxWrapperDelegate::eventsDidUpdate, slot);
                                     });
  const MetricGate::Pass pass = [slot = delegate_](const Event& event) {
    forward(event, &RhoxWrapperDelegate::metricsDidUpdate, slot);
  };
  rhox::client::RegisterEventHandler(
      rhoxManager_, rhox::kEventMetric,
      [pass, gate = sharedGate()](const ipc::Object& event, const rhox::client::DispatchGroup&) {
        Event record = logged(event, metricLine);
        gate ? gate->take(std::move(record), pass) : pass(std::move(record));
      });
  rhox::client::EventsOff(rhoxManager_);
  rhox::client::EventsOn(rhoxManager_);
  log::system("-[RhoxWrapper listen]: listening for events");
}

std::shared_ptr<RhoxWrapperDelegate> RhoxWrapper::delegate() const { return delegate_->load(); }

void RhoxWrapper::setDelegate(const std::shared_ptr<RhoxWrapperDelegate>& delegate) { delegate_->store(delegate); }

}  // namespace vespscope
