// The client's side of the bus: whatever a manager sends, an event or a reply is read completely or counted as
// malformed.
#include <vector>

#include "BusMessages.h"
#include "platform/log/Log.h"
#include "rhoxlink/bus/Bus.h"

using namespace vespscope;
using fuzz::require;

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  log::discardOutputs();
  const fuzz::Connection connection;
  std::uint64_t events = 0;
  std::uint64_t textBytes = 0;
  auto end = bus::ClientEnd::overSocket(
      connection.endOfOurs(), [&](std::string_view kind, std::uint64_t, const ipc::Dictionary& event) {
        ++events;
        textBytes += kind.size();
        for (const auto key : {rhox::kKeyMetricID, rhox::kKeyPayload, rhox::kKeyProfileID}) {
          if (const ipc::Object* value = event.find(key); value != nullptr && value->asData() != nullptr) {
            textBytes += value->asData()->size();
          }
        }
      });
  require(end.ok(), "no client's end");
  std::vector<int> replies(3, 0);
  ipc::Dictionary request;
  request.set(rhox::kKeyAppID, ipc::Object(std::int64_t{2}));
  for (int& count : replies) {
    (*end)->performCommand("Status", request, std::chrono::seconds(60), [&count](const bus::Reply&) { ++count; });
  }
  (*end)->setEvents(true);
  const Bytes conversation = fuzz::conversationOf(fuzz::Side::server, {data, size});
  connection.send(conversation);
  for (int round = 0; round < 8; ++round) {
    if (!(*end)->process()) break;
    connection.drain();
  }
  for (const int count : replies) require(count <= 1, "one call is answered twice");
  require(textBytes <= conversation.size(), "an event holds more than was sent");
  return 0;
}
