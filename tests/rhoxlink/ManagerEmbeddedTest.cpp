// The client library with a manager inside the process.
#include <fstream>
#include <iterator>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "manager/embedded/EmbeddedManagers.h"
#include "platform/dispatch/SerialQueue.h"
#include "platform/log/Log.h"
#include "rhoxlink/Rhoxlink.h"
#include "support/Eventually.h"
#include "support/ScratchFile.h"
#include "support/SharedCaptures.h"
#include "support/WrittenLog.h"

namespace vespscope::test {
namespace {

using namespace rhox;
using namespace rhox::client;
using vespscope::ipc::Dictionary;
using vespscope::ipc::Object;

Dictionary shippedConfiguration() {
  std::ifstream file(VESPSCOPE_SOURCE_DIR "/resources/ice_test_lte.deviceconfig", std::ios::binary);
  const vespscope::Bytes contents{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  Dictionary request;
  request.set(kKeyAppID, Object(std::int64_t{2}));
  request.set(kKeyPayload, Object(contents));
  request.set(kKeyPayloadType, Object(std::int64_t{0}));
  return request;
}

class ManagerEmbeddedInTheProcess : public testing::Test {
 protected:
  ManagerEmbeddedInTheProcess() { setEmbeddedFactory(managers.factory()); }

  std::shared_ptr<Manager> connect(const std::string& words) {
    setAddress(*Address::parse("embedded:" + words));
    return CreateManager("test", queue);
  }

  // Plays `log` and expects `cells` reports of the serving cell, without a loss.
  void expectWhole(const std::string& log, const std::string& label, int cells) {
    std::atomic<int> servingCells = 0;
    const auto manager = connect("diag:" + log + ",speed=10000");
    RegisterEventHandler(manager, kEventMetric, [&](const Object& event, const DispatchGroup&) {
      if (*event.asDictionary()->find(kKeyMetricID)->asInt64() == 3948738) ++servingCells;
    });
    EventsOn(manager);
    Object reply;
    const client::Result result = PerformCommand(manager, kCommandAddConfiguration, shippedConfiguration(), reply);
    EXPECT_EQ(result.status, 0) << result.message;
    EXPECT_TRUE(eventually([&] { return servingCells >= cells; }));
    const ConnectionStatus status = connectionStatus(manager);
    EXPECT_TRUE(status.connected);
    EXPECT_EQ(status.sourceLabel, label);
    EXPECT_EQ(status.sourceKind, vespscope::SourceKind::recorded);
    EXPECT_EQ(status.eventsLost, 0U);
  }

  vespscope::manager::EmbeddedManagers managers;
  std::shared_ptr<vespscope::dispatch::SerialQueue> queue = std::make_shared<vespscope::dispatch::SerialQueue>("test");
};

TEST_F(ManagerEmbeddedInTheProcess, AWrittenModemLogArrivesWholeThroughTheProtocol) {
  const ScratchFile log("written.mi2log", writtenLog());
  expectWhole(log.path(), "written.mi2log", writtenLogCells);
}

TEST_F(ManagerEmbeddedInTheProcess, ARealModemLogArrivesWholeThroughTheProtocol) {
  const std::string log = sharedCapture("lte-ca-drive.mi2log");
  SKIP_WITHOUT_CAPTURE(log);
  expectWhole(log, "lte-ca-drive.mi2log", 2);
}

TEST_F(ManagerEmbeddedInTheProcess, ASourceThatCannotBeMadeIsReportedInTheStatusAndInCommands) {
  const auto manager = connect("replay:/no/such/file.pcap");
  EXPECT_FALSE(connectionStatus(manager).connected);
  EXPECT_THAT(connectionStatus(manager).problem, testing::HasSubstr("/no/such/file.pcap"));
  Object reply;
  const client::Result result = PerformCommand(manager, kCommandAddConfiguration, shippedConfiguration(), reply);
  EXPECT_EQ(result.status, kStatusNotConnected);
  EXPECT_THAT(result.message, testing::HasSubstr("/no/such/file.pcap"));
}

TEST_F(ManagerEmbeddedInTheProcess, AProgramWithoutAManagerOfItsOwnRefusesTheAddress) {
  setEmbeddedFactory(nullptr);
  const auto manager = connect("scenario");
  EXPECT_EQ(connectionStatus(manager).problem, "this program cannot run a baseband manager");
}

}  // namespace
}  // namespace vespscope::test
