// Any table screen as a list model: its section headers and rows, filtered, with marks on rows that have changed.
//
// Reading the table again changes only what differs, so that a view keeps its scroll position and selection.
#pragma once

#include <QAbstractListModel>
#include <QTimer>
#include <cstdint>
#include <memory>

#include <QtQml/qqmlregistration.h>

#include "frontends/quick/TableLines.h"

namespace vespscope::quick {

class TableModel : public QAbstractListModel {
  Q_OBJECT
  QML_ELEMENT
  QML_UNCREATABLE("made for each screen")
  Q_PROPERTY(QString title READ title CONSTANT)
  Q_PROPERTY(QString filter READ filter WRITE setFilter NOTIFY filterChanged)
  Q_PROPERTY(int count READ count NOTIFY countChanged)
  Q_PROPERTY(bool filtered READ filtered NOTIFY filterChanged)

 public:
  enum Role {
    header = Qt::UserRole,
    label,
    value,
    hasValue,
    disclosure,
    first,
    last,
    apart,
    changed,
    expanded,
    opened
  };

  explicit TableModel(std::shared_ptr<application::TableViewController> screen, QObject* parent = nullptr);

  [[nodiscard]] int rowCount(const QModelIndex& parent = {}) const override;
  [[nodiscard]] QVariant data(const QModelIndex& index, int role) const override;
  [[nodiscard]] QHash<int, QByteArray> roleNames() const override;

  [[nodiscard]] QString title() const { return QString::fromStdString(screen_->title()); }
  [[nodiscard]] const QString& filter() const { return filter_; }
  void setFilter(const QString& filter);
  [[nodiscard]] bool filtered() const { return !filter_.isEmpty(); }
  [[nodiscard]] int count() const { return static_cast<int>(shown_.size()); }
  [[nodiscard]] const Lines& lines() const { return shown_; }
  [[nodiscard]] const std::shared_ptr<application::TableViewController>& screen() const { return screen_; }

  // Reads the table again.
  void read();
  // Does so if its screen has asked for that since the last time.
  void refreshIfAsked();
  // Marks the one row that led to the next screen; -1 marks none.
  void setOpened(int line);

  // The row to which a step of the selection leads: headers are passed over, and the ends hold. -1 if there is none.
  Q_INVOKABLE [[nodiscard]] int rowFrom(int line, int step) const;
  Q_INVOKABLE void toggleExpanded(int line);
  // To the clipboard; returns what the user is told.
  Q_INVOKABLE [[nodiscard]] QString copyRow(int line) const;
  Q_INVOKABLE [[nodiscard]] QString copyAll() const;

 signals:
  void filterChanged();
  void countChanged();

 private:
  static constexpr int markMilliseconds = 1600;

  void show(Lines next);
  void clearMarks();
  template <class Change>
  void changeWhere(const LineKey& key, Change change, int role);

  std::shared_ptr<application::TableViewController> screen_;
  std::uint64_t reloadsSeen_ = 0;
  QString filter_;
  Lines all_;
  Lines shown_;  // those of all lines that match the filter
  QTimer markTimer_;
};

}  // namespace vespscope::quick
