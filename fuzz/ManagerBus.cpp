// The manager's side of the bus: whatever a client sends, the manager answers or disconnects it, and continues to
// deliver to others.
#include <memory>

#include "BusMessages.h"
#include "manager/ManagerCore.h"
#include "manager/PeerConnection.h"
#include "platform/log/Log.h"
#include "support/ScriptedSource.h"

using namespace vespscope;
using namespace vespscope::manager;
using fuzz::require;

namespace {

// Delivers an event, once a client has started the source.
void deliverOnce(const test::ScriptedSource::Control& source) {
  if (source.sink != nullptr) source.deliver(0x3C4E04, {0x10, 0x01});
}

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  log::discardOutputs();
  const auto source = std::make_shared<test::ScriptedSource::Control>();
  source->simCardFiles = MetricEvent{0x3C0013, 0, {0x08, 0x01}, {}};
  ManagerCore core(std::make_unique<test::ScriptedSource>(source), [] {});
  const fuzz::Connection socket;
  const auto connection = PeerConnection::open(core, socket.endOfOurs(), socket.endOfOurs());
  require(connection != nullptr, "no server's end");
  socket.send(fuzz::conversationOf(fuzz::Side::client, {data, size}));
  for (int round = 0; round < 8; ++round) {
    if (!connection->work()) break;
    deliverOnce(*source);
    socket.drain();
  }
  // Another client is served as before.
  const auto other = core.addPeer({});
  require(other.ok(), "one client takes all places");
  bool answered = false;
  core.performCommand(*other, std::string(rhox::kCommandStatus), {},
                      [&answered](const bus::Reply& reply) { answered = reply.status == 0; });
  require(answered, "the manager is gone");
  return 0;
}
