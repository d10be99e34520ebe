// What does it cost to reload the largest screen: 64 sections of 14 rows?
#include <memory>
#include <stdexcept>

#include <benchmark/benchmark.h>

#include "corpus/Corpus.h"
#include "frontends/terminal/ScreenModel.h"
#include "frontends/terminal/TableLines.h"
#include "metrics/MetricValidator.h"
#include "platform/application/TableSnapshot.h"
#include "platform/log/Log.h"
#include "rhoxlink/Rhoxlink.h"
#include "screens/SecondLevelViewController.h"

namespace vespscope::bench {
namespace {

constexpr std::size_t sections = 64;
constexpr std::size_t rows = 14;

std::shared_ptr<SecondLevelViewController> largestScreen() {
  rhox::client::setAddress({rhox::client::Address::Kind::none, {}});
  auto screen = std::make_shared<SecondLevelViewController>();
  screen->tableView().registerPrototype({"SecondClickView", application::CellStyle::value, false, ""});
  screen->myMetricValidator = std::make_shared<MetricValidator>();
  screen->firstSelection = "LTE";
  screen->seguedThroughRow = "EUTRA Neighbor Info";
  Record neighbour;
  for (const char* key : {"earfcn", "Q_rxlev_min", "Q_qual_min", "Q_offset", "Pmax", "dl_bw", "Thres_X_highP",
                          "Thres_X_lowP", "Thres_X_highQ", "Thres_X_lowQ", "priority", "band"}) {
    neighbour.set(Key(std::string(key)), std::int32_t{1234});
  }
  neighbour.set("frame_type", "FDD");
  neighbour.set("timestamp", "2026-11-21 12:00:00 UTC");
  screen->myMetricValidator->myLTE.EutraNbrs.assign(sections, neighbour);
  const application::TableSnapshot table = application::readTable(*screen);
  if (table.sections.size() != sections || table.sections[0].rows.size() != rows) {
    throw std::logic_error("not the screen that was meant");
  }
  return screen;
}

void read(benchmark::State& state) {
  const auto screen = largestScreen();
  for (auto _ : state) {
    const application::TableSnapshot table = application::readTable(*screen);
    benchmark::DoNotOptimize(&table);
  }
}

void readAndLayOut(benchmark::State& state) {
  const auto screen = largestScreen();
  terminal::ScreenModel model;
  for (auto _ : state) {
    model.reload(application::readTable(*screen));
    const terminal::TableLines lines = terminal::layOutTable(model, 80, true);
    benchmark::DoNotOptimize(&lines);
  }
}

BENCHMARK(read)->Name("reload: read the table")->Unit(benchmark::kMicrosecond);
BENCHMARK(readAndLayOut)->Name("reload: read, compare and lay out for the terminal")->Unit(benchmark::kMicrosecond);

}  // namespace
}  // namespace vespscope::bench

int main(int count, char** arguments) {
  vespscope::log::discardOutputs();
  benchmark::Initialize(&count, arguments);
  benchmark::RunSpecifiedBenchmarks();
  return 0;
}
