#include "screens/SecondLevelViewController.h"

#include <chrono>

#include "metrics/MetricValidator.h"
#include "platform/application/Timer.h"
#include "platform/dispatch/MainLoop.h"
#include "platform/log/Log.h"
#include "screens/ScreenSources.h"
#include "screens/SystemBackground.h"
#include "values/Text.h"

namespace vespscope {
namespace {

constexpr std::chrono::milliseconds refreshInterval{5000};

}  // namespace

SecondLevelViewController::SecondLevelViewController()
    : tableViewFields(VespViewItems::shared()), myMetricValidator(MetricValidator::shared()) {}

void SecondLevelViewController::viewDidLoad() {
  TableViewController::viewDidLoad();
  application::scheduleTimer(refreshInterval, std::static_pointer_cast<SecondLevelViewController>(shared_from_this()),
                             &SecondLevelViewController::update);
  adoptSystemBackground(*this);
}

std::string SecondLevelViewController::screenKey() const {
  if (!firstSelection || !seguedThroughRow) log::fatal("a second-level screen was shown without its selection");
  return *firstSelection + " " + *seguedThroughRow;
}

const Record* SecondLevelViewController::recordOf(const ScreenSource& source, std::size_t section) const {
  const std::size_t sections = source.list == nullptr ? 1 : source.list(*myMetricValidator).size();
  if (section >= sections) log::fatal("\"" + screenKey() + "\" has no section " + std::to_string(section));
  return source.list == nullptr ? source.record(*myMetricValidator) : &source.list(*myMetricValidator)[section];
}

std::size_t SecondLevelViewController::numberOfSections() {
  const ScreenSource* source = screenSource(screenKey());
  return source == nullptr || source->list == nullptr ? 1 : source->list(*myMetricValidator).size();
}

std::size_t SecondLevelViewController::numberOfRows(std::size_t section) {
  const ScreenSource* source = screenSource(screenKey());
  if (source == nullptr) return 1;
  const Record* record = recordOf(*source, section);
  return record == nullptr ? 0 : record->size();
}

std::shared_ptr<application::TableCell> SecondLevelViewController::cellForRow(application::IndexPath path) {
  currentCell = tableView().dequeueReusableCell("SecondClickView", path);
  std::string label = "Come back later";
  std::string value = label;
  if (const ScreenSource* source = screenSource(screenKey())) {
    const Record* record = recordOf(*source, path.section);
    if (record == nullptr || path.row >= record->size()) {
      log::fatal("\"" + screenKey() + "\" has no row " + std::to_string(path.row));
    }
    const Entry& field = record->at(path.row);
    label = printable(field.key.view());
    value = toText(field.value);
  }
  if (currentCell->textLabel) currentCell->textLabel->text = std::move(label);
  if (currentCell->detailTextLabel) currentCell->detailTextLabel->text = std::move(value);
  return currentCell;
}

std::optional<std::string> SecondLevelViewController::titleForHeader(std::size_t section) {
  const ScreenSource* source = screenSource(screenKey());
  if (source == nullptr || source->headerPrefix.empty()) return std::nullopt;
  return std::string(source->headerPrefix) + std::to_string(section + 1);
}

double SecondLevelViewController::heightForRow(application::IndexPath /*path*/) {
  return application::automaticDimension;
}
double SecondLevelViewController::estimatedHeightForRow(application::IndexPath /*path*/) {
  return application::automaticDimension;
}

std::optional<std::int64_t> SecondLevelViewController::metric() const {
  const ScreenSource* source = screenSource(screenKey());
  return source == nullptr ? std::nullopt : source->metric;
}

void SecondLevelViewController::update() {
  dispatch::MainLoop::main().async([self = shared_from_this(), this] { tableView().reloadData(); });
}

}  // namespace vespscope
