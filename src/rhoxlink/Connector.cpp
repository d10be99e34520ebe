#include "rhoxlink/Connector.h"

#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <string>
#include <utility>

#include "rhoxlink/SshProcess.h"

namespace rhox::client {
namespace {

using vespscope::Failure;
using vespscope::Result;
using vespscope::bus::ClientEnd;
using vespscope::bus::EmbeddedEnd;
using vespscope::bus::EmbeddedFactory;
using EventHandler = ClientEnd::EventHandler;

Result<int> connectTo(const std::string& path) {
  sockaddr_un name{};
  name.sun_family = AF_UNIX;
  std::memcpy(name.sun_path, path.data(), path.size());  // Address limits the length
  const int descriptor = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0);
  if (descriptor < 0) return Failure{std::string("cannot create a socket: ") + std::strerror(errno)};
  if (::connect(descriptor, reinterpret_cast<const sockaddr*>(&name), sizeof name) == 0) return descriptor;
  const int error = errno;
  ::close(descriptor);
  return Failure{"no manager at " + path + ": " + std::strerror(error)};
}

Result<Link> speakOver(int descriptor, std::shared_ptr<void> keeper, EventHandler onEvent) {
  auto end = ClientEnd::overSocket(descriptor, std::move(onEvent));
  if (!end) return Failure{end.reason()};
  return Link{std::move(keeper), std::move(*end), nullptr};
}

Result<Link> openUnixSocket(const std::string& path, EventHandler onEvent) {
  const Result<int> descriptor = connectTo(path);
  if (!descriptor) return Failure{descriptor.reason()};
  Result<Link> link = speakOver(*descriptor, nullptr, std::move(onEvent));
  if (link) return link;
  return Failure{"the manager at " + path + " closed the connection, perhaps because it has no free place (" +
                 link.reason() + ")"};
}

Result<Link> openEmbedded(const std::string& source, const EmbeddedFactory& factory, EventHandler onEvent) {
  if (!factory) return Failure{std::string("this program cannot run a baseband manager")};
  Result<EmbeddedEnd> made = factory(source);
  if (!made) return Failure{made.reason()};
  return speakOver(made->descriptor, std::move(made->keeper), std::move(onEvent));
}

Result<Link> openSystemBus(EventHandler onEvent) {
  auto end = ClientEnd::onSystemBus(std::move(onEvent));
  if (!end) return Failure{end.reason()};
  return Link{nullptr, std::move(*end), nullptr};
}

Result<Link> openSsh(const std::string& destination, EventHandler onEvent) {
  auto started = SshProcess::start(destination);
  if (!started) return Failure{started.reason()};
  const std::shared_ptr<SshProcess> ssh = std::move(*started);
  Result<Link> link = speakOver(ssh->takeDescriptor(), ssh, std::move(onEvent));
  if (!link) return Failure{ssh->explainEnd()};                        // ssh exited at once
  link->explainEnd = [ssh = ssh.get()] { return ssh->explainEnd(); };  // the link owns it
  return link;
}

}  // namespace

Address resolveAutomatic(const AutomaticProbes& probes) {
  if (probes.serviceOnSystemBus && probes.serviceOnSystemBus()) return {Address::Kind::system, ""};
  if (probes.modem && probes.modem()) return {Address::Kind::embedded, "modemmanager"};
  return {Address::Kind::embedded, "scenario"};
}

Result<Link> openLink(const Address& address, const EmbeddedFactory& factory, EventHandler onEvent) {
  switch (address.kind) {
    case Address::Kind::none:
    case Address::Kind::automatic:  // resolved earlier
      break;
    case Address::Kind::unixSocket:
      return openUnixSocket(address.detail, std::move(onEvent));
    case Address::Kind::embedded:
      return openEmbedded(address.detail, factory, std::move(onEvent));
    case Address::Kind::system:
      return openSystemBus(std::move(onEvent));
    case Address::Kind::ssh:
      return openSsh(address.detail, std::move(onEvent));
  }
  return Failure{std::string("no manager is wanted")};
}

}  // namespace rhox::client
