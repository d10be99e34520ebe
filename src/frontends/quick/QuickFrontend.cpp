#include "frontends/quick/QuickFrontend.h"

#include <QGuiApplication>
#include <array>
#include <utility>

#include "frontends/quick/Display.h"
#include "frontends/quick/MainWindow.h"
#include "platform/dispatch/MainLoop.h"
#include "platform/dispatch/SignalWatch.h"
#include "platform/log/Log.h"

namespace vespscope::quick {
namespace {

// While it lives, the message with which the toolkit would abort is passed to the handler instead.
class StartWatch {
 public:
  explicit StartWatch(RefusalHandler refused) {
    handler = std::move(refused);
    previous = qInstallMessageHandler(&hear);
  }
  StartWatch(const StartWatch&) = delete;
  StartWatch& operator=(const StartWatch&) = delete;
  ~StartWatch() {
    qInstallMessageHandler(previous);
    handler = nullptr;
  }

 private:
  static void hear(QtMsgType type, const QMessageLogContext& context, const QString& text) {
    // The first sentence says what failed; the rest is advice for developers.
    if (type == QtFatalMsg) handler(text.section(QLatin1Char('.'), 0, 0).toStdString());
    previous(type, context, text);
  }

  // The toolkit's hook has no context argument.
  static inline RefusalHandler handler;
  static inline QtMessageHandler previous = nullptr;
};

// The display connection opened by the check; kept until the toolkit has opened its own.
std::shared_ptr<void>& openDisplay() {
  static std::shared_ptr<void> connection;
  return connection;
}

class QuickFrontend : public application::Frontend {
 public:
  explicit QuickFrontend(RefusalHandler refused)
      : signals_(dispatch::MainLoop::main(), [] { QCoreApplication::quit(); }) {
    const StartWatch watch(std::move(refused));
    gui_.emplace(count_, words_.data());
    openDisplay().reset();
    QGuiApplication::setApplicationName(QStringLiteral("vespscope"));
    QGuiApplication::setApplicationDisplayName(QStringLiteral("vespscope"));
    QGuiApplication::setDesktopFileName(QStringLiteral("org.vespscope.Vespscope"));
  }

  int run(application::Application& application) override {
    int status = 0;
    {
      MainWindow window(application);
      window.appearance().followDesktop();
      status = QGuiApplication::exec();
    }
    log::flush();
    return status;
  }

 private:
  // The toolkit keeps references to these. It does not receive the program's arguments.
  int count_ = 1;
  std::string name_ = "vespscope";
  std::array<char*, 2> words_ = {name_.data(), nullptr};
  dispatch::SignalWatch signals_;
  std::optional<QGuiApplication> gui_;
};

}  // namespace

std::optional<Obstacle> displayObstacle() {
  DisplayCheck display = checkDisplay();
  if (display.opens) {
    openDisplay() = std::move(display.connection);
    return std::nullopt;
  }
  return Obstacle{.reason = display.reason, .unexpected = display.named};
}

std::unique_ptr<application::Frontend> makeQuickFrontend(RefusalHandler refused) {
  return std::make_unique<QuickFrontend>(std::move(refused));
}

}  // namespace vespscope::quick

// The program finds this symbol by its name, moduleSymbol.
extern "C" {
extern const vespscope::quick::Module vespscopeQuickModule;
const vespscope::quick::Module vespscopeQuickModule{.version = VESPSCOPE_VERSION,
                                                    .obstacle = &vespscope::quick::displayObstacle,
                                                    .makeFrontend = &vespscope::quick::makeQuickFrontend};
}
