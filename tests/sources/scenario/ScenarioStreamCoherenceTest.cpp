// The events of a drive are consistent, in each technology and between them.
#include <algorithm>
#include <cmath>
#include <optional>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include "messages/gsm/KCellularGsmGrrEventMeasCr.h"
#include "messages/gsm/KCellularGsmScellInfo.h"
#include "messages/lte/KCellularEmmContext.h"
#include "messages/lte/KCellularLteCarrierAggregationStatus.h"
#include "messages/lte/KCellularLteComponentCarrierInfo.h"
#include "messages/lte/KCellularLteNbrEutraCellMeas.h"
#include "messages/lte/KCellularLteRrcState.h"
#include "messages/lte/KCellularLteRsrpRsrqSinr.h"
#include "messages/lte/KCellularLteScellInfo.h"
#include "messages/lte/KCellularLteServingCellMeasurement.h"
#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "messages/umts/KCellularWcdmaCellInfo.h"
#include "messages/umts/KCellularWcdmaNbrCellMeas.h"
#include "messages/umts/KCellularWcdmaRrcConnectionState.h"
#include "sources/scenario/Drive.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;

using Transition = std::pair<std::int32_t, std::int32_t>;

std::string technologyOf(const MetricEvent& event) {
  const std::string_view name = metricName(event);
  if (name.starts_with("K_LTE_") && name != "K_LTE_EMM_CTXT") return "LTE";
  if (name.starts_with("K_UMTS_")) return "UMTS";
  if (name.starts_with("K_GSM_")) return "GSM";
  return "";
}

struct Visit {
  std::string technology;
  std::chrono::milliseconds from;
};

std::vector<Visit> visitsOf(const std::vector<MetricEvent>& events) {
  std::vector<Visit> visits;
  for (const MetricEvent& event : events) {
    const std::string technology = technologyOf(event);
    if (technology.empty() || (!visits.empty() && visits.back().technology == technology)) continue;
    visits.push_back({technology, sinceStart(event)});
  }
  return visits;
}

TEST(ScenarioStreamCoherenceOfDrive, TheFirstTourThroughAllTechnologiesEndsWithinTwoMinutes) {
  for (std::uint64_t seed = 1; seed <= 20; ++seed) {
    const std::vector<Visit> visits = visitsOf(driveOf(seed, 2min));
    std::vector<std::string> names;
    for (const Visit& visit : visits) names.push_back(visit.technology);
    ASSERT_EQ(names, (std::vector<std::string>{"LTE", "UMTS", "GSM", "UMTS", "LTE"})) << "seed " << seed;
  }
}

TEST(ScenarioStreamCoherenceOfDrive, LaterToursTakeMinutesAndNeverEnd) {
  const std::vector<Visit> visits = visitsOf(driveOf(8, 1h));
  std::vector<std::chrono::milliseconds> arrivals;  // in GSM, once per tour
  for (const Visit& visit : visits) {
    if (visit.technology == "GSM" && (arrivals.empty() || visit.from - arrivals.back() > 100s)) {
      arrivals.push_back(visit.from);
    }
  }
  ASSERT_GE(arrivals.size(), 6U);
  EXPECT_GT(arrivals.back(), 45min);
  for (std::size_t i = 2; i < arrivals.size(); ++i) EXPECT_GT(arrivals[i] - arrivals[i - 1], 150s);
  // From LTE the phone reaches GSM only through UMTS.
  for (std::size_t i = 1; i < visits.size(); ++i) {
    EXPECT_TRUE(visits[i].technology == "UMTS" || visits[i - 1].technology == "UMTS");
  }
}

