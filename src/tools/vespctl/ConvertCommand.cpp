#include <utility>

#include "capture/CaptureWriter.h"
#include "platform/console/Console.h"
#include "sources/MakeSource.h"
#include "sources/SourceInputs.h"
#include "sources/diag/DiagStream.h"
#include "sources/diag/UnreadSamples.h"
#include "sources/playback/Playback.h"
#include "sources/playback/Source.h"
#include "sources/playback/SourceSpec.h"
#include "tools/vespctl/Commands.h"
#include "tools/vespctl/Diagnosis.h"
#include "tools/vespctl/EndSignals.h"
#include "tools/vespctl/Progress.h"
#include "tools/vespctl/SampleFiles.h"
#include "tools/vespctl/ScreenCoverage.h"

namespace vespscope::tools {
namespace {

using capture::CaptureWriter;
using sources::EventStream;
using sources::SourceSpec;
using sources::diag::DiagStream;
using sources::diag::UnreadSamples;

Problem checkEnd(const std::string& source, const SourceSpec& spec, bool limited) {
  if (spec.isLive()) return source + ": a live modem is recorded, not converted";
  const bool endless = spec.kind == SourceSpec::Kind::scenario || spec.playback.loop;
  if (endless && !limited) return source + ": has no end; limit it with --seconds";
  return std::nullopt;
}

// Takes what is converted.
class Outputs {
 public:
  // `sim`: the only card that is written, beside events of no card in particular; empty: all.
  Outputs(const Conversion& conversion, Sim sim) : conversion_(conversion), sim_(sim) {
    if (conversion.report) coverage_.emplace();
  }

  // Creates the capture, if one is wanted.
  [[nodiscard]] Problem create() {
    if (conversion_.output.empty()) return std::nullopt;
    auto writer = CaptureWriter::createWhole(
        conversion_.output, capture::Flushing::inBlocks,
        conversion_.force ? CaptureWriter::Existing::replace : CaptureWriter::Existing::refuse);
    if (!writer) return writer.reason();
    writer_.emplace(std::move(*writer));
    return std::nullopt;
  }

  [[nodiscard]] Problem take(const MetricEvent& event) {
    if (sim_ && event.profileID != 0 && event.profileID != *sim_) return std::nullopt;
    ++count_;
    if (coverage_) coverage_->take(event);
    return writer_ ? writer_->write(event) : std::nullopt;
  }

  [[nodiscard]] std::uint64_t count() const { return count_; }
  [[nodiscard]] bool isPartial() const { return writer_ && writer_->isPartial(); }
  [[nodiscard]] Problem finish() { return writer_ ? writer_->finish() : std::nullopt; }
  [[nodiscard]] std::string leavePartial() { return writer_ ? writer_->leavePartial() : std::string(); }

  void printReport(const DiagStream& log) const {
    if (coverage_) console::errorText(log.report() + screensText(coverage_->screens(), log.counts()));
  }

 private:
  const Conversion& conversion_;
  const Sim sim_;
  std::optional<CaptureWriter> writer_;
  std::optional<ScreenCoverage> coverage_;
  std::uint64_t count_ = 0;
};

Problem run(EventStream& stream, sources::PlaybackOptions options, Outputs& outputs,
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
      if (outputs.count() == 0) break;
      stream.rewind();
      playback.restart();
      continue;
    }
    const std::optional<std::chrono::nanoseconds> position = playback.schedule(event->time);
    if (!position) continue;
    if (limit && *position > *limit) break;
    if (Problem unwritten = outputs.take(*event)) return unwritten;
    if (progress.due()) progress.show(progressText(stream.progress(), outputs.count(), progress.elapsed()));
  }
  const std::string summary = stream.summary();
  progress.say(std::to_string(outputs.count()) + " events" + (summary.empty() ? "" : " from " + summary));
  return std::nullopt;
}

Problem checkRequest(const Conversion& conversion, const SourceSpec& spec) {
  if (Problem problem = checkEnd(conversion.source, spec, conversion.limit.has_value())) return problem;
  const bool isLog = spec.kind == SourceSpec::Kind::diag;
  if (conversion.report && !isLog) return conversion.source + ": only a modem log has a report";
  if (conversion.unread && !isLog) return conversion.source + ": only a modem log has records that are not read";
  return std::nullopt;
}

}  // namespace

Problem convert(const Conversion& conversion) {
  Result<SourceSpec> spec = SourceSpec::parse(conversion.source);
  if (!spec) return spec.reason();
  if (Problem problem = checkRequest(conversion, *spec)) return problem;
  // The log reports what it does not read of every card, so the choice is made behind it.
  const Sim named = std::exchange(spec->sim, std::nullopt);
  if (conversion.sim && named) return conversion.source + ": names a SIM card, and so does --sim";
  Result<std::unique_ptr<EventStream>> stream = sources::makeStream(*spec);
  if (!stream) return stream.reason();
  if (!conversion.output.empty() && sources::readsOutput(*spec, conversion.output)) {
    return conversion.output + ": is the source itself";
  }
  UnreadSamples samples;
  auto* log = dynamic_cast<DiagStream*>(stream->get());
  if (log != nullptr && conversion.unread) log->sampleUnread(samples);
  Outputs outputs(conversion, named ? named : conversion.sim);
  if (Problem problem = outputs.create()) return problem;
  // Only a file needs to be completed after a signal.
  std::optional<EndSignals> signals;
  if (outputs.isPartial()) signals.emplace(**stream);
  Problem problem = run(**stream, spec->playback, outputs, conversion.limit, signals ? &*signals : nullptr);
  const bool interrupted = signals && signals->received();
  if (!problem && !interrupted) problem = outputs.finish();
  if (log != nullptr) outputs.printReport(*log);
  if (interrupted) {
    console::error("vespctl: interrupted" + outputs.leavePartial());
    signals->endProcess();
  }
  if (problem) *problem += outputs.leavePartial();
  if (!conversion.unread) return problem;
  const Problem unwritten = writeSamples(samples, *conversion.unread, *spec, conversion.force);
  if (problem && unwritten) console::error("vespctl: " + *unwritten);
  return problem ? problem : unwritten;
}

}  // namespace vespscope::tools
