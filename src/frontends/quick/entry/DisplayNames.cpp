#include "frontends/quick/entry/DisplayNames.h"

#include <cstdlib>
#include <sstream>

namespace vespscope::quick {
namespace {

// "wayland;xcb:option" becomes "wayland" and "xcb:option".
std::vector<std::string> platformsOf(const std::string& list) {
  std::vector<std::string> platforms;
  std::istringstream rest(list);
  for (std::string platform; std::getline(rest, platform, ';');) platforms.push_back(platform);
  return platforms;
}

}  // namespace

std::string environmentVariable(const char* name) {
  const char* value = std::getenv(name);
  return value == nullptr ? std::string() : value;
}

std::vector<std::string> platformsToTry() {
  if (const std::string list = environmentVariable("QT_QPA_PLATFORM"); !list.empty()) return platformsOf(list);
  std::vector<std::string> platforms;
  if (!environmentVariable("WAYLAND_DISPLAY").empty() || !environmentVariable("WAYLAND_SOCKET").empty()) {
    platforms.emplace_back("wayland");
  }
  if (!environmentVariable("DISPLAY").empty()) platforms.emplace_back("xcb");
  return platforms;
}

}  // namespace vespscope::quick