TEST(ScenarioStreamCoherenceOfLte, RrcStatesFollowEachOtherAsTheyMay) {
  using State = LteRrcState;
  const std::set<Transition> legal = {
      {State::KLTE_RRC_STATE_NULL, State::KLTE_RRC_STATE_IDLE},
      {State::KLTE_RRC_STATE_NULL, State::KLTE_RRC_STATE_ATMPT_INBND_MOBILITY},
      {State::KLTE_RRC_STATE_IDLE, State::KLTE_RRC_STATE_NULL},
      {State::KLTE_RRC_STATE_IDLE, State::KLTE_RRC_STATE_ATMPT_CONNECTION},
      {State::KLTE_RRC_STATE_ATMPT_CONNECTION, State::KLTE_RRC_STATE_CONNECTED},
      {State::KLTE_RRC_STATE_ATMPT_CONNECTION, State::KLTE_RRC_STATE_IDLE},
      {State::KLTE_RRC_STATE_CONNECTED, State::KLTE_RRC_STATE_ENDING},
      {State::KLTE_RRC_STATE_CONNECTED, State::KLTE_RRC_STATE_ATMPT_CONNECTION},  // re-establishment
      {State::KLTE_RRC_STATE_CONNECTED, State::KLTE_RRC_STATE_ATMPT_OUTBND_MOBILITY},
      {State::KLTE_RRC_STATE_ENDING, State::KLTE_RRC_STATE_IDLE},
      {State::KLTE_RRC_STATE_ATMPT_OUTBND_MOBILITY, State::KLTE_RRC_STATE_NULL},
      {State::KLTE_RRC_STATE_ATMPT_INBND_MOBILITY, State::KLTE_RRC_STATE_CONNECTED},
  };
  std::set<Transition> seen;
  for (const std::uint64_t seed : {2U, 5U}) {
    std::int32_t state = State::KLTE_RRC_STATE_NULL;
    std::chrono::milliseconds since = 0ms;
    for (const MetricEvent& event : driveOf(seed, 45min)) {
      if (metricName(event) != "K_LTE_RRC_STATE") continue;
      const auto change = as<KCellularLteRrcState>(event);
      EXPECT_EQ(change->prevState(), state);
      EXPECT_NEAR(change->prevStateDurMs(), static_cast<double>((sinceStart(event) - since).count()), 10);
      EXPECT_TRUE(legal.contains({state, change->state()})) << state << " to " << change->state();
      seen.insert({state, change->state()});
      state = change->state();
      since = sinceStart(event);
    }
  }
  EXPECT_EQ(seen.size(), legal.size()) << "some way of changing the state never occurred";
}

