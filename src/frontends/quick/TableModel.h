// Any table screen as a list model: its section headers and rows, filtered, with marks on rows that have changed.
//
// Reading the table again changes only what differs, so that a view keeps its scroll position and selection.
#pragma once

#include <QAbstractListModel>
#include <QTimer>
#include <cstdint>
#include <memory>
#include <optional>
#include <vector>

#include <QtQml/qqmlregistration.h>

#include "frontends/quick/TableLines.h"
#include "platform/application/ScreenAge.h"
#include "platform/application/TableViewController.h"

namespace vespscope::quick {

class TableModel : public QAbstractListModel {
  Q_OBJECT
  QML_ELEMENT
  QML_UNCREATABLE("made for each screen")
  Q_PROPERTY(QString title READ title CONSTANT)
  Q_PROPERTY(QString filter READ filter WRITE setFilter NOTIFY filterChanged)
  Q_PROPERTY(int count READ count NOTIFY countChanged)
  Q_PROPERTY(bool filtered READ filtered NOTIFY filterChanged)
  Q_PROPERTY(QString age READ age NOTIFY ageChanged)
  Q_PROPERTY(bool outdated READ outdated NOTIFY ageChanged)
  Q_PROPERTY(bool reported READ reported NOTIFY ageChanged)

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

  // `screenAge` may be empty.
  explicit TableModel(std::shared_ptr<application::TableViewController> screen,
                      application::ScreenAgeProvider screenAge = {}, QObject* parent = nullptr);

  [[nodiscard]] int rowCount(const QModelIndex& parent = {}) const override;
  [[nodiscard]] QVariant data(const QModelIndex& index, int role) const override;
  [[nodiscard]] QHash<int, QByteArray> roleNames() const override;

  [[nodiscard]] QString title() const { return QString::fromStdString(screen_->title()); }
  [[nodiscard]] QString filter() const { return QString::fromStdString(table_.filter()); }
  void setFilter(const QString& filter);
  [[nodiscard]] bool filtered() const { return !table_.filter().empty(); }
  [[nodiscard]] int count() const { return static_cast<int>(shown_.size()); }
  [[nodiscard]] const Lines& lines() const { return shown_; }
  [[nodiscard]] const std::shared_ptr<application::TableViewController>& screen() const { return screen_; }

  // The age of the screen's values; empty for a screen without reports or before the first one.
  [[nodiscard]] QString age() const { return age_; }
  // Whether they are old, or the last known values of a technology that no longer serves.
  [[nodiscard]] bool outdated() const { return outdated_; }
  // Whether a report for this screen has arrived.
  [[nodiscard]] bool reported() const { return !age_.isEmpty(); }
  // Reads the age again.
  void refreshAge();

  // Reads the table again.
  void read();
  // Reads the table again if its screen has requested that since the last reading.
  void refreshIfAsked();
  // Marks the one row that led to the next screen; -1 marks none.
  void setOpened(int line);

  // The row that a step of the selection leads to: headers are skipped, and the selection stops at the ends. -1 if
  // there is none.
  Q_INVOKABLE [[nodiscard]] int rowFrom(int line, int step) const;
  Q_INVOKABLE void toggleExpanded(int line);
  // Copies the row to the clipboard; returns a message for the user.
  Q_INVOKABLE [[nodiscard]] QString copyRow(int line) const;
  Q_INVOKABLE [[nodiscard]] QString copyAll() const;

 signals:
  void filterChanged();
  void countChanged();
  void ageChanged();

 private:
  static constexpr int markMilliseconds = 1600;

  // Updates the shown lines from the table and the user's selections.
  void update();
  void show(Lines next);
  void clearMarks();
  [[nodiscard]] const Line* rowAt(int line) const;

  std::shared_ptr<application::TableViewController> screen_;
  application::ScreenAgeProvider screenAge_;
  std::uint64_t reloadsSeen_ = 0;
  application::LiveTable table_;
  std::vector<application::RowIdentity> expanded_;
  std::optional<application::RowIdentity> opened_;
  Lines shown_;
  QString age_;
  bool outdated_ = false;
  QTimer markTimer_;
};

}  // namespace vespscope::quick
