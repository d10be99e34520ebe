// A manager's core with a scripted source and clients without sockets, for tests of its parts.
#pragma once

#include <atomic>
#include <chrono>
#include <cstdint>
#include <filesystem>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "LoggedLines.h"
#include "manager/CommandStatus.h"
#include "manager/ManagerCore.h"
#include "platform/log/Log.h"
#include "support/Eventually.h"
#include "support/ScriptedSource.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {

using namespace std::chrono_literals;
using bus::Reply;
using ipc::Dictionary;
using ipc::Object;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

inline constexpr std::int32_t rrcState = 3952132;
inline constexpr std::int32_t txPower = 3986178;
inline constexpr std::int32_t simCardFiles = 3932179;

inline const std::string everyChange =
    "[metrics]\nK_LTE_RRC_STATE = { on = \"change\" }\nK_LTE_TX_POWER = { on = \"change\" }\n";
inline const std::string rrcStateOnly = "[metrics]\nK_LTE_RRC_STATE = { on = \"change\" }\n";

inline Object integer(std::int64_t number) { return Object(number); }

inline Dictionary addRequest(const std::string& toml, std::int64_t application = 2) {
  Dictionary request;
  request.set(rhox::kKeyAppID, integer(application));
  request.set(rhox::kKeyPayload, Object(Bytes(toml.begin(), toml.end())));
  request.set(rhox::kKeyPayloadType, integer(0));
  return request;
}

inline Dictionary applicationRequest(std::int64_t application = 2) {
  Dictionary request;
  request.set(rhox::kKeyAppID, integer(application));
  return request;
}

inline Dictionary detailsRequest() {
  Dictionary request;
  request.set(rhox::kKeyDetails, Object(true));
  return request;
}

inline Dictionary queryRequest() {
  Dictionary request;
  request.set(rhox::kKeyAppID, integer(2));
  request.set(rhox::kKeyPayloadType, integer(0));
  request.set(rhox::kKeyTriggerRef, integer(9999));
  request.set(rhox::kKeyTriggerType, integer(0));
  request.set(rhox::kKeyTriggerID, integer(8323091));
  request.set(rhox::kKeyProfileID, integer(0));
  request.set(rhox::kKeyMetricID, integer(0));
  return request;
}

// Stores the events in memory, and reports a status that the test sets.
class NotingRecorder final : public manager::EventRecorder {
 public:
  struct Notes {
    std::vector<std::int32_t> metrics;
    manager::RecordingStatus status;
  };
  explicit NotingRecorder(std::shared_ptr<Notes> notes) : notes_(std::move(notes)) {}
  void record(manager::SharedEvent event) override { notes_->metrics.push_back(event->metricID); }
  [[nodiscard]] manager::RecordingStatus status() const override { return notes_->status; }

 private:
  std::shared_ptr<Notes> notes_;
};

class CoreTesting : public testing::Test {
 protected:
  using Peer = manager::ManagerCore::PeerIdentifier;

  CoreTesting() {
    log::discardOutputs();
    restart();
  }

  // Replaces the manager by a new one.
  void restart(std::optional<manager::ConfigurationStore> store = std::nullopt) {
    core.reset();
    core = std::make_unique<manager::ManagerCore>(
        std::make_unique<ScriptedSource>(control), [this] { ++wakes; }, std::move(store));
  }
  // The same, with configurations stored in `folder`.
  void restartWithStore() { restart(manager::ConfigurationStore(folder.path())); }

  // Adds a client of the administrator.
  Peer addPeer() { return *core->addPeer({}); }

  // Returns the answer, which may have to wait for the disk.
  Reply ask(Peer peer, std::string_view command, const Dictionary& request) {
    std::optional<Reply> reply;
    core->performCommand(peer, std::string(command), request, [&reply](const Reply& given) { reply = given; });
    EXPECT_TRUE(eventually([&] {
      core->sendAnswers();
      return reply.has_value();
    }));
    return reply.value_or(Reply{-1, "no answer", {}});
  }
  Reply add(Peer peer, const std::string& toml, std::int64_t application = 2) {
    return ask(peer, rhox::kCommandAddConfiguration, addRequest(toml, application));
  }
  bool isConfigured(std::int64_t application) {
    const Reply reply = ask(addPeer(), rhox::kCommandStatus, applicationRequest(application));
    return ipc::toValue(*reply.values.find(rhox::kKeyConfigured)) == Value(true);
  }

  // A client that listens for application 2 with the given configuration.
  Peer listener(const std::string& toml, std::int64_t application = 2) {
    const Peer peer = addPeer();
    EXPECT_EQ(add(peer, toml, application).status, 0);
    core->setEvents(peer, true);
    return peer;
  }

  std::vector<std::int32_t> taken(Peer peer) {
    std::vector<std::int32_t> metrics;
    while (const auto next = core->take(peer)) metrics.push_back(next->event->metricID);
    return metrics;
  }

  const TemporaryFolder folder;
  const std::shared_ptr<ScriptedSource::Control> control = std::make_shared<ScriptedSource::Control>();
  std::atomic<int> wakes = 0;
  std::unique_ptr<manager::ManagerCore> core;
};

}  // namespace vespscope::test
