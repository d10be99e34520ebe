#include "frontends/quick/NavigationModel.h"

#include <QQmlEngine>

#include "platform/log/Log.h"

namespace vespscope::quick {

NavigationModel::NavigationModel(application::Application& application, QObject* parent)
    : QAbstractListModel(parent), application_(application) {
  follow();
  connect(&ageTimer_, &QTimer::timeout, this, &NavigationModel::refreshAges);
  ageTimer_.start(500);
}

int NavigationModel::rowCount(const QModelIndex& parent) const { return parent.isValid() ? 0 : depth(); }

QHash<int, QByteArray> NavigationModel::roleNames() const { return {{table, "table"}}; }

QVariant NavigationModel::data(const QModelIndex& index, int role) const {
  if (!checkIndex(index, CheckIndexOption::IndexIsValid) || role != table) return {};
  return QVariant::fromValue(tableAt(index.row()));
}

bool NavigationModel::open(int level, int line) {
  if (level < 0 || level >= depth() || line < 0 || line >= tableAt(level)->count()) return false;
  const std::shared_ptr<application::TableViewController> screen = tableAt(level)->screen();
  const Line& chosen = tableAt(level)->lines()[static_cast<std::size_t>(line)];
  // The screen may have fewer rows now than when it was read.
  const application::IndexPath path = chosen.path;
  if (chosen.header || path.section >= screen->numberOfSections() || path.row >= screen->numberOfRows(path.section) ||
      screen->cellForRow(path)->segueTo.empty()) {
    return false;
  }
  if (chosen.opened && level + 1 < depth()) return true;
  leaveTo(level + 1);
  if (!application_.navigation->selectRow(application_.interface, screen, path)) return false;
  tableAt(level)->setOpened(line);
  follow();
  return true;
}

void NavigationModel::leaveTo(int depth) {
  while (static_cast<int>(application_.navigation->viewControllers().size()) > depth &&
         application_.navigation->pop()) {
  }
  follow();
}

void NavigationModel::refresh() {
  follow();
  for (const auto& model : tables_) model->refreshIfAsked();
}

void NavigationModel::refreshAges() {
  for (const auto& model : tables_) model->refreshAge();
}

void NavigationModel::showNextSim() {
  if (application_.showNextSim) application_.showNextSim();
}

void NavigationModel::readAgain() {
  follow();
  for (const auto& model : tables_) model->read();
}

void NavigationModel::follow() {
  const auto& screens = application_.navigation->viewControllers();
  std::size_t kept = 0;
  while (kept < tables_.size() && kept < screens.size() && tables_[kept]->screen() == screens[kept]) ++kept;
  if (kept == tables_.size() && kept == screens.size()) return;
  if (kept < tables_.size()) {
    beginRemoveRows({}, static_cast<int>(kept), depth() - 1);
    tables_.erase(tables_.begin() + static_cast<std::ptrdiff_t>(kept), tables_.end());
    endRemoveRows();
    if (kept > 0) tables_.back()->setOpened(-1);
  }
  if (kept < screens.size()) {
    beginInsertRows({}, static_cast<int>(kept), static_cast<int>(screens.size()) - 1);
    for (std::size_t level = kept; level < screens.size(); ++level) {
      auto screen = std::dynamic_pointer_cast<application::TableViewController>(screens[level]);
      if (!screen) log::fatal("a screen that is no table cannot be drawn");
      tables_.emplace_back(new TableModel(std::move(screen), application_.screenAge));
      QQmlEngine::setObjectOwnership(tables_.back().get(), QQmlEngine::CppOwnership);
    }
    endInsertRows();
  }
  emit depthChanged();
}

}  // namespace vespscope::quick
