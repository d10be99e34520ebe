#include "capture/CaptureWriter.h"
#include "platform/console/Console.h"
#include "sources/MakeSource.h"
#include "sources/SourceInputs.h"
#include "sources/playback/Playback.h"
#include "sources/playback/Source.h"
#include "sources/playback/SourceSpec.h"
#include "tools/vespctl/Commands.h"
#include "tools/vespctl/EndSignals.h"
#include "tools/vespctl/Progress.h"

namespace vespscope::tools {
namespace {

using capture::CaptureWriter;
using sources::EventStream;
using sources::SourceSpec;

Problem checkEnd(const std::string& source, const SourceSpec& spec, bool limited) {
  if (spec.isLive()) return source + ": a live modem is recorded, not converted";
  const bool endless = spec.kind == SourceSpec::Kind::scenario || spec.playback.loop;
  if (endless && !limited) return source + ": has no end; limit it with --seconds";
  return std::nullopt;
}

Problem run(EventStream& stream, sources::PlaybackOptions options, CaptureWriter& writer,
            std::optional<std::chrono::seconds> limit, const EndSignals* signals) {
  Progress progress;
  options.speed = 1;
  sources::Playback playback(options);
  while (signals == nullptr || !signals->received()) {
    const std::optional<MetricEvent> event = stream.next();
    if (!event) {
      if (Problem failure = stream.failure()) return failure;
      if (!options.loop) break;
      // After a round without an event the loop would never reach the limit.
      if (writer.count() == 0) break;
      stream.rewind();
      playback.restart();
      continue;
    }
    const std::optional<std::chrono::nanoseconds> position = playback.schedule(event->time);
    if (!position) continue;
    if (limit && *position > *limit) break;
    if (Problem unwritten = writer.write(*event)) return unwritten;
    if (progress.due()) progress.show(progressText(stream.progress(), writer.count(), progress.elapsed()));
  }
  const std::string summary = stream.summary();
  progress.say(std::to_string(writer.count()) + " events" + (summary.empty() ? "" : " from " + summary));
  return std::nullopt;
}

}  // namespace

Problem convert(const Conversion& conversion) {
  const std::string& source = conversion.source;
  const Result<SourceSpec> spec = SourceSpec::parse(source);
  if (!spec) return spec.reason();
  if (Problem problem = checkEnd(source, *spec, conversion.limit.has_value())) return problem;
  if (conversion.report && spec->kind != SourceSpec::Kind::diag) return source + ": only a modem log has a report";
  Result<std::unique_ptr<EventStream>> stream = sources::makeStream(*spec);
  if (!stream) return stream.reason();
  if (sources::readsOutput(*spec, conversion.output)) return conversion.output + ": is the source itself";
  Result<CaptureWriter> writer =
      CaptureWriter::createWhole(conversion.output, capture::Flushing::inBlocks,
                                 conversion.force ? CaptureWriter::Existing::replace : CaptureWriter::Existing::refuse);
  if (!writer) return writer.reason();
  // Only a file needs to be completed after a signal.
  std::optional<EndSignals> signals;
  if (writer->isPartial()) signals.emplace(**stream);
  Problem problem = run(**stream, spec->playback, *writer, conversion.limit, signals ? &*signals : nullptr);
  const bool interrupted = signals && signals->received();
  if (!problem && !interrupted) problem = writer->finish();
  if (conversion.report) console::errorText((*stream)->report());
  if (interrupted) {
    console::error("vespctl: interrupted" + writer->leavePartial());
    signals->endProcess();
  }
  if (problem) *problem += writer->leavePartial();
  return problem;
}

}  // namespace vespscope::tools
