// What does it cost to decode an event, into its message and into its dictionary, and how do other decoders compare?
#include <array>
#include <memory_resource>
#include <string>
#include <string_view>

#include <benchmark/benchmark.h>
#include <google/protobuf/util/json_util.h>

#include "AllMessages.h"
#include "Peers.h"
#include "corpus/Corpus.h"
#include "messages/Message.h"
#include "messages/MessageClasses.h"
#include "messages/WireReader.h"
#include "metrics/EventRows.h"
#include "peers/Dictionaries.h"
#include "peers/Reflection.h"
#include "platform/log/Log.h"

namespace vespscope::bench {
namespace {

using Owning = peers::OwningDictionary<peers::EnumerationText::own>;
using OwningWithViews = peers::OwningDictionary<peers::EnumerationText::view>;

protozero::pbf_reader readerOf(const Bytes& payload) {
  return {reinterpret_cast<const char*>(payload.data()), payload.size()};
}

// One way of decoding a payload of class `Ours`, whose class in the reference decoder is `Theirs`.
using Decode = void (*)(const Bytes& payload);

template <class Ours>
void toMessage(const Bytes& payload) {
  benchmark::DoNotOptimize(Ours::initWithData(payload).get());
}

template <class Theirs>
void protobufFresh(const Bytes& payload) {
  Theirs message;
  benchmark::DoNotOptimize(message.ParseFromArray(payload.data(), static_cast<int>(payload.size())));
}

template <class Theirs>
Theirs& reused() {
  static Theirs message;
  return message;
}

template <class Theirs>
void protobufReused(const Bytes& payload) {
  benchmark::DoNotOptimize(reused<Theirs>().ParseFromArray(payload.data(), static_cast<int>(payload.size())));
}

template <class Struct>
void structFresh(const Bytes& payload) {
  Struct message;
  message.read(readerOf(payload));
  benchmark::DoNotOptimize(&message);
}

template <class Struct>
void structReused(const Bytes& payload) {
  Struct& message = reused<Struct>();
  message.clear();
  message.read(readerOf(payload));
  benchmark::DoNotOptimize(&message);
}

template <class Theirs, void (*copy)(const Theirs&, Owning&)>
void protobufAccessors(const Bytes& payload) {
  Theirs& message = reused<Theirs>();
  benchmark::DoNotOptimize(message.ParseFromArray(payload.data(), static_cast<int>(payload.size())));
  Owning dictionary;
  copy(message, dictionary);
  benchmark::DoNotOptimize(&dictionary);
}

template <class Dictionary, void (*read)(protozero::pbf_reader, Dictionary&)>
void protozeroDictionary(const Bytes& payload) {
  Dictionary dictionary;
  read(readerOf(payload), dictionary);
  benchmark::DoNotOptimize(&dictionary);
}

template <void (*read)(protozero::pbf_reader, peers::ArenaDictionary&)>
void protozeroArena(const Bytes& payload) {
  alignas(16) static std::array<std::byte, std::size_t{1} << 16> memory;
  std::pmr::monotonic_buffer_resource arena(memory.data(), memory.size());
  peers::ArenaDictionary dictionary(&arena);
  read(readerOf(payload), dictionary);
  benchmark::DoNotOptimize(&dictionary);
}

template <class Theirs>
void reflectionDictionary(const Bytes& payload) {
  Theirs& message = reused<Theirs>();
  benchmark::DoNotOptimize(message.ParseFromArray(payload.data(), static_cast<int>(payload.size())));
  Owning dictionary;
  peers::reflect(message, dictionary);
  benchmark::DoNotOptimize(&dictionary);
}

template <class Theirs>
void reflectionMap(const Bytes& payload) {
  Theirs& message = reused<Theirs>();
  benchmark::DoNotOptimize(message.ParseFromArray(payload.data(), static_cast<int>(payload.size())));
  peers::Map map;
  peers::reflect(message, peers::MapDictionary(map));
  benchmark::DoNotOptimize(&map);
}

template <class Theirs>
void json(const Bytes& payload) {
  Theirs& message = reused<Theirs>();
  benchmark::DoNotOptimize(message.ParseFromArray(payload.data(), static_cast<int>(payload.size())));
  std::string text;
  benchmark::DoNotOptimize(google::protobuf::util::MessageToJsonString(message, &text).ok());
}

struct Ways {
  std::string_view message;
  Decode toMessage, protobufReused, protobufFresh, structReused, structFresh, accessors, owning, owningWithViews, arena,
      reflection, map, json;
};

#define WAYS(Name)                                                             \
  {#Name,                                                                      \
   &toMessage<Name>,                                                           \
   &protobufReused<peer::Name>,                                                \
   &protobufFresh<peer::Name>,                                                 \
   &structReused<peers::Name<std::string_view>>,                               \
   &structFresh<peers::Name<std::string>>,                                     \
   &protobufAccessors<peer::Name, &peers::copy##Name<Owning>>,                 \
   &protozeroDictionary<Owning, &peers::read##Name<Owning>>,                   \
   &protozeroDictionary<OwningWithViews, &peers::read##Name<OwningWithViews>>, \
   &protozeroArena<&peers::read##Name<peers::ArenaDictionary>>,                \
   &reflectionDictionary<peer::Name>,                                          \
   &reflectionMap<peer::Name>,                                                 \
   &json<peer::Name>},
const Ways allWays[] = {FOR_EACH_PEER(WAYS)};

struct Prepared {
  const Bytes* payload;
  const EventRow* row;
  const Ways* ways;
};

struct Prepare {
  std::vector<MetricEvent> events;
  std::vector<Prepared> prepared;

