// The application window with its contents, driven by the main loop inside the toolkit's event loop.
#pragma once

#include <QQmlApplicationEngine>
#include <QSocketNotifier>

#include "frontends/quick/Appearance.h"
#include "frontends/quick/LogModel.h"
#include "frontends/quick/NavigationModel.h"
#include "frontends/quick/StatusModel.h"
#include "platform/application/Application.h"

class QQuickWindow;

namespace vespscope::quick {

class MainWindow {
 public:
  // Opens the window; `application`, whose first screen is loaded, must outlive it.
  explicit MainWindow(application::Application& application);

  [[nodiscard]] Appearance& appearance() { return appearance_; }
  [[nodiscard]] StatusModel& status() { return status_; }
  [[nodiscard]] LogModel& log() { return log_; }
  [[nodiscard]] NavigationModel& navigation() { return navigation_; }
  [[nodiscard]] QQuickWindow* window() const;

 private:
  Appearance appearance_;
  LogModel log_;
  StatusModel status_;
  NavigationModel navigation_;
  QSocketNotifier loop_;
  // The last member, so that the views are destroyed before their models.
  QQmlApplicationEngine engine_;
};

}  // namespace vespscope::quick
