// Secondary carriers: configured by messages, activated by measurements, released by messages and with the connection.
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "sources/diag/CarrierTracker.h"
#include "sources/diag/DecodedMetrics.h"

namespace vespscope::test {
namespace {

using rrc::lte::Reconfiguration;
using rrc::lte::SecondaryCell;
using sources::diag::CellName;
using sources::diag::EventList;
using sources::diag::ServingMeasurement;
using sources::diag::ServingMeasurementRecord;
using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

constexpr CellName primary{5780, 185};
constexpr CellName secondary{700, 210};

SecondaryCell addition(std::uint8_t index, const CellName& cell) {
  SecondaryCell added;
  added.index = index;
  added.physicalCell = cell.pci;
  added.downlinkCarrier = cell.earfcn;
  added.bandwidth = 50;
  return added;
}

Reconfiguration adding(std::uint8_t index, const CellName& cell) {
  Reconfiguration change;
  change.addedCells = {addition(index, cell)};
  return change;
}

Reconfiguration releasing(std::uint8_t index) {
  Reconfiguration change;
  change.releasedCells = {index};
  return change;
}

class CarrierTrackerTest : public testing::Test {
 protected:
  // At a time in milliseconds.
  template <class Action>
  std::vector<std::string> at(std::int64_t time, Action action) {
    EventList out(0, std::chrono::milliseconds(time));
    tracker_.expire(out);
    action(out);
    return textsOf(out.take());
  }
  std::vector<std::string> change(const Reconfiguration& change, std::int64_t time) {
    return at(time, [&](EventList& out) { tracker_.take(change, out); });
  }
  std::vector<std::string> measure(std::uint8_t index, const CellName& cell, std::int64_t time) {
    ServingMeasurement measured;
    measured.cell = cell;
    measured.cellIndex = index;
    measured.serving = true;
    measured.combined = {.rsrp = -90, .rsrq = -10, .rssi = -60, .snr = {}};
    return at(time, [&](EventList& out) { tracker_.take(ServingMeasurementRecord{{measured}, {}}, out); });
  }
  std::vector<std::string> serve(const CellName& cell, std::optional<std::uint8_t> blocks, std::int64_t time) {
    return at(time, [&](EventList& out) { tracker_.serve(cell, blocks, out); });
  }
  std::vector<std::string> pass(std::int64_t time) {
    return at(time, [](EventList&) {});
  }

