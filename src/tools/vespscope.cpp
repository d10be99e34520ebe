// The viewer: reads the command line, picks a frontend and runs the application.
#include <signal.h>
#include <unistd.h>

#include <clocale>
#include <cstdlib>
#include <exception>
#include <functional>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "frontends/headless/HeadlessFrontend.h"
#include "frontends/quick/entry/PhoneInterface.h"
#include "frontends/terminal/TerminalFrontend.h"
#include "manager/embedded/EmbeddedManagers.h"
#include "platform/application/Application.h"
#include "platform/console/Console.h"
#include "platform/dispatch/MainLoop.h"
#include "platform/files/StandardDescriptors.h"
#include "platform/log/Log.h"
#include "rhoxlink/Rhoxlink.h"
#include "shell/AppDelegate.h"
#include "shell/ConnectionFacts.h"
#include "shell/MainInterface.h"
#include "shell/ScreenAges.h"
#include "shell/SimSwitch.h"
#include "sources/modemmanager/Probe.h"
#include "tools/vespscopeOptions.h"

namespace vespscope {
namespace {

// An uncaught exception stops the program like a programming error: the terminal is restored, and one line printed.
[[noreturn]] void stopOnException() {
  try {
    if (const std::exception_ptr uncaught = std::current_exception()) std::rethrow_exception(uncaught);
  } catch (const std::exception& error) {
    log::fatal(std::string("uncaught exception: ") + error.what());
  } catch (...) {
    log::fatal("uncaught exception of an unknown kind");
  }
  log::fatal("terminated without an exception");
}

bool onTerminal() { return ::isatty(STDIN_FILENO) != 0 && ::isatty(STDOUT_FILENO) != 0; }

struct Choice {
  UserInterface interface = UserInterface::none;
  std::string remark;  // printed for the user; may be empty
};

// Chooses the interface that fits the environment.
Choice fittingInterface() {
  const auto obstacle = quick::obstacle();
  if (!obstacle) return {.interface = UserInterface::quick, .remark = {}};
  Choice choice{.interface = onTerminal() ? UserInterface::terminal : UserInterface::none, .remark = {}};
  if (obstacle->unexpected) {
    choice.remark = obstacle->reason + "; " +
                    (choice.interface == UserInterface::terminal ? "this is the terminal interface"
                                                                 : "without a terminal too, there are log lines only");
  }
  return choice;
}

[[noreturn]] void stopForRefusal(const std::string& reason) {
  console::error("vespscope: the phone interface does not start: " + reason +
                 " (--ui terminal shows the same screens)");
  std::exit(usageStatus);
}

std::unique_ptr<application::Frontend> makeFrontend(const Choice& choice) {
  // The line stays above the terminal interface's screen, and appears in its log.
  if (!choice.remark.empty()) console::error("vespscope: " + choice.remark);
  if (choice.interface == UserInterface::quick) return quick::makeFrontend(stopForRefusal);
  if (choice.interface == UserInterface::none) return std::make_unique<HeadlessFrontend>();
  auto frontend = terminal::makeTerminalFrontend();
  if (!choice.remark.empty()) log::system(choice.remark);
  return frontend;
}

int run(const ViewerOptions& options, const std::vector<std::string>& arguments) {
  const Choice choice = options.interface ? Choice{.interface = *options.interface, .remark = {}} : fittingInterface();
  if (options.interface == UserInterface::quick) {
    if (const auto obstacle = quick::obstacle()) {
      console::error("vespscope: --ui quick: " + obstacle->reason);
      return usageStatus;
    }
  }
  if (choice.interface == UserInterface::terminal && !terminal::isTerminalAvailable()) {
    console::error("vespscope: --ui terminal: there is no terminal");
    return usageStatus;
  }
  manager::EmbeddedManagers embedded;
  if (options.manager.kind == rhox::client::Address::Kind::embedded) {
    // Checked here because the connection would report a wrong source or file in the background only.
    if (const auto problem = embedded.open(options.manager.detail)) {
      console::error("vespscope: embedded manager: " + *problem);
      return usageStatus;
    }
  }
  const std::unique_ptr<application::Frontend> frontend = makeFrontend(choice);
  rhox::client::setAddress(options.manager);
  rhox::client::setEmbeddedFactory(embedded.factory());
  // Events are decoded on the main queue.
  rhox::client::setAfterwards([](std::function<void()> task) { dispatch::MainLoop::main().async(std::move(task)); });
  rhox::client::setModemProbe([] { return sources::modemmanager::modemManagerHasModem(); });
  application::registerDelegateClass("AppDelegate", [] { return std::make_unique<AppDelegate>(); });
  const std::shared_ptr<SimSwitch> sims = SimSwitch::create(options.sim);
  sims->install();
  application::Application application{.interface = mainInterface(),
                                       .navigation = nullptr,
                                       .status = statusProvider(sims),
                                       .screenAge = screenAgeProvider(sims),
                                       .showNextSim = [&sims] { sims->showNext(); }};
  sims->onShown([&application] { application::reloadTables(application); });
  return application::applicationMain(arguments, "AppDelegate", application, *frontend);
}

}  // namespace
}  // namespace vespscope

int main(int argc, char** argv) {
  vespscope::files::openStandardDescriptors();
  ::signal(SIGPIPE, SIG_IGN);
  std::set_terminate(vespscope::stopOnException);
  std::setlocale(LC_CTYPE, "");

  const vespscope::ViewerCommandLine line = vespscope::readViewerCommandLine(argc, argv);
  if (!line.options) return line.ending.print();
  return vespscope::run(*line.options, {argv, argv + argc});
}
