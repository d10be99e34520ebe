// The road of a modem's signalling through logs of our own: registrations, connections and bearers of LTE, UMTS and
// GSM, carriers and levels, and records of NR. What the tests on real logs compare with other sources is compared here
// with what the log was written from.
#include <algorithm>
#include <chrono>
#include <map>
#include <memory>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "../../rrc/Literals.h"
#include "Bytes.h"
#include "LiteralRecords.h"
#include "LogRecords.h"
#include "sources/diag/DecodedMetrics.h"
#include "sources/diag/DiagStream.h"
#include "sources/diag/NrRecords.h"
#include "sources/diag/WcdmaRecords.h"
#include "sources/nas/LiteralMessages.h"
#include "support/LogWriter.h"
#include "support/ScratchFile.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;
using namespace std::chrono_literals;
using testing::AllOf;
using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;
using Milliseconds = std::chrono::milliseconds;

constexpr unsigned downlinkDcch = 1;
constexpr unsigned uplinkCcch = 2;
constexpr unsigned uplinkDcch = 3;

Bytes literalMessage(std::string_view name) {
  const auto* found = std::find_if(std::begin(literals), std::end(literals),
                                   [name](const Literal& literal) { return literal.name == name; });
  EXPECT_NE(found, std::end(literals)) << name;
  return bytesOf(found->hex);
}

// The field of a record as text; empty when it is absent.
std::string field(const Record& record, std::string_view key) {
  const Value* value = record.find(key);
  return value == nullptr ? std::string() : toText(*value);
}

