// The application window with everything that it shows, fed by the main loop inside the toolkit's own loop.
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
  // Opens the window; `application`, whose first screen is loaded, outlives it.
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
  // Last, so that the views are gone before what they show.
  QQmlApplicationEngine engine_;
};

}  // namespace vespscope::quick
