#include "frontends/quick/QuickFrontend.h"

#include <QGuiApplication>
#include <array>
#include <cstdlib>

#include "frontends/quick/MainWindow.h"
#include "platform/dispatch/MainLoop.h"
#include "platform/dispatch/SignalWatch.h"
#include "platform/log/Log.h"

namespace vespscope::quick {
namespace {

bool isSet(const char* variable) {
  const char* value = std::getenv(variable);
  return value != nullptr && *value != '\0';
}

class QuickFrontend : public application::Frontend {
 public:
  QuickFrontend()
      : signals_(dispatch::MainLoop::main(), [] { QCoreApplication::quit(); }), gui_(count_, words_.data()) {
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
  // The toolkit keeps references to these. It gets no arguments of the program's.
  int count_ = 1;
  std::string name_ = "vespscope";
  std::array<char*, 2> words_ = {name_.data(), nullptr};
  dispatch::SignalWatch signals_;
  QGuiApplication gui_;
};

}  // namespace

std::optional<std::string> obstacle() {
  for (const char* variable : {"WAYLAND_DISPLAY", "DISPLAY", "QT_QPA_PLATFORM"}) {
    if (isSet(variable)) return std::nullopt;
  }
  return "there is no display: neither WAYLAND_DISPLAY nor DISPLAY is set";
}

std::unique_ptr<application::Frontend> makeFrontend() {
  if (const auto reason = obstacle()) log::fatal("the phone interface was asked for, but " + *reason);
  return std::make_unique<QuickFrontend>();
}

}  // namespace vespscope::quick
