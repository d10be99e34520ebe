// Whole frames, compared as text with golden files.
#include <clocale>
#include <cstdlib>

#include <gtest/gtest.h>

#include "frontends/terminal/FakeScreens.h"
#include "frontends/terminal/Frame.h"
#include "frontends/terminal/Session.h"
#include "support/Golden.h"

namespace vespscope::test {
namespace {

using namespace terminal;
using application::TableSnapshot;
using namespace std::chrono_literals;

const std::chrono::system_clock::time_point now{1'700'000'000s};  // 22:13:20 UTC

TableSnapshot servingCell(const std::string& rsrp) {
  return {{valueSection({}, {{"timestamp", "2023-11-14 22:13:17 UTC"},
                             {"mo_signalling_ac_barring_for_special_ac", "0"},
                             {"plmn", "[mcc: 262, mnc: 1, num_mnc_digits: 2]"},
                             {"guti", "[plmn: [mcc: 262, mnc: 1], mme_group_id: 32769, mme_code: 7, m_tmsi: 0]"},
                             {"nbr_rsrp", rsrp},
                             {"contents", "<98 01 10 30 00 00 00 00 00 f0 ff ff ff ff ff ff ff ff ff ff ff ff>"},
                             {"provider", "中国移动通信 e\u0301te\u0301 \xF0\x9F\x93\xB1"},
                             {"empty", ""}})}};
}

TableSnapshot neighbours(int count) {
  TableSnapshot table;
  for (int cell = 1; cell <= count; ++cell) {
    table.sections.push_back(valueSection(
        "LTE Neighbor " + std::to_string(cell),
        {{"earfcn", "1300"}, {"phy_cell_id", std::to_string(100 + cell)}, {"nbr_rsrp", std::to_string(-90 - cell)}}));
  }
  return table;
}

struct Place {
  Size size;
  bool utf8;
};

// Every golden file contains one screen at one size, as characters only.
class FrameGolden : public ::testing::TestWithParam<Place> {
 protected:
  void SetUp() override {
    ::setenv("TZ", "UTC", 1);
    ASSERT_NE(std::setlocale(LC_CTYPE, "C.UTF-8"), nullptr);
    fake.root->table = leadingRows({"Device Info", "LTE", "UMTS", "GSM"});
    fake.application.status = [] {
      application::Status status;
      status.kind = SourceKind::recorded;
      status.source = "lte-ca-drive.mi2log";
      status.connected = true;
      status.events = 10502;
      status.eventsPerSecond = 3.4;
      status.lastEvent = now - 2s;
      status.playback.emplace();
      status.playback->position = 97s;
      status.playback->length = 123s;
      status.playback->clock = 1'453'002'134s;  // 2016-01-17 03:42:14 UTC
      return status;
    };
    fake.application.screenAge = [this](const application::ViewController& screen) {
      return &screen == fake.detail.get() ? std::optional(application::ScreenAge{4s, true, false}) : std::nullopt;
    };
    session = std::make_unique<Session>(fake.application, mailbox, GetParam().utf8);
    draw();
  }

  void draw() { text = session->draw(GetParam().size, now).grid.text(); }
  void press(Key key) {
    session->handle({key, 0, 0, 0});
    draw();
  }
  void type(std::u32string_view keys) {
    for (const char32_t key : keys) session->handle({Key::character, key, 0, 0});
    draw();
  }
  void open(TableSnapshot table) {
    fake.detail->table = std::move(table);
    press(Key::down);
    press(Key::enter);
  }
  [[nodiscard]] ::testing::AssertionResult matches(const std::string& name) const {
    const Place& place = GetParam();
    const std::string size = std::to_string(place.size.width) + "x" + std::to_string(place.size.height);
    return matchesGolden(std::string(VESPSCOPE_SOURCE_DIR "/tests/frontends/terminal/golden/frames/") + name + "-" +
                             size + (place.utf8 ? "-utf8" : "-ascii") + ".txt",
                         text);
  }

  FakeApplication fake;
  LogMailbox mailbox;
  std::unique_ptr<Session> session;
  std::string text;
};

TEST_P(FrameGolden, TheLaunchList) { EXPECT_TRUE(matches("launch")); }

TEST_P(FrameGolden, ValuesLongAndWideAndTheOneThatChanged) {
  open(servingCell("-90"));
  fake.detail->show(servingCell("-91"));
  draw();
  EXPECT_TRUE(matches("values"));
}

TEST_P(FrameGolden, SectionsScrolledIntoTheirMiddle) {
  open(neighbours(20));
  type(U"jjjjjjjjjjjjjjjjjjjjjjjjj");
  EXPECT_TRUE(matches("sections"));
}

TEST_P(FrameGolden, AFilterBeingTyped) {
  open(neighbours(3));
  type(U"/RSRP");
  EXPECT_TRUE(matches("filter-typed"));
}

TEST_P(FrameGolden, AFilterThatIsKept) {
  open(neighbours(3));
  type(U"/102");
  press(Key::enter);
  EXPECT_TRUE(matches("filter-kept"));
}

TEST_P(FrameGolden, AFilterThatNothingMatches) {
  open(neighbours(3));
  type(U"/nothing");
  press(Key::enter);
  EXPECT_TRUE(matches("filter-none"));
}

TEST_P(FrameGolden, Help) {
  type(U"?");
  EXPECT_TRUE(matches("help"));
}

TEST_P(FrameGolden, TheLogPane) {
  for (int number = 0; number < 12; ++number) {
    mailbox.post(log::Channel::systemLog, "metricsDidUpdate: MetricsTrigger dict=[kKeyMetricID: 3952132]", now);
    mailbox.post(log::Channel::standardOutput, "Metric ID in Hex =  3C4E04", now);
    mailbox.post(log::Channel::standardOutput,
                 "Current RRC state is [timestamp: 2023-11-14 22:13:17 UTC, rrc_state: " + std::to_string(number) + "]",
                 now);
  }
  type(U"l");
  EXPECT_TRUE(matches("log"));
}

TEST_P(FrameGolden, AnEmptyScreen) {
  open({{valueSection({}, {})}});
  EXPECT_TRUE(matches("empty"));
}

TEST_P(FrameGolden, AScreenOfALongPath) {
  fake.root->table = leadingRows({"x",
                                  "LTE with a name that is far too long for a line of this terminal, whatever its "
                                  "width may be, since it goes on and on"});
  fake.root->tableView().reloadData();
  draw();
  open(neighbours(1));
  EXPECT_TRUE(matches("long-path"));
}

INSTANTIATE_TEST_SUITE_P(At, FrameGolden,
                         ::testing::Values(Place{{40, 12}, true}, Place{{40, 12}, false}, Place{{80, 24}, true},
                                           Place{{80, 24}, false}, Place{{120, 40}, true}, Place{{120, 40}, false}),
                         [](const auto& place) {
                           return std::to_string(place.param.size.width) + "x" +
                                  std::to_string(place.param.size.height) + (place.param.utf8 ? "Utf8" : "Ascii");
                         });

std::string tooSmallText(Size size) { return layOutFrame(View{}, size, true).grid.text(); }

TEST(Frame, ATerminalThatIsTooSmallSaysSoAtAnySize) {
  EXPECT_EQ(tooSmallText({39, 3}), "terminal too small (39x3, needs 40x12)\n\n\n");
  EXPECT_EQ(tooSmallText({30, 3}), "terminal too small (30x3,\nneeds 40x12)\n\n");
  EXPECT_EQ(tooSmallText({10, 3}), "terminal\ntoo small\n(10x3,\n");
  EXPECT_EQ(tooSmallText({1, 1}), "t\n");
  EXPECT_EQ(tooSmallText({0, 0}), "");
}

TEST(Frame, EverySizeFromTheSmallestOnHasABodyOfAtLeastHalf) {
  for (int height = smallestSize.height; height < 60; ++height) {
    const FrameShape shape = shapeOf({40, height});
    EXPECT_GE(shape.bodyHeight * 2, height);
    EXPECT_LT(shape.body + shape.bodyHeight, height);
  }
}

}  // namespace
}  // namespace vespscope::test