TEST(ScenarioStreamCoherenceOfUmts, RrcStatesFollowEachOtherAsTheyMay) {
  using State = KCellularWcdmaRrcConnectionState::State;
  const std::set<Transition> legal = {
      {State::KWCDMA_RRC_CONN_STATE_INACTIVE, State::KWCDMA_RRC_CONN_STATE_IDLE},
      {State::KWCDMA_RRC_CONN_STATE_INACTIVE, State::KWCDMA_RRC_CONN_STATE_CELL_DCH},
      {State::KWCDMA_RRC_CONN_STATE_IDLE, State::KWCDMA_RRC_CONN_STATE_ESTABLISH},
      {State::KWCDMA_RRC_CONN_STATE_IDLE, State::KWCDMA_RRC_CONN_STATE_INACTIVE},
      {State::KWCDMA_RRC_CONN_STATE_ESTABLISH, State::KWCDMA_RRC_CONN_STATE_CELL_DCH},
      {State::KWCDMA_RRC_CONN_STATE_ESTABLISH, State::KWCDMA_RRC_CONN_STATE_IDLE},
      {State::KWCDMA_RRC_CONN_STATE_CELL_DCH, State::KWCDMA_RRC_CONN_STATE_CELL_FACH},
      {State::KWCDMA_RRC_CONN_STATE_CELL_DCH, State::KWCDMA_RRC_CONN_STATE_RELEASE},
      {State::KWCDMA_RRC_CONN_STATE_CELL_DCH, State::KWCDMA_RRC_CONN_STATE_INACTIVE},
      {State::KWCDMA_RRC_CONN_STATE_CELL_FACH, State::KWCDMA_RRC_CONN_STATE_CELL_DCH},
      {State::KWCDMA_RRC_CONN_STATE_CELL_FACH, State::KWCDMA_RRC_CONN_STATE_URA_PCH},
      {State::KWCDMA_RRC_CONN_STATE_CELL_FACH, State::KWCDMA_RRC_CONN_STATE_CELL_PCH},
      {State::KWCDMA_RRC_CONN_STATE_CELL_FACH, State::KWCDMA_RRC_CONN_STATE_RELEASE},
      {State::KWCDMA_RRC_CONN_STATE_CELL_FACH, State::KWCDMA_RRC_CONN_STATE_INACTIVE},
      {State::KWCDMA_RRC_CONN_STATE_URA_PCH, State::KWCDMA_RRC_CONN_STATE_CELL_FACH},
      {State::KWCDMA_RRC_CONN_STATE_URA_PCH, State::KWCDMA_RRC_CONN_STATE_RELEASE},
      {State::KWCDMA_RRC_CONN_STATE_URA_PCH, State::KWCDMA_RRC_CONN_STATE_INACTIVE},
      {State::KWCDMA_RRC_CONN_STATE_CELL_PCH, State::KWCDMA_RRC_CONN_STATE_CELL_FACH},
      {State::KWCDMA_RRC_CONN_STATE_CELL_PCH, State::KWCDMA_RRC_CONN_STATE_RELEASE},
      {State::KWCDMA_RRC_CONN_STATE_CELL_PCH, State::KWCDMA_RRC_CONN_STATE_INACTIVE},
      {State::KWCDMA_RRC_CONN_STATE_RELEASE, State::KWCDMA_RRC_CONN_STATE_IDLE},
      {State::KWCDMA_RRC_CONN_STATE_RELEASE, State::KWCDMA_RRC_CONN_STATE_INACTIVE},
  };
  std::set<std::int32_t> states;
  for (const std::uint64_t seed : {2U, 4U}) {
    std::int32_t state = State::KWCDMA_RRC_CONN_STATE_INACTIVE;
    for (const MetricEvent& event : driveOf(seed, 45min)) {
      if (metricName(event) != "K_UMTS_RRC_STATE") continue;
      const auto change = as<KCellularWcdmaRrcConnectionState>(event);
      EXPECT_TRUE(legal.contains({state, change->state()})) << state << " to " << change->state();
      if (change->state() == State::KWCDMA_RRC_CONN_STATE_RELEASE) {
        EXPECT_TRUE(change->hasReleaseCause());
      }
      if (change->state() == State::KWCDMA_RRC_CONN_STATE_ESTABLISH) {
        EXPECT_TRUE(change->hasEstablishmentCause());
      }
      state = change->state();
      states.insert(state);
    }
  }
  EXPECT_EQ(states.size(), 8U);
}

// A new cell in LTE was reported as a neighbour before, unless the phone searched again in between.
TEST(ScenarioStreamCoherenceOfLte, CellsChangeBetweenNeighboursOnly) {
  using Carrier = std::pair<std::uint32_t, std::uint32_t>;  // EARFCN, PCI
  int changes = 0;
  for (const std::uint64_t seed : {1U, 2U}) {
    std::set<Carrier> neighbours;
    std::optional<Carrier> serving;
    bool searched = true;
    for (const MetricEvent& event : driveOf(seed, 30min)) {
      if (metricName(event) == "K_LTE_RRC_STATE") {
        const auto change = as<KCellularLteRrcState>(event);
        const bool again = change->state() == LteRrcState::KLTE_RRC_STATE_CONNECTED &&
                           change->cause() >= KCellularLteRrcState::Cause::KLTE_RRC_CAUSE_REEST_RECFG_FAIL;
        searched = searched || again || change->prevState() == LteRrcState::KLTE_RRC_STATE_NULL;
      } else if (metricName(event) == "K_LTE_INTRARAT_MEAS") {
        neighbours.clear();
        const auto report = as<KCellularLteNbrEutraCellMeas>(event);
        for (std::size_t i = 0; i < report->measNbrEutrasCount(); ++i) {
          const auto& cell = *report->measNbrEutraAtIndex(i);
          neighbours.insert({cell.nbrEarfcn(), cell.nbrPhysCellId()});
          EXPECT_NE(std::optional(Carrier(cell.nbrEarfcn(), cell.nbrPhysCellId())), serving);
        }
        searched = false;
      } else if (metricName(event) == "K_LTE_SCELL_INFO") {
        const auto cell = as<KCellularLteScellInfo>(event);
        const Carrier carrier{cell->dlFreq(), cell->phyCellId()};
        if (!searched && carrier != serving) {
          ++changes;
          EXPECT_TRUE(neighbours.contains(carrier)) << "seed " << seed << " at " << sinceStart(event).count() << " ms";
        }
        serving = carrier;
      }
    }
  }
  EXPECT_GT(changes, 80);
}

