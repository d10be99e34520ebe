#include "frontends/quick/TableModel.h"

#include <QClipboard>
#include <QGuiApplication>
#include <algorithm>
#include <utility>

#include "frontends/quick/ListDifference.h"

namespace vespscope::quick {

TableModel::TableModel(std::shared_ptr<application::TableViewController> screen, QObject* parent)
    : QAbstractListModel(parent),
      screen_(std::move(screen)),
      reloadsSeen_(screen_->tableView().reloadCount()),
      all_(linesOf(application::readTable(*screen_))),
      shown_(all_) {
  show(linesMatching(all_, filter_));
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
      return line.key.header;
    case Qt::DisplayRole:
    case label:
      return line.key.label;
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
  if (filter == filter_) return;
  filter_ = filter;
  show(linesMatching(all_, filter_));
  emit filterChanged();
}

void TableModel::refreshIfAsked() {
  if (screen_->tableView().reloadCount() != reloadsSeen_) read();
}

void TableModel::read() {
  reloadsSeen_ = screen_->tableView().reloadCount();
  Lines now = linesOf(application::readTable(*screen_));
  carryOver(all_, now);
  all_ = std::move(now);
  if (std::any_of(all_.begin(), all_.end(), [](const Line& line) { return line.changed; })) markTimer_.start();
  show(linesMatching(all_, filter_));
}

void TableModel::show(Lines next) {
  const std::size_t before = shown_.size();
  const auto edits = differenceOf(shown_.size(), next.size(),
                                  [&](std::size_t i, std::size_t j) { return shown_[i].key == next[j].key; });
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
  // The lists hold the same lines now; runs of lines whose contents differ are told in one piece each.
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
  for (Line& line : all_) line.changed = false;
  show(linesMatching(all_, filter_));
}

template <class Change>
void TableModel::changeWhere(const LineKey& key, Change change, int role) {
  for (Lines* lines : {&all_, &shown_}) {
    const auto found = std::find_if(lines->begin(), lines->end(), [&](const Line& line) { return line.key == key; });
    if (found == lines->end()) continue;
    change(*found);
    if (lines != &shown_) continue;
    const QModelIndex changedIndex = index(static_cast<int>(found - lines->begin()));
    emit dataChanged(changedIndex, changedIndex, {role});
  }
}

void TableModel::setOpened(int line) {
  for (const Line& each : Lines(all_)) {
    if (each.opened)
      changeWhere(
          each.key, [](Line& now) { now.opened = false; }, opened);
  }
  if (line < 0 || line >= count()) return;
  const LineKey key = shown_[static_cast<std::size_t>(line)].key;
  changeWhere(
      key, [](Line& now) { now.opened = true; }, opened);
}

void TableModel::toggleExpanded(int line) {
  if (line < 0 || line >= count() || shown_[static_cast<std::size_t>(line)].key.header) return;
  const LineKey key = shown_[static_cast<std::size_t>(line)].key;
  changeWhere(
      key, [](Line& now) { now.expanded = !now.expanded; }, expanded);
}

int TableModel::rowFrom(int line, int step) const {
  const int direction = step < 0 ? -1 : 1;
  int found = -1;
  int left = std::abs(step);
  const bool valid = line >= 0 && line < count();
  if (valid && !shown_[static_cast<std::size_t>(line)].key.header) found = line;
  const int start = valid ? line + direction : direction > 0 ? 0 : count() - 1;
  for (int at = start; left > 0 && at >= 0 && at < count(); at += direction) {
    if (shown_[static_cast<std::size_t>(at)].key.header) continue;
    found = at;
    --left;
  }
  return found;
}

QString TableModel::copyRow(int line) const {
  if (line < 0 || line >= count()) return {};
  const Line& copied = shown_[static_cast<std::size_t>(line)];
  QGuiApplication::clipboard()->setText(textOf(copied));
  return tr("Copied “%1”").arg(copied.key.label);
}

QString TableModel::copyAll() const {
  QGuiApplication::clipboard()->setText(title() + QStringLiteral("\n\n") + textOf(shown_) + QLatin1Char('\n'));
  const auto rows = std::count_if(shown_.begin(), shown_.end(), [](const Line& line) { return !line.key.header; });
  return rows == 1 ? tr("Copied 1 row") : tr("Copied %1 rows").arg(rows);
}

}  // namespace vespscope::quick
