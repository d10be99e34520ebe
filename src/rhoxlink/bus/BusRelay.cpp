#include "rhoxlink/bus/BusRelay.h"

#include <chrono>
#include <utility>
#include <vector>

#include "rhoxlink/bus/Waiting.h"

namespace vespscope::bus {
namespace {

using namespace std::chrono_literals;

constexpr int turn = 64;  // the manager's messages between two turns of the client

}  // namespace

Result<std::unique_ptr<BusRelay>> BusRelay::open(int input, int output) {
  std::unique_ptr<BusRelay> relay(new BusRelay);
  auto client = ServerEnd::overPipes(input, output, *relay);
  if (!client) return Failure{client.reason()};
  relay->client_ = std::move(*client);
  auto manager = ClientEnd::onSystemBus(
      [relay = relay.get()](std::string_view kind, std::uint64_t sequence, const ipc::Dictionary& event) {
        relay->client_->sendEvent(kind, sequence, event);
      });
  if (!manager) return Failure{manager.reason()};
  relay->manager_ = std::move(*manager);
  return relay;
}

std::string BusRelay::run() {
  while (true) {
    if (!client_->process()) return {};
    // Events that the client does not accept stay in its queue at the manager, where they are bounded and counted.
    if (client_->ready() && !manager_->process(turn)) {
      return manager_->ending().empty() ? "the system bus has closed the connection" : manager_->ending();
    }
    waitForWork();
  }
}

void BusRelay::performCommand(const std::string& command, const ipc::Dictionary& request, const Answer& answer) {
  // The client has its own timeout.
  if (!manager_->performCommand(command, request, 24h, [answer](const Reply& reply) { answer(reply); })) {
    answer({rhox::kStatusCannotEncode, "the request cannot be passed on: it is too large or nested too deep", {}});
  }
}

void BusRelay::waitForWork() const {
  Waiting waiting;
  waiting.add(client_->wait());
  if (client_->ready()) waiting.add(manager_->wait());
  waiting.wait();
}

}  // namespace vespscope::bus
