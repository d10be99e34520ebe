#include <cstdio>
#include <filesystem>
#include <system_error>

#include "capture/CaptureWriter.h"
#include "sources/MakeSource.h"
#include "sources/playback/Playback.h"
#include "sources/playback/Source.h"
#include "sources/playback/SourceSpec.h"
#include "tools/vespctl/Commands.h"
#include "tools/vespctl/Progress.h"

namespace vespscope::tools {
namespace {

using sources::EventStream;
using sources::SourceSpec;

Problem checkEnd(const std::string& source, const SourceSpec& spec, bool limited) {
  if (spec.isLive()) return source + ": a live modem is recorded, not converted";
  const bool endless = spec.kind == SourceSpec::Kind::scenario || spec.playback.loop;
  if (endless && !limited) return source + ": goes on without end; say with --seconds how much of it";
  return std::nullopt;
}

// Writes over the very file that is read, or into the folder.
bool overwritesInput(const SourceSpec& spec, const std::string& output) {
  std::error_code absent;
  const std::filesystem::path file(output);
  const std::filesystem::path folder = file.has_parent_path() ? file.parent_path() : ".";
  return !spec.file.empty() && (std::filesystem::equivalent(spec.file, file, absent) ||
                                std::filesystem::equivalent(spec.file, folder, absent));
}

Problem run(EventStream& stream, sources::PlaybackOptions options, capture::CaptureWriter& writer,
            std::optional<std::chrono::seconds> limit) {
  Progress progress;
  options.speed = 1;
  sources::Playback playback(options);
  for (;;) {
    const std::optional<MetricEvent> event = stream.next();
    if (!event) {
      if (Problem failure = stream.failure()) return failure;
      if (!options.loop) break;
      // A round without an event would never reach the limit.
      if (writer.count() == 0) break;
      stream.rewind();
      playback.restart();
      continue;
    }
    const std::optional<std::chrono::nanoseconds> position = playback.schedule(event->time);
    if (!position) continue;
    if (limit && *position > *limit) break;
    if (Problem unwritten = writer.write(*event)) return unwritten;
    progress.show(writer.count());
  }
  const std::string summary = stream.summary();
  progress.say(std::to_string(writer.count()) + " events" + (summary.empty() ? "" : " from " + summary));
  return std::nullopt;
}

}  // namespace

Problem convert(const std::string& source, const std::string& output, std::optional<std::chrono::seconds> limit,
                bool report) {
  const Result<SourceSpec> spec = SourceSpec::parse(source);
  if (!spec) return spec.reason();
  if (Problem problem = checkEnd(source, *spec, limit.has_value())) return problem;
  if (report && spec->kind != SourceSpec::Kind::diag) return source + ": only a modem log has a report";
  Result<std::unique_ptr<EventStream>> stream = sources::makeStream(*spec);
  if (!stream) return stream.reason();
  if (overwritesInput(*spec, output)) return output + ": is the source itself";
  Result<capture::CaptureWriter> writer = capture::CaptureWriter::create(output, capture::Flushing::inBlocks);
  if (!writer) return writer.reason();
  Problem problem = run(**stream, spec->playback, *writer, limit);
  Problem unwritten = writer->flush();
  if (report) std::fputs((*stream)->report().c_str(), stderr);
  return problem ? problem : unwritten;
}

}  // namespace vespscope::tools