  sources::diag::CarrierTracker tracker_;
};

const std::string carrier = "[index: 1, state: SCC_STATE_";
const std::string described = ", pci: 210, dl_earfcn: 700, dl_rf_band: 2, dl_bandwidth: 3, has_uplink: 0";

TEST_F(CarrierTrackerTest, AnAddedCellIsConfiguredThenActivatedByItsMeasurementAndReleasedByAMessage) {
  EXPECT_THAT(serve(primary, 100, 1000), ElementsAre("KCellularLteComponentCarrierInfo[timestamp: 1000, pcc_earfcn: "
                                                     "5780, pcc_bandwidth: 20]"));
  EXPECT_THAT(change(adding(1, secondary), 1100),
              ElementsAre("KCellularLteComponentCarrierInfo[timestamp: 1100, pcc_earfcn: 5780, scc0_earfcn: 700, "
                          "pcc_bandwidth: 20, scc0_bandwidth: 10]",
                          "KCellularLteCarrierAggregationStatus[timestamp: 1100, scc_list: [" + carrier +
                              "CONFIGURED_DEACTIVATED" + described + "]]]"));
  EXPECT_THAT(measure(1, secondary, 1200),
              ElementsAre("KCellularLteCarrierAggregationStatus[timestamp: 1200, scc_list: [" + carrier + "ACTIVATED" +
                          described + ", rsrp: -9000, rsrq: -1000, rssi: -6000]]]"));
  EXPECT_THAT(pass(4201), ElementsAre(HasSubstr(carrier + "CONFIGURED_DEACTIVATED" + described + "]")));
  EXPECT_THAT(pass(9000), IsEmpty());
  EXPECT_THAT(change(releasing(1), 9100),
              ElementsAre("KCellularLteComponentCarrierInfo[timestamp: 9100, pcc_earfcn: 5780, pcc_bandwidth: 20]",
                          HasSubstr(carrier + "DECONFIGURED" + described + "]")));
  EXPECT_THAT(change(releasing(1), 9200), IsEmpty());
}

TEST_F(CarrierTrackerTest, AMeasurementThatComesAfterTheReleaseActivatesNothing) {
  serve(primary, 100, 1000);
  measure(1, secondary, 1050);
  EXPECT_THAT(change(releasing(1), 1100), Contains(HasSubstr("SCC_STATE_DECONFIGURED")));
  EXPECT_THAT(measure(1, secondary, 1110), IsEmpty());
  EXPECT_THAT(measure(1, {2000, 7}, 1120), Contains(HasSubstr("SCC_STATE_ACTIVATED"))) << "another cell";
  EXPECT_THAT(measure(1, secondary, 1250), Contains(HasSubstr("SCC_STATE_ACTIVATED")));
}

TEST_F(CarrierTrackerTest, AnotherCellUnderTheIndexReplacesTheOneConfigured) {
  change(adding(1, secondary), 1000);
  EXPECT_THAT(measure(1, {2000, 7}, 1100),
              Contains("KCellularLteCarrierAggregationStatus[timestamp: 1100, scc_list: [[index: 1, state: "
                       "SCC_STATE_ACTIVATED, pci: 7, dl_earfcn: 2000, dl_rf_band: 4, rsrp: -9000, rsrq: -1000, rssi: "
                       "-6000]]]"));
}

TEST_F(CarrierTrackerTest, AFullConfigurationReplacesAllCells) {
  change(adding(1, secondary), 1000);
  Reconfiguration full = adding(2, {2000, 7});
  full.fullConfiguration = true;
  EXPECT_THAT(change(full, 1100),
              ElementsAre(HasSubstr("scc_list: [[index: 2, state: SCC_STATE_CONFIGURED_DEACTIVATED, "
                                    "pci: 7, dl_earfcn: 2000, dl_rf_band: 4, dl_bandwidth: 3, "
                                    "has_uplink: 0], [index: 1, state: SCC_STATE_DECONFIGURED")));
}

TEST_F(CarrierTrackerTest, TheEndOfTheConnectionDeconfiguresAllCellsOnce) {
  change(adding(1, secondary), 1000);
  const auto end = [this](EventList& out) { tracker_.endConnection(out); };
  EXPECT_THAT(at(1100, end), ElementsAre(HasSubstr("SCC_STATE_DECONFIGURED")));
  EXPECT_THAT(at(1200, end), IsEmpty());
}

TEST_F(CarrierTrackerTest, AnUplinkThatIsConfiguredIsReportedWithItsCarrier) {
  Reconfiguration change = adding(1, secondary);
  change.addedCells[0].uplink = true;
  EXPECT_THAT(this->change(change, 1000),
              ElementsAre(HasSubstr("has_uplink: 1, ul_earfcn: 18700, ul_rf_band: 2, ul_bandwidth: 3")));
}

TEST_F(CarrierTrackerTest, APrimaryOfUnknownBandwidthIsReportedOnlyInPlaceOfAnother) {
  EXPECT_THAT(serve(primary, {}, 1000), IsEmpty());
  EXPECT_THAT(serve(primary, 50, 1100), ElementsAre(HasSubstr("pcc_earfcn: 5780, pcc_bandwidth: 10")));
  EXPECT_THAT(serve(secondary, {}, 1200), ElementsAre(HasSubstr("pcc_earfcn: 700]")));
}

}  // namespace
}  // namespace vespscope::test
