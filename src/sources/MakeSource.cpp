#include "sources/MakeSource.h"

#include <chrono>
#include <utility>

#include "sources/OneSimStream.h"
#include "sources/RecogniseFile.h"
#include "sources/diag/DiagPortSource.h"
#include "sources/diag/DiagStream.h"
#include "sources/diag/PortConnection.h"
#include "sources/modemmanager/ModemManagerSource.h"
#include "sources/playback/Player.h"
#include "sources/replay/ReplayStream.h"
#include "sources/scenario/ScenarioStream.h"

namespace vespscope::sources {

namespace {

Result<std::unique_ptr<EventStream>> openReplay(const std::string& file) {
  Result<std::unique_ptr<EventStream>> stream = openReplayStream(file);
  if (stream || !isModemLog(file)) return stream;
  return Failure{file + ": is a modem log, not a capture; play it as " + sourceWords(FileKind::modemLog, file)};
}

Result<std::unique_ptr<EventStream>> openStream(const SourceSpec& spec) {
  switch (spec.kind) {
    case SourceSpec::Kind::scenario: {
      // The drive began as long ago as the part that is left out, so that the played events have the present time.
      const auto now = std::chrono::system_clock::now().time_since_epoch();
      return makeScenarioStream(spec.seed, now - spec.playback.start);
    }
    case SourceSpec::Kind::replay:
      return openReplay(spec.file);
    case SourceSpec::Kind::diag:
      return openDiagStream(spec.file);
    case SourceSpec::Kind::diagPort:
    case SourceSpec::Kind::modemManager:
      return Failure{std::string("a live modem cannot be read ahead of its time")};
  }
  return Failure{std::string("unknown kind of source")};
}

Result<std::unique_ptr<EventStream>> openWhole(const SourceSpec& spec) {
  Result<std::unique_ptr<EventStream>> stream = openStream(spec);
  if (stream && spec.playback.loop && !(*stream)->canRewind()) {
    return Failure{"\"" + spec.file + "\" cannot be played in a loop: it cannot be read again"};
  }
  return stream;
}

Result<std::unique_ptr<Source>> openPort(const SourceSpec& spec) {
  const std::string& port = spec.file;
  if (port.starts_with("tcp:")) {
    if (const auto problem = diag::problemWithTcpPort(port)) return Failure{"\"" + port + "\": " + *problem};
  }
  auto source = std::make_unique<diag::DiagPortSource>(port);
  source->preferSimCard(spec.sim);
  return std::unique_ptr<Source>(std::move(source));
}

}  // namespace

Result<std::unique_ptr<EventStream>> makeStream(const SourceSpec& spec) {
  Result<std::unique_ptr<EventStream>> stream = openWhole(spec);
  if (stream && spec.sim) *stream = std::make_unique<OneSimStream>(std::move(*stream), *spec.sim);
  return stream;
}

Result<std::unique_ptr<Source>> makeSource(std::string_view words) {
  const Result<SourceSpec> spec = SourceSpec::parse(words);
  if (!spec) return Failure{spec.reason()};
  if (spec->kind == SourceSpec::Kind::modemManager) {
    return std::unique_ptr<Source>(std::make_unique<modemmanager::ModemManagerSource>());
  }
  if (spec->kind == SourceSpec::Kind::diagPort) return openPort(*spec);
  Result<std::unique_ptr<EventStream>> stream = openWhole(*spec);
  if (!stream) return Failure{stream.reason()};
  const bool recorded = spec->kind != SourceSpec::Kind::scenario;
  const std::optional<std::int32_t> card = spec->sim || !recorded ? spec->sim : simCardOfData(**stream);
  auto player = std::make_unique<Player>(std::move(*stream), spec->playback);
  player->preferSimCard(card);
  return std::unique_ptr<Source>(std::move(player));
}

}  // namespace vespscope::sources