TEST(ScenarioStreamCoherenceOfUmts, CellsChangeBetweenNeighboursOnly) {
  std::vector<std::set<std::uint32_t>> lists;  // scrambling codes, of the reports since the arrival in UMTS
  int changes = 0;
  for (const MetricEvent& event : driveOf(2, 30min)) {
    if (technologyOf(event) != "UMTS" && !technologyOf(event).empty()) lists.clear();
    if (metricName(event) == "K_UMTS_NCELL_MEAS") {
      const auto report = as<KCellularWcdmaNbrCellMeas>(event);
      lists.emplace_back();
      for (std::size_t i = 0; i < report->measUtraResultsCount(); ++i) {
        lists.back().insert(report->measUtraResultAtIndex(i)->psc());
      }
    } else if (metricName(event) == "K_UMTS_SCELL_INFO" && !lists.empty()) {
      const std::uint32_t code = as<KCellularWcdmaCellInfo>(event)->psc();
      const auto first = lists.size() > 2 ? lists.end() - 2 : lists.begin();
      EXPECT_TRUE(std::any_of(first, lists.end(), [&](const auto& list) { return list.contains(code); }));
      ++changes;
    }
  }
  EXPECT_GT(changes, 10);
}

TEST(ScenarioStreamCoherenceOfGsm, CellsChangeBetweenNeighboursOnly) {
  std::vector<std::set<std::uint32_t>> lists;  // cell identities
  std::optional<std::uint32_t> serving;
  int changes = 0;
  for (const std::uint64_t seed : {2U, 3U}) {
    for (const MetricEvent& event : driveOf(seed, 30min)) {
      if (technologyOf(event) != "GSM" && !technologyOf(event).empty()) lists.clear();
      if (metricName(event) == "K_GSM_NCELL_MEAS") {
        const auto report = as<KCellularGsmGrrEventMeasCr>(event);
        lists.emplace_back();
        for (std::size_t i = 0; i < report->gsmNcellMeasCount(); ++i) {
          lists.back().insert(report->gsmNcellMeasAtIndex(i)->ci());
        }
      } else if (metricName(event) == "K_GSM_SCELL_INFO") {
        const std::uint32_t identity = as<KCellularGsmScellInfo>(event)->cellId();
        if (!lists.empty() && serving != identity) {
          const auto first = lists.size() > 2 ? lists.end() - 2 : lists.begin();
          EXPECT_TRUE(std::any_of(first, lists.end(), [&](const auto& list) { return list.contains(identity); }));
          ++changes;
        }
        serving = identity;
      }
    }
  }
  EXPECT_GT(changes, 3);
}

