// Table screens whose contents a test sets, and an application with them.
#pragma once

#include <functional>
#include <memory>
#include <string>
#include <utility>

#include "platform/application/Application.h"
#include "platform/application/TableSnapshot.h"

namespace vespscope::test {

// Shows the sections of `table`; selecting a row with a disclosure mark opens the screen that `opens` makes for its
// label.
class FakeScreen : public application::TableViewController {
 public:
  application::TableSnapshot table;

  std::size_t numberOfSections() override { return table.sections.size(); }
  std::size_t numberOfRows(std::size_t section) override { return table.sections.at(section).rows.size(); }
  std::optional<std::string> titleForHeader(std::size_t section) override { return table.sections.at(section).title; }
  std::shared_ptr<application::TableCell> cellForRow(application::IndexPath path) override {
    const application::RowSnapshot& row = table.sections.at(path.section).rows.at(path.row);
    const auto style = row.value ? application::CellStyle::value : application::CellStyle::basic;
    auto cell = application::makeCell({"fake", style, row.disclosure, row.disclosure ? "fake" : ""});
    cell->textLabel->text = row.label;
    if (row.value) cell->detailTextLabel->text = row.value;
    return cell;
  }

  void show(application::TableSnapshot next) {
    table = std::move(next);
    tableView().reloadData();
  }
};

// An application whose first screen is `root`; every row with a disclosure mark opens `detail`.
struct FakeApplication {
  std::shared_ptr<FakeScreen> root = std::make_shared<FakeScreen>();
  std::shared_ptr<FakeScreen> detail = std::make_shared<FakeScreen>();
  application::Application application;

  FakeApplication() {
    root->setTitle("vespscope");
    application.interface.addScene({"fake", "", {}, [this] {
                                      detail->setTitle("");
                                      return detail;
                                    }});
    application.navigation = std::make_shared<application::NavigationController>(root);
  }
};

inline application::RowSnapshot leadingRow(std::string label) { return {std::move(label), std::nullopt, true}; }

inline application::TableSnapshot leadingRows(const std::vector<std::string>& labels) {
  application::TableSnapshot table{{{}}};
  for (const std::string& label : labels) table.sections[0].rows.push_back(leadingRow(label));
  return table;
}

using Pairs = std::vector<std::pair<std::string, std::string>>;

inline application::SectionSnapshot valueSection(std::optional<std::string> title, const Pairs& rows) {
  application::SectionSnapshot section{std::move(title), {}};
  for (const auto& [label, value] : rows) section.rows.push_back({label, value, false});
  return section;
}

}  // namespace vespscope::test
