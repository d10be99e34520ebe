#include <algorithm>
#include <memory>

#include <nlohmann/json.hpp>

#include "metrics/MetricValidator.h"
#include "platform/application/NavigationController.h"
#include "platform/application/TableSnapshot.h"
#include "rhoxlink/Rhoxlink.h"
#include "screens/VespViewItems.h"
#include "shell/MainInterface.h"
#include "tools/vespctl/Commands.h"
#include "tools/vespctl/Input.h"
#include "tools/vespctl/Json.h"
#include "tools/vespctl/Output.h"
#include "tools/vespctl/Playback.h"

namespace vespscope::tools {
namespace {

using Rows = VespViewItems::Rows;

std::string listed(const Rows& rows) {
  std::string text;
  for (const std::string& row : rows) text += (text.empty() ? "" : ", ") + row;
  return text;
}

bool contains(const Rows& rows, const std::string& sought) {
  return std::find(rows.begin(), rows.end(), sought) != rows.end();
}

Problem checkSelection(const std::optional<std::string>& launch, const std::optional<std::string>& row) {
  const VespViewItems& catalogue = VespViewItems::shared();
  if (!launch) return std::nullopt;
  if (!contains(catalogue.launchViewItemNames, *launch)) {
    return "no launch row '" + *launch + "'; there are " + listed(catalogue.launchViewItemNames);
  }
  const Rows& rows = catalogue.firstLevelViewItems.at(*launch);
  if (row && !contains(rows, *row)) return "no row '" + *row + "' behind " + *launch + "; there are " + listed(rows);
  return std::nullopt;
}

Json sectionsOf(const application::TableSnapshot& table) {
  Json sections = Json::array();
  for (const application::SectionSnapshot& section : table.sections) {
    Json rows = Json::array();
    for (const application::RowSnapshot& row : section.rows) {
      rows.push_back(Json::array({row.label, row.value ? Json(*row.value) : Json(nullptr)}));
    }
    sections.push_back({{"title", section.title ? Json(*section.title) : Json(nullptr)}, {"rows", std::move(rows)}});
  }
  return sections;
}

// Walks the drill-down as a user does, by selecting rows.
class Walk {
 public:
  Walk() : interface_(mainInterface()), navigation_(interface_) {}

  Json screens(const std::optional<std::string>& launch, const std::optional<std::string>& row) {
    const VespViewItems& catalogue = VespViewItems::shared();
    Json screens = Json::array();
    const Rows& launchRows = catalogue.launchViewItemNames;
    for (std::size_t first = 0; first < launchRows.size(); ++first) {
      if (launch && *launch != launchRows[first]) continue;
      select(first);
      const Rows& rows = catalogue.firstLevelViewItems.at(launchRows[first]);
      for (std::size_t second = 0; second < rows.size(); ++second) {
        if (row && *row != rows[second]) continue;
        select(second);
        screens.push_back({{"launch", launchRows[first]},
                           {"row", rows[second]},
                           {"key", launchRows[first] + " " + rows[second]},
                           {"sections", sectionsOf(application::readTable(*top()))}});
        navigation_.pop();
      }
      navigation_.pop();
    }
    return screens;
  }

 private:
  [[nodiscard]] std::shared_ptr<application::TableViewController> top() const {
    return std::dynamic_pointer_cast<application::TableViewController>(navigation_.topViewController());
  }
  void select(std::size_t row) { navigation_.selectRow(interface_, top(), {0, row}); }

  application::InterfaceDescription interface_;
  application::NavigationController navigation_;
};

}  // namespace

Problem screens(const std::string& file, const std::optional<std::string>& launch,
                const std::optional<std::string>& row, Sim sim) {
  if (Problem problem = checkSelection(launch, row)) return problem;
  Result<Input> input = Input::open(file);
  if (!input) return input.reason();
  input->choose(sim);
  // The screens read the shared decoder, whose wrapper must not find a manager here.
  rhox::client::setAddress({rhox::client::Address::Kind::none, {}});
  Problem problem = playInto(*MetricValidator::shared(), *input);
  if (Problem unwritten = writeLine(write(Walk().screens(launch, row)))) return unwritten;
  return problem;
}

}  // namespace vespscope::tools
