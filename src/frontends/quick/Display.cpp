#include "frontends/quick/Display.h"

#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <memory>
#include <optional>
#include <string_view>
#include <utility>
#include <vector>

#include <xcb/xcb.h>

#include "frontends/quick/entry/DisplayNames.h"

namespace vespscope::quick {
namespace {

// The functions below return why a display does not open; empty when it does.

std::optional<std::string> xObstacle(std::shared_ptr<void>& kept) {
  const std::string name = environmentVariable("DISPLAY");
  if (name.empty()) return "DISPLAY is not set";
  const std::shared_ptr<xcb_connection_t> connection(xcb_connect(nullptr, nullptr), &xcb_disconnect);
  if (xcb_connection_has_error(connection.get()) == 0) {
    kept = connection;
    return std::nullopt;
  }
  return "DISPLAY=" + name + " does not open";
}

std::optional<std::string> waylandObstacle() {
  // A socket inherited from the parent process is connected already.
  if (!environmentVariable("WAYLAND_SOCKET").empty()) return std::nullopt;
  const std::string name = environmentVariable("WAYLAND_DISPLAY");
  std::string path = name.empty() ? "wayland-0" : name;
  if (!path.starts_with('/')) path = environmentVariable("XDG_RUNTIME_DIR") + '/' + path;
  const std::string failure = name.empty() ? "no Wayland display opens" : "WAYLAND_DISPLAY=" + name + " does not open";

  sockaddr_un address{};
  address.sun_family = AF_UNIX;
  if (path.size() >= sizeof address.sun_path) return failure + " (its path is too long)";
  std::memcpy(address.sun_path, path.data(), path.size());
  const int descriptor = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
  if (descriptor < 0) return failure + " (" + std::strerror(errno) + ")";
  const bool connected = ::connect(descriptor, reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0;
  const int error = errno;
  ::close(descriptor);
  if (connected) return std::nullopt;
  return failure + " (" + path + ": " + std::strerror(error) + ")";
}

std::optional<std::string> platformObstacle(std::string_view platform, std::shared_ptr<void>& kept) {
  if (platform.starts_with("xcb")) return xObstacle(kept);
  if (platform.starts_with("wayland")) return waylandObstacle();
  return std::nullopt;
}

}  // namespace

DisplayCheck checkDisplay() {
  const std::vector<std::string> platforms = platformsToTry();
  if (platforms.empty()) {
    return {.reason = noDisplayNamed, .connection = nullptr, .named = false};
  }
  std::string reasons;
  for (const std::string& platform : platforms) {
    std::shared_ptr<void> kept;
    const auto obstacle = platformObstacle(platform, kept);
    if (!obstacle) return {.opens = true, .reason = {}, .connection = std::move(kept), .named = true};
    reasons += (reasons.empty() ? "" : ", ") + *obstacle;
  }
  return {.reason = "there is no display: " + reasons, .connection = nullptr, .named = true};
}

}  // namespace vespscope::quick
