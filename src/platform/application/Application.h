// The application's entry: makes the delegate by its class name, builds the first screen from the interface
// description, and runs a frontend.
#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "platform/application/InterfaceDescription.h"
#include "platform/application/ScreenAge.h"
#include "platform/application/Status.h"

namespace vespscope::application {

// The application window: its root is the navigation controller.
struct Window {
  std::shared_ptr<NavigationController> rootViewController;
};

class Application;

class Responder {
 public:
  virtual ~Responder() = default;
};

class ApplicationDelegate : public Responder {
 public:
  virtual bool didFinishLaunchingWithOptions(Application& application, const std::vector<std::string>& options) = 0;
  virtual void applicationWillResignActive(Application& application) = 0;
  virtual void applicationDidEnterBackground(Application& application) = 0;
  virtual void applicationWillEnterForeground(Application& application) = 0;
  virtual void applicationDidBecomeActive(Application& application) = 0;
  virtual void applicationWillTerminate(Application& application) = 0;
  [[nodiscard]] virtual std::shared_ptr<Window> window() const = 0;
  virtual void setWindow(std::shared_ptr<Window> window) = 0;
};

// Draws the screens and runs the main loop until the user quits.
class Frontend {
 public:
  virtual ~Frontend() = default;
  // Returns the process's exit status.
  virtual int run(Application& application) = 0;
};

class Application {
 public:
  InterfaceDescription interface;
  std::shared_ptr<NavigationController> navigation;
  StatusProvider status;        // may be empty
  ScreenAgeProvider screenAge;  // may be empty
  // Shows the values of the phone's next SIM card; may be empty. The screens reload when they are there.
  std::function<void()> showNextSim;
};

// Requests a reload of every open table.
void reloadTables(const Application& application);

// Registers a delegate class, so that applicationMain() can make it by its name.
void registerDelegateClass(const std::string& name, std::function<std::unique_ptr<ApplicationDelegate>()> create);

// Runs the application: makes the delegate named `delegateClass` (an unknown name is a programming error), then the
// navigation controller and its root screen from the interface description, loads them, notifies the delegate that
// launching has finished, and runs `frontend`. Returns the frontend's status.
int applicationMain(const std::vector<std::string>& arguments, const std::string& delegateClass,
                    Application& application, Frontend& frontend);

}  // namespace vespscope::application
