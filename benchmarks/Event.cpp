// What does one whole event cost, from its dictionary to the stored values, and what does each part cost?
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include <benchmark/benchmark.h>
#include <malloc.h>

#include "corpus/Corpus.h"
#include "metrics/EventRows.h"
#include "metrics/MetricValidator.h"
#include "metrics/PostProcessing.h"
#include "platform/log/Log.h"
#include "values/Text.h"

namespace vespscope::bench {
namespace {

// No more than one event needs, so that the parts are measured with memory as warm as in an event.
struct Prepared {
  std::shared_ptr<const Record> event;
  const Bytes* payload;
  const EventRow* row;
};

std::vector<Prepared> prepare() {
  std::vector<Prepared> all;
  for (MetricEvent& event : makeCorpus()) {
    Prepared prepared;
    prepared.event = std::make_shared<const Record>(Record{{"kKeyMetricID", std::int64_t{event.metricID}},
                                                           {"kKeyPayload", std::move(event.payload)},
                                                           {"kKeyProfileID", std::int64_t{0}}});
    prepared.payload = prepared.event->find("kKeyPayload")->asBytes();
    prepared.row = findEventRow(event.metricID);
    all.push_back(std::move(prepared));
  }
  return all;
}

const std::vector<Prepared>& events() {
  static const std::vector<Prepared> all = prepare();
  return all;
}

template <class Run>
void overCorpus(benchmark::State& state, Run run) {
  const std::vector<Prepared>& all = events();
  std::size_t index = 0;
  for (auto _ : state) {
    run(all[index]);
    if (++index == all.size()) index = 0;
  }
  state.SetItemsProcessed(static_cast<std::int64_t>(state.iterations()));
}

MetricValidator& validator() {
  static MetricValidator shared;
  return shared;
}

void wholeEvent(benchmark::State& state) {
  overCorpus(state, [](const Prepared& event) { validator().metricsDidUpdate(event.event); });
}

void decode(benchmark::State& state) {
  overCorpus(state, [](const Prepared& event) {
    const DecodedPayload decoded = event.row->decode(event.payload);
    benchmark::DoNotOptimize(&decoded);
  });
}

void timestamp(benchmark::State& state) {
  double milliseconds = 1.7e12;
  for (auto _ : state) {
    benchmark::DoNotOptimize(validator().formatTimestamp(milliseconds).data());
    milliseconds += 100;
  }
}

// The other parts follow decoding, as in an event; subtract decoding from their figures.
void text(benchmark::State& state) {
  std::string line;
  overCorpus(state, [&line](const Prepared& event) {
    const DecodedPayload decoded = event.row->decode(event.payload);
    line = event.row->literal;
    appendText(line, decoded.record);
    benchmark::DoNotOptimize(line.data());
  });
}
void logging(benchmark::State& state) {
  std::string line;
  overCorpus(state, [&line](const Prepared& event) {
    const DecodedPayload decoded = event.row->decode(event.payload);
    line = event.row->literal;
    appendText(line, decoded.record);
    log::print("Metric ID in Hex = 3C4E04");
    log::print(line);
    log::print("Received Valid Metric");
  });
}
void holders(benchmark::State& state) {
  overCorpus(state, [](const Prepared& event) {
    DecodedPayload decoded = event.row->decode(event.payload);
    postProcess(validator(), decoded.record, event.row->steps);
    benchmark::DoNotOptimize(&decoded);
  });
}

BENCHMARK(wholeEvent)->Name("event: whole");
BENCHMARK(decode)->Name("event: decode to dictionary");
BENCHMARK(timestamp)->Name("event: timestamp");
BENCHMARK(text)->Name("event: decode, text of the log line");
BENCHMARK(logging)->Name("event: decode, text of the log line, three lines through the log");
BENCHMARK(holders)->Name("event: decode, holders and conversions");

// Cost by the length of a list: the LTE neighbour measurement with neighbours only.
void list(benchmark::State& state) {
  const auto elements = static_cast<std::size_t>(state.range(0));
  const MetricEvent event = makeNeighbours(elements);
  const EventRow* row = findEventRow(event.metricID);
  for (auto _ : state) {
    const DecodedPayload decoded = row->decode(&event.payload);
    benchmark::DoNotOptimize(&decoded);
  }
}
void listEvent(benchmark::State& state) {
  const auto elements = static_cast<std::size_t>(state.range(0));
  MetricEvent event = makeNeighbours(elements);
  const auto dictionary = std::make_shared<const Record>(
      Record{{"kKeyMetricID", std::int64_t{event.metricID}}, {"kKeyPayload", std::move(event.payload)}});
  for (auto _ : state) validator().metricsDidUpdate(dictionary);
}
BENCHMARK(list)->Name("list: decode to dictionary")->Arg(0)->Arg(1)->Arg(4)->Arg(16)->Arg(64)->Arg(256)->Arg(1024);
BENCHMARK(listEvent)->Name("list: whole event")->Arg(0)->Arg(1)->Arg(4)->Arg(16)->Arg(64)->Arg(256)->Arg(1024);

// Heap in use after ten rounds over the corpus and after a hundred: memory must not grow with the events.
void describeHeap() {
  const auto round = [] {
    for (const Prepared& event : events()) validator().metricsDidUpdate(event.event);
  };
  for (int count = 0; count < 10; ++count) round();
  const auto once = ::mallinfo2().uordblks;
  for (int count = 10; count < 100; ++count) round();
  const auto often = ::mallinfo2().uordblks;
  benchmark::AddCustomContext("heap_after_10_rounds", std::to_string(once));
  benchmark::AddCustomContext("heap_after_100_rounds", std::to_string(often));
}

}  // namespace
}  // namespace vespscope::bench

int main(int count, char** arguments) {
  // The lines are made and passed to the observers, but not written.
  vespscope::log::discardOutputs();
  const vespscope::log::Observation sink(
      [](vespscope::log::Channel, std::string_view line) { benchmark::DoNotOptimize(line.data()); });
  benchmark::Initialize(&count, arguments);
  vespscope::bench::describeHeap();
  benchmark::RunSpecifiedBenchmarks();
  return 0;
}
