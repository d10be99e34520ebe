#include "shell/AppDelegate.h"

namespace vespscope {

bool AppDelegate::didFinishLaunchingWithOptions(application::Application& /*application*/,
                                                const std::vector<std::string>& /*options*/) {
  return true;
}

void AppDelegate::applicationWillResignActive(application::Application& /*application*/) {}
void AppDelegate::applicationDidEnterBackground(application::Application& /*application*/) {}
void AppDelegate::applicationWillEnterForeground(application::Application& /*application*/) {}
void AppDelegate::applicationDidBecomeActive(application::Application& /*application*/) {}
void AppDelegate::applicationWillTerminate(application::Application& /*application*/) {}

}  // namespace vespscope
