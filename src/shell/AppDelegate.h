// The application delegate: holds the window; the steps of the application's life need no further action.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "platform/application/Application.h"

namespace vespscope {

class AppDelegate : public application::ApplicationDelegate {
 public:
  bool didFinishLaunchingWithOptions(application::Application& application,
                                     const std::vector<std::string>& options) override;
  void applicationWillResignActive(application::Application& application) override;
  void applicationDidEnterBackground(application::Application& application) override;
  void applicationWillEnterForeground(application::Application& application) override;
  void applicationDidBecomeActive(application::Application& application) override;
  void applicationWillTerminate(application::Application& application) override;

  // Null until the platform sets it.
  [[nodiscard]] std::shared_ptr<application::Window> window() const override { return window_; }
  void setWindow(std::shared_ptr<application::Window> window) override { window_ = std::move(window); }

 private:
  std::shared_ptr<application::Window> window_;
};

}  // namespace vespscope