// All reports about the serving cell at one moment come from one measurement.
TEST(ScenarioStreamCoherenceOfLte, TheServingCellsLevelIsTheSameInEveryReportOfAMoment) {
  std::optional<MetricEvent> measurement;
  std::optional<std::uint32_t> serving;
  int compared = 0;
  for (const MetricEvent& event : driveOf(4, 15min)) {
    if (metricName(event) == "K_LTE_SCELL_INFO") serving = as<KCellularLteScellInfo>(event)->phyCellId();
    if (metricName(event) == "K_LTE_SCELL_MEAS") measurement = event;
    if (metricName(event) != "K_LTE_RSRP_RSRQ_SINR") continue;
    ASSERT_TRUE(measurement && event.time - measurement->time < 2ms);
    const auto antennas = as<KCellularLteServingCellMeasurement>(*measurement);
    const auto levels = as<KCellularLteRsrpRsrqSinr>(event);
    ASSERT_GE(levels->instValuesCount(), 1U);
    ASSERT_EQ(antennas->rxInfosCount(), 2U);
    const RsrpRsrqSinr& first = *levels->instValuesAtIndex(0);
    EXPECT_EQ(first.phyCellId(), serving);
    EXPECT_EQ(levels->avgValues()->phyCellId(), serving);
    const int rsrp[] = {first.rsrp0(), first.rsrp1()};
    const int rsrq[] = {first.rsrq0(), first.rsrq1()};
    const int sinr[] = {first.sinr0(), first.sinr1()};
    for (std::size_t i = 0; i < 2; ++i) {
      const RxInfo& rx = *antennas->rxInfoAtIndex(i);
      EXPECT_NEAR(rsrp[i], static_cast<int>(rx.rsrpRange()) - 140, 1);
      if (rx.rsrqRange() > 0) {
        EXPECT_NEAR(rsrq[i], rx.rsrqRange() * 0.5 - 19.5, 0.8);
      }
      EXPECT_NEAR(sinr[i] * 0.5, rx.snr(), 0.8);
    }
    ++compared;
  }
  EXPECT_GT(compared, 1000);
}

TEST(ScenarioStreamCoherenceOfLte, LevelsOfAServingCellGiveItsCarriersResourceBlocks) {
  std::uint32_t halfMegahertz = 0;
  std::vector<double> ratios;  // to the number of resource blocks
  for (const MetricEvent& event : driveOf(5, 30min)) {
    if (const auto cell = as<KCellularLteScellInfo>(event)) halfMegahertz = cell->dlBw();
    const auto report = as<KCellularLteServingCellMeasurement>(event);
    for (std::size_t i = 0; report && i < report->rxInfosCount(); ++i) {
      const RxInfo& rx = *report->rxInfoAtIndex(i);
      if (rx.rsrpRange() == 0 || rx.rsrqRange() == 0) continue;  // "or below"
      const double decibel = rx.rsrqRange() * 0.5 - 19.5 - (static_cast<double>(rx.rsrpRange()) - 140) + rx.rssi();
      ratios.push_back(std::pow(10, decibel / 10) / (halfMegahertz * 2.5));
    }
  }
  ASSERT_GT(ratios.size(), 3000U);
  std::sort(ratios.begin(), ratios.end());
  EXPECT_NEAR(ratios[ratios.size() / 2], 1, 0.02);
  // Whole and half decibels are reported: 0.5 + 0.25 + 0.5 dB at worst.
  EXPECT_GT(ratios.front(), std::pow(10, -0.126));
  EXPECT_LT(ratios.back(), std::pow(10, 0.126));
}

