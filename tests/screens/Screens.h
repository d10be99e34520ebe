// Makes screens with their cell prototypes and a separate decoder.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "metrics/MetricValidator.h"
#include "platform/application/TableSnapshot.h"
#include "rhoxlink/Rhoxlink.h"
#include "screens/FirstLevelViewController.h"
#include "screens/SecondLevelViewController.h"
#include "screens/VespViewController.h"

namespace vespscope::test {

// The screens of these tests must not look for a manager.
inline void useNoManager() { rhox::client::setAddress({rhox::client::Address::Kind::none, {}}); }

template <class Screen>
std::shared_ptr<Screen> makeScreen(const std::string& cell, application::CellStyle style) {
  useNoManager();
  auto screen = std::make_shared<Screen>();
  screen->tableView().registerPrototype({cell, style, false, ""});
  return screen;
}

inline std::shared_ptr<SecondLevelViewController> secondLevel(const std::string& first, const std::string& second) {
  auto screen = makeScreen<SecondLevelViewController>("SecondClickView", application::CellStyle::value);
  screen->myMetricValidator = std::make_shared<MetricValidator>();
  screen->firstSelection = first;
  screen->seguedThroughRow = second;
  return screen;
}

using Pairs = std::vector<std::pair<std::string, std::string>>;

// Label and value of each row of one section.
inline Pairs rowsOf(application::TableViewController& screen, std::size_t section = 0) {
  const application::TableSnapshot table = application::readTable(screen);
  Pairs pairs;
  for (const auto& row : table.sections.at(section).rows) {
    pairs.emplace_back(row.label, row.value.value_or("(none)"));
  }
  return pairs;
}

// A cell with a text, or without any.
inline std::shared_ptr<application::TableCell> cellSaying(std::optional<std::string> text) {
  auto cell = std::make_shared<application::TableCell>();
  cell->textLabel = application::Label{std::move(text)};
  return cell;
}

// The labels of a screen's first section.
inline std::vector<std::string> labelsOf(application::TableViewController& screen) {
  const application::TableSnapshot table = application::readTable(screen);
  std::vector<std::string> labels;
  for (const auto& row : table.sections.at(0).rows) labels.push_back(row.label);
  return labels;
}

inline auto launchScreen() { return makeScreen<VespViewController>("LaunchView", application::CellStyle::basic); }

inline auto firstLevel(std::optional<std::string> launchRow) {
  auto screen = makeScreen<FirstLevelViewController>("FirstClickView", application::CellStyle::basic);
  screen->seguedThroughRow = std::move(launchRow);
  return screen;
}

inline const std::vector<std::string> launchRows = {"Device Info", "LTE", "UMTS", "GSM"};

}  // namespace vespscope::test
