// The whole path of a modem log, tested with a written log: the simulated drive as records of every version, with a
// second SIM card and damaged frames between them.
#include <map>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "messages/WireReader.h"
#include "messages/lte/KCellularLteNbrEutraCellMeas.h"
#include "messages/lte/KCellularLteRrcState.h"
#include "messages/lte/KCellularLteRsrpRsrqSinr.h"
#include "messages/lte/KCellularLteScellInfo.h"
#include "messages/lte/LteRrcState.h"
#include "messages/umts/KCellularWcdmaCellInfo.h"
#include "registry/MetricRows.h"
#include "sources/diag/DiagStream.h"
#include "sources/scenario/ScenarioStream.h"
#include "support/LogWriter.h"
#include "support/ScratchFile.h"

namespace vespscope::test {
namespace {

using sources::diag::DiagStream;
using State = LteRrcState;

template <class Message>
Message as(const MetricEvent& event) {
  Message message;
  WireReader reader(event.payload);
  EXPECT_TRUE(message.readFrom(reader));
  return message;
}

// The written and the read contents of a log, as comparable lines by metric.
using Lines = std::map<std::string, std::vector<std::string>>;

std::string lineOf(const KCellularLteScellInfo& cell) {
  return std::to_string(cell.phyCellId()) + '@' + std::to_string(cell.dlFreq()) + '/' + std::to_string(cell.ulFreq()) +
         " bw " + std::to_string(cell.dlBw()) + " cell " + std::to_string(cell.cellId()) + " tac " +
         std::to_string(cell.trackingAreaCode()) + " band " + std::to_string(cell.freqBandInd()) + " plmn " +
         std::to_string(cell.selPlmnMcc()) + '-' + std::to_string(cell.selPlmnMnc()) + '/' +
         std::to_string(cell.numMncDigits());
}

std::string lineOf(const RsrpRsrqSinr& levels) {
  return std::to_string(levels.phyCellId()) + " rsrp " + std::to_string(levels.rsrp0()) + ' ' +
         std::to_string(levels.rsrp1()) + " rsrq " + std::to_string(levels.rsrq0()) + ' ' +
         std::to_string(levels.rsrq1());
}

std::string lineOf(const KCellularLteNbrEutraCellMeas& neighbours, std::uint32_t earfcn) {
  std::string line = std::to_string(earfcn);
  for (std::size_t index = 0; index < neighbours.measNbrEutrasCount(); ++index) {
    const auto& cell = *neighbours.measNbrEutraAtIndex(index);
    if (cell.nbrEarfcn() != earfcn) continue;
    line += ' ' + std::to_string(cell.nbrPhysCellId()) + ':' + std::to_string(cell.nbrRsrp()) + ':' +
            std::to_string(cell.nbrRsrq());
  }
  return line;
}

std::string lineOf(const KCellularWcdmaCellInfo& cell) {
  return std::to_string(cell.dlUarfcn()) + " psc " + std::to_string(cell.psc()) + " cell " +
         std::to_string(cell.cellId()) + " lac " + std::to_string(cell.lac()) + " plmn " + std::to_string(cell.mcc()) +
         '-' + std::to_string(cell.mnc());
}

// Writes the drive as the modem of radio 1 would log it, and stores its contents.
class DriveLog {
 public:
  DriveLog() {
    const auto drive = sources::makeScenarioStream(1, std::chrono::seconds(1'700'000'000));
    const auto end = std::chrono::seconds(1'700'000'000 + 150);
    while (const auto event = drive->next()) {
      if (event->time > end) break;
      write(*event);
    }
  }

  [[nodiscard]] const Bytes& bytes() const { return writer_.bytes(); }
  [[nodiscard]] const Lines& said() const { return said_; }
  [[nodiscard]] std::uint64_t damaged() const { return damaged_; }
  [[nodiscard]] std::uint64_t records() const { return records_; }

 private:
  void record(std::uint16_t code, const MetricEvent& event, const Bytes& payload) {
    writer_.record(code, event.time, payload, 1);
    ++records_;
    if (records_ % 40 == 0) {
      writer_.damagedFrame();
      ++damaged_;
    }
    if (records_ % 50 == 0) writer_.otherFrame();
    // The second card is in another cell.
    if (records_ % 30 == 0) {
      WrittenServingCell other{{411, 6300}, 24300, 50, 50, 77, 99, 20, 262, 2, 1};
      writer_.record(0xB0C2, event.time, servingCellPayload(3, other), 2);
      ++records_;
    }
  }

  void write(const MetricEvent& event) {
    if (event.metricID == metricIdentifier("K_LTE_SCELL_INFO")) return write(event, as<KCellularLteScellInfo>(event));
    if (event.metricID == metricIdentifier("K_LTE_RSRP_RSRQ_SINR")) {
      return write(event, as<KCellularLteRsrpRsrqSinr>(event));
    }
    if (event.metricID == metricIdentifier("K_LTE_INTRARAT_MEAS")) {
      return write(event, as<KCellularLteNbrEutraCellMeas>(event));
    }
    if (event.metricID == metricIdentifier("K_LTE_RRC_STATE")) return write(event, as<KCellularLteRrcState>(event));
    if (event.metricID == metricIdentifier("K_UMTS_SCELL_INFO")) {
      return write(event, as<KCellularWcdmaCellInfo>(event));
    }
  }

  void write(const MetricEvent& event, const KCellularLteScellInfo& cell) {
    serving_ = WrittenCell{static_cast<std::uint16_t>(cell.phyCellId()), cell.dlFreq()};
    WrittenServingCell written{*serving_,
                               cell.ulFreq(),
                               static_cast<std::uint8_t>(cell.dlBw() * 5 / 2),
                               static_cast<std::uint8_t>(cell.ulBw() * 5 / 2),
                               static_cast<std::uint32_t>(cell.cellId()),
                               static_cast<std::uint16_t>(cell.trackingAreaCode()),
                               cell.freqBandInd(),
                               static_cast<std::uint16_t>(cell.selPlmnMcc()),
                               static_cast<std::uint8_t>(cell.numMncDigits()),
                               static_cast<std::uint16_t>(cell.selPlmnMnc())};
    record(0xB0C2, event, servingCellPayload(said_["cell"].size() % 2 == 0 ? 3 : 2, written));
    said_["cell"].push_back(lineOf(cell));
  }

  void write(const MetricEvent& event, const KCellularLteRsrpRsrqSinr& message) {
    constexpr std::array<std::uint8_t, 5> versions = {18, 19, 22, 36, 48};
    const RsrpRsrqSinr& levels = *message.instValuesAtIndex(0);
    if (!serving_ || levels.phyCellId() != serving_->pci) return;
    const auto antenna = [](int rsrp, int rsrq) {
      // With fifty resource blocks.
      return WrittenLevels{static_cast<double>(rsrp), static_cast<double>(rsrq), rsrp - rsrq + 16.99, 10};
    };
    record(0xB193, event,
           measurementPayload(versions.at(said_["levels"].size() % versions.size()), *serving_,
                              {antenna(levels.rsrp0(), levels.rsrq0()), antenna(levels.rsrp1(), levels.rsrq1())}));
    said_["levels"].push_back(lineOf(levels));
  }

  void write(const MetricEvent& event, const KCellularLteNbrEutraCellMeas& message) {
    constexpr std::array<std::uint16_t, 3> codes = {0xB195, 0xB179, 0xB192};
    if (!serving_) return;
    std::vector<WrittenNeighbour> neighbours;
    for (std::size_t index = 0; index < message.measNbrEutrasCount(); ++index) {
      const auto& cell = *message.measNbrEutraAtIndex(index);
      if (cell.nbrEarfcn() != serving_->earfcn) continue;
      neighbours.push_back(
          {static_cast<std::uint16_t>(cell.nbrPhysCellId()), cell.nbrRsrp() - 140.0, cell.nbrRsrq() / 2.0 - 19.5});
    }
    record(codes.at(said_["neighbours"].size() % codes.size()), event,
           neighboursPayload(codes.at(said_["neighbours"].size() % codes.size()), *serving_, serving_->earfcn,
                             neighbours));
    said_["neighbours"].push_back(lineOf(message, serving_->earfcn));
  }

  // The messages that lead to the states of an ordinary connection.
  void write(const MetricEvent& event, const KCellularLteRrcState& message) {
    constexpr std::array<std::uint8_t, 23> versions = {2,  3,  4,  5,  6,  7,  8,  9,  12, 13, 14, 15,
                                                       16, 19, 20, 22, 24, 25, 26, 27, 29, 30, 31};
    const Bytes request = {0x40, 0, 0, 0, 0, 0x08};
    const Bytes complete = {0x24, 0};
    const Bytes release = {0x2A, 0x02};
    if (!serving_) return;
    const auto put = [&](unsigned channel, const Bytes& content) {
      record(0xB0C0, event, rrcPayload(versions.at(rrcRecords_++ % versions.size()), channel, *serving_, content));
    };
    if (message.state() == State::KLTE_RRC_STATE_ATMPT_CONNECTION) {
      put(2, request);
    } else if (message.state() == State::KLTE_RRC_STATE_CONNECTED) {
      put(3, complete);
    } else if (message.state() == State::KLTE_RRC_STATE_IDLE) {
      put(1, release);
    } else {
      return;
    }
    const std::string state = std::to_string(message.state());
    std::vector<std::string>& states = said_["rrc"];
    // A repeated connected state is not reported.
    if (states.empty() || states.back() != state || message.state() != State::KLTE_RRC_STATE_CONNECTED) {
      states.push_back(state);
    }
  }

  void write(const MetricEvent& event, const KCellularWcdmaCellInfo& cell) {
    record(0x4127, event,
           wcdmaCellPayload({cell.dlUarfcn(), static_cast<std::uint32_t>(cell.cellId()),
                             static_cast<std::uint16_t>(cell.psc()), "00101", static_cast<std::uint16_t>(cell.lac())}));
    said_["umts"].push_back(lineOf(cell));
  }

  LogWriter writer_;
  Lines said_;
  std::optional<WrittenCell> serving_;
  std::size_t rrcRecords_ = 0;
  std::uint64_t records_ = 0;
  std::uint64_t damaged_ = 0;
};

class DiagStreamWrittenLog : public testing::Test {
 protected:
  static void SetUpTestSuite() { log_ = std::make_unique<DriveLog>(); }
  static void TearDownTestSuite() { log_.reset(); }

  // The log's contents for radio 1.
  Lines read() {
    auto stream = DiagStream::open(file_.path());
    EXPECT_TRUE(stream) << stream.reason();
    Lines lines;
    while (const auto event = (*stream)->next()) {
      if (event->profileID != 1) {
        EXPECT_EQ(event->profileID, 2);
        if (event->metricID == metricIdentifier("K_LTE_SCELL_INFO")) {
          others_.push_back(lineOf(as<KCellularLteScellInfo>(*event)));
        } else {
          EXPECT_EQ(event->metricID, metricIdentifier("K_LTE_COMPCARR_INFO"));
        }
        continue;
      }
      take(*event, lines);
    }
    report_ = (*stream)->counts();
    return lines;
  }

  static void take(const MetricEvent& event, Lines& lines) {
    if (event.metricID == metricIdentifier("K_LTE_SCELL_INFO")) {
      lines["cell"].push_back(lineOf(as<KCellularLteScellInfo>(event)));
    } else if (event.metricID == metricIdentifier("K_LTE_RSRP_RSRQ_SINR")) {
      lines["levels"].push_back(lineOf(*as<KCellularLteRsrpRsrqSinr>(event).instValuesAtIndex(0)));
    } else if (event.metricID == metricIdentifier("K_LTE_RRC_STATE")) {
      lines["rrc"].push_back(std::to_string(as<KCellularLteRrcState>(event).state()));
    } else if (event.metricID == metricIdentifier("K_UMTS_SCELL_INFO")) {
      lines["umts"].push_back(lineOf(as<KCellularWcdmaCellInfo>(event)));
    } else if (event.metricID == metricIdentifier("K_LTE_INTRARAT_MEAS")) {
      lines["neighbours"].emplace_back();
    }
  }

  static std::unique_ptr<DriveLog> log_;
  ScratchFile file_{"written.mi2log", log_->bytes()};
  std::vector<std::string> others_;
  sources::diag::DiagReport report_;
};

std::unique_ptr<DriveLog> DiagStreamWrittenLog::log_;

TEST_F(DiagStreamWrittenLog, SaysWhatTheDriveSaid) {
  const Lines lines = read();
  const Lines& said = log_->said();
  ASSERT_GT(said.at("cell").size(), 2U);
  ASSERT_GT(said.at("levels").size(), 50U);
  EXPECT_EQ(lines.at("cell"), said.at("cell"));
  EXPECT_EQ(lines.at("levels"), said.at("levels"));
  EXPECT_EQ(lines.at("rrc"), said.at("rrc"));
  EXPECT_EQ(lines.at("umts"), said.at("umts"));
  EXPECT_EQ(lines.at("neighbours").size(), said.at("neighbours").size());
}

TEST_F(DiagStreamWrittenLog, CountsEveryFrameAndRefusesTheDamagedOnes) {
  read();
  EXPECT_GT(log_->damaged(), 3U);
  EXPECT_EQ(report_.frames.badChecksum, log_->damaged());
  std::uint64_t records = 0;
  for (const auto& [kind, count] : report_.read) records += count;
  EXPECT_EQ(records, log_->records());
  EXPECT_TRUE(report_.skipped.empty()) << report_.text();
  EXPECT_TRUE(report_.broken.empty()) << report_.text();
  EXPECT_EQ(report_.malformedFrames, 0U);
  EXPECT_GT(report_.otherFrames, 3U);
}

TEST_F(DiagStreamWrittenLog, KeepsTheSecondCardApart) {
  read();
  ASSERT_GT(others_.size(), 5U);
  for (const std::string& line : others_) EXPECT_EQ(line.substr(0, 9), "411@6300/");
  auto all = sources::openDiagStream(file_.path());
  ASSERT_TRUE(all);
  std::size_t events = 0;
  while (const auto event = (*all)->next()) {
    // The serving cell's own report; carriers follow it.
    events += event->profileID == 2 && event->metricID == metricIdentifier("K_LTE_SCELL_INFO") ? 1 : 0;
  }
  EXPECT_EQ(events, others_.size());
}

}  // namespace
}  // namespace vespscope::test
