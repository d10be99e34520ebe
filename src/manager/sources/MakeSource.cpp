#include "manager/sources/MakeSource.h"

#include <sys/socket.h>

#include <array>
#include <cerrno>
#include <chrono>
#include <cstring>
#include <utility>

#include "manager/PeerServer.h"
#include "manager/Player.h"
#include "manager/sources/diag/DiagPortSource.h"
#include "manager/sources/diag/DiagStream.h"
#include "manager/sources/diag/PortConnection.h"
#include "manager/sources/modemmanager/ModemManagerSource.h"
#include "manager/sources/replay/ReplayStream.h"
#include "manager/sources/scenario/ScenarioStream.h"

namespace vespscope::manager {

namespace {

Result<std::unique_ptr<EventStream>> openStream(const SourceSpec& spec) {
  switch (spec.kind) {
    case SourceSpec::Kind::scenario: {
      // The drive has been going on for as long as is left out, so that what is played carries the present time.
      const auto now = std::chrono::system_clock::now().time_since_epoch();
      return makeScenarioStream(spec.seed, now - spec.playback.start);
    }
    case SourceSpec::Kind::replay:
      return openReplayStream(spec.file);
    case SourceSpec::Kind::diag:
      return openDiagStream(spec.file);
    case SourceSpec::Kind::diagPort:
    case SourceSpec::Kind::modemManager:
      return Failure{std::string("a live modem is no recording that can be read ahead of its time")};
  }
  return Failure{std::string("unknown kind of source")};
}

Result<std::unique_ptr<Source>> openPort(const std::string& port) {
  if (port.starts_with("tcp:")) {
    if (const auto problem = diag::problemWithTcpPort(port)) return Failure{"\"" + port + "\": " + *problem};
  }
  return std::unique_ptr<Source>(std::make_unique<diag::DiagPortSource>(port));
}

}  // namespace

Result<std::unique_ptr<EventStream>> makeStream(const SourceSpec& spec) {
  Result<std::unique_ptr<EventStream>> stream = openStream(spec);
  if (stream && spec.playback.loop && !(*stream)->canRewind()) {
    return Failure{"\"" + spec.file + "\" cannot be played in a loop: it is no file that can be read again"};
  }
  return stream;
}

Result<std::unique_ptr<Source>> makeSource(std::string_view words) {
  const Result<SourceSpec> spec = SourceSpec::parse(words);
  if (!spec) return Failure{spec.reason()};
  if (spec->kind == SourceSpec::Kind::modemManager) {
    return std::unique_ptr<Source>(std::make_unique<modemmanager::ModemManagerSource>());
  }
  if (spec->kind == SourceSpec::Kind::diagPort) return openPort(spec->file);
  Result<std::unique_ptr<EventStream>> stream = makeStream(*spec);
  if (!stream) return Failure{stream.reason()};
  return std::unique_ptr<Source>(std::make_unique<Player>(std::move(*stream), spec->playback));
}

Result<bus::EmbeddedEnd> startEmbeddedManager(const std::string& words) {
  Result<std::unique_ptr<Source>> source = makeSource(words);
  if (!source) return Failure{source.reason()};
  std::array<int, 2> ends{};
  if (::socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0, ends.data()) != 0) {
    return Failure{std::string("no sockets can be had: ") + std::strerror(errno)};
  }
  const auto server = std::make_shared<PeerServer>(std::move(*source));
  server->adopt(ends[1]);
  server->start();
  return bus::EmbeddedEnd{ends[0], server};
}

}  // namespace vespscope::manager
