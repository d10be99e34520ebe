// How fast do events travel from the manager to the viewer's stored values, and what does the bus alone cost?
//
// bench_bus RATE SECONDS: one process delivers events at RATE (per second) through a manager that listens on a socket;
// another is the viewer without its interface, whose lines are discarded. Latency is measured from the manager's
// delivery to the stored value. Before that, the same rate over the bus alone: signals of the same content from one
// process to another that only reads them off the socket. Prints one JSON object.
#include <fcntl.h>
#include <poll.h>
#include <sys/resource.h>
#include <sys/socket.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <atomic>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include <time.h>

#include "client/RhoxWrapper.h"
#include "corpus/Corpus.h"
#include "manager/ListeningSocket.h"
#include "manager/PeerServer.h"
#include "messages/WireReader.h"
#include "messages/WireWriter.h"
#include "metrics/MetricValidator.h"
#include "platform/dispatch/MainLoop.h"
#include "platform/log/Log.h"
#include "registry/MetricRows.h"
#include "rhoxlink/Rhoxlink.h"
#include "sources/playback/Source.h"

namespace vespscope::bench {
namespace {

using Clock = std::chrono::steady_clock;

std::uint64_t nowNanoseconds() {
  return static_cast<std::uint64_t>(
      std::chrono::duration_cast<std::chrono::nanoseconds>(Clock::now().time_since_epoch()).count());
}

double cpuSeconds() {
  rusage usage{};
  ::getrusage(RUSAGE_SELF, &usage);
  const auto seconds = [](const timeval& time) {
    return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_usec) / 1e6;
  };
  return seconds(usage.ru_utime) + seconds(usage.ru_stime);
}

// Payloads of a frequent event, each with the moment of its delivery as its timestamp.
Bytes stamped(std::uint64_t moment, std::uint32_t count) {
  WireWriter writer;
  writer.writeUint64(moment, 1);
  writer.writeUint32(count % 504, 2);
  writer.writeUint32(1300, 3);
  writer.writeUint32(19300, 4);
  writer.writeUint32(50, 5);
  writer.writeUint32(50, 6);
  writer.writeUint32(27447297, 7);
  writer.writeUint32(3, 8);
  writer.writeUint32(4711, 9);
  return writer.takeBytes();
}

struct Pace {
  std::uint64_t rate;
  std::uint64_t events;
  // Calls `send` with the number of each event when it is due.
  template <class Send>
  void run(Send send) const {
    const Clock::time_point begin = Clock::now();
    for (std::uint64_t sent = 0; sent < events;) {
      const auto due = static_cast<std::uint64_t>(std::chrono::duration<double>(Clock::now() - begin).count() *
                                                  static_cast<double>(rate));
      for (const std::uint64_t until = std::min(due, events); sent < until; ++sent) send(sent);
      // At low rates each event is sent when it is due, at high ones in a thousand batches a second.
      const auto next = static_cast<double>(std::max(sent + 1, due + rate / 1000)) / static_cast<double>(rate);
      std::this_thread::sleep_until(begin +
                                    std::chrono::duration_cast<Clock::duration>(std::chrono::duration<double>(next)));
    }
  }
};

class PacedSource final : public sources::Source {
 public:
  explicit PacedSource(Pace pace) : pace_(pace) {}
  ~PacedSource() override { stop(); }
  [[nodiscard]] std::string label() const override { return "paced"; }
  [[nodiscard]] sources::SourceKind kind() const override { return sources::SourceKind::simulated; }
  void start(sources::EventSink& sink) override {
    thread_ = std::thread([this, &sink] {
      pace_.run([&sink](std::uint64_t count) {
        const std::uint64_t moment = nowNanoseconds();
        sink.deliver({metricIdentifier("K_LTE_SCELL_INFO"), 0, stamped(moment, static_cast<std::uint32_t>(count)),
                      std::chrono::nanoseconds(moment)});
      });
    });
  }
  void stop() override {
    if (thread_.joinable()) thread_.join();
  }
  void findSimCardFiles(sources::SimCardFilesHandler found) override { found(std::nullopt); }

