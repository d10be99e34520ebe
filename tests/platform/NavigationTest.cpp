// Cells, table screens, navigation and the application's main function.
#include <memory>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "platform/application/Application.h"
#include "platform/application/TableSnapshot.h"
#include "platform/log/Log.h"

namespace vespscope::test {
namespace {

using namespace application;

class Screen : public TableViewController {
 public:
  explicit Screen(std::string name) : name_(std::move(name)) {}

  void viewDidLoad() override { ++loads; }
  std::size_t numberOfRows(std::size_t /*section*/) override { return 2; }
  std::shared_ptr<TableCell> cellForRow(IndexPath path) override {
    auto cell = tableView().dequeueReusableCell(path.row == 0 ? "leads" : "stays", path);
    cell->textLabel->text = name_ + " " + std::to_string(path.row);
    if (cell->detailTextLabel) cell->detailTextLabel->text = "value";
    return cell;
  }
  std::optional<std::string> titleForHeader(std::size_t section) override { return "part " + std::to_string(section); }
  void prepareForSegue(const Segue& segue, const SegueSender& sender) override {
    ++prepared;
    source = segue.source;
    destination = segue.destination;
    selected = sender.cell;
    destinationLoads = std::dynamic_pointer_cast<Screen>(segue.destination)->loads;
  }

  int loads = 0;
  int destinationLoads = -1;
  int prepared = 0;
  // Of the last segue; weak, because the source of a segue is this screen itself.
  std::weak_ptr<ViewController> source;
  std::weak_ptr<ViewController> destination;
  std::shared_ptr<TableCell> selected;

