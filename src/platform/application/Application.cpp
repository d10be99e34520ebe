#include "platform/application/Application.h"

#include <map>
#include <utility>

#include "platform/log/Log.h"

namespace vespscope::application {
namespace {

using DelegateClasses = std::map<std::string, std::function<std::unique_ptr<ApplicationDelegate>()>>;

DelegateClasses& delegateClasses() {
  static DelegateClasses classes;
  return classes;
}

}  // namespace

void reloadTables(const Application& application) {
  if (!application.navigation) return;
  for (const auto& screen : application.navigation->viewControllers()) {
    if (const auto table = std::dynamic_pointer_cast<TableViewController>(screen)) table->tableView().reloadData();
  }
}

void registerDelegateClass(const std::string& name, std::function<std::unique_ptr<ApplicationDelegate>()> create) {
  delegateClasses()[name] = std::move(create);
}

int applicationMain(const std::vector<std::string>& arguments, const std::string& delegateClass,
                    Application& application, Frontend& frontend) {
  const auto known = delegateClasses().find(delegateClass);
  if (known == delegateClasses().end()) log::fatal("no application delegate class \"" + delegateClass + "\"");
  const std::unique_ptr<ApplicationDelegate> delegate = known->second();

  application.navigation = application.interface.instantiateInitial();
  auto window = std::make_shared<Window>();
  window->rootViewController = application.navigation;
  delegate->setWindow(std::move(window));
  application.navigation->loadViewIfNeeded();
  if (const auto first = application.navigation->topViewController()) first->loadViewIfNeeded();

  delegate->didFinishLaunchingWithOptions(application, arguments);
  delegate->applicationDidBecomeActive(application);
  const int status = frontend.run(application);
  delegate->applicationWillTerminate(application);
  return status;
}

}  // namespace vespscope::application