class DiagStreamWrittenSignalling : public testing::Test {
 protected:
  // Milliseconds since the log began, at 2023-11-14 22:13:20.
  void write(std::uint16_t code, std::int64_t at, const Bytes& payload) {
    writer_.record(code, 1'700'000'000s + Milliseconds(at), payload, 1);
  }
  void writeRrc(std::int64_t at, unsigned channel, std::string_view name, const WrittenCell& cell = primary) {
    write(rrcMessageCode, at, rrcPayload(15, channel, cell, literalMessage(name)));
  }
  // On BCCH-DL-SCH.
  void writeBroadcast(std::int64_t at, std::string_view name, const WrittenCell& cell = primary) {
    Bytes payload = rrcPayload(15, 0, cell, literalMessage(name));
    payload.at(12) = 2;  // the channel's number in this version
    write(rrcMessageCode, at, payload);
  }

  // Reads the log by its file; each class has its events in `texts`, and its last one in `latest`.
  void read() {
    const ScratchFile file("signalling.mi2log", writer_.bytes());
    auto stream = DiagStream::open(file.path());
    ASSERT_TRUE(stream) << stream.reason();
    while (const auto event = (*stream)->next()) {
      EXPECT_EQ(event->profileID, 1);
      const Record record = recordOf(*event);
      // Levels and identities that no message can have would mean a field read from the wrong place.
      events_[classNameOf(event->metricID)].push_back(record);
    }
    EXPECT_FALSE((*stream)->failure());
    summary_ = (*stream)->summary();
    report_ = (*stream)->counts();
  }

  [[nodiscard]] std::vector<std::string> fieldsOf(const std::string& message, std::string_view key) {
    std::vector<std::string> fields;
    for (const Record& record : events_[message]) {
      if (record.find(key) != nullptr) fields.push_back(field(record, key));
    }
    return fields;
  }
  [[nodiscard]] const Record& latest(const std::string& message) {
    EXPECT_FALSE(events_[message].empty()) << message;
    if (events_[message].empty()) events_[message].emplace_back();
    return events_[message].back();
  }

  static constexpr WrittenCell primary{.pci = 185, .earfcn = 5780};
  static constexpr WrittenCell secondary{.pci = 185, .earfcn = 700, .index = 1};

  LogWriter writer_;
  std::map<std::string, std::vector<Record>> events_;
  std::string summary_;
  DiagReport report_;
};

TEST_F(DiagStreamWrittenSignalling, ShowsTheRegistrationAndTheBearersOfAnAttach) {
  write(0xB0ED, 0, epsMessagePayload(bytesOf(literal::attachRequest)));
  write(0xB0EC, 200, epsMessagePayload(bytesOf(literal::attachAccept)));
  write(0xB0E2, 210, epsMessagePayload(bytesOf(literal::activateDefault)));
  write(0xB0EE, 220, emmStatePayload(3, 0, {"26201", 0x8001, 2, 0xC0000001}));
  write(0xB0E5, 230, bearerStatePayload(5, 2, 9));
  read();
  EXPECT_THAT(fieldsOf("KCellularEmmContext", "reg_proc"), ElementsAre("EMM_PROC_ATTACH_COMB", "EMM_PROC_NO_PROC"));
  const Record& registration = latest("KCellularEmmContext");
  EXPECT_EQ(field(registration, "t3412_dur_s"), "7200");
  EXPECT_EQ(registration.find("tai_list")->asList()->size(), 1U);
  EXPECT_EQ(field(registration, "is_ims_voice_supported"), "1");
  EXPECT_EQ(field(registration, "ue_op_mode"), "EPS_UE_OP_MODE_CSPS_MODE_1");
  EXPECT_EQ(field(registration, "guti"), "[mmegi: 32769, mmec: 2, m_tmsi: 3221225473]");
  const Record& bearers = latest("KCellularActivatedBearerContexts");
  EXPECT_EQ(field(bearers, "bearer_context_count"), "1");
  EXPECT_THAT(field(bearers, "bearer_contexts"), AllOf(HasSubstr("apn: internet"), HasSubstr("<0a 01 02 03>")));
  EXPECT_EQ(summary_, "5 frames, 5 records read, 0 skipped");
}

// The identity that the modem states and the one in the messages of its updates are one.
TEST_F(DiagStreamWrittenSignalling, ShowsOneIdentityOfTheModemAndOfItsMessages) {
  write(0xB0EE, 0, emmStatePayload(3, 0, {"26201", 0x8001, 2, 0xC0000001}));
  write(0xB0ED, 100, epsMessagePayload(bytesOf(literal::updateRequest)));
  write(0xB0EC, 200, epsMessagePayload(bytesOf(literal::updateAccept)));
  // The same with the security head.
  Bytes secured = bytesOf("17 a1 a2 a3 a4 05");
  append(secured, bytesOf("07 4e 27"));
  write(0xB0EA, 300, epsMessagePayload(secured));
  read();
  const std::vector<std::string> identities = fieldsOf("KCellularEmmContext", "guti");
  ASSERT_FALSE(identities.empty());
  EXPECT_EQ(std::set<std::string>(identities.begin(), identities.end()),
            (std::set<std::string>{"[mmegi: 32769, mmec: 2, m_tmsi: 3221225473]"}));
  EXPECT_THAT(fieldsOf("KCellularEmmContext", "reg_proc"), Contains("EMM_PROC_TAU_COMB"));
  EXPECT_EQ(field(latest("KCellularEmmContext"), "t3412_dur_s"), "3240");
  EXPECT_EQ(field(latest("KCellularEmmContext"), "reject_cause"), "EMM_CAUSE_CS_DOMAIN_TEMPORARILY_NOT_AVAILABLE");
}

TEST_F(DiagStreamWrittenSignalling, ShowsTheStatesOfAConnectionAndNoneAfterItsRelease) {
  writeRrc(0, uplinkCcch, "request");
  writeRrc(100, uplinkDcch, "setup-complete");
  writeRrc(200, downlinkDcch, "recon-drx");
  writeRrc(300, uplinkDcch, "report-umts");
  writeRrc(2000, downlinkDcch, "release");
  writeRrc(2060, uplinkDcch, "report-umts");  // sent before, logged after
  writeRrc(4000, uplinkCcch, "request");
  read();
  EXPECT_THAT(fieldsOf("KCellularLteRrcState", "state"),
              ElementsAre("KLTE_RRC_STATE_ATMPT_CONNECTION", "KLTE_RRC_STATE_CONNECTED", "KLTE_RRC_STATE_IDLE",
                          "KLTE_RRC_STATE_ATMPT_CONNECTION"));
  EXPECT_THAT(fieldsOf("KCellularLteCdrxConfig", "cdrx_config_status"), ElementsAre("1", "0"));
  EXPECT_THAT(fieldsOf("KCellularLteRsrpRsrqSinr", "inst_values"), Contains(HasSubstr("phy_cell_id: 185")));
  EXPECT_THAT(fieldsOf("KCellularLteNbrInterRatCellMeas", "timestamp"), Not(testing::IsEmpty()));
}

TEST_F(DiagStreamWrittenSignalling, DescribesACellByItsBroadcastAsTheModemDoes) {
  writeRrc(0, downlinkDcch, "release");
  writeBroadcast(100, "sib1");
  writeBroadcast(200, "si");
  read();
  const Record broadcast = latest("KCellularLteScellInfo");
  EXPECT_THAT(fieldsOf("KCellularLteSelReselCellInfo", "nbr_eutra"), Contains(HasSubstr("earfcn: ")));
  // The same cell as the modem describes it in a record of its own.
  writer_ = LogWriter();
  events_.clear();
  WrittenServingCell described;
  described.cell = primary;
  described.uplinkEarfcn = 23'780;
  described.downlinkBlocks = described.uplinkBlocks = 50;
  described.cellIdentity = 180'149'761;
  described.trackingAreaCode = 4660;
  described.band = 66;
  described.mcc = 1;
  described.mncDigits = 2;
  described.mnc = 1;
  write(servingCellCode, 0, servingCellPayload(3, described));
  read();
  for (const char* key : {"phy_cell_id", "dl_freq", "cell_id", "freq_band_ind", "tracking_area_code", "num_mnc_digits",
                          "sel_plmn_mcc", "sel_plmn_mnc"}) {
    EXPECT_EQ(field(broadcast, key), field(latest("KCellularLteScellInfo"), key)) << key;
  }
}

TEST_F(DiagStreamWrittenSignalling, ShowsTheSecondaryCarrierAsLongAsItIsMeasured) {
  const WrittenLevels levels{.rsrp = -95, .rsrq = -10.5, .rssi = -67.5, .snr = 12};
  for (int tenth = 0; tenth < 60; ++tenth) {
    write(servingMeasurementCode, tenth * 100, measurementPayload(19, primary, {levels, levels}));
    if (tenth < 20)
      write(servingMeasurementCode, tenth * 100 + 40, measurementPayload(22, secondary, {levels, levels}));
  }
  read();
  const std::vector<std::string> carriers = fieldsOf("KCellularLteCarrierAggregationStatus", "scc_list");
  ASSERT_FALSE(carriers.empty());
  EXPECT_THAT(carriers.front(), AllOf(HasSubstr("dl_earfcn: 700"), HasSubstr("pci: 185"), HasSubstr("dl_rf_band: 2")));
  EXPECT_THAT(carriers.back(), HasSubstr("SCC_STATE_DECONFIGURED"));
  std::size_t aggregated = 0;
  for (const Record& record : events_["KCellularLteRsrpRsrqSinr"]) {
    aggregated += record.find("inst_values")->asList()->size() == 2 ? 1 : 0;
  }
  EXPECT_EQ(events_["KCellularLteRsrpRsrqSinr"].size(), 60U);
  // Twenty measurements of the secondary, and the second after them.
  EXPECT_NEAR(static_cast<double>(aggregated), 29, 2);
}

// Every antenna of every version: its levels and its part of the carrier's resource blocks.
TEST_F(DiagStreamWrittenSignalling, GivesTheBandwidthByTheLevelsOfEachVersion) {
  constexpr std::array<std::uint8_t, 5> versions = {18, 19, 22, 36, 48};
  std::int64_t at = 0;
  for (const std::uint8_t version : versions) {
    const std::size_t antennas = version >= 36 ? 4 : 2;
    for (std::size_t count = version >= 36 ? 1 : 2; count <= antennas; ++count) {
      std::vector<WrittenLevels> levels;
      for (std::size_t antenna = 0; antenna < count; ++antenna) {
        const double rsrp = -90 - 2.5 * static_cast<double>(antenna);
        levels.push_back({rsrp, -11.5, rsrp + 11.5 + 10 * std::log10(50), 7});
      }
      write(servingMeasurementCode, at += 100, measurementPayload(version, primary, levels));
    }
  }
  std::size_t present = 0;
  std::size_t records = 0;
  const FrameCounters counters = forEachRecord(writer_.bytes(), [&](const LogRecord& record) {
    ++records;
    const auto decoded = std::get<ServingMeasurementRecord>(servingMeasurementOf(record.payload));
    ASSERT_EQ(decoded.cells.size(), 1U);
    EXPECT_TRUE(decoded.unread.empty());
    EXPECT_EQ(decoded.cells[0].cell, (CellName{5780, 185}));
    EXPECT_NEAR(blocksOf(decoded.cells[0].combined), 50, 50 * 0.04);
    for (std::size_t antenna = 0; antenna < decoded.cells[0].antennas.size(); ++antenna) {
      const auto& levels = decoded.cells[0].antennas[antenna];
      if (!levels) continue;
      ++present;
      EXPECT_NEAR(blocksOf(*levels), 50, 50 * 0.04);
      EXPECT_EQ(levels->rsrp, -90 - 2.5 * static_cast<double>(antenna));
    }
  });
  EXPECT_EQ(records, 3U + 2 * 4);
  EXPECT_EQ(counters, (FrameCounters{.good = records}));
  // Antennas outside the mask are absent.
  EXPECT_EQ(present, 3U * 2 + 2 * (1 + 2 + 3 + 4));
}

// The neighbours of a carrier in the filtered and in the raw measurement of the same moment.
TEST_F(DiagStreamWrittenSignalling, ReadsTheSameNeighboursFromBothMeasurements) {
  const std::vector<WrittenNeighbour> neighbours = {{210, -101.5, -13}, {17, -108, -16.5}};
  const auto textOf = [&](std::uint16_t code) {
    writer_ = LogWriter();
    events_.clear();
    write(servingMeasurementCode, 0, measurementPayload(19, primary, {{-95, -11, -67, 12}, {-96, -11, -68, 12}}));
    write(code, 100, neighboursPayload(code, primary, primary.earfcn, neighbours));
    read();
    return field(latest("KCellularLteNbrEutraCellMeas"), "meas_nbr_eutra");
  };
  const std::string filtered = textOf(neighbourMeasurementCode);
  EXPECT_THAT(filtered, AllOf(HasSubstr("nbr_phys_cell_id: 210"), HasSubstr("nbr_phys_cell_id: 17")));
  EXPECT_EQ(textOf(connectedNeighboursCode), filtered);
  EXPECT_EQ(textOf(idleNeighboursCode), filtered);
}

TEST_F(DiagStreamWrittenSignalling, ShowsTheAttachInUmts) {
  write(wcdmaRrcCode, 0, wcdmaBroadcastPayload(9890, 293, bytesOf("7a 55")));
  write(wcdmaRrcCode, 10, wcdmaBroadcastPayload(9890, 293, bytesOf("7a 56")));
  write(wcdmaCellCode, 50, wcdmaCellPayload({9890, 0x01020304, 293, "310260", 7145}));
  for (const std::int64_t begin : {0, 5000}) {
    write(wcdmaRrcCode, begin + 100, wcdmaRrcPayload(0, bytesOf("39 00 00 00 01 31 09 30 0d f4 b5 24")));
    write(wcdmaRrcCode, begin + 200, wcdmaRrcPayload(2, bytesOf("30 00 60 00 00 00 00 00 00 00 7f ff ff ff a0")));
    write(wcdmaRrcCode, begin + 300, wcdmaRrcPayload(1, bytesOf("48")));
    write(wcdmaRrcCode, begin + 350, wcdmaRrcPayload(1, bytesOf("00")));
    write(gprsMessageCode, begin + 400, gprsMessagePayload(bytesOf(literal::gmmAttachRequest)));
    write(gprsMessageCode, begin + 800, gprsMessagePayload(bytesOf(literal::gmmAttachAccept)));
    write(wcdmaRrcCode, begin + 900, wcdmaRrcPayload(3, bytesOf("3e 31 0c 00")));
    write(wcdmaRrcCode, begin + 950, wcdmaRrcPayload(1, bytesOf("44 00")));
  }
  write(gmmRegistrationCode, 6000, gmmRegistrationPayload("310260", 7145, 18));
  write(mmStateCode, 6010, mobilityStatePayload(0x13, 0, 0));
  write(gmmStateCode, 6020, mobilityStatePayload(3, 0, 0));
  read();
  const Record& cell = latest("KCellularWcdmaCellInfo");
  EXPECT_EQ(field(cell, "dl_uarfcn"), "9890");
  EXPECT_EQ(field(cell, "psc"), "293");
  EXPECT_EQ(field(cell, "mcc"), "310");
  EXPECT_EQ(field(cell, "mnc"), "260");
  EXPECT_EQ(field(cell, "lac"), "7145");
  EXPECT_EQ(field(cell, "wcdma_band"), "SYS_BAND_WCDMA_II_PCS_1900");
  const std::vector<std::string> connection = {"KWCDMA_RRC_CONN_STATE_ESTABLISH", "KWCDMA_RRC_CONN_STATE_CELL_FACH",
                                               "KWCDMA_RRC_CONN_STATE_CELL_DCH", "KWCDMA_RRC_CONN_STATE_RELEASE",
                                               "KWCDMA_RRC_CONN_STATE_IDLE"};
  std::vector<std::string> twice = connection;
  twice.insert(twice.end(), connection.begin(), connection.end());
  EXPECT_EQ(fieldsOf("KCellularWcdmaRrcConnectionState", "state"), twice);
  const Record& packet = latest("KCellularGmmContext");
  EXPECT_EQ(field(packet, "reg_status"), "KREG_STATUS_NORMAL_SERVICE");
  EXPECT_EQ(field(packet, "rai"), "[encoded_plmn: <13 00 62>, lac: 7145, rac: 18]");
  EXPECT_EQ(field(packet, "t3312_dur_s"), "3240");
  EXPECT_EQ(field(latest("KCellularMmContext"), "lai"), "[encoded_plmn: <13 00 62>, lac: 7145]");
  EXPECT_EQ(summary_, "22 frames, 20 records read, 2 skipped (412F channel 132: 2)");
}

// The carrier and the scrambling code that the broadcasts are heard with are those of the cell.
TEST_F(DiagStreamWrittenSignalling, HearsTheCellInUmtsThatTheModemDescribes) {
  write(wcdmaRrcCode, 0, wcdmaBroadcastPayload(9890, 293, bytesOf("7a 55")));
  write(wcdmaCellCode, 50, wcdmaCellPayload({9890, 0x01020304, 293, "310260", 7145}));
  std::pair<unsigned, unsigned> heard;
  std::pair<unsigned, unsigned> described;
  forEachRecord(writer_.bytes(), [&](const LogRecord& record) {
    const auto u16 = [&](std::size_t offset) { return record.payload[offset] | record.payload[offset + 1] << 8U; };
    if (record.code == wcdmaRrcCode) {
      heard = {u16(4), u16(6)};
    } else {
      const auto cell = std::get<WcdmaCellRecord>(wcdmaCellOf(record.payload));
      described = {cell.downlinkUarfcn, cell.primaryScramblingCode};
    }
  });
  EXPECT_EQ(heard, described);
  EXPECT_EQ(heard, (std::pair<unsigned, unsigned>{9890, 293}));
}

TEST_F(DiagStreamWrittenSignalling, ShowsTheCellAndThePacketServiceOfGsm) {
  write(0x512F, 0, gsmMessagePayload(bytesOf(literal::gsmType3)));
  write(0x512F, 500, gsmMessagePayload(bytesOf(literal::gsmType4)));
  write(0x512F, 900, gsmMessagePayload(bytesOf(literal::gsmType13)));
  write(0x512F, 1000, gsmMessagePayload(bytesOf("55 06 19 00")));  // another message
  read();
  EXPECT_EQ(toText(latest("KCellularGsmScellInfo")),
            "[timestamp: 1700000000000, mcc: 262, mnc: 1, lac: 10000, cell_id: 4660, num_mnc_digits: 2]");
  EXPECT_EQ(field(latest("KCellularGsmIdleConfig"), "ci"), "4660");
  EXPECT_EQ(field(latest("KCellularGsmIdleConfig"), "cbch_supported"), "1");
  EXPECT_EQ(field(latest("KCellularGsmGprsConfig"), "rac"), "18");
  EXPECT_EQ(summary_, "4 frames, 3 records read, 1 skipped (512F message 25: 1)");
}

TEST_F(DiagStreamWrittenSignalling, ReadsEveryMessageOfNr) {
  const std::map<std::uint8_t, const char*> contents = {{1, "nr-mib"},  {8, "nr-report"}, {9, "nr-reconfiguration"},
                                                        {10, "nr-mib"}, {25, "nr-mib"},   {26, "nr-mib"}};
  std::int64_t at = 0;
  for (const auto& [content, name] : contents) {
    write(nrRrcMessageCode, at += 10, nrRrcPayload(content, 138, 504'990, literalMessage(name)));
  }
  std::set<NrRrcContent> read;
  forEachRecord(writer_.bytes(), [&](const LogRecord& record) {
    const auto decoded = nrRrcMessageOf(record.payload);
    ASSERT_TRUE(std::holds_alternative<NrRrcMessageRecord>(decoded));
    EXPECT_EQ(std::get<NrRrcMessageRecord>(decoded).nrArfcn, 504'990U);
    EXPECT_EQ(std::get<NrRrcMessageRecord>(decoded).pci, 138);
    read.insert(std::get<NrRrcMessageRecord>(decoded).content);
  });
  EXPECT_EQ(read.size(), contents.size());
  EXPECT_FALSE(read.contains(NrRrcContent::other));
  this->read();
  EXPECT_EQ(summary_, "6 frames, 6 records read, 0 skipped");
}

TEST_F(DiagStreamWrittenSignalling, FillsTheScreensItHasMessagesFor) {
  writeRrc(0, uplinkCcch, "request");
  writeRrc(100, uplinkDcch, "setup-complete");
  write(0xB0ED, 150, epsMessagePayload(bytesOf(literal::attachRequest)));
  write(0xB0EC, 200, epsMessagePayload(bytesOf(literal::attachAccept)));
  const WrittenLevels levels{.rsrp = -95, .rsrq = -10.5, .rssi = -67.5, .snr = 12};
  write(servingMeasurementCode, 300, measurementPayload(36, primary, {levels, levels, levels}));
  write(neighbourMeasurementCode, 310, neighboursPayload(neighbourMeasurementCode, primary, 5780, {{210, -101, -13}}));
  writeBroadcast(400, "si");
  read();
  std::set<std::string> filled;
  for (const auto& [name, records] : events_) filled.insert(name);
  EXPECT_THAT(filled,
              testing::IsSupersetOf({"KCellularLteScellInfo", "KCellularLteRsrpRsrqSinr",
                                     "KCellularLteNbrEutraCellMeas", "KCellularLteRrcState", "KCellularEmmContext",
                                     "KCellularActivatedBearerContexts", "KCellularLteSelReselCellInfo"}));
}

}  // namespace
}  // namespace vespscope::test
