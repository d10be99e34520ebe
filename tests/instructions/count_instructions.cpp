// Does one kind of work on one fixed corpus, for a profiler that counts the instructions of measured() only.
//
// count_instructions decode|event mixed|numbers|lists; prints how many events measured() processes.
#include <cstdio>
#include <memory>
#include <string_view>
#include <vector>

#include "corpus/Corpus.h"
#include "metrics/EventRows.h"
#include "metrics/MetricValidator.h"
#include "platform/log/Log.h"
#include "registry/MetricRows.h"

namespace vespscope::test {
namespace {

std::vector<MetricEvent> corpusOf(std::string_view name) {
  if (name == "lists") return {bench::makeNeighbours(16), bench::makeNeighbours(64), bench::makeNeighbours(256)};
  bench::CorpusShape shape;
  shape.eventsPerMetric = 20;
  std::vector<MetricEvent> events = bench::makeCorpus(shape);
  // Flat messages: the minimum cost of an event.
  if (name == "numbers") {
    std::erase_if(events, [](const MetricEvent& event) {
      return event.metricID != metricIdentifier("K_LTE_SCELL_INFO") &&
             event.metricID != metricIdentifier("K_LTE_RRC_STATE") &&
             event.metricID != metricIdentifier("K_LTE_CDRX_CONFIG");
    });
  }
  return events;
}

struct Work {
  bool whole = false;
  std::vector<std::shared_ptr<const Record>> events;
  MetricValidator validator;

  void run() {
    for (const auto& event : events) {
      if (whole) {
        validator.metricsDidUpdate(event);
      } else {
        const Bytes* payload = event->find("kKeyPayload")->asBytes();
        static_cast<void>(findEventRow(*event->find("kKeyMetricID")->asInteger())->decode(payload));
      }
    }
  }
};

Work* work = nullptr;

}  // namespace
}  // namespace vespscope::test

// The profiler finds the function by its name.
extern "C" __attribute__((noinline, noclone, used)) void measured() { vespscope::test::work->run(); }

int main(int count, char** arguments) {
  if (count != 3) return 2;
  vespscope::log::discardOutputs();
  // Lines are made, as for a frontend that shows them.
  const vespscope::log::Observation sink([](vespscope::log::Channel, std::string_view) {});
  vespscope::test::Work work;
  work.whole = std::string_view(arguments[1]) == "event";
  for (vespscope::MetricEvent& event : vespscope::test::corpusOf(arguments[2])) {
    work.events.push_back(std::make_shared<const vespscope::Record>(
        vespscope::Record{{"kKeyMetricID", std::int64_t{event.metricID}}, {"kKeyPayload", std::move(event.payload)}}));
  }
  vespscope::test::work = &work;
  work.run();  // excludes first uses from the measurement
  measured();
  std::printf("%zu\n", work.events.size());
}
