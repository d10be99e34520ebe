// Runs the viewer with millions of events; `./dev soak` builds and starts it.
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <string>

#include "platform/application/Application.h"
#include "platform/log/Log.h"
#include "shell/AppDelegate.h"
#include "shell/ConnectionFacts.h"
#include "shell/MainInterface.h"
#include "soak/Soak.h"

namespace vespscope::test {
namespace {

void print(const Figures& figures) {
  const auto line = [](const char* name, std::uint64_t value) {
    std::printf("%-38s %12llu\n", name, static_cast<unsigned long long>(value));
  };
  line("events sent", figures.sent);
  line("  stored", figures.stored);
  line("  counted as dropped", figures.dropped);
  line("  on their way to the viewer at a kill", figures.cut);
  line("managers restarted", figures.restarts);
  line("managers killed", figures.kills);
  line("deliveries turned off and on", figures.relistens);
  line("times that the viewer stood still", figures.standstills);
  line("screens opened", figures.screens);
  line("rows read", figures.rows);
  const auto holdings = [](const char* when, const Holdings& held) {
    std::printf("%-38s %9ld KiB, %ld threads, %ld descriptors\n", when, held.memory, held.threads, held.descriptors);
  };
  holdings("held after a tenth", figures.early);
  holdings("held at the end", figures.late);
  std::printf("%-38s %12.0f\n", "seconds", figures.seconds);
}

int run(std::uint64_t events, std::uint32_t seed) {
  log::discardOutputs();
  Soak soak(events, seed, [](std::uint64_t sent, const Holdings& held) {
    std::printf("after %llu events: %ld KiB\n", static_cast<unsigned long long>(sent), held.memory);
    std::fflush(stdout);
  });
  soak.prepare();
  application::registerDelegateClass("AppDelegate", [] { return std::make_unique<AppDelegate>(); });
  application::Application application{
      .interface = mainInterface(), .navigation = nullptr, .status = statusProvider(), .screenAge = {}};
  const int status = application::applicationMain({"soak"}, "AppDelegate", application, soak);
  print(soak.figures());
  if (status != 0) std::fprintf(stderr, "soak: %s\n", soak.fault().c_str());
  return status;
}

}  // namespace
}  // namespace vespscope::test

int main(int count, char** arguments) {
  const std::uint64_t events = count > 1 ? std::strtoull(arguments[1], nullptr, 10) : 10'000'000;
  const auto seed = static_cast<std::uint32_t>(count > 2 ? std::strtoul(arguments[2], nullptr, 10) : 1);
  if (events < 1000) {
    std::fprintf(stderr, "usage: soak [EVENTS [SEED]], 1000 events or more\n");
    return 2;
  }
  return vespscope::test::run(events, seed);
}
