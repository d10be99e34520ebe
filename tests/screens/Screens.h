// Makes screens with their cell prototypes, on a decoder of the test's own.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "metrics/MetricValidator.h"
#include "platform/application/TableSnapshot.h"
#include "rhoxlink/Rhoxlink.h"
#include "screens/SecondLevelViewController.h"

namespace vespscope::testing {

// No screen of these tests may look for a manager.
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

}  // namespace vespscope::testing
