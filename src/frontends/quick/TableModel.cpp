#include "frontends/quick/TableModel.h"

#include <QClipboard>
#include <QGuiApplication>
#include <algorithm>
#include <utility>

#include "frontends/quick/ListDifference.h"

namespace vespscope::quick {

TableModel::TableModel(std::shared_ptr<application::TableViewController> screen,
                       application::ScreenAgeProvider screenAge, QObject* parent)
    : QAbstractListModel(parent),
      screen_(std::move(screen)),
      screenAge_(std::move(screenAge)),
      reloadsSeen_(screen_->tableView().reloadCount()) {
  table_.reload(application::readTable(*screen_));
  update();
  refreshAge();
  markTimer_.setSingleShot(true);
  markTimer_.setInterval(markMilliseconds);
  connect(&markTimer_, &QTimer::timeout, this, &TableModel::clearMarks);
}

int TableModel::rowCount(const QModelIndex& parent) const { return parent.isValid() ? 0 : count(); }

QHash<int, QByteArray> TableModel::roleNames() const {
  return {{header, "header"},         {label, "label"},       {value, "value"},  {hasValue, "hasValue"},
          {disclosure, "disclosure"}, {first, "first"},       {last, "last"},    {apart, "apart"},
          {changed, "changed"},       {expanded, "expanded"}, {opened, "opened"}};
}

QVariant TableModel::data(const QModelIndex& index, int role) const {
  if (!checkIndex(index, CheckIndexOption::IndexIsValid)) return {};
  const Line& line = shown_[static_cast<std::size_t>(index.row())];
  switch (role) {
    case header:
      return line.header;
    case Qt::DisplayRole:
    case label:
      return line.label;
    case value:
      return line.value.value_or(QString());
    case hasValue:
      return line.value.has_value();
    case disclosure:
      return line.disclosure;
    case first:
      return line.first;
    case last:
      return line.last;
    case apart:
      return line.apart;
    case changed:
      return line.changed;
    case expanded:
      return line.expanded;
    case opened:
      return line.opened;
    default:
      return {};
  }
}

void TableModel::setFilter(const QString& filter) {
  std::string wanted = filter.toStdString();
  if (wanted == table_.filter()) return;
  table_.setFilter(std::move(wanted));
  update();
  emit filterChanged();
}

void TableModel::refreshIfAsked() {
  if (screen_->tableView().reloadCount() != reloadsSeen_) read();
}

void TableModel::read() {
  reloadsSeen_ = screen_->tableView().reloadCount();
  table_.reload(application::readTable(*screen_));
  if (table_.hasChanges()) markTimer_.start();
  update();
  refreshAge();
}

void TableModel::refreshAge() {
  const auto answer = screenAge_ ? screenAge_(*screen_) : std::nullopt;
  const QString age = answer ? QString::fromStdString(application::screenAgeText(*answer)) : QString();
  const auto freshness = answer ? application::freshnessOf(*answer) : application::Freshness::none;
  const bool outdated = freshness == application::Freshness::old || freshness == application::Freshness::lastKnown;
  if (age == age_ && outdated == outdated_) return;
  age_ = age;
  outdated_ = outdated;
  emit ageChanged();
}

void TableModel::update() {
  Lines next = linesOf(table_);
  for (Line& line : next) {
    if (line.header) continue;
    line.expanded = std::find(expanded_.begin(), expanded_.end(), line.identity) != expanded_.end();
    line.opened = opened_ == line.identity;
  }
  show(std::move(next));
}

void TableModel::show(Lines next) {
  const std::size_t before = shown_.size();
  const auto edits = differenceOf(shown_.size(), next.size(),
                                  [&](std::size_t i, std::size_t j) { return shown_[i].isSameAs(next[j]); });
  for (const Edit& edit : edits) {
    const int from = static_cast<int>(edit.at);
    const int to = static_cast<int>(edit.at + edit.count) - 1;
    const auto place = shown_.begin() + from;
    if (edit.kind == Edit::Kind::remove) {
      beginRemoveRows({}, from, to);
      shown_.erase(place, place + static_cast<std::ptrdiff_t>(edit.count));
      endRemoveRows();
    } else {
      const auto source = next.begin() + static_cast<std::ptrdiff_t>(edit.from);
      beginInsertRows({}, from, to);
      shown_.insert(place, source, source + static_cast<std::ptrdiff_t>(edit.count));
      endInsertRows();
    }
  }
  // The lists have the same lines now; runs of lines with different contents are reported together.
  for (std::size_t start = 0; start < next.size();) {
    if (shown_[start] == next[start]) {
      ++start;
      continue;
    }
    std::size_t end = start;
    for (; end < next.size() && shown_[end] != next[end]; ++end) shown_[end] = next[end];
    emit dataChanged(index(static_cast<int>(start)), index(static_cast<int>(end) - 1));
    start = end;
  }
  if (shown_.size() != before) emit countChanged();
}

void TableModel::clearMarks() {
  table_.forgetChanges();
  update();
}

// Null for a header, and for an index out of range.
const Line* TableModel::rowAt(int line) const {
  if (line < 0 || line >= count()) return nullptr;
  const Line& found = shown_[static_cast<std::size_t>(line)];
  return found.header ? nullptr : &found;
}

void TableModel::setOpened(int line) {
  const Line* row = rowAt(line);
  opened_ = row == nullptr ? std::nullopt : std::optional(row->identity);
  update();
}

void TableModel::toggleExpanded(int line) {
  const Line* row = rowAt(line);
  if (row == nullptr) return;
  const application::RowIdentity identity = row->identity;
  if (std::erase(expanded_, identity) == 0) expanded_.push_back(identity);
  update();
}

int TableModel::rowFrom(int line, int step) const {
  const int direction = step < 0 ? -1 : 1;
  int found = -1;
  int left = std::abs(step);
  const bool valid = line >= 0 && line < count();
  if (valid && !shown_[static_cast<std::size_t>(line)].header) found = line;
  const int start = valid ? line + direction : direction > 0 ? 0 : count() - 1;
  for (int at = start; left > 0 && at >= 0 && at < count(); at += direction) {
    if (shown_[static_cast<std::size_t>(at)].header) continue;
    found = at;
    --left;
  }
  return found;
}

QString TableModel::copyRow(int line) const {
  const Line* row = rowAt(line);
  if (row == nullptr) return {};
  QGuiApplication::clipboard()->setText(QString::fromStdString(application::rowText(table_.row(row->path))));
  return tr("Copied “%1”").arg(row->label);
}

QString TableModel::copyAll() const {
  QGuiApplication::clipboard()->setText(QString::fromStdString(application::tableText(screen_->title(), table_)));
  const std::size_t rows = table_.rows().size();
  return rows == 1 ? tr("Copied 1 row") : tr("Copied %1 rows").arg(rows);
}

}  // namespace vespscope::quick
