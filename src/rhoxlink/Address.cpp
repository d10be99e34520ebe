#include "rhoxlink/Address.h"

#include <sys/un.h>

namespace rhox::client {
namespace {

using vespscope::Failure;
using vespscope::Result;

constexpr std::size_t pathLimit = sizeof(sockaddr_un::sun_path) - 1;

std::string quoted(std::string_view words) { return "\"" + std::string(words) + "\""; }

Result<Address> parseUnix(std::string_view words, std::string_view rest) {
  constexpr std::string_view key = "path=";
  if (!rest.starts_with(key) || rest.size() == key.size()) {
    return Failure{quoted(words) + " is not a manager address: a socket is written unix:path=FILE"};
  }
  const std::string_view path = rest.substr(key.size());
  if (path.size() > pathLimit) {
    return Failure{"the socket's path is longer than " + std::to_string(pathLimit) + " bytes: " + std::string(path)};
  }
  return Address{Address::Kind::unixSocket, std::string(path)};
}

Result<Address> parseSsh(std::string_view words, std::string_view host) {
  // ssh would read a host that starts with a dash as an option.
  if (host.empty() || host.front() == '-') {
    return Failure{quoted(words) + " is not a manager address: a machine is written ssh:HOST"};
  }
  return Address{Address::Kind::ssh, std::string(host)};
}

}  // namespace

Result<Address> Address::parse(std::string_view words) {
  if (words == "none") return Address{Kind::none, ""};
  if (words == "auto") return Address{Kind::automatic, ""};
  if (words == "system") return Address{Kind::system, ""};
  const std::size_t colon = words.find(':');
  const std::string_view scheme = words.substr(0, colon);
  const std::string_view rest = colon == std::string_view::npos ? "" : words.substr(colon + 1);
  if (scheme == "unix") return parseUnix(words, rest);
  if (scheme == "ssh") return parseSsh(words, rest);
  if (scheme == "embedded") {
    if (rest.empty()) {
      return Failure{quoted(words) + " names no source: a manager in the process is written embedded:SOURCE"};
    }
    return Address{Kind::embedded, std::string(rest)};
  }
  return Failure{quoted(words) +
                 " is not a manager address (auto, system, unix:path=FILE, ssh:HOST or embedded:SOURCE)"};
}

}  // namespace rhox::client