 private:
  std::string name_;
};

InterfaceDescription twoScenes(std::string secondTitle) {
  InterfaceDescription interface;
  const std::vector<CellPrototype> prototypes = {{"leads", CellStyle::basic, true, "second"},
                                                 {"stays", CellStyle::value, false, ""}};
  interface.addScene({"first", "Start", prototypes, [] { return std::make_shared<Screen>("first"); }});
  interface.addScene({"second", std::move(secondTitle), prototypes, [] { return std::make_shared<Screen>("second"); }});
  interface.setInitial(
      "first", [](const InterfaceDescription& archive) { return std::make_shared<NavigationController>(archive); });
  return interface;
}

std::shared_ptr<Screen> top(const NavigationController& navigation) {
  return std::dynamic_pointer_cast<Screen>(navigation.topViewController());
}

TEST(TableCellPrototypes, ABasicPrototypeGivesOneLabelWithoutText) {
  const auto cell = makeCell({"Row", CellStyle::basic, true, "next"});
  EXPECT_EQ(cell->reuseIdentifier, "Row");
  EXPECT_TRUE(cell->disclosure);
  EXPECT_EQ(cell->segueTo, "next");
  ASSERT_TRUE(cell->textLabel);
  EXPECT_FALSE(cell->textLabel->text);
  EXPECT_FALSE(cell->detailTextLabel);
}

TEST(TableCellPrototypes, AValuePrototypeGivesTwoLabelsWithoutText) {
  const auto cell = makeCell({"Row", CellStyle::value, false, ""});
  ASSERT_TRUE(cell->textLabel && cell->detailTextLabel);
  EXPECT_FALSE(cell->textLabel->text);
  EXPECT_FALSE(cell->detailTextLabel->text);
}

TEST(TableCellPrototypes, AnUnknownIdentifierIsAProgrammingError) {
  TableView table;
  table.registerPrototype({"Row", CellStyle::basic, false, ""});
  EXPECT_EQ(table.dequeueReusableCell("Row", {})->reuseIdentifier, "Row");
  EXPECT_DEATH((void)table.dequeueReusableCell("row", {}), "fatal: no cell prototype \"row\"");
}

TEST(Screens, AScreenIsLoadedOnce) {
  Screen screen("any");
  screen.loadViewIfNeeded();
  screen.loadViewIfNeeded();
  EXPECT_EQ(screen.loads, 1);
}

TEST(Screens, AReloadIsCounted) {
  Screen screen("any");
  EXPECT_EQ(screen.tableView().reloadCount(), 0U);
  screen.tableView().reloadData();
  EXPECT_EQ(screen.tableView().reloadCount(), 1U);
}

TEST(Screens, ASnapshotHoldsTitlesLabelsValuesAndMarks) {
  const auto screen = twoScenes("").instantiate("first");
  const TableSnapshot expected = {{{"part 0", {{"first 0", std::nullopt, true}, {"first 1", "value", false}}}}};
  EXPECT_EQ(readTable(*screen), expected);
}

TEST(Navigation, TheInitialControllerHoldsTheRootScreenNotLoaded) {
  const auto navigation = twoScenes("").instantiateInitial();
  ASSERT_EQ(navigation->viewControllers().size(), 1U);
  EXPECT_EQ(navigation->topViewController()->title(), "Start");
  EXPECT_EQ(top(*navigation)->loads, 0);
}

TEST(Navigation, EachInitialiserKeepsWhatItIsGiven) {
  const auto screen = std::make_shared<Screen>("root");
  EXPECT_EQ(NavigationController(screen).topViewController(), screen);
  const NavigationController barred(BarClasses{"Top", "Bottom"});
  EXPECT_EQ(barred.bars().navigationBar, "Top");
  EXPECT_EQ(barred.bars().toolbar, "Bottom");
  EXPECT_EQ(barred.topViewController(), nullptr);
  const NavigationController fromResource("Main", nullptr);
  EXPECT_EQ(fromResource.resourceName(), "Main");
  EXPECT_EQ(fromResource.bundle(), nullptr);
}

TEST(Navigation, PushingLoadsAndPoppingKeepsTheFirstScreen) {
  const auto navigation = twoScenes("").instantiateInitial();
  const auto pushed = std::make_shared<Screen>("pushed");
  navigation->push(pushed);
  EXPECT_EQ(pushed->loads, 1);
  EXPECT_EQ(navigation->topViewController(), pushed);
  EXPECT_TRUE(navigation->pop());
  EXPECT_FALSE(navigation->pop());
  EXPECT_EQ(navigation->viewControllers().size(), 1U);
}

TEST(Navigation, SelectingARowPreparesTheDestinationBeforeItLoads) {
  const InterfaceDescription interface = twoScenes("");
  const auto navigation = interface.instantiateInitial();
  const auto source = top(*navigation);
  ASSERT_TRUE(navigation->selectRow(interface, source, {0, 0}));
  ASSERT_EQ(source->prepared, 1);
  EXPECT_EQ(source->source.lock(), source);
  EXPECT_EQ(source->destination.lock(), navigation->topViewController());
  ASSERT_TRUE(source->selected);
  EXPECT_EQ(source->selected->textLabel->text, "first 0");
  EXPECT_EQ(source->destinationLoads, 0);
  EXPECT_EQ(top(*navigation)->loads, 1);
}

TEST(Navigation, TheRowNamesADestinationWhoseSceneHasNoTitle) {
  const InterfaceDescription untitled = twoScenes("");
  const auto navigation = untitled.instantiateInitial();
  navigation->selectRow(untitled, top(*navigation), {0, 0});
  EXPECT_EQ(navigation->topViewController()->title(), "first 0");
}

TEST(Navigation, ASceneTitleNamesTheDestination) {
  const InterfaceDescription titled = twoScenes("Details");
  const auto navigation = titled.instantiateInitial();
  navigation->selectRow(titled, top(*navigation), {0, 0});
  EXPECT_EQ(navigation->topViewController()->title(), "Details");
}

TEST(Navigation, ARowWithoutASegueLeadsNowhere) {
  const InterfaceDescription interface = twoScenes("");
  const auto navigation = interface.instantiateInitial();
  EXPECT_FALSE(navigation->selectRow(interface, top(*navigation), {0, 1}));
  EXPECT_EQ(navigation->viewControllers().size(), 1U);
}

TEST(Navigation, AnUnknownSceneIsAProgrammingError) {
  EXPECT_DEATH((void)twoScenes("").instantiate("third"), "fatal: no scene \"third\" in the interface description");
  EXPECT_DEATH((void)InterfaceDescription().instantiateInitial(), "fatal: the interface description has no initial");
}

std::vector<std::string> steps;

class Delegate : public ApplicationDelegate {
 public:
  bool didFinishLaunchingWithOptions(Application& /*application*/, const std::vector<std::string>& options) override {
    steps.push_back("launched with " + options.at(0));
    return true;
  }
  void applicationWillResignActive(Application& /*application*/) override { steps.emplace_back("resign"); }
  void applicationDidEnterBackground(Application& /*application*/) override { steps.emplace_back("background"); }
  void applicationWillEnterForeground(Application& /*application*/) override { steps.emplace_back("foreground"); }
  void applicationDidBecomeActive(Application& /*application*/) override { steps.emplace_back("active"); }
  void applicationWillTerminate(Application& /*application*/) override { steps.emplace_back("terminate"); }
  [[nodiscard]] std::shared_ptr<Window> window() const override { return window_; }
  void setWindow(std::shared_ptr<Window> window) override { window_ = std::move(window); }

 private:
  std::shared_ptr<Window> window_;
};

class OneLook : public Frontend {
 public:
  int run(Application& application) override {
    steps.emplace_back("run");
    EXPECT_EQ(top(*application.navigation)->loads, 1);
    return 7;
  }
};

TEST(ApplicationMain, MakesTheDelegateAndTheFirstScreenAndRunsTheFrontend) {
  registerDelegateClass("Delegate", [] { return std::make_unique<Delegate>(); });
  Application application;
  application.interface = twoScenes("");
  OneLook frontend;
  EXPECT_EQ(applicationMain({"program"}, "Delegate", application, frontend), 7);
  EXPECT_EQ(steps, (std::vector<std::string>{"launched with program", "active", "run", "terminate"}));
}

TEST(ApplicationMain, AnUnknownDelegateClassIsAProgrammingError) {
  Application application;
  application.interface = twoScenes("");
  OneLook frontend;
  EXPECT_DEATH(applicationMain({"program"}, "NoSuchDelegate", application, frontend),
               "fatal: no application delegate class \"NoSuchDelegate\"");
}

}  // namespace
}  // namespace vespscope::test
