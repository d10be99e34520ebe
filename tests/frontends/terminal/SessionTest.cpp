// Keys and screens of a session without a terminal.
#include <clocale>
#include <cstdlib>

#include <gtest/gtest.h>

#include "frontends/terminal/FakeScreens.h"
#include "frontends/terminal/Session.h"

namespace vespscope::test {
namespace {

using namespace terminal;
using namespace std::chrono_literals;

const std::chrono::system_clock::time_point now{1'700'000'000s};  // 22:13:20 UTC

class SessionTest : public ::testing::Test {
 protected:
  void SetUp() override {
    ::setenv("TZ", "UTC", 1);
    ASSERT_NE(std::setlocale(LC_CTYPE, "C.UTF-8"), nullptr);
    fake.root->table = leadingRows({"Device Info", "LTE", "UMTS", "GSM"});
    fake.detail->table = {{valueSection({}, {{"dl_rf_channel_number", "5780"}, {"phy_cell_id", "185"}})}};
    session = std::make_unique<Session>(fake.application, mailbox, true, [this](const std::string& text) {
      copied = text;
      return hasClipboard;
    });
    draw();
  }

  void draw() { frame = &session->draw(size, now); }
  Session::Wish press(Input input) {
    const Session::Wish wish = session->handle(input);
    draw();
    return wish;
  }
  Session::Wish press(Key key) { return press({key, 0, 0, 0}); }
  Session::Wish type(std::u32string_view text) {
    Session::Wish wish = Session::Wish::draw;
    for (const char32_t character : text) wish = press({Key::character, character, 0, 0});
    return wish;
  }
  Session::Wish paste(std::u32string_view text) {
    Session::Wish wish = Session::Wish::draw;
    for (const char32_t character : text) wish = press({Key::pasted, character, 0, 0});
    return wish;
  }
  [[nodiscard]] std::string line(int number) const {
    std::string text = frame->grid.text();
    for (int skip = 0; skip < number; ++skip) text.erase(0, text.find('\n') + 1);
    return text.substr(0, text.find('\n'));
  }
  [[nodiscard]] bool shows(const std::string& text) const { return frame->grid.text().find(text) != std::string::npos; }
  void open(const std::string& label) {
    while (line(selectedLine()).find(label) == std::string::npos) press(Key::down);
    press(Key::enter);
  }
  [[nodiscard]] int selectedLine() const {
    for (int y = 0; y < size.height; ++y) {
      if (frame->grid.at(0, y).style.selected) return y;
    }
    return -1;
  }

  FakeApplication fake;
  LogMailbox mailbox;
  std::string copied;
  bool hasClipboard = true;
  Size size{80, 24};
  std::unique_ptr<Session> session;
  const Frame* frame = nullptr;
};

TEST_F(SessionTest, TheFirstScreenIsShownWithItsFirstRowSelected) {
  EXPECT_EQ(line(0), "vespscope");
  EXPECT_EQ(line(2), "▸  Device Info  ›");
  EXPECT_EQ(line(3), "   LTE          ›");
  EXPECT_EQ(selectedLine(), 2);
}

TEST_F(SessionTest, EnterOpensTheSelectedRowAndTheBreadcrumbGrows) {
  press(Key::down);
  press(Key::enter);
  EXPECT_EQ(line(0), "vespscope › LTE");
  EXPECT_EQ(line(2), "▸  dl_rf_channel_number  5780");
}

TEST_F(SessionTest, RightOpensAndLeftGoesBackToTheSameRow) {
  press(Key::down);
  press(Key::right);
  EXPECT_EQ(line(0), "vespscope › LTE");
  press(Key::left);
  EXPECT_EQ(line(0), "vespscope");
  EXPECT_EQ(selectedLine(), 3);
}

TEST_F(SessionTest, LettersMoveLikeArrows) {
  type(U"jj");
  EXPECT_EQ(selectedLine(), 4);
  type(U"k");
  EXPECT_EQ(selectedLine(), 3);
  type(U"G");
  EXPECT_EQ(selectedLine(), 5);
  type(U"g");
  EXPECT_EQ(selectedLine(), 2);
  press(Key::enter);
  type(U"h");
  EXPECT_EQ(line(0), "vespscope");
}

TEST_F(SessionTest, EscapeAndBackspaceGoBackToo) {
  for (const Key key : {Key::escape, Key::backspace}) {
    press(Key::enter);
    EXPECT_EQ(line(0), "vespscope › Device Info");
    press(key);
    EXPECT_EQ(line(0), "vespscope");
  }
}

TEST_F(SessionTest, TheFirstScreenIsNotLeft) {
  EXPECT_EQ(press(Key::escape), Session::Wish::draw);
  EXPECT_EQ(press(Key::left), Session::Wish::draw);
  EXPECT_EQ(line(0), "vespscope");
}

TEST_F(SessionTest, ARowThatLeadsNowhereDoesNotOpen) {
  press(Key::enter);
  press(Key::enter);
  EXPECT_EQ(line(0), "vespscope › Device Info");
}

TEST_F(SessionTest, QuitAsksToQuit) { EXPECT_EQ(type(U"q"), Session::Wish::quit); }

TEST_F(SessionTest, ControlLRedrawsTheScreen) { EXPECT_EQ(type(U"\x0C"), Session::Wish::drawAnew); }

TEST_F(SessionTest, AReloadMarksTheRowsThatChanged) {
  press(Key::enter);
  fake.detail->table = {{valueSection({}, {{"dl_rf_channel_number", "700"}, {"phy_cell_id", "185"}})}};
  draw();
  EXPECT_EQ(line(2), "▸  dl_rf_channel_number  5780");
  EXPECT_FALSE(session->isStale());
  fake.detail->tableView().reloadData();
  EXPECT_TRUE(session->isStale());
  draw();
  EXPECT_FALSE(session->isStale());
  EXPECT_EQ(line(2), "▸* dl_rf_channel_number  700");
  EXPECT_EQ(line(3), "   phy_cell_id           185");
  EXPECT_EQ(frame->grid.at(1, 2).style.role, Role::changed);
  fake.detail->tableView().reloadData();
  draw();
  EXPECT_EQ(line(2), "▸  dl_rf_channel_number  700");
}

TEST_F(SessionTest, RReadsTheScreenAtOnce) {
  press(Key::enter);
  fake.detail->table = {{valueSection({}, {{"dl_rf_channel_number", "700"}, {"phy_cell_id", "185"}})}};
  const auto before = fake.detail->tableView().reloadCount();
  type(U"r");
  EXPECT_EQ(line(2), "▸* dl_rf_channel_number  700");
  EXPECT_EQ(fake.detail->tableView().reloadCount(), before);
}

TEST_F(SessionTest, SSwitchesToTheOtherSimCard) {
  application::SimCards sims{1, {2}};
  int switched = 0;
  fake.application.status = [&sims] {
    application::Status status;
    status.sims = sims;
    return status;
  };
  fake.application.showNextSim = [&] {
    ++switched;
    sims = {2, {1}};
  };
  draw();
  EXPECT_TRUE(shows("SIM 1 (also SIM 2)"));
  EXPECT_TRUE(shows("s SIM 2"));
  type(U"s");
  EXPECT_EQ(switched, 1);
  EXPECT_TRUE(shows("Showing SIM 2"));
  EXPECT_TRUE(shows("SIM 2 (also SIM 1)"));
}

TEST_F(SessionTest, SSaysThatThereIsNoOtherSimCard) {
  fake.application.status = [] { return application::Status(); };
  draw();
  EXPECT_FALSE(shows("SIM"));
  type(U"s");
  EXPECT_TRUE(shows("No other SIM card reports"));
}

TEST_F(SessionTest, AScreenThatAppearsByItselfIsStaleAndThenShown) {
  auto other = std::make_shared<FakeScreen>();
  other->setTitle("Pushed");
  fake.application.navigation->push(other);
  EXPECT_TRUE(session->isStale());
  draw();
  EXPECT_EQ(line(0), "vespscope › Pushed");
}

TEST_F(SessionTest, OpeningARowThatIsGoneInTheMeantimeOpensNothing) {
  type(U"G");
  fake.root->table = leadingRows({"Device Info"});
  press(Key::enter);
  EXPECT_EQ(line(0), "vespscope");
}

TEST_F(SessionTest, OpeningARowThatMovedInTheMeantimeOpensThatRow) {
  type(U"G");
  fake.root->table = leadingRows({"GSM", "Device Info"});
  press(Key::enter);
  EXPECT_EQ(line(0), "vespscope › GSM");
}

TEST_F(SessionTest, TheFilterNarrowsTheListWhileItIsTyped) {
  type(U"/");
  EXPECT_EQ(line(23), "/" + std::string(72, ' ') + " 4 of 4");
  ASSERT_TRUE(frame->cursor);
  EXPECT_EQ(*frame->cursor, std::pair(1, 23));
  type(U"tE");
  EXPECT_EQ(line(2), "▸  LTE          ›");
  EXPECT_EQ(line(3), "");
  EXPECT_EQ(line(23), "/tE" + std::string(70, ' ') + " 1 of 4");
}

TEST_F(SessionTest, EnterKeepsTheFilterAndEscapeClearsItBeforeGoingBack) {
  press(Key::enter);
  type(U"/185");
  press(Key::enter);
  EXPECT_FALSE(frame->cursor);
  EXPECT_TRUE(shows("1 of 2 rows with \"185\""));
  EXPECT_EQ(line(2), "▸  phy_cell_id           185");
  press(Key::escape);
  EXPECT_EQ(line(0), "vespscope › Device Info");
  EXPECT_EQ(line(2), "▸  dl_rf_channel_number  5780");
  press(Key::escape);
  EXPECT_EQ(line(0), "vespscope");
}

TEST_F(SessionTest, EscapeWhileTypingClearsTheFilter) {
  type(U"/gsm");
  press(Key::escape);
  EXPECT_FALSE(frame->cursor);
  EXPECT_EQ(line(5), "   GSM          ›");
}

TEST_F(SessionTest, BackspaceTakesCharactersBackAndThenLeavesTheFilter) {
  type(U"/é");
  EXPECT_TRUE(shows("No row contains “é”"));
  press(Key::backspace);
  EXPECT_TRUE(frame->cursor);
  EXPECT_TRUE(shows("GSM"));
  press(Key::backspace);
  EXPECT_FALSE(frame->cursor);
}

TEST_F(SessionTest, LettersThatAreKeysElsewhereAreTextInTheFilter) {
  EXPECT_EQ(type(U"/ql?r"), Session::Wish::draw);
  EXPECT_TRUE(shows("No row contains “ql?r”"));
  type(U"\x15");
  EXPECT_TRUE(shows("4 of 4"));
}

TEST_F(SessionTest, PastedTextIsTextOfTheFilterAndNeverAKey) {
  EXPECT_EQ(paste(U"q\r/l?"), Session::Wish::draw);
  EXPECT_EQ(line(5), "   GSM          ›");
  EXPECT_FALSE(frame->cursor);
  type(U"/");
  EXPECT_EQ(paste(U"\r\nno\tsuch\r\n\nrow\x1b\x15\r"), Session::Wish::draw);
  EXPECT_TRUE(frame->cursor);
  EXPECT_TRUE(shows("No row contains “no such row”"));
  type(U"s");
  EXPECT_TRUE(shows("No row contains “no such rows”"));
}

TEST_F(SessionTest, ArrowsMoveWhileTheFilterIsTyped) {
  type(U"/s");
  EXPECT_EQ(line(2), "▸  UMTS         ›");
  press(Key::down);
  EXPECT_EQ(selectedLine(), 3);
}

TEST_F(SessionTest, EachScreenHasItsOwnFilter) {
  type(U"/lte");
  press(Key::enter);
  press(Key::enter);
  EXPECT_EQ(line(0), "vespscope › LTE");
  EXPECT_TRUE(shows("phy_cell_id"));
  press(Key::escape);
  EXPECT_TRUE(shows("1 of 4 rows with \"lte\""));
}

TEST_F(SessionTest, HelpOpensAndCloses) {
  for (const auto close : {Input{Key::character, '?', 0, 0}, Input{Key::escape, 0, 0, 0}, Input{Key::enter, 0, 0, 0},
                           Input{Key::left, 0, 0, 0}}) {
    type(U"?");
    EXPECT_EQ(line(0), "vespscope › Help");
    EXPECT_TRUE(shows("previous, next row"));
    press(close);
    EXPECT_EQ(line(0), "vespscope");
  }
  type(U"?");
  EXPECT_EQ(type(U"q"), Session::Wish::quit);
}

TEST_F(SessionTest, HelpScrollsToItsLastLine) {
  size = {40, 12};
  draw();
  type(U"?");
  EXPECT_FALSE(shows("events per second"));
  press(Key::end);
  EXPECT_TRUE(shows("events per second"));
  press(Key::home);
  EXPECT_TRUE(shows("previous, next row"));
}

TEST_F(SessionTest, TheLogPaneShowsLinesOfBothChannels) {
  mailbox.post(log::Channel::standardOutput, "pushing metric file", now);
  mailbox.post(log::Channel::systemLog, "listen: listening for events", now);
  type(U"l");
  EXPECT_EQ(line(0), "vespscope › Log");
  EXPECT_EQ(line(2), "22:13:20 out  pushing metric file");
  EXPECT_EQ(line(3), "22:13:20 sys  listen: listening for events");
  EXPECT_FALSE(session->isStale());
  mailbox.post(log::Channel::standardOutput, "more", now);
  EXPECT_TRUE(session->isStale());
  draw();
  EXPECT_EQ(line(4), "22:13:20 out  more");
  type(U"l");
  EXPECT_EQ(line(0), "vespscope");
}

TEST_F(SessionTest, NewLogLinesDoNotMatterWhileThePaneIsClosed) {
  mailbox.post(log::Channel::standardOutput, "more", now);
  EXPECT_FALSE(session->isStale());
}

TEST_F(SessionTest, TheFilterWorksInTheLogPane) {
  mailbox.post(log::Channel::standardOutput, "Received Tx Power is []", now);
  mailbox.post(log::Channel::standardOutput, "Received Valid Metric", now);
  type(U"l/tx");
  EXPECT_EQ(line(2), "22:13:20 out  Received Tx Power is []");
  EXPECT_EQ(line(3), "");
  press(Key::enter);
  EXPECT_TRUE(shows("1 of 2 lines with \"tx\""));
  press(Key::escape);
  EXPECT_EQ(line(3), "22:13:20 out  Received Valid Metric");
  press(Key::escape);
  EXPECT_EQ(line(0), "vespscope");
}

TEST_F(SessionTest, TheLogPaneScrolls) {
  for (int number = 0; number < 100; ++number) {
    mailbox.post(log::Channel::standardOutput, "line " + std::to_string(number), now);
  }
  type(U"l");
  EXPECT_TRUE(shows(" newest "));
  EXPECT_TRUE(shows("line 99"));
  press(Key::up);
  EXPECT_TRUE(shows(" 1 below "));
  press(Key::home);
  EXPECT_EQ(line(2), "22:13:20 out  line 0");
  press({Key::wheelDown, 0, 0, 0});
  EXPECT_EQ(line(2), "22:13:20 out  line 3");
  press(Key::pageDown);
  EXPECT_EQ(line(2), "22:13:20 out  line 21");
  press(Key::end);
  EXPECT_TRUE(shows(" newest "));
}

TEST_F(SessionTest, AClickOpensARowThatLeadsOn) {
  press({Key::click, 0, 5, 4});
  EXPECT_EQ(line(0), "vespscope › UMTS");
}

TEST_F(SessionTest, AClickSelectsARowThatLeadsNowhere) {
  press(Key::enter);
  press({Key::click, 0, 5, 3});
  EXPECT_EQ(selectedLine(), 3);
  EXPECT_EQ(line(0), "vespscope › Device Info");
}

TEST_F(SessionTest, AClickOnTheBreadcrumbGoesBack) {
  press(Key::enter);
  press({Key::click, 0, 10, 0});  // the separator
  EXPECT_EQ(line(0), "vespscope › Device Info");
  press({Key::click, 0, 8, 0});
  EXPECT_EQ(line(0), "vespscope");
}

TEST_F(SessionTest, AClickBesideTheRowsDoesNothing) {
  press({Key::click, 0, 5, 15});
  press({Key::click, 0, 5, 22});
  press({Key::click, 0, 200, 200});
  press({Key::click, 0, -1, -1});
  EXPECT_EQ(line(0), "vespscope");
  EXPECT_EQ(selectedLine(), 2);
}

TEST_F(SessionTest, TheWheelScrollsTheTable) {
  Pairs rows;
  for (int number = 0; number < 50; ++number) rows.emplace_back("row " + std::to_string(number), "x");
  fake.detail->table = {{valueSection({}, rows)}};
  press(Key::enter);
  press({Key::wheelDown, 0, 0, 0});
  EXPECT_EQ(line(2), "▸  row 3   x");
  press({Key::wheelUp, 0, 0, 0});
  EXPECT_EQ(line(2), "   row 0   x");
}

TEST_F(SessionTest, BelowTheSmallestSizeOnlyQuittingWorks) {
  for (const Size small : {Size{39, 12}, Size{40, 11}, Size{1, 1}, Size{3, 2}}) {
    size = small;
    draw();
    press(Key::enter);
    EXPECT_EQ(type(U"j?l/x"), Session::Wish::draw);
    EXPECT_EQ(type(U"q"), Session::Wish::quit);
  }
  size = {80, 24};
  draw();
  EXPECT_EQ(line(0), "vespscope");
  EXPECT_EQ(selectedLine(), 2);
}

TEST_F(SessionTest, TheSelectedRowStaysInViewWhenTheTerminalShrinks) {
  Pairs rows;
  for (int number = 0; number < 18; ++number) rows.emplace_back("row " + std::to_string(number), "x");
  fake.detail->table = {{valueSection({}, rows)}};
  press(Key::enter);
  type(U"G");
  size = {40, 12};
  draw();
  EXPECT_TRUE(shows("row 17"));
  EXPECT_NE(selectedLine(), -1);
}

TEST_F(SessionTest, AScreenWithoutRowsExplainsWhatItWaitsFor) {
  fake.detail->table = {{valueSection({}, {})}};
  press(Key::enter);
  EXPECT_TRUE(shows("Waiting for Update"));
  EXPECT_TRUE(shows("The modem has not reported these values yet"));
  fake.application.status = [] { return application::Status{}; };
  draw();
  EXPECT_TRUE(shows("The baseband manager is not connected"));
  fake.application.status = [] {
    application::Status status;
    status.connected = true;
    return status;
  };
  draw();
  EXPECT_TRUE(shows("has not sent any event yet"));
}

TEST_F(SessionTest, AScreenWithoutSectionsSaysThatItsListIsEmpty) {
  fake.detail->table = {};
  press(Key::enter);
  EXPECT_TRUE(shows("Waiting for Update"));
  EXPECT_TRUE(shows("had no entries"));
}

TEST_F(SessionTest, AFilterKeepsTheHeaderOfWhatItFindsAndFindsHeaders) {
  fake.detail->table = {{valueSection("LTE Neighbor 1", {{"pci", "1"}, {"rsrp", "-90"}}),
                         valueSection("LTE Neighbor 2", {{"pci", "2"}, {"rsrp", "-95"}})}};
  press(Key::enter);
  type(U"/-95");
  EXPECT_EQ(line(2), " LTE Neighbor 2");
  EXPECT_EQ(line(3), "▸  rsrp  -95");
  press(Key::escape);
  type(U"/neighbor 2");
  EXPECT_EQ(line(2), " LTE Neighbor 2");
  EXPECT_EQ(line(3), "▸  pci   2");
  EXPECT_EQ(line(4), "   rsrp  -95");
  EXPECT_FALSE(shows("LTE Neighbor 1"));
}

TEST_F(SessionTest, ALongPasteIntoTheFilterIsCutAndAppliedOnce) {
  Pairs rows;
  for (int number = 0; number < 1000; ++number) rows.emplace_back("row " + std::to_string(number), "x");
  fake.detail->table = {{valueSection({}, rows)}};
  press(Key::enter);
  type(U"/");
  for (int count = 0; count < 100'000; ++count) session->handle({Key::character, U'中', 0, 0});
  draw();
  EXPECT_TRUE(shows("0 of 1000"));
  press(Key::enter);
  // The rule shows the filter as far as it fits; characters beyond the longest filter were ignored.
  for (std::size_t left = application::TextFilter::longestText; left > 1; --left) {
    type(U"/");
    press(Key::backspace);
    press(Key::enter);
  }
  type(U"/");
  EXPECT_TRUE(shows("/中  "));
  press(Key::backspace);
  EXPECT_TRUE(shows("row 0"));
}

TEST_F(SessionTest, AFilterThatIsTypedAndKeptBeforeTheNextFrameIsApplied) {
  press(Key::enter);
  for (const char32_t character : U"/185") {
    if (character != 0) session->handle({Key::character, character, 0, 0});
  }
  press(Key::enter);
  EXPECT_TRUE(shows("1 of 2 rows with \"185\""));
}

TEST_F(SessionTest, YCopiesTheSelectedRowAndCapitalYTheScreen) {
  fake.detail->table = {{valueSection("Section", {{"dl_rf_channel_number", "5780"}, {"phy_cell_id", "185"}})}};
  press(Key::enter);
  press(Key::down);
  type(U"y");
  EXPECT_EQ(copied, "phy_cell_id: 185");
  EXPECT_TRUE(shows("Copied phy_cell_id"));
  press(Key::up);
  EXPECT_FALSE(shows("Copied"));
  type(U"Y");
  EXPECT_EQ(copied, "Device Info\n\nSection\ndl_rf_channel_number: 5780\nphy_cell_id: 185\n");
  EXPECT_TRUE(shows("Copied 2 rows"));
  hasClipboard = false;
  type(U"y");
  EXPECT_TRUE(shows("This terminal has no clipboard"));
  fake.detail->table = {{valueSection({}, {{"apn", std::string(Session::longestCopy, 'x')}})}};
  type(U"r");
  copied.clear();
  type(U"y");
  EXPECT_EQ(copied, "");
  EXPECT_TRUE(shows("Too long for a terminal's clipboard"));
}

TEST_F(SessionTest, TheFirstLineSaysHowOldTheValuesAre) {
  application::ScreenAge age;
  fake.application.screenAge = [&age, this](const application::ViewController& screen) {
    return &screen == fake.detail.get() ? std::optional(age) : std::nullopt;
  };
  const auto role = [this] { return frame->grid.at(size.width - 1, 0).style.role; };
  draw();
  EXPECT_EQ(line(0), "vespscope");
  press(Key::enter);
  EXPECT_EQ(line(0), "vespscope › Device Info");  // no report has come
  age.age = 3s;
  age.measurement = true;
  draw();
  EXPECT_EQ(line(0).substr(line(0).size() - 16), " updated 3 s ago");
  EXPECT_EQ(role(), Role::faint);
  age.age = 47s;
  draw();
  EXPECT_EQ(line(0).substr(line(0).size() - 17), " updated 47 s ago");
  EXPECT_EQ(role(), Role::old);
  age.lastKnown = true;
  draw();
  EXPECT_EQ(line(0).substr(line(0).size() - 22), "  last known, 47 s ago");
  EXPECT_EQ(role(), Role::old);
  size = {40, 12};
  draw();
  EXPECT_EQ(line(0), "vespscope › Device Info       last known");
  type(U"?");
  EXPECT_FALSE(shows("last known, 47"));
}

TEST_F(SessionTest, TextsCannotBringControlCharacters) {
  fake.detail->table = {
      {valueSection("ti\x1btle", {{"la\nbel", "va\x07lue\x9b"}, {"\u009b31m", "\u202e\u2066\x7f\x1b]0;t\x07"}})}};
  fake.detail->setTitle("x");
  press(Key::enter);
  for (const char character : frame->grid.text()) {
    EXPECT_TRUE(character == '\n' || static_cast<unsigned char>(character) >= 0x20);
  }
  EXPECT_TRUE(shows("la␊bel"));
  EXPECT_TRUE(shows("\uFFFD31m"));
  EXPECT_TRUE(shows("\uFFFD\uFFFD␡␛]0;t␇"));
  for (const std::string raw : {"\x7f", "\u009b", "\u202e", "\u2066"}) {
    EXPECT_EQ(frame->grid.text().find(raw), std::string::npos);
  }
}

TEST_F(SessionTest, AListOfFourThousandSectionsAndAValueOfAMegabyteAreShownAndMovedThrough) {
  application::TableSnapshot table;
  for (int number = 0; number < 4096; ++number) {
    table.sections.push_back(
        valueSection("LTE Neighbor " + std::to_string(number + 1), {{"pci", std::to_string(number)}}));
  }
  table.sections.push_back(valueSection("last", {{"apn", std::string(std::size_t{1} << 20, 'x')}}));
  fake.detail->table = table;
  fake.detail->setTitle("x");
  press(Key::enter);
  EXPECT_TRUE(shows("LTE Neighbor 1"));
  type(U"/4095");
  EXPECT_TRUE(shows("LTE Neighbor 4096"));
  press(Key::escape);
  press(Key::end);
  EXPECT_TRUE(shows("xxxxxxxxxx"));
  EXPECT_EQ(frame->grid.size(), size);
}

TEST_F(SessionTest, ManyRandomKeysLeaveAFrameOfTheRightSize) {
  Pairs rows;
  for (int number = 0; number < 40; ++number) rows.emplace_back("row " + std::to_string(number), std::string(90, 'x'));
  unsigned random = 1;
  for (int step = 0; step < 1500; ++step) {
    random = random * 1103515245U + 12345U;
    const unsigned pick = (random >> 16) % 64;
    if (pick == 63) size = {static_cast<int>(random >> 20) % 130, static_cast<int>(random >> 24) % 50};
    if (pick == 62) fake.detail->show({{valueSection("s", Pairs(rows.begin(), rows.begin() + (random >> 20) % 40))}});
    if (pick < 16) {
      press({static_cast<Key>(pick % 15), U'x', static_cast<int>(random >> 22) % 100, static_cast<int>(random >> 25)});
    } else {
      type(std::u32string(1, U"jkhlgGr?/ \x0c\x15q中z"[pick % 15]));
    }
    ASSERT_EQ(frame->grid.size(), size);
  }
}

}  // namespace
}  // namespace vespscope::test