 private:
  Pace pace_;
  std::thread thread_;
};

// A receiver's measurements.
struct Seen {
  std::uint64_t events = 0;
  std::vector<std::uint32_t> delays;  // ns
  double cpu = 0;

  void note(std::uint64_t moment) {
    ++events;
    // A million of them are a sufficient sample.
    if (delays.size() < 1'000'000) delays.push_back(static_cast<std::uint32_t>(nowNanoseconds() - moment));
  }
  void print(const char* name, double senderCpu) {
    std::sort(delays.begin(), delays.end());
    const auto at = [this](double share) {
      return delays.empty() ? 0.0
                            : delays[static_cast<std::size_t>(share * static_cast<double>(delays.size() - 1))] / 1e6;
    };
    std::printf(
        "\"%s\": {\"events\": %llu, \"median_ms\": %.3f, \"p99_ms\": %.3f, \"receiver_us\": %.2f, \"sender_us\": %.2f}",
        name, static_cast<unsigned long long>(events), at(0.5), at(0.99), 1e6 * cpu / static_cast<double>(events),
        1e6 * senderCpu / static_cast<double>(events));
  }
};

// `sender` runs in a child process and returns its processor time; the receiver runs here.
template <class Sender, class Receiver>
void betweenProcesses(const char* name, Sender sender, Receiver receiver) {
  std::array<int, 2> figures{};
  if (::pipe(figures.data()) != 0) std::abort();
  const pid_t child = ::fork();
  if (child == 0) {
    sender();
    const double cpu = cpuSeconds();
    if (::write(figures[1], &cpu, sizeof cpu) != sizeof cpu) std::abort();
    std::_Exit(0);
  }
  Seen seen;
  const double before = cpuSeconds();
  receiver(seen);
  seen.cpu = cpuSeconds() - before;
  double senderCpu = 0;
  if (::read(figures[0], &senderCpu, sizeof senderCpu) != sizeof senderCpu) std::abort();
  ::waitpid(child, nullptr, 0);
  seen.print(name, senderCpu);
}

ipc::Dictionary dictionaryOf(std::uint64_t moment, std::uint32_t count) {
  ipc::Dictionary dictionary;
  dictionary.set(rhox::kKeyMetricID, ipc::Object(std::int64_t{metricIdentifier("K_LTE_SCELL_INFO")}));
  dictionary.set(rhox::kKeyPayload, ipc::Object(stamped(moment, count)));
  dictionary.set(rhox::kKeyProfileID, ipc::Object(static_cast<std::int64_t>(moment)));
  return dictionary;
}

class Nothing final : public bus::Service {
 public:
  void performCommand(const std::string&, const ipc::Dictionary&, const Answer& answer) override { answer({}); }
  void eventsOn() override {}
  void eventsOff() override {}
};

template <class End>
void workOnce(End& end, int milliseconds) {
  end.process();
  const bus::Wait wait = end.wait();
  pollfd ready{wait.descriptor, wait.events, 0};
  ::poll(&ready, 1, wait.timeout.count() == 0 ? 0 : milliseconds);
}

void busAlone(const Pace& pace) {
  std::array<int, 2> sockets{};
  if (::socketpair(AF_UNIX, SOCK_STREAM | SOCK_NONBLOCK, 0, sockets.data()) != 0) std::abort();
  const auto sender = [&] {
    ::close(sockets[1]);
    Nothing service;
    auto end = std::move(*bus::ServerEnd::overSocket(sockets[0], service));
    for (int round = 0; round < 20; ++round) workOnce(*end, 10);  // the handshake
    pace.run([&end](std::uint64_t count) {
      const std::uint64_t moment = nowNanoseconds();
      end->sendEvent(rhox::kEventMetric, count + 1, dictionaryOf(moment, static_cast<std::uint32_t>(count)));
      while (end->unsent() >= 64) workOnce(*end, 10);
    });
    while (end->unsent() > 0) workOnce(*end, 10);
    ::shutdown(sockets[0], SHUT_WR);
  };
  betweenProcesses("bus", sender, [&](Seen& seen) {
    ::close(sockets[0]);
    auto end = std::move(
        *bus::ClientEnd::overSocket(sockets[1], [&seen](std::string_view, std::uint64_t, const ipc::Dictionary& event) {
          seen.note(static_cast<std::uint64_t>(*event.find(rhox::kKeyProfileID)->asInt64()));
        }));
    while (seen.events < pace.events) workOnce(*end, 1000);
  });
}

// The viewer's decoder, which records when a value has been stored.
class NotingValidator final : public MetricValidator {
 public:
  explicit NotingValidator(Seen& seen) : seen_(seen) {}
  bool processMetric(const Record& event) override {
    const bool known = MetricValidator::processMetric(event);
    // The payload begins with its timestamp, the moment of its delivery.
    WireReader reader(*event.find("kKeyPayload")->asBytes());
    reader.readVarint();
    seen_.note(reader.readVarint());
    last_ = Clock::now();
    return known;
  }
  [[nodiscard]] Clock::time_point last() const { return last_; }