  explicit Prepare(bool mixed) {
    CorpusShape shape;
    shape.mixed = mixed;
    events = makeCorpus(shape);
    for (const MetricEvent& event : events) {
      const EventRow* row = findEventRow(event.metricID);
      const Ways* ways = nullptr;
      for (const Ways& each : allWays) {
        if (each.message == row->message) ways = &each;
      }
      prepared.push_back({&event.payload, row, ways});
    }
  }
};

const Prepare& prepared(bool mixed) {
  static const Prepare mixedEvents(true);
  static const Prepare sortedEvents(false);
  return mixed ? mixedEvents : sortedEvents;
}

template <class Run>
void overCorpus(benchmark::State& state, bool mixed, Run run) {
  const std::vector<Prepared>& events = prepared(mixed).prepared;
  std::size_t index = 0;
  for (auto _ : state) {
    run(events[index]);
    if (++index == events.size()) index = 0;
  }
  state.SetItemsProcessed(static_cast<std::int64_t>(state.iterations()));
}

void way(benchmark::State& state, Decode Ways::*decode) {
  overCorpus(state, true, [decode](const Prepared& event) { (event.ways->*decode)(*event.payload); });
}

void dictionary(benchmark::State& state, bool mixed) {
  overCorpus(state, mixed, [](const Prepared& event) {
    const DecodedPayload decoded = event.row->decode(event.payload);
    benchmark::DoNotOptimize(&decoded);
  });
}

// Reads every byte of the payload as varints: the minimum work of any decoder.
void skim(benchmark::State& state) {
  overCorpus(state, true, [](const Prepared& event) {
    std::uint64_t sum = 0;
    std::uint64_t value = 0;
    for (const std::uint8_t byte : *event.payload) {
      value = value << 7 | (byte & 0x7FU);
      if (byte < 0x80) {
        sum += value;
        value = 0;
      }
    }
    benchmark::DoNotOptimize(sum);
  });
}

BENCHMARK_CAPTURE(dictionary, mixed, true)->Name("ours: dictionary");
BENCHMARK_CAPTURE(dictionary, sorted, false)->Name("ours: dictionary, one metric after the other");
BENCHMARK_CAPTURE(way, message, &Ways::toMessage)->Name("ours: message");
BENCHMARK(skim)->Name("varint skim");
BENCHMARK_CAPTURE(way, protobufReused, &Ways::protobufReused)->Name("protobuf: reused message");
BENCHMARK_CAPTURE(way, protobufFresh, &Ways::protobufFresh)->Name("protobuf: fresh message");
BENCHMARK_CAPTURE(way, structReused, &Ways::structReused)->Name("protozero: reused struct of views");
BENCHMARK_CAPTURE(way, structFresh, &Ways::structFresh)->Name("protozero: fresh owning struct");
BENCHMARK_CAPTURE(way, accessors, &Ways::accessors)->Name("protobuf: accessors to owning dictionary");
BENCHMARK_CAPTURE(way, owning, &Ways::owning)->Name("protozero: owning dictionary");
BENCHMARK_CAPTURE(way, owningViews, &Ways::owningWithViews)->Name("protozero: owning dictionary, static names");
BENCHMARK_CAPTURE(way, arena, &Ways::arena)->Name("protozero: arena of views");
BENCHMARK_CAPTURE(way, reflection, &Ways::reflection)->Name("protobuf: reflection to dictionary");
BENCHMARK_CAPTURE(way, map, &Ways::map)->Name("protobuf: reflection to std::map");
BENCHMARK_CAPTURE(way, json, &Ways::json)->Name("protobuf: JSON");

// The amount of work in one event.
void describe() {
  struct {
    std::size_t values = 0, dictionaries = 0, bytes = 0;
    void count(const Record& record) {
      ++dictionaries;
      for (const Entry& entry : record) {
        if (const Record* embedded = entry.value.asRecord()) {
          count(*embedded);
        } else if (const List* list = entry.value.asList()) {
          for (const Value& value : *list) {
            if (value.asRecord() != nullptr) {
              count(*value.asRecord());
            } else {
              ++values;
            }
          }
        } else {
          ++values;
        }
      }
    }
  } sum;
  const auto& events = prepared(true).prepared;
  for (const Prepared& event : events) {
    sum.bytes += event.payload->size();
    sum.count(event.row->decode(event.payload).record);
  }
  const auto per = [&events](std::size_t total) {
    return std::to_string(static_cast<double>(total) / static_cast<double>(events.size())).substr(0, 5);
  };
  benchmark::AddCustomContext("corpus", std::to_string(events.size()) + " events of " + per(sum.bytes) + " bytes, " +
                                            per(sum.values) + " values, " + per(sum.dictionaries) + " dictionaries");
}

}  // namespace
}  // namespace vespscope::bench

int main(int count, char** arguments) {
  vespscope::log::discardOutputs();
  benchmark::Initialize(&count, arguments);
  vespscope::bench::describe();
  benchmark::RunSpecifiedBenchmarks();
  return 0;
}
