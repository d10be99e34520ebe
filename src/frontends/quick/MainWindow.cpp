#include "frontends/quick/MainWindow.h"

#include <QLoggingCategory>
#include <QQuickWindow>

#include "platform/dispatch/MainLoop.h"
#include "platform/log/Log.h"

// The module's types and its compiled files are registered by functions that only generated code declares; in a static
// library they must be called explicitly.
extern void qml_register_types_Vespscope_Quick();
static void registerModule() {
  Q_INIT_RESOURCE(qmake_Vespscope_Quick);
  Q_INIT_RESOURCE(quick_raw_qml_0);
  Q_INIT_RESOURCE(qmlcache_quick);
  qml_register_types_Vespscope_Quick();
}

namespace vespscope::quick {
namespace {

// Silent unless QT_LOGGING_RULES="vespscope.quick=true"; measurements wait for these lines.
Q_LOGGING_CATEGORY(progress, "vespscope.quick", QtWarningMsg)

}  // namespace

MainWindow::MainWindow(application::Application& application)
    : status_(application.status),
      navigation_(application),
      loop_(dispatch::MainLoop::main().descriptor(), QSocketNotifier::Read) {
  QObject::connect(&loop_, &QSocketNotifier::activated, &navigation_, [this] {
    dispatch::MainLoop::main().runOnce(std::chrono::milliseconds(0));
    navigation_.refresh();
  });

  registerModule();
  engine_.addImportPath(QStringLiteral("qrc:/"));
  engine_.setInitialProperties({{"navigation", QVariant::fromValue(&navigation_)},
                                {"status", QVariant::fromValue(&status_)},
                                {"log", QVariant::fromValue(&log_)},
                                {"appearance", QVariant::fromValue(&appearance_)}});
  engine_.load(QUrl(QStringLiteral("qrc:/Vespscope/Quick/Main.qml")));
  if (engine_.rootObjects().isEmpty()) log::fatal("the window's description does not load");
  QObject::connect(
      window(), &QQuickWindow::frameSwapped, window(), [] { qCDebug(progress, "first frame"); },
      Qt::SingleShotConnection);
}

QQuickWindow* MainWindow::window() const { return qobject_cast<QQuickWindow*>(engine_.rootObjects().constFirst()); }

}  // namespace vespscope::quick
