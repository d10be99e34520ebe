// The screen stack as a list model of tables, and the navigation in it.
#pragma once

#include <QAbstractListModel>
#include <QTimer>
#include <memory>
#include <vector>

#include <QtQml/qqmlregistration.h>

#include "frontends/quick/TableModel.h"
#include "platform/application/Application.h"

namespace vespscope::quick {

class NavigationModel : public QAbstractListModel {
  Q_OBJECT
  QML_ELEMENT
  QML_UNCREATABLE("made for the application")
  Q_PROPERTY(int depth READ depth NOTIFY depthChanged)

 public:
  enum Role { table = Qt::UserRole };

  // `application` must outlive the model.
  explicit NavigationModel(application::Application& application, QObject* parent = nullptr);

  [[nodiscard]] int rowCount(const QModelIndex& parent = {}) const override;
  [[nodiscard]] QVariant data(const QModelIndex& index, int role) const override;
  [[nodiscard]] QHash<int, QByteArray> roleNames() const override;

  [[nodiscard]] int depth() const { return static_cast<int>(tables_.size()); }
  [[nodiscard]] TableModel* tableAt(int level) const { return tables_.at(static_cast<std::size_t>(level)).get(); }

  // Leaves the screens above `level` and opens the screen that a line of it leads to; if that screen is already open,
  // nothing changes. Returns false, and changes nothing, when the line leads nowhere.
  Q_INVOKABLE bool open(int level, int line);
  // Leaves screens until `depth` remain; the first one stays.
  Q_INVOKABLE void leaveTo(int depth);

  // Reads every table again, whether or not its screen requested a reload.
  Q_INVOKABLE void readAgain();
  // Shows the phone's next SIM card; the tables are read again with its values.
  Q_INVOKABLE void showNextSim();

  // Follows changes of the stack, and reads the tables again that have requested a reload.
  void refresh();

 signals:
  void depthChanged();

 private:
  // A view may still use a table when its row is removed.
  struct DeleteLater {
    void operator()(QObject* object) const { object->deleteLater(); }
  };

  void follow();
  void refreshAges();

  application::Application& application_;
  std::vector<std::unique_ptr<TableModel, DeleteLater>> tables_;
  QTimer ageTimer_;
};

}  // namespace vespscope::quick
