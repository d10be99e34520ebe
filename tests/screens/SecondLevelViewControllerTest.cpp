// The second-level screens: keys, rows, headers, and the refresh every five seconds.
#include <chrono>

#include <gtest/gtest.h>

#include "platform/dispatch/MainLoop.h"
#include "screens/ScreenSources.h"
#include "screens/Screens.h"

namespace vespscope::test {
namespace {

using application::readTable;

const Pairs waiting = {{"Waiting for Update", "Waiting for Update"}};
const Pairs comeBackLater = {{"Come back later", "Come back later"}};

TEST(SecondLevelViewController, FormsItsKeyWithExactlyOneBlank) {
  const auto screen = secondLevel("GSM", "Serving Cell Info");
  screen->myMetricValidator->myGSMScellInfoDict = Record{{"mcc", std::uint32_t{262}}};
  EXPECT_EQ(rowsOf(*screen), (Pairs{{"mcc", "262"}}));
  screen->firstSelection = "GSM ";
  EXPECT_EQ(rowsOf(*screen), comeBackLater);
}

TEST(SecondLevelViewController, ComparesItsKeyExactly) {
  EXPECT_EQ(rowsOf(*secondLevel("gsm", "Serving Cell Info")), comeBackLater);
  EXPECT_EQ(rowsOf(*secondLevel("GSM", "Serving Cell")), comeBackLater);
  EXPECT_EQ(rowsOf(*secondLevel("", "")), comeBackLater);
}

TEST(SecondLevelViewController, ShowsLabelsAndValuesInTheOrderOfTheRecord) {
  const auto screen = secondLevel("LTE", "NAS");
  screen->myMetricValidator->myLTEEMMContextDict =
      Record{{"zulu", -5}, {"alpha", 1.4F}, {"flag", true}, {"bytes", Bytes{0x13, 0x00, 0x14}}, {"text", "a\nb"}};
  EXPECT_EQ(rowsOf(*screen),
            (Pairs{{"zulu", "-5"}, {"alpha", "1.4"}, {"flag", "1"}, {"bytes", "<13 00 14>"}, {"text", "a\u240Ab"}}));
}

TEST(SecondLevelViewController, BeforeItsMetricASingleScreenHasNoRowsAndAListScreenWaits) {
  const auto single = secondLevel("LTE", "RRC State");
  EXPECT_EQ(single->numberOfSections(), 1U);
  EXPECT_EQ(single->numberOfRows(0), 0U);
  const auto list = secondLevel("LTE", "Tx Power");
  EXPECT_EQ(list->numberOfSections(), 1U);
  EXPECT_EQ(rowsOf(*list), waiting);
}

TEST(SecondLevelViewController, AListThatArrivedEmptyHasNoSections) {
  const auto screen = secondLevel("LTE", "Tx Power");
  screen->myMetricValidator->myLTE.TxPower.clear();
  EXPECT_EQ(screen->numberOfSections(), 0U);
  EXPECT_TRUE(readTable(*screen).sections.empty());
}

TEST(SecondLevelViewController, HasASectionForEachEntryNumberedFromOne) {
  const auto screen = secondLevel("GSM", "Active Bearers");
  screen->myMetricValidator->myCommon.activeBearer = {Record{{"cid", 1}}, Record{}, Record{{"cid", 3}, {"apn", "ims"}}};
  const auto table = readTable(*screen);
  ASSERT_EQ(table.sections.size(), 3U);
  EXPECT_EQ(table.sections[0].title, "PDP 1");
  EXPECT_EQ(table.sections[1].title, "PDP 2");
  EXPECT_TRUE(table.sections[1].rows.empty());
  EXPECT_EQ(table.sections[2].title, "PDP 3");
  EXPECT_EQ(rowsOf(*screen, 2), (Pairs{{"cid", "3"}, {"apn", "ims"}}));
}

TEST(SecondLevelViewController, TheRowNamedTwiceAfterGsmFindsNoBranch) {
  const auto screen = secondLevel("GSM", "GSM GPRS Config");
  screen->myMetricValidator->myGSMGPRSConfigDict = Record{{"rac", 7}};
  EXPECT_EQ(screen->numberOfSections(), 1U);
  EXPECT_EQ(rowsOf(*screen), comeBackLater);
  EXPECT_EQ(screen->titleForHeader(0), std::nullopt);
  screen->seguedThroughRow = "GPRS Config";
  EXPECT_EQ(rowsOf(*screen), (Pairs{{"rac", "7"}}));
}

TEST(SecondLevelViewController, ConnectedServCellMeasUnderGsmFindsNoBranch) {
  const auto screen = secondLevel("GSM", "Connected Serv Cell Meas");
  screen->myMetricValidator->myGSMConnRfMeasDict = Record{{"cs_rxlev_sub", 30}};
  EXPECT_EQ((*screen->firstSelection + " " + *screen->seguedThroughRow).size(), 28U);
  EXPECT_EQ(rowsOf(*screen), comeBackLater);
}

TEST(SecondLevelViewController, ConnectedServCellMeasIsKnownWithoutItsTechnology) {
  const auto screen = secondLevel("Connected", "Serv Cell Meas");
  screen->myMetricValidator->myGSMConnRfMeasDict = Record{{"cs_rxlev_sub", 30}};
  EXPECT_EQ((*screen->firstSelection + " " + *screen->seguedThroughRow).size(), 24U);
  EXPECT_EQ(rowsOf(*screen), (Pairs{{"cs_rxlev_sub", "30"}}));
}

TEST(SecondLevelViewController, DeviceIdentitiesFindNoBranch) {
  EXPECT_EQ(rowsOf(*secondLevel("Device Info", "IMSI")), comeBackLater);
  EXPECT_EQ(rowsOf(*secondLevel("Device Info", "IMEISV")), comeBackLater);
}

TEST(SecondLevelViewController, LteServingCellMeasShowsTheFirstEntryOnly) {
  const auto screen = secondLevel("LTE", "Serving Cell Meas");
  EXPECT_EQ(rowsOf(*screen), waiting);
  screen->myMetricValidator->myLTE.RsrpRsrqSinr = {Record{{"rsrp0", -9050}}, Record{{"rsrp0", -10000}}};
  EXPECT_EQ(screen->numberOfSections(), 1U);
  EXPECT_EQ(screen->titleForHeader(0), std::nullopt);
  EXPECT_EQ(rowsOf(*screen), (Pairs{{"rsrp0", "-9050"}}));
  screen->myMetricValidator->myLTE.RsrpRsrqSinr.clear();
  EXPECT_EQ(screen->numberOfSections(), 1U);
  EXPECT_EQ(screen->numberOfRows(0), 0U);
}

TEST(SecondLevelViewController, UmtsServingCellMeasShowsEachReceiver) {
  const auto screen = secondLevel("UMTS", "Serving Cell Meas");
  screen->myMetricValidator->myUMTS.rXInfo = {Record{{"rssi", -70}}, Record{{"rssi", -75}}};
  EXPECT_EQ(screen->numberOfSections(), 2U);
  EXPECT_EQ(screen->titleForHeader(1), "RxInfo 2");
  EXPECT_EQ(rowsOf(*screen, 1), (Pairs{{"rssi", "-75"}}));
}

TEST(SecondLevelViewController, TheLongNameOfUmtsServingCellMeasHasOneSection) {
  const auto screen = secondLevel("UMTS", "Serving Cell Measurement");
  screen->myMetricValidator->myUMTS.rXInfo = {Record{{"rssi", -70}}, Record{{"rssi", -75}}};
  EXPECT_EQ(screen->numberOfSections(), 1U);
  EXPECT_EQ(screen->titleForHeader(0), std::nullopt);
  EXPECT_EQ(rowsOf(*screen), (Pairs{{"rssi", "-70"}}));
}

TEST(SecondLevelViewController, ComponentCarriersAreKnownThoughNoRowLeadsThere) {
  const auto screen = secondLevel("LTE", "Component Carrier Info");
  EXPECT_EQ(screen->numberOfRows(0), 0U);
  screen->myMetricValidator->myLTECompCarrDict = Record{{"pcc_earfcn", 5780}};
  EXPECT_EQ(rowsOf(*screen), (Pairs{{"pcc_earfcn", "5780"}}));
}

TEST(SecondLevelViewController, CarrierAggregationHasSectionsWithoutHeaders) {
  const auto screen = secondLevel("LTE", "CA Status");
  screen->myMetricValidator->myLTE.CAStatusList = {Record{{"index", 1}}, Record{{"index", 2}}};
  EXPECT_EQ(screen->numberOfSections(), 2U);
  EXPECT_EQ(screen->titleForHeader(0), std::nullopt);
  EXPECT_EQ(rowsOf(*screen, 1), (Pairs{{"index", "2"}}));
}

TEST(SecondLevelViewController, SizesRowsToTheirText) {
  const auto screen = secondLevel("LTE", "NAS");
  EXPECT_EQ(screen->heightForRow({0, 0}), application::automaticDimension);
  EXPECT_EQ(screen->estimatedHeightForRow({0, 0}), application::automaticDimension);
}

TEST(SecondLevelViewController, RemembersTheCellItFilledLast) {
  const auto screen = secondLevel("LTE", "Tx Power");
  EXPECT_EQ(screen->currentCell, nullptr);
  const auto cell = screen->cellForRow({0, 0});
  EXPECT_EQ(cell->reuseIdentifier, "SecondClickView");
  EXPECT_EQ(screen->currentCell, cell);
}

TEST(SecondLevelViewController, IsCreatedWithTheSharedDecoderAndNoSelection) {
  useNoManager();
  const SecondLevelViewController screen;
  EXPECT_EQ(screen.myMetricValidator, MetricValidator::shared());
  EXPECT_EQ(screen.tableViewFields.launchViewItemNames, VespViewItems::shared().launchViewItemNames);
  EXPECT_FALSE(screen.firstSelection || screen.seguedThroughRow);
  EXPECT_EQ(screen.currentCell, nullptr);
}

TEST(SecondLevelViewController, WithoutASelectionEveryOperationIsAProgrammingError) {
  const auto screen = secondLevel("LTE", "NAS");
  const std::string message = "fatal: a second-level screen was shown without its selection";
  screen->seguedThroughRow.reset();
  EXPECT_DEATH((void)screen->numberOfSections(), message);
  EXPECT_DEATH((void)screen->titleForHeader(0), message);
  screen->seguedThroughRow = "NAS";
  screen->firstSelection.reset();
  EXPECT_DEATH((void)screen->numberOfRows(0), message);
  EXPECT_DEATH((void)screen->cellForRow({0, 0}), message);
}

TEST(SecondLevelViewController, AnIndexOutOfRangeIsAProgrammingError) {
  const auto list = secondLevel("LTE", "Tx Power");
  EXPECT_DEATH((void)list->numberOfRows(1), "fatal: \"LTE Tx Power\" has no section 1");
  EXPECT_DEATH((void)list->cellForRow({1, 0}), "fatal: \"LTE Tx Power\" has no section 1");
  EXPECT_DEATH((void)list->cellForRow({0, 1}), "fatal: \"LTE Tx Power\" has no row 1");
  const auto single = secondLevel("LTE", "NAS");
  EXPECT_DEATH((void)single->cellForRow({0, 0}), "fatal: \"LTE NAS\" has no row 0");
  EXPECT_DEATH((void)single->numberOfRows(1), "fatal: \"LTE NAS\" has no section 1");
}

void pass(std::chrono::milliseconds time) {
  auto& loop = dispatch::MainLoop::main();
  loop.advance(time);
  loop.runOnce(std::chrono::milliseconds(0));  // the timers, which queue their reloads
  loop.drain();
}

TEST(SecondLevelViewControllerRefresh, ReloadsEveryFiveSecondsOnceTheScreenHasLoaded) {
  const auto screen = secondLevel("LTE", "RRC State");
  pass(std::chrono::seconds(20));
  EXPECT_EQ(screen->tableView().reloadCount(), 0U);
  screen->loadViewIfNeeded();
  pass(std::chrono::milliseconds(4999));
  EXPECT_EQ(screen->tableView().reloadCount(), 0U);
  pass(std::chrono::milliseconds(1));
  EXPECT_EQ(screen->tableView().reloadCount(), 1U);
  pass(std::chrono::seconds(5));
  EXPECT_EQ(screen->tableView().reloadCount(), 2U);
}

TEST(SecondLevelViewControllerRefresh, IsQueuedAndNotDoneByTheTimerItself) {
  const auto screen = secondLevel("LTE", "RRC State");
  screen->update();
  EXPECT_EQ(screen->tableView().reloadCount(), 0U);
  dispatch::MainLoop::main().drain();
  EXPECT_EQ(screen->tableView().reloadCount(), 1U);
}

TEST(SecondLevelViewControllerRefresh, ShowsWhatArrivedSinceTheScreenWasOpened) {
  const auto screen = secondLevel("LTE", "RRC State");
  screen->loadViewIfNeeded();
  EXPECT_EQ(screen->numberOfRows(0), 0U);
  screen->myMetricValidator->myLTERRCStateDict = Record{{"state", "KLTE_RRC_STATE_CONNECTED"}};
  pass(std::chrono::seconds(5));
  EXPECT_EQ(screen->tableView().reloadCount(), 1U);
  EXPECT_EQ(rowsOf(*screen), (Pairs{{"state", "KLTE_RRC_STATE_CONNECTED"}}));
}

TEST(SecondLevelViewControllerRefresh, ContinuesAfterTheScreenWasLeftAndReEnteringStartsAnother) {
  auto screen = secondLevel("LTE", "RRC State");
  screen->loadViewIfNeeded();
  const std::weak_ptr<SecondLevelViewController> left = screen;
  screen.reset();
  ASSERT_FALSE(left.expired());
  const auto entered = secondLevel("LTE", "RRC State");
  entered->loadViewIfNeeded();
  EXPECT_EQ(dispatch::MainLoop::main().timerCount(), 2U);
  pass(std::chrono::seconds(5));
  pass(std::chrono::seconds(5));
  ASSERT_FALSE(left.expired());
  EXPECT_EQ(left.lock()->tableView().reloadCount(), 2U);
  EXPECT_EQ(entered->tableView().reloadCount(), 2U);
}

}  // namespace
}  // namespace vespscope::test
