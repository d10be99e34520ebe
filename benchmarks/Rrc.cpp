// What does it cost to read an RRC message, and to extract what the product uses of it?
//
// The messages are those of the tests, and those of modem logs in the folder that VESPSCOPE_CAPTURES names.
#include <memory>
#include <vector>

#include <benchmark/benchmark.h>

#include "rrc/Captures.h"
#include "rrc/Literals.h"
#include "rrc/Message.h"
#include "rrc/lte/CellInformation.h"
#include "rrc/lte/Connection.h"
#include "rrc/lte/MeasurementReport.h"
#include "rrc/lte/Reconfiguration.h"
#include "rrc/lte/Release.h"
#include "rrc/lte/Reselection.h"
#include "rrc/nr/MeasurementReport.h"
#include "rrc/nr/Reconfiguration.h"

namespace vespscope::bench {
namespace {

using test::CapturedMessage;
using Messages = std::vector<CapturedMessage>;

Messages literals() {
  Messages messages;
  for (const test::Literal& literal : test::literals) {
    CapturedMessage message{literal.pdu, {}};
    for (std::size_t index = 0; index < literal.hex.size(); index += 2) {
      message.bytes.push_back(
          static_cast<std::uint8_t>(std::stoul(std::string(literal.hex.substr(index, 2)), nullptr, 16)));
    }
    messages.push_back(std::move(message));
  }
  return messages;
}

const Messages& captured() {
  static const Messages messages = [] {
    Messages all;
    for (const auto& file : test::captureFiles()) {
      for (CapturedMessage& message : test::readCapture(file).messages) all.push_back(std::move(message));
    }
    return all;
  }();
  return messages;
}

// The operation of a log's reader for every message: read the struct for its name.
void ask(const rrc::Message& message) {
  using namespace rrc;
  switch (message.body().id()) {
    case "systemInformationBlockType1"_name:
      benchmark::DoNotOptimize(lte::cellInformationOf(message));
      break;
    case "systemInformation"_name:
      benchmark::DoNotOptimize(lte::systemInformationOf(message));
      break;
    case "paging"_name:
      benchmark::DoNotOptimize(lte::pagingOf(message));
      break;
    case "rrcConnectionSetup"_name:
      benchmark::DoNotOptimize(lte::connectionSetupOf(message));
      break;
    case "rrcConnectionReconfiguration"_name:
      benchmark::DoNotOptimize(lte::reconfigurationOf(message));
      break;
    case "rrcConnectionRelease"_name:
      benchmark::DoNotOptimize(lte::releaseOf(message));
      break;
    case "dlInformationTransfer"_name:
    case "ulInformationTransfer"_name:
      benchmark::DoNotOptimize(lte::transferredNasOf(message));
      break;
    case "measurementReport"_name:
      if (message.pdu() == Pdu::lteUlDcch) {
        benchmark::DoNotOptimize(lte::measurementReportOf(message));
      } else {
        benchmark::DoNotOptimize(nr::measurementReportOf(message));
      }
      break;
    case noName:
      benchmark::DoNotOptimize(nr::reconfigurationOf(message));
      break;
    default:
      break;
  }
}

void run(benchmark::State& state, const Messages& messages, bool asking) {
  rrc::Message message;
  std::size_t index = 0;
  for (auto _ : state) {
    const CapturedMessage& next = messages[index];
    if (message.read(next.pdu, next.bytes)) state.SkipWithError("a message cannot be read");
    if (asking) ask(message);
    benchmark::DoNotOptimize(message.nodes().data());
    if (++index == messages.size()) index = 0;
  }
}

void readLiterals(benchmark::State& state) { run(state, literals(), false); }
void askLiterals(benchmark::State& state) { run(state, literals(), true); }
void readCaptured(benchmark::State& state) { run(state, captured(), false); }
void askCaptured(benchmark::State& state) { run(state, captured(), true); }

BENCHMARK(readLiterals)->Name("rrc: read a message of the tests");
BENCHMARK(askLiterals)->Name("rrc: read a message of the tests and its struct");

}  // namespace

void registerCaptured() {
  if (captured().empty()) return;
  benchmark::RegisterBenchmark("rrc: read a captured message", readCaptured);
  benchmark::RegisterBenchmark("rrc: read a captured message and its struct", askCaptured);
}

}  // namespace vespscope::bench

int main(int count, char** arguments) {
  vespscope::bench::registerCaptured();
  benchmark::Initialize(&count, arguments);
  benchmark::RunSpecifiedBenchmarks();
  return 0;
}
