// The baseband manager as a program: serves a source's events on the system bus, a socket or both, until a signal ends
// it.
#include <fcntl.h>
#include <signal.h>
#include <unistd.h>

#include <atomic>
#include <memory>
#include <optional>
#include <string>
#include <utility>

#include "manager/ListeningSocket.h"
#include "manager/PeerServer.h"
#include "manager/recording/RotatingCapture.h"
#include "platform/console/Console.h"
#include "platform/files/StandardDescriptors.h"
#include "platform/log/Log.h"
#include "rhoxlink/bus/BusClient.h"
#include "rhoxlink/bus/BusRelay.h"
#include "sources/MakeSource.h"
#include "sources/SourceInputs.h"
#include "tools/rhoxdOptions.h"

namespace vespscope {
namespace {

constexpr int failureStatus = 1;  // after a source or a socket that is not available

// The signals are blocked in every thread from here on; waitForEnd() receives one.
sigset_t blockEndSignals() {
  sigset_t signals;
  ::sigemptyset(&signals);
  for (const int number : {SIGINT, SIGTERM, SIGHUP}) ::sigaddset(&signals, number);
  ::pthread_sigmask(SIG_BLOCK, &signals, nullptr);
  return signals;
}

// Serves clients on the system bus. One that does not answer holds this thread up, so a signal ends the process here.
std::optional<std::string> serveSystemBus(manager::PeerServer& server, const std::string& group,
                                          const sigset_t& signals) {
  ::pthread_sigmask(SIG_UNBLOCK, &signals, nullptr);
  auto problem = server.serveSystemBus(manager::BusAccess::ofGroup(group));
  ::pthread_sigmask(SIG_BLOCK, &signals, nullptr);
  return problem;
}

void waitForEnd(const sigset_t& signals) {
  int number = 0;
  while (::sigwait(&signals, &number) != 0) {
  }
}

int fail(const std::string& why) {
  console::error("rhoxd: " + why);
  return failureStatus;
}

struct Streams {
  int input = -1;
  int output = -1;
};

// Reserves standard input and output for the protocol: other output goes to standard error.
Streams takeStandardStreams() {
  const Streams streams{::fcntl(STDIN_FILENO, F_DUPFD_CLOEXEC, STDERR_FILENO + 1),
                        ::fcntl(STDOUT_FILENO, F_DUPFD_CLOEXEC, STDERR_FILENO + 1)};
  const int nothing = ::open("/dev/null", O_RDONLY | O_CLOEXEC);
  if (nothing >= 0) ::dup2(nothing, STDIN_FILENO);
  ::dup2(STDERR_FILENO, STDOUT_FILENO);
  return streams;
}

// Relays the client on standard input and output to the manager on the system bus.
int relay(const Streams& streams) {
  const auto way = bus::BusRelay::open(streams.input, streams.output);
  if (!way) return fail(way.reason());
  const std::string ending = (*way)->run();
  return ending.empty() ? 0 : fail(ending);
}

int run(const DaemonOptions& options) {
  Streams streams;
  if (options.stdio) streams = takeStandardStreams();
  if (options.relay && bus::isOnSystemBus(bus::serviceName)) return relay(streams);
  // Opening standard input may block: until the source is ready, a signal ends the process at once.
  auto source = sources::makeSource(options.source);
  if (!source) return fail(source.reason());
  const sigset_t signals = blockEndSignals();
  std::unique_ptr<manager::EventRecorder> recorder;
  if (options.record) {
    // Rotation would remove the files being played.
    if (const auto spec = sources::SourceSpec::parse(options.source); spec && readsFrom(*spec, *options.record)) {
      return fail("--record: " + options.record->string() + ": contains the source itself");
    }
    auto folder = manager::RotatingCapture::open(*options.record, options.recordingLimits);
    if (!folder) return fail(folder.reason());
    recorder = std::make_unique<manager::Recorder>(std::move(*folder));
  }
  std::string words = (*source)->label();
  std::optional<manager::ConfigurationStore> store;
  if (options.state) store.emplace(*options.state);
  manager::PeerServer server(std::move(*source), std::move(store));
  // Before the socket, which a signal would leave behind.
  if (options.system) {
    if (const auto problem = serveSystemBus(server, options.group, signals)) return fail(*problem);
  }
  if (options.socket) {
    auto socket = manager::ListeningSocket::at(*options.socket);
    if (!socket) return fail(socket.reason());
    server.listenOn(std::move(*socket));
    words += " at " + *options.socket;
  }
  if (options.system) words += " on the system bus";
  if (options.stdio) server.adopt(streams.input, streams.output);
  // A manager that has lost its bus exits with an error, so that the service manager restarts it; one whose only client
  // has left exits normally.
  std::atomic<bool> left = false;
  server.onEnd([&left] {
    left = true;
    ::kill(::getpid(), SIGTERM);
  });
  if (recorder) {
    server.recordTo(std::move(recorder));
    words += ", recording into " + options.record->string();
  }
  server.start();
  if (!options.stdio) log::print("rhoxd: " + words);
  waitForEnd(signals);
  return left && !options.stdio ? fail("the system bus has closed the connection") : 0;
}

}  // namespace
}  // namespace vespscope

int main(int argc, char** argv) {
  vespscope::files::openStandardDescriptors();
  ::signal(SIGPIPE, SIG_IGN);
  ::signal(SIGXFSZ, SIG_IGN);  // reaching the process's file size limit is reported like a full disk
  const vespscope::DaemonCommandLine line = vespscope::readDaemonCommandLine(argc, argv);
  if (!line.options) return line.ending.print();
  const int status = vespscope::run(*line.options);
  vespscope::log::flush();
  return status;
}