TEST(ScenarioStreamCoherenceOfCarrierAggregation, SecondaryCarriersAgreeWithWhatElseIsSaidOfThem) {
  int measured = 0;
  int activated = 0;
  std::shared_ptr<KCellularLteComponentCarrierInfo> carriers;
  std::shared_ptr<KCellularLteCarrierAggregationStatus> status;
  std::chrono::nanoseconds statusTime{0};
  for (const MetricEvent& event : driveOf(6, 30min)) {
    if (metricName(event) == "K_LTE_COMPCARR_INFO") carriers = as<KCellularLteComponentCarrierInfo>(event);
    if (metricName(event) == "K_LTE_CA_STATUS") {
      status = as<KCellularLteCarrierAggregationStatus>(event);
      statusTime = event.time;
      for (std::size_t i = 0; i < status->sccListsCount(); ++i) {
        const SecondaryComponentCarrier& scc = *status->sccListAtIndex(i);
        if (scc.state() == SecondaryComponentCarrier::State::SCC_STATE_DECONFIGURED) {
          EXPECT_FALSE(scc.hasRsrp());
          continue;
        }
        EXPECT_EQ(scc.dlEarfcn(), scc.index() == 0 ? carriers->scc0Earfcn() : carriers->scc1Earfcn());
        EXPECT_NE(scc.dlEarfcn(), carriers->pccEarfcn());
        const double blocks = std::pow(10, (scc.rsrq() - scc.rsrp() + scc.rssi()) / 1000.0);
        EXPECT_NEAR(blocks, scc.dlBandwidth() == 5 ? 100 : 50, 0.5);
        ++measured;
      }
    }
    if (metricName(event) != "K_LTE_RSRP_RSRQ_SINR" || event.time - statusTime > 3ms) continue;
    const auto levels = as<KCellularLteRsrpRsrqSinr>(event);
    std::size_t position = 1;
    for (std::size_t i = 0; i < status->sccListsCount(); ++i) {
      const SecondaryComponentCarrier& scc = *status->sccListAtIndex(i);
      if (scc.state() != SecondaryComponentCarrier::State::SCC_STATE_ACTIVATED) continue;
      ASSERT_LT(position, levels->instValuesCount());
      const RsrpRsrqSinr& values = *levels->instValuesAtIndex(position++);
      EXPECT_EQ(values.phyCellId(), scc.pci());
      EXPECT_NEAR(std::max(values.rsrp0(), values.rsrp1()), scc.rsrp() / 100.0, 0.51);
      ++activated;
    }
    EXPECT_EQ(position, levels->instValuesCount());
  }
  EXPECT_GT(measured, 300);
  EXPECT_GT(activated, 200);
}

TEST(ScenarioStreamCoherenceOfNas, RegistrationsAndBearersFollowTheCell) {
  std::string technology;
  std::uint32_t trackingArea = 0;
  int updates = 0;
  std::set<std::uint32_t> areas;
  for (const MetricEvent& event : driveOf(7, 1h)) {
    if (!technologyOf(event).empty()) technology = technologyOf(event);
    if (metricName(event) == "K_LTE_SCELL_INFO") trackingArea = as<KCellularLteScellInfo>(event)->trackingAreaCode();
    if (metricName(event) == "K_LTE_EMM_CTXT") {
      const auto context = as<KCellularEmmContext>(event);
      if (context->regStatus() != RegStatus::KREG_STATUS_NORMAL_SERVICE) continue;
      ++updates;
      areas.insert(trackingArea);
      ASSERT_EQ(context->taiListsCount(), 1U);
      EXPECT_EQ(context->taiListAtIndex(0)->tac(), trackingArea);
      EXPECT_EQ(*context->taiListAtIndex(0)->encodedPlmn(), (Bytes{0x00, 0xF1, 0x10}));
    }
    if (metricName(event) == "K_CELLULAR_ACTIVE_BEARER") {
      const auto bearers = as<KCellularActivatedBearerContexts>(event);
      EXPECT_EQ(bearers->bearerContextCount(), bearers->bearerContextsCount());
      ASSERT_GE(bearers->bearerContextsCount(), 1U);
      EXPECT_EQ(*bearers->bearerContextsAtIndex(0)->apn(), "internet");
      EXPECT_EQ(bearers->bearerContextsAtIndex(0)->pdpAddr()->size(), 20U) << "both address families";
      EXPECT_EQ(bearers->bearerContextsCount(), technology == "LTE" ? 2U : 1U) << "voice over packets in LTE alone";
    }
  }
  EXPECT_GT(updates, 10);
  EXPECT_EQ(areas.size(), 4U) << "one lap of the ring crosses every area";
}

}  // namespace
}  // namespace vespscope::test
