// Recordings of real modems: levels, cells and states compared with independently known facts.
#include <algorithm>
#include <array>
#include <cmath>
#include <fstream>
#include <map>
#include <utility>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "radio/Channel.h"
#include "rrc/lte/CellInformation.h"
#include "sources/diag/DecodedMetrics.h"
#include "sources/diag/DiagStream.h"
#include "sources/diag/LogRecord.h"
#include "sources/diag/LteRecords.h"
#include "sources/diag/NasRecords.h"
#include "sources/diag/NrRecords.h"
#include "sources/diag/WcdmaRecords.h"
#include "support/SharedCaptures.h"

namespace vespscope::test {
namespace {

using namespace sources;
using namespace sources::diag;

constexpr std::array<const char*, 6> captures = {"lte-ca-drive.mi2log",   "lte-four-antennas.mi2log",
                                                 "lte-mobility.mi2log",   "nsa-dual-sim-1.mi2log",
                                                 "nsa-dual-sim-2.mi2log", "umts-attach.mi2log"};

// Calls `visit` with every log record of the file.
template <class Visit>
FrameCounters forEachRecord(const std::string& path, Visit visit) {
  std::ifstream file(path, std::ios::binary);
  const Bytes content{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  FrameReader reader;
  reader.feed(content);
  while (const auto frame = reader.next()) {
    const auto parsed = logRecordOf(*frame);
    EXPECT_TRUE(std::holds_alternative<LogRecord>(parsed));
    if (const auto* record = std::get_if<LogRecord>(&parsed)) visit(*record);
  }
  reader.finish();
  return reader.counters();
}

// RSRQ is RSRP over RSSI, times the resource blocks of the carrier (3GPP TS 36.214 5.1.3).
double blocksOf(const AntennaLevels& levels) { return std::pow(10, (levels.rsrq - levels.rsrp + levels.rssi) / 10); }

double quantile(std::vector<double> values, double part) {
  std::sort(values.begin(), values.end());
  return values.at(static_cast<std::size_t>(part * static_cast<double>(values.size() - 1)));
}

void expectFiftyBlocks(const std::vector<double>& blocks) {
  EXPECT_NEAR(quantile(blocks, 0.5), 50, 50 * 0.02);
  EXPECT_NEAR(quantile(blocks, 0.01), 50, 50 * 0.05);
  EXPECT_NEAR(quantile(blocks, 0.99), 50, 50 * 0.05);
}

TEST(DiagStreamRealLog, LevelsOfTheDriveGiveTheCarriersBandwidth) {
  const std::string path = sharedCapture("lte-ca-drive.mi2log");
  SKIP_WITHOUT_CAPTURE(path);
  std::map<std::uint8_t, std::vector<double>> combined;
  std::array<std::vector<double>, 2> antennas;
  const auto counters = forEachRecord(path, [&](const LogRecord& record) {
    if (record.code != servingMeasurementCode) return;
    const auto decoded = std::get<ServingMeasurementRecord>(servingMeasurementOf(record.payload));
    ASSERT_EQ(decoded.cells.size(), 1U);
    EXPECT_TRUE(decoded.unread.empty());
    const ServingMeasurement& cell = decoded.cells[0];
    EXPECT_TRUE(cell.serving);
    EXPECT_EQ(cell.cell, (cell.cellIndex == 0 ? CellName{5780, 185} : CellName{700, 185}));
    EXPECT_EQ(cell.combined.rsrp, std::max(cell.antennas.at(0)->rsrp, cell.antennas.at(1)->rsrp));
    EXPECT_EQ(cell.combined.rssi, std::max(cell.antennas.at(0)->rssi, cell.antennas.at(1)->rssi));
    EXPECT_EQ(cell.combined.rsrq, std::max(cell.antennas.at(0)->rsrq, cell.antennas.at(1)->rsrq));
    combined[cell.cellIndex].push_back(blocksOf(cell.combined));
    if (cell.cellIndex == 0) {
      for (std::size_t antenna = 0; antenna < 2; ++antenna) {
        antennas[antenna].push_back(blocksOf(cell.antennas.at(antenna).value()));
      }
    }
  });
  EXPECT_EQ(counters, (FrameCounters{.good = 1808}));
  EXPECT_EQ(combined[0].size(), 975U);
  EXPECT_EQ(combined[1].size(), 116U);
  expectFiftyBlocks(antennas[0]);
  expectFiftyBlocks(antennas[1]);
}

TEST(DiagStreamRealLog, EachAntennaOfFourGivesTheCarriersBandwidth) {
  const std::string path = sharedCapture("lte-four-antennas.mi2log");
  SKIP_WITHOUT_CAPTURE(path);
  constexpr double floor = -30;  // dB, the lowest RSRQ that the record can hold
  int compared = 0;
  int absent = 0;
  forEachRecord(path, [&](const LogRecord& record) {
    if (record.code != servingMeasurementCode) return;
    const auto decoded = std::get<ServingMeasurementRecord>(servingMeasurementOf(record.payload));
    ASSERT_EQ(decoded.cells.size(), 1U);
    const ServingMeasurement& cell = decoded.cells[0];
    EXPECT_TRUE(radio::Earfcn::fromNumber(cell.cell.earfcn, radio::Direction::downlink)) << cell.cell.earfcn;
    for (const auto& antenna : cell.antennas) {
      if (!antenna) {
        ++absent;
      } else if (antenna->rsrq > floor) {
        ++compared;
        EXPECT_NEAR(blocksOf(*antenna), 50, 50 * 0.04);
      }
    }
  });
  // 145 records have two antennas in their mask, 91 have one.
  EXPECT_EQ(compared, 381);
  EXPECT_EQ(absent, 4 * 236 - 381);
}

TEST(DiagStreamRealLog, EveryNrMessageFitsItsRecord) {
  int messages = 0;
  for (const char* name : {"nsa-dual-sim-1.mi2log", "nsa-dual-sim-2.mi2log"}) {
    const std::string path = sharedCapture(name);
    SKIP_WITHOUT_CAPTURE(path);
    forEachRecord(path, [&](const LogRecord& record) {
      if (record.code != nrRrcMessageCode) return;
      ++messages;
      const auto decoded = nrRrcMessageOf(record.payload);
      ASSERT_TRUE(std::holds_alternative<NrRrcMessageRecord>(decoded));
      EXPECT_NE(std::get<NrRrcMessageRecord>(decoded).content, NrRrcContent::other);
      EXPECT_EQ(std::get<NrRrcMessageRecord>(decoded).nrArfcn, 504'990U);
    });
  }
  EXPECT_EQ(messages, 227 + 188);
}

// Adds the state unless it confirms the one before.
void addChange(std::vector<std::string>& states, const std::string& state) {
  if (states.empty() || states.back() != state) states.push_back(state);
}

std::unique_ptr<EventStream> opened(const std::string& path) {
  auto stream = openDiagStream(path);
  EXPECT_TRUE(stream) << stream.reason();
  return std::move(*stream);
}

std::int64_t numberIn(const Record& record, std::string_view key) {
  const Value* value = record.find(key);
  EXPECT_NE(value, nullptr) << key;
  return value == nullptr ? 0 : value->asInteger().value();
}

void expectRange(const Record& record, std::string_view key, std::int64_t lowest, std::int64_t highest) {
  const Value* value = record.find(key);
  if (value == nullptr) return;
  EXPECT_GE(value->asInteger().value(), lowest) << key;
  EXPECT_LE(value->asInteger().value(), highest) << key;
}

// The ranges of 3GPP TS 36.133 9.1 for every level in `record`, in any message.
void expectLegal(std::int32_t metricID, const Record& record) {
  for (const auto& [key, value] : record) {
    if (const List* list = value.asList()) {
      for (const Value& element : *list) {
        if (const Record* inner = element.asRecord()) expectLegal(metricID, *inner);
      }
    }
  }
  for (const char* key : {"phy_cell_id", "nbr_phys_cell_id", "pci"}) expectRange(record, key, 0, 503);
  for (const char* key : {"rsrp0", "rsrp1"}) expectRange(record, key, -156, -44);
  for (const char* key : {"rsrq0", "rsrq1"}) expectRange(record, key, -34, 3);
  for (const char* key : {"sinr0", "sinr1"}) expectRange(record, key, -46, 80);
  expectRange(record, "nbr_rsrp", -16, 97);
  expectRange(record, "nbr_rsrq", -30, 46);
  // Steps of half a MHz for a cell; a code for a neighbouring frequency.
  const bool code = metricID == metricIdentifier("K_LTE_SEL_RESEL_INFO");
  expectRange(record, "dl_bw", code ? 0 : 3, code ? 5 : 40);
  expectRange(record, "rsrp", -15'600, -4'400);
  expectRange(record, "rsrq", -3'400, 250);
  expectRange(record, "snr", -23, 40);
}

TEST(DiagStreamRealLog, TheDriveShowsItsCarriersAndItsConnection) {
  const std::string path = sharedCapture("lte-ca-drive.mi2log");
  SKIP_WITHOUT_CAPTURE(path);
  const auto stream = opened(path);
  std::map<std::int32_t, int> counts;
  std::map<std::int32_t, Record> latest;
  std::vector<std::string> states;
  int aggregated = 0;
  std::chrono::nanoseconds time{0};
  while (const auto event = stream->next()) {
    const Record record = recordOf(*event);
    EXPECT_GE(event->time, time);
    time = event->time;
    EXPECT_EQ(numberIn(record, "timestamp"), time / std::chrono::milliseconds(1));
    expectLegal(event->metricID, record);
    if (event->metricID == metricIdentifier("K_LTE_SCELL_INFO")) {
      EXPECT_EQ(numberIn(record, "dl_freq"), 5780);
      EXPECT_EQ(numberIn(record, "phy_cell_id"), 185);
    }
    if (event->metricID == metricIdentifier("K_LTE_RSRP_RSRQ_SINR")) {
      aggregated += record.find("inst_values")->asList()->size() == 2 ? 1 : 0;
    }
    if (event->metricID == metricIdentifier("K_LTE_RRC_STATE")) addChange(states, *record.find("state")->asText());
    ++counts[event->metricID];
    latest[event->metricID] = record;
  }
  EXPECT_EQ(counts,
            (std::map<std::int32_t, int>{{metricIdentifier("K_LTE_SCELL_INFO"), 4},
                                         {metricIdentifier("K_LTE_RRC_STATE"), 7 + 2},  // two confirm the state before
                                         {metricIdentifier("K_LTE_EMM_CTXT"), 5 + 1},
                                         {metricIdentifier("K_LTE_RSRP_RSRQ_SINR"), 975},
                                         {metricIdentifier("K_LTE_CDRX_CONFIG"), 3},
                                         {metricIdentifier("K_LTE_COMPCARR_INFO"), 4},
                                         {metricIdentifier("K_LTE_INTRARAT_MEAS"), 223 + 224},
                                         {metricIdentifier("K_LTE_CA_STATUS"), 116}}));
  // The measurements of the secondary until a message releases it; one more is logged 5 ms later and activates nothing.
  EXPECT_EQ(aggregated, 114);
  const Record& cell = latest[metricIdentifier("K_LTE_SCELL_INFO")];
  EXPECT_EQ(numberIn(cell, "ul_freq"), 23780);
  EXPECT_EQ(numberIn(cell, "freq_band_ind"), 17);
  EXPECT_EQ(numberIn(cell, "dl_bw"), 20);
  const Record& carrier = *latest[metricIdentifier("K_LTE_CA_STATUS")].find("scc_list")->asList()->at(0).asRecord();
  EXPECT_EQ(numberIn(carrier, "dl_earfcn"), 700);
  EXPECT_EQ(numberIn(carrier, "pci"), 185);
  EXPECT_EQ(numberIn(carrier, "dl_rf_band"), 2);
  EXPECT_EQ(*carrier.find("state")->asText(), "SCC_STATE_DECONFIGURED");
  EXPECT_THAT(states,
              testing::ElementsAre("KLTE_RRC_STATE_CONNECTED", "KLTE_RRC_STATE_IDLE", "KLTE_RRC_STATE_ATMPT_CONNECTION",
                                   "KLTE_RRC_STATE_CONNECTED", "KLTE_RRC_STATE_IDLE", "KLTE_RRC_STATE_ATMPT_CONNECTION",
                                   "KLTE_RRC_STATE_CONNECTED"));
}

TEST(DiagStreamRealLog, EachCellOfTheMobilityLogIsInTheBandThatTheModemReports) {
  const std::string path = sharedCapture("lte-mobility.mi2log");
  SKIP_WITHOUT_CAPTURE(path);
  int cells = 0;
  const auto counters = forEachRecord(path, [&](const LogRecord& record) {
    if (record.code != servingCellCode) return;
    ++cells;
    const auto cell = std::get<ServingCellRecord>(servingCellOf(record.payload));
    const auto channel = radio::Earfcn::fromNumber(cell.cell.earfcn, radio::Direction::downlink);
    ASSERT_TRUE(channel);
    EXPECT_EQ(channel->band(), cell.band);
    // The default uplink carrier of an FDD downlink carrier (3GPP TS 36.101 5.7.4).
    EXPECT_EQ(cell.uplinkEarfcn, cell.cell.earfcn + 18'000);
    EXPECT_EQ(cell.downlinkBlocks, cell.uplinkBlocks);
    EXPECT_THAT(cell.downlinkBlocks, testing::AnyOf(25, 50, 100));
    ASSERT_TRUE(cell.plmn);
    EXPECT_EQ(cell.plmn->mcc(), 310);
    EXPECT_EQ(cell.plmn->mncDigits(), 3);
  });
  EXPECT_EQ(cells, 310);
  EXPECT_EQ(counters, (FrameCounters{.good = 8183}));
}

TEST(DiagStreamRealLog, TheMobilityLogShowsHandoversAndTheirCauses) {
  const std::string path = sharedCapture("lte-mobility.mi2log");
  SKIP_WITHOUT_CAPTURE(path);
  const auto stream = opened(path);
  int described = 0;
  int named = 0;
  std::map<std::string, int> causes;
  std::string before;
  while (const auto event = stream->next()) {
    const Record record = recordOf(*event);
    expectLegal(event->metricID, record);
    if (event->metricID == metricIdentifier("K_LTE_SCELL_INFO")) {
      ++(record.find("cell_id") != nullptr ? described : named);
    } else if (event->metricID == metricIdentifier("K_LTE_RRC_STATE")) {
      // A confirmation has another time alone.
      const std::string all = toText(record);
      const std::string content = all.substr(all.find(", "));
      const Value* cause = content == std::exchange(before, content) ? nullptr : record.find("cause");
      if (cause != nullptr) ++causes[*cause->asText()];
      expectRange(record, "prev_state_dur_ms", 0, 3'600'000);
    }
  }
  // In addition to the modem's 310 descriptions, earlier broadcasts describe cells that messages name.
  EXPECT_EQ(described, 705);
  EXPECT_EQ(named, 172);
  EXPECT_EQ(causes, (std::map<std::string, int>{{"KLTE_RRC_CAUSE_EST_MO_DATA", 44},
                                                {"KLTE_RRC_CAUSE_EST_MO_SIGNAL", 4},
                                                {"KLTE_RRC_CAUSE_EST_MT_ACC", 4},
                                                {"KLTE_RRC_CAUSE_REEST_HO_FAIL", 14},
                                                {"KLTE_RRC_CAUSE_REEST_OTHER_FAIL", 20},
                                                {"KLTE_RRC_CAUSE_REL_OTHER", 37}}));
}

TEST(DiagStreamRealLog, TheMobilityLogShowsRegistrationsAndBearers) {
  const std::string path = sharedCapture("lte-mobility.mi2log");
  SKIP_WITHOUT_CAPTURE(path);
  const auto stream = opened(path);
  std::map<std::string, int> procedures;
  int accepted = 0;
  std::size_t bearers = 0;
  while (const auto event = stream->next()) {
    const Record record = recordOf(*event);
    if (event->metricID == metricIdentifier("K_LTE_EMM_CTXT")) {
      if (const Value* procedure = record.find("reg_proc")) ++procedures[*procedure->asText()];
      if (record.find("t3412_dur_s") == nullptr) continue;
      ++accepted;
      EXPECT_EQ(numberIn(record, "t3412_dur_s"), 3240);
      EXPECT_EQ(record.find("tai_list")->asList()->size(), 1U);
      EXPECT_EQ(toText(*record.find("is_ims_voice_supported")), "1");
      // Known from the request, which is missing in the first log.
      const Value* mode = record.find("ue_op_mode");
      EXPECT_TRUE(mode == nullptr || *mode->asText() == "EPS_UE_OP_MODE_CSPS_MODE_1");
    } else if (event->metricID == metricIdentifier("K_CELLULAR_ACTIVE_BEARER")) {
      bearers = std::max(bearers, record.find("bearer_contexts")->asList()->size());
    }
  }
  EXPECT_GT(accepted, 56);
  EXPECT_EQ(bearers, 2U);
  EXPECT_EQ(procedures["EMM_PROC_TAU_COMB"], 56);
}

// The GUTI that the modem logs and the one in the messages of its updates.
TEST(DiagStreamRealLog, TheModemAndItsMessagesReportTheSameIdentity) {
  const std::string path = sharedCapture("lte-mobility.mi2log");
  SKIP_WITHOUT_CAPTURE(path);
  std::optional<nas::Guti> told;
  int compared = 0;
  int same = 0;
  forEachRecord(path, [&](const LogRecord& record) {
    if (record.code == emmStateCode) told = std::get<EmmStateRecord>(emmStateOf(record.payload)).guti;
    if (record.code != emmMessageOutCode || !told) return;
    const auto message = std::get<NasMessageRecord>(epsMessageOf(record.payload)).message;
    // The header of the message and the type of the update, then the identity with its length.
    if (message[0] != 0x07 || message[1] != 0x48) return;
    const auto identity = nas::gutiOf(message.subspan(4));
    ASSERT_TRUE(identity);
    ++compared;
    same += identity == told ? 1 : 0;
  });
  EXPECT_EQ(compared, 57);
  // One phone returns from UMTS with an identity derived from the one it had there (3GPP TS 23.003 2.8.2.1).
  EXPECT_EQ(same, 56);
}

TEST(DiagStreamRealLog, TheSameCellIsNamedByAllRecordsOfTheDrive) {
  const std::string path = sharedCapture("lte-ca-drive.mi2log");
  SKIP_WITHOUT_CAPTURE(path);
  const CellName primary{5780, 185};
  std::map<std::uint16_t, int> agreeing;
  std::uint8_t blocks = 0;
  std::vector<double> measuredBlocks;
  forEachRecord(path, [&](const LogRecord& record) {
    if (record.code == servingCellCode) {
      const auto cell = std::get<ServingCellRecord>(servingCellOf(record.payload));
      agreeing[record.code] += cell.cell == primary ? 1 : 0;
      blocks = cell.downlinkBlocks;
    } else if (record.code == servingMeasurementCode) {
      const auto measured = std::get<ServingMeasurementRecord>(servingMeasurementOf(record.payload));
      const ServingMeasurement& cell = measured.cells.at(0);
      if (cell.cellIndex != 0) return;
      agreeing[record.code] += cell.cell == primary ? 1 : 0;
      measuredBlocks.push_back(blocksOf(cell.antennas.at(0).value()));
    } else if (record.code == neighbourMeasurementCode) {
      // One record per carrier; that of the primary names the primary cell.
      const auto serving = std::get<NeighbourMeasurementRecord>(neighbourMeasurementOf(record.payload)).serving;
      EXPECT_TRUE(serving.pci == primary.pci) << serving.pci;
      agreeing[record.code] += serving.earfcn == primary.earfcn || serving.earfcn == 700 ? 1 : 0;
    } else if (record.code == rrcMessageCode) {
      agreeing[record.code] += std::get<RrcMessageRecord>(rrcMessageOf(record.payload)).cell == primary ? 1 : 0;
    }
  });
  EXPECT_EQ(agreeing, (std::map<std::uint16_t, int>{{0xB0C0, 31}, {0xB0C2, 2}, {0xB179, 223}, {0xB193, 975}}));
  // The resource blocks derived from the levels equal those that the modem logs.
  EXPECT_EQ(blocks, 50);
  EXPECT_NEAR(quantile(measuredBlocks, 0.5), blocks, blocks * 0.02);
}

// The neighbours of a carrier in the filtered and in the raw measurement of the same moment.
TEST(DiagStreamRealLog, BothMeasurementsOfTheNeighboursAgree) {
  const std::string path = sharedCapture("lte-ca-drive.mi2log");
  SKIP_WITHOUT_CAPTURE(path);
  std::map<std::pair<std::uint32_t, std::uint16_t>, std::pair<double, std::chrono::nanoseconds>> filtered;
  std::vector<double> differences;
  forEachRecord(path, [&](const LogRecord& record) {
    if (record.code == neighbourMeasurementCode) {
      const auto decoded = std::get<NeighbourMeasurementRecord>(neighbourMeasurementOf(record.payload));
      for (const auto& cell : decoded.neighbours) {
        filtered[{decoded.serving.earfcn, cell.pci}] = {cell.rsrp, record.time};
      }
    } else if (record.code == connectedNeighboursCode) {
      const auto decoded = std::get<NeighbourCarriersRecord>(connectedNeighboursOf(record.payload));
      ASSERT_EQ(decoded.carriers.size(), 1U);
      for (const auto& cell : decoded.carriers[0].neighbours) {
        const auto same = filtered.find({decoded.carriers[0].earfcn, cell.pci});
        if (same == filtered.end() || record.time - same->second.second > std::chrono::milliseconds(200)) continue;
        differences.push_back(std::abs(cell.rsrp - same->second.first));
      }
    }
  });
  EXPECT_GT(differences.size(), 300U);
  EXPECT_LT(quantile(differences, 0.5), 1.5);
  EXPECT_LT(quantile(differences, 0.95), 6);
}

// The modem's description of a cell and the cell's own broadcast, wherever a log has both.
TEST(DiagStreamRealLog, DescriptionsAndBroadcastsOfACellAreEqual) {
  using Name = std::pair<std::uint32_t, std::uint16_t>;
  int compared = 0;
  int widths = 0;
  for (const char* name : captures) {
    const std::string path = sharedCapture(name);
    SKIP_WITHOUT_CAPTURE(path);
    std::map<Name, rrc::lte::CellInformation> information;
    std::map<Name, std::uint8_t> bandwidths;
    rrc::Message message;
    const auto hear = [&](const RrcMessageRecord& broadcast) {
      const Name cell{broadcast.cell.earfcn, broadcast.cell.pci};
      if (broadcast.channel == RrcChannel::broadcast && !message.read(rrc::Pdu::lteBcchBch, broadcast.message)) {
        if (const auto master = rrc::lte::masterInformationOf(message)) bandwidths[cell] = master->bandwidth;
      } else if (broadcast.channel == RrcChannel::systemInformation &&
                 !message.read(rrc::Pdu::lteBcchDlSch, broadcast.message)) {
        if (auto block = rrc::lte::cellInformationOf(message)) information[cell] = *std::move(block);
      }
    };
    const auto compare = [&](const ServingCellRecord& cell) {
      const Name key{cell.cell.earfcn, cell.cell.pci};
      if (const auto width = bandwidths.find(key); width != bandwidths.end()) {
        ++widths;
        EXPECT_EQ(width->second, cell.downlinkBlocks);
      }
      const auto block = information.find(key);
      if (block == information.end()) return;
      ++compared;
      EXPECT_EQ(block->second.cellIdentity, cell.cellIdentity);
      EXPECT_EQ(block->second.trackingAreaCode, cell.trackingAreaCode);
      EXPECT_EQ(block->second.band, cell.band);
      ASSERT_TRUE(cell.plmn);
      const auto& networks = block->second.networks;
      EXPECT_TRUE(std::any_of(networks.begin(), networks.end(), [&](const auto& network) {
        return network.plmn.countryCode == cell.plmn->mcc() && network.plmn.networkCode == cell.plmn->mnc() &&
               network.plmn.networkDigits == cell.plmn->mncDigits();
      }));
    };
    forEachRecord(path, [&](const LogRecord& record) {
      if (record.code == servingCellCode) {
        compare(std::get<ServingCellRecord>(servingCellOf(record.payload)));
      } else if (record.code == rrcMessageCode) {
        const auto decoded = rrcMessageOf(record.payload);
        if (const auto* broadcast = std::get_if<RrcMessageRecord>(&decoded)) hear(*broadcast);
      }
    });
  }
  EXPECT_EQ(compared, 331);
  EXPECT_EQ(widths, 0) << "no log has the master information block of a cell that its modem describes";
}

// A message that opens a connection in LTE or releases it, by its first bits (3GPP TS 36.331 6.2.1).
enum class Turn { none, opened, handedOver, released };
Turn turnOf(RrcChannel channel, std::span<const std::uint8_t> message) {
  if (message.empty()) return Turn::none;
  const unsigned first = message[0];
  if (channel == RrcChannel::downlinkDcch) return first >> 3U == 5 ? Turn::released : Turn::none;
  if (channel != RrcChannel::uplinkDcch) return Turn::none;
  const bool resumed = first >> 2U == 0x24;  // of the messages that later releases have added
  if (first >> 3U == 4 || first >> 3U == 3 || resumed) return Turn::opened;
  return first >> 3U == 2 ? Turn::handedOver : Turn::none;
}

// CONNECTED is reported, or confirmed, only while no release is newer than the last set-up; a handover from another
// technology counts as one when it is completed more than 100 ms after the release.
TEST(DiagStreamRealLog, NoConnectionIsOpenAfterItsRelease) {
  int states = 0;
  int releases = 0;
  for (const char* name : captures) {
    const std::string path = sharedCapture(name);
    SKIP_WITHOUT_CAPTURE(path);
    struct Moment {
      std::chrono::nanoseconds time;
      Turn turn;
    };
    std::map<std::int32_t, std::vector<Moment>> turns;  // by radio
    forEachRecord(path, [&](const LogRecord& record) {
      if (record.code != rrcMessageCode) return;
      const auto decoded = rrcMessageOf(record.payload);
      const auto* message = std::get_if<RrcMessageRecord>(&decoded);
      const Turn turn = message == nullptr ? Turn::none : turnOf(message->channel, message->message);
      if (turn != Turn::none) turns[static_cast<std::int32_t>(record.radio)].push_back({record.time, turn});
      releases += turn == Turn::released ? 1 : 0;
    });
    const auto stream = opened(path);
    while (const auto event = stream->next()) {
      if (event->metricID != metricIdentifier("K_LTE_RRC_STATE")) continue;
      ++states;
      if (*recordOf(*event).find("state")->asText() != "KLTE_RRC_STATE_CONNECTED") continue;
      std::optional<std::chrono::nanoseconds> releasedAt;
      bool open = true;
      for (const Moment& moment : turns[event->profileID]) {
        if (moment.time > event->time) break;
        if (moment.turn == Turn::released) {
          releasedAt = moment.time;
          open = false;
        } else if (moment.turn == Turn::opened || !releasedAt ||
                   moment.time - *releasedAt > std::chrono::milliseconds(100)) {
          open = true;
        }
      }
      EXPECT_TRUE(open) << name << ' ' << event->time.count();
    }
  }
  EXPECT_GT(states, 800);
  EXPECT_EQ(releases, 44);
}

// A cell's description comes a little after, or a little before, messages name the cell.
TEST(DiagStreamRealLog, DescriptionsAndMessagesOfTheMobilityLogNameTheSameCells) {
  const std::string path = sharedCapture("lte-mobility.mi2log");
  SKIP_WITHOUT_CAPTURE(path);
  std::vector<std::pair<CellName, std::chrono::nanoseconds>> described;
  std::vector<std::pair<CellName, std::chrono::nanoseconds>> named;
  forEachRecord(path, [&](const LogRecord& record) {
    if (record.code == servingCellCode) {
      described.emplace_back(std::get<ServingCellRecord>(servingCellOf(record.payload)).cell, record.time);
    } else if (record.code == rrcMessageCode) {
      const auto message = std::get<RrcMessageRecord>(rrcMessageOf(record.payload));
      if (isDedicated(message.channel)) named.emplace_back(message.cell, record.time);
    }
  });
  const auto isNamed = [&](const auto& description) {
    return std::any_of(named.begin(), named.end(), [&](const auto& message) {
      return message.first == description.first && stillCounts(message.second, description.second);
    });
  };
  ASSERT_EQ(described.size(), 310U);
  // The log has no messages of the others.
  EXPECT_EQ(std::count_if(described.begin(), described.end(), isNamed), 299);
}

TEST(DiagStreamRealLog, TheAttachInUmtsShowsItsCellItsConnectionAndItsRegistration) {
  const std::string path = sharedCapture("umts-attach.mi2log");
  SKIP_WITHOUT_CAPTURE(path);
  const auto stream = opened(path);
  std::vector<std::string> states;
  std::map<std::int32_t, Record> latest;
  while (const auto event = stream->next()) {
    latest[event->metricID] = recordOf(*event);
    if (event->metricID == metricIdentifier("K_UMTS_RRC_STATE")) {
      addChange(states, *latest[event->metricID].find("state")->asText());
    }
  }
  EXPECT_FALSE(stream->failure());
  const Record& cell = latest[metricIdentifier("K_UMTS_SCELL_INFO")];
  EXPECT_EQ(numberIn(cell, "dl_uarfcn"), 9890);
  EXPECT_EQ(numberIn(cell, "psc"), 293);
  EXPECT_EQ(numberIn(cell, "mcc"), 310);
  EXPECT_EQ(numberIn(cell, "mnc"), 260);
  EXPECT_EQ(numberIn(cell, "num_mnc_digits"), 3);
  EXPECT_EQ(numberIn(cell, "lac"), 7145);
  EXPECT_EQ(*cell.find("wcdma_band")->asText(), "SYS_BAND_WCDMA_II_PCS_1900");
  EXPECT_THAT(states, testing::ElementsAre("KWCDMA_RRC_CONN_STATE_ESTABLISH", "KWCDMA_RRC_CONN_STATE_CELL_DCH",
                                           "KWCDMA_RRC_CONN_STATE_RELEASE", "KWCDMA_RRC_CONN_STATE_IDLE",
                                           "KWCDMA_RRC_CONN_STATE_ESTABLISH", "KWCDMA_RRC_CONN_STATE_CELL_DCH",
                                           "KWCDMA_RRC_CONN_STATE_RELEASE", "KWCDMA_RRC_CONN_STATE_IDLE"));
  // The same location according to the messages to and from the core network.
  const Record& packet = latest[metricIdentifier("K_CELLULAR_GMM_CTXT")];
  EXPECT_EQ(*packet.find("reg_status")->asText(), "KREG_STATUS_NORMAL_SERVICE");
  EXPECT_EQ(toText(*packet.find("rai")), "[encoded_plmn: <13 00 62>, lac: 7145, rac: 18]");
  EXPECT_EQ(numberIn(packet, "t3312_dur_s"), 10'800);
  EXPECT_EQ(toText(*latest[metricIdentifier("K_CELLULAR_MM_CTXT")].find("lai")),
            "[encoded_plmn: <13 00 62>, lac: 7145]");
  EXPECT_EQ(stream->summary(), "80 frames, 47 records read, 33 skipped (412F channel 132: 23, 412F channel 254: 10)");
}

// The downlink carrier of the cell is the one of its broadcasts, which have UARFCN and PSC.
TEST(DiagStreamRealLog, TheCellInUmtsIsTheOneWhoseBroadcastsWereReceived) {
  const std::string path = sharedCapture("umts-attach.mi2log");
  SKIP_WITHOUT_CAPTURE(path);
  std::optional<WcdmaCellRecord> cell;
  std::map<std::pair<unsigned, unsigned>, int> heard;
  forEachRecord(path, [&](const LogRecord& record) {
    if (record.code == wcdmaCellCode) cell = std::get<WcdmaCellRecord>(wcdmaCellOf(record.payload));
    if (record.code != wcdmaRrcCode || record.payload[0] != 0x84) return;
    const auto u16 = [&](std::size_t offset) { return record.payload[offset] | record.payload[offset + 1] << 8U; };
    ++heard[{u16(4), u16(6)}];
  });
  ASSERT_TRUE(cell);
  EXPECT_EQ(cell->uplinkUarfcn, 9490U);
  EXPECT_GT((heard[{cell->downlinkUarfcn, cell->primaryScramblingCode}]), 10);
}

}  // namespace
}  // namespace vespscope::test