 private:
  Seen& seen_;
  Clock::time_point last_ = Clock::now();
};

void throughManager(const Pace& pace) {
  const std::string path =
      (std::filesystem::temp_directory_path() / ("bench-bus-" + std::to_string(::getpid()))).string();
  std::array<int, 2> done{};
  if (::pipe(done.data()) != 0) std::abort();
  const auto sender = [&] {
    ::close(done[1]);
    manager::PeerServer server(std::make_unique<PacedSource>(pace));
    server.listenOn(std::move(*manager::ListeningSocket::at(path)));
    server.start();
    char byte = 0;
    while (::read(done[0], &byte, 1) > 0) {
    }
  };
  betweenProcesses("viewer", sender, [&](Seen& seen) {
    ::close(done[0]);
    while (!std::filesystem::exists(path)) ::usleep(1000);
    rhox::client::setAddress({rhox::client::Address::Kind::unixSocket, path});
    const auto wrapper = RhoxWrapper::sharedInstance();
    const auto validator = std::make_shared<NotingValidator>(seen);
    wrapper->setDelegate(validator);
    const std::string configuration = path + ".deviceconfig";
    std::FILE* file = std::fopen(configuration.c_str(), "w");
    if (file == nullptr) std::abort();
    std::fputs("[metrics]\nK_LTE_SCELL_INFO = { on = \"event\" }\n", file);
    std::fclose(file);
    if (!wrapper->addOrblConfigForAppId("vespscope", configuration)) std::abort();
    wrapper->listen();
    // Runs until all events have arrived, or none has for two seconds: then some were lost.
    auto& loop = dispatch::MainLoop::main();
    while (seen.events < pace.events && Clock::now() - validator->last() < std::chrono::seconds(2)) {
      loop.runOnce(std::chrono::milliseconds(100));
    }
    std::filesystem::remove(configuration);
    ::close(done[1]);
  });
}

}  // namespace
}  // namespace vespscope::bench

int main(int count, char** arguments) {
  if (count != 3) {
    std::fputs("usage: bench_bus RATE SECONDS\n", stderr);
    return 2;
  }
  const std::uint64_t rate = std::strtoull(arguments[1], nullptr, 10);
  const vespscope::bench::Pace pace{rate, rate * std::strtoull(arguments[2], nullptr, 10)};
  // The result goes to the original standard output; the viewer's lines are made and written, but to /dev/null.
  const int result = ::dup(STDOUT_FILENO);
  const int nowhere = ::open("/dev/null", O_WRONLY);
  ::dup2(nowhere, STDERR_FILENO);
  std::string text;
  std::printf("{\"sent\": %llu, ", static_cast<unsigned long long>(pace.events));
  std::fflush(stdout);
  vespscope::bench::busAlone(pace);
  std::printf(", ");
  std::fflush(stdout);
  ::dup2(nowhere, STDOUT_FILENO);
  vespscope::bench::throughManager(pace);
  // Still buffered, so it has not been written yet.
  ::dup2(result, STDOUT_FILENO);
  std::printf("}\n");
  return std::fflush(stdout) == 0 ? 0 : 1;
}
