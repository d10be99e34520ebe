// Draws the pictures of the documentation: the window on a simulated drive, the same pictures every time.
//
// quick_screenshots FOLDER
#include <QGuiApplication>
#include <QImage>
#include <QTest>
#include <algorithm>
#include <cstdlib>
#include <iostream>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "frontends/quick/Hand.h"
#include "metrics/MetricValidator.h"
#include "platform/log/Log.h"
#include "rhoxlink/Rhoxlink.h"
#include "screens/SecondLevelViewController.h"
#include "shell/MainInterface.h"
#include "shell/MetricAges.h"
#include "sources/scenario/ScenarioStream.h"
#include "support/ScriptedRun.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using quick::Appearance;

constexpr std::uint64_t seed = 7;
// 2026-03-02 08:30:00 UTC.
constexpr auto start = std::chrono::nanoseconds(1'772'440'200s);

struct Shot {
  const char* name;
  std::vector<QString> rows;  // opened one after the other
};

const Shot shots[] = {
    {"launch", {}},
    {"lte", {"LTE"}},
    {"serving-cell-info", {"LTE", "Serving Cell Info"}},
    {"lte-neighbor-cell-meas", {"LTE", "LTE Neighbor Cell Meas"}},
    {"ca-status", {"LTE", "CA Status"}},
};

struct Drive {
  std::uint64_t events = 0;
  std::chrono::nanoseconds length{0};
  MetricAges ages;  // by the drive's own clock
};

// Whether every picture has content: neighbours, and two more carriers.
bool isWorthAPicture(const LTE& lte) {
  const auto carriers = lte.CAStatusList.size();
  return lte.EutraNbrsMeas.size() >= 3 && carriers >= 2;
}

// Runs the drive until the pictures have content, for an hour at most.
Drive drive() {
  const auto stream = sources::makeScenarioStream(seed, start);
  Drive driven;
  while (auto event = stream->next()) {
    driven.length = event->time - start;
    MetricValidator::shared()->metricsDidUpdate(std::make_shared<Record>(eventDictionary(*event)));
    driven.ages.note(event->metricID, event->time, {});
    ++driven.events;
    if (driven.length > 1h || (driven.length > 1min && isWorthAPicture(MetricValidator::shared()->myLTE))) break;
  }
  return driven;
}

// Reduces a picture to its 256 most frequent colours, replacing others by the nearest of them: the difference is
// invisible in flat colours, and the file is half the size.
QImage withPalette(const QImage& image) {
  std::map<QRgb, int> counts;
  for (int y = 0; y < image.height(); ++y) {
    for (int x = 0; x < image.width(); ++x) ++counts[image.pixel(x, y)];
  }
  std::vector<std::pair<int, QRgb>> frequent;
  for (const auto& [color, count] : counts) frequent.emplace_back(count, color);
  std::sort(frequent.rbegin(), frequent.rend());
  frequent.resize(std::min<std::size_t>(frequent.size(), 256));
  QList<QRgb> palette;
  for (const auto& [count, color] : frequent) palette << color;
  return image.convertToFormat(QImage::Format_Indexed8, palette, Qt::AvoidDither | Qt::ThresholdDither);
}

bool take(application::Application& application, const Shot& shot, QSize size, Appearance::Mode mode,
          const QString& path) {
  application.navigation = application.interface.instantiateInitial();
  application.navigation->topViewController()->loadViewIfNeeded();
  Hand hand(application, size);
  hand.main().appearance().setMode(mode);
  for (const QString& row : shot.rows) {
    QQuickItem* line = hand.line(row);
    while (line == nullptr) {
      hand.wheel(hand.list(), -1);
      line = hand.line(row);
    }
    hand.click(line);
  }
  // Waits until colours have faded in, and the pointer has left the rows.
  QTest::mouseMove(hand.window(), QPoint(1, 1));
  QTest::qWait(700);
  return withPalette(hand.window()->grabWindow().convertToFormat(QImage::Format_RGB32)).save(path, "PNG", 0);
}

int run(const QString& folder) {
  log::discardOutputs();
  rhox::client::setAddress({rhox::client::Address::Kind::none, {}});
  application::Status status;
  status.kind = SourceKind::simulated;
  status.source = "scenario seed=" + std::to_string(seed);
  status.connected = true;
  const Drive driven = drive();
  status.events = driven.events;
  status.eventsPerSecond = static_cast<double>(driven.events) / std::chrono::duration<double>(driven.length).count();
  application::Application application;
  application.interface = mainInterface();
  application.status = [&] {
    status.lastEvent = std::chrono::system_clock::now();
    return status;
  };
  application.screenAge = [&](const application::ViewController& screen) -> std::optional<application::ScreenAge> {
    const auto* shown = dynamic_cast<const SecondLevelViewController*>(&screen);
    const std::optional<std::int64_t> metric = shown == nullptr ? std::nullopt : shown->metric();
    if (!metric) return std::nullopt;
    const MetricAges::Source source{.connected = true, .recorded = true, .recordingClock = start + driven.length};
    return driven.ages.ageOf(*metric, source, {});
  };
  for (const Shot& shot : shots) {
    for (const auto& [sizeName, size] : {std::pair("phone", QSize(360, 720)), std::pair("wide", QSize(1280, 800))}) {
      for (const auto& [modeName, mode] :
           {std::pair("light", Appearance::Mode::Light), std::pair("dark", Appearance::Mode::Dark)}) {
        const QString path = folder + QString("/%1-%2-%3.png").arg(shot.name, sizeName, modeName);
        if (!take(application, shot, size, mode, path)) {
          std::cerr << "quick_screenshots: " << path.toStdString() << ": cannot be written\n";
          return 1;
        }
      }
    }
  }
  return 0;
}

}  // namespace
}  // namespace vespscope::test

int main(int argc, char** argv) {
  ::setenv("QT_QPA_PLATFORM", "offscreen", 1);
  ::setenv("QT_QUICK_BACKEND", "software", 1);
  ::setenv("QT_SCALE_FACTOR", "2", 1);
  ::setenv("TZ", "UTC", 1);
  ::setenv("LC_ALL", "C.UTF-8", 1);
  const QGuiApplication gui(argc, argv);
  if (argc != 2) {
    std::cerr << "usage: quick_screenshots FOLDER\n";
    return 2;
  }
  return vespscope::test::run(QString::fromLocal8Bit(argv[1]));
}
