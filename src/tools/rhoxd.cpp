// The baseband manager as a program: serves a source's events on the system bus, a socket or both, until it is told to
// end.
#include <signal.h>
#include <unistd.h>

#include <atomic>
#include <iostream>
#include <memory>
#include <string>
#include <utility>

#include "manager/ListeningSocket.h"
#include "manager/PeerServer.h"
#include "manager/recording/RotatingCapture.h"
#include "manager/sources/MakeSource.h"
#include "platform/log/Log.h"
#include "tools/rhoxdOptions.h"
#include "values/Text.h"

namespace vespscope {
namespace {

constexpr int failureStatus = 1;  // after a source or a socket that cannot be had

// Blocked in every thread from here on; waitForEnd() takes one.
sigset_t blockEndSignals() {
  sigset_t signals;
  ::sigemptyset(&signals);
  for (const int number : {SIGINT, SIGTERM, SIGHUP}) ::sigaddset(&signals, number);
  ::pthread_sigmask(SIG_BLOCK, &signals, nullptr);
  return signals;
}

void waitForEnd(const sigset_t& signals) {
  int number = 0;
  while (::sigwait(&signals, &number) != 0) {
  }
}

int fail(const std::string& why) {
  std::cerr << "rhoxd: " << printable(why) << '\n';
  return failureStatus;
}

int run(const DaemonOptions& options) {
  const sigset_t signals = blockEndSignals();
  auto source = manager::makeSource(options.source);
  if (!source) return fail(source.reason());
  std::unique_ptr<manager::EventRecorder> recorder;
  if (options.record) {
    auto folder = manager::RotatingCapture::open(*options.record, options.recordingLimits);
    if (!folder) return fail(folder.reason());
    recorder = std::make_unique<manager::Recorder>(std::move(*folder));
  }
  std::string words = (*source)->label();
  std::optional<manager::ConfigurationStore> store;
  if (options.state) store.emplace(*options.state);
  manager::PeerServer server(std::move(*source), std::move(store));
  if (options.socket) {
    auto socket = manager::ListeningSocket::at(*options.socket);
    if (!socket) return fail(socket.reason());
    server.listenOn(std::move(*socket));
    words += " at " + *options.socket;
  }
  std::atomic<bool> busLost = false;
  if (options.system) {
    if (const auto problem = server.serveSystemBus(manager::BusAccess::ofGroup(options.group))) return fail(*problem);
    words += " on the system bus";
  }
  // A manager without its bus is of no use to whoever started it for that; it is started again.
  server.onEnd([&busLost] {
    busLost = true;
    ::kill(::getpid(), SIGTERM);
  });
  if (recorder) {
    server.recordTo(std::move(recorder));
    words += ", recording into " + options.record->string();
  }
  server.start();
  log::print("rhoxd: " + words);
  waitForEnd(signals);
  return busLost ? fail("the system bus has closed the connection") : 0;
}

}  // namespace
}  // namespace vespscope

int main(int argc, char** argv) {
  ::signal(SIGPIPE, SIG_IGN);
  ::signal(SIGXFSZ, SIG_IGN);  // a file at the process's limit is told like a full disk
  const vespscope::DaemonCommandLine line = vespscope::readDaemonCommandLine(argc, argv);
  if (!line.options) {
    (line.status == 0 ? std::cout : std::cerr) << line.text << (line.status == 0 ? "" : "\n");
    return line.status;
  }
  const int status = vespscope::run(*line.options);
  vespscope::log::flush();
  return status;
}
