#include "tools/vespctl/Diagnosis.h"

#include <algorithm>
#include <memory>
#include <utility>

#include "sources/MakeSource.h"
#include "sources/diag/DiagStream.h"
#include "sources/playback/Playback.h"
#include "sources/playback/SourceSpec.h"
#include "tools/vespctl/RecordScreens.h"

namespace vespscope::tools {
namespace {

using sources::EventStream;
using sources::FileKind;
using sources::SourceSpec;
using sources::diag::DiagReport;
using sources::diag::RecordCounts;
using sources::diag::RecordKind;

// "B0C0, B0C2 or B193".
std::string listed(const std::vector<std::string>& names, std::string_view last) {
  std::string text;
  for (std::size_t i = 0; i < names.size(); ++i) {
    if (i > 0) text += i + 1 == names.size() ? " " + std::string(last) + " " : ", ";
    text += names[i];
  }
  return text;
}

bool reaches(const RecordScreens& records, const std::string& screen) {
  return std::find(records.screens.begin(), records.screens.end(), screen) != records.screens.end();
}

bool holdsCode(const RecordCounts& counts, std::uint16_t code) {
  return std::any_of(counts.begin(), counts.end(), [code](const auto& each) { return each.first.code == code; });
}

std::string codeName(std::uint16_t code) { return sources::diag::nameOf({code, std::nullopt, std::nullopt}); }

// Why the screen stays empty, from the records that could fill it.
EmptyScreen emptyScreen(const CoveredScreen& screen, const DiagReport& report, const std::vector<UnreadKind>& unread) {
  EmptyScreen empty{screen.launch, screen.row, {}, false};
  std::vector<std::string> read;
  std::vector<std::string> absent;
  for (const RecordScreens& records : recordScreens()) {
    if (!reaches(records, screen.key())) continue;
    (holdsCode(report.read, records.code) ? read : absent).push_back(codeName(records.code));
  }
  std::vector<std::string> notRead;
  for (const UnreadKind& each : unread) {
    if (std::find(each.screens.begin(), each.screens.end(), screen.key()) == each.screens.end()) continue;
    notRead.push_back(nameOf(each.kind) + " (" + std::to_string(each.count) + ")");
  }
  if (!notRead.empty()) {
    empty.unread = true;
    empty.reason = "records that could fill it are not read: " + listed(notRead, "and");
  } else if (!read.empty()) {
    empty.reason = "nothing for it in " + listed(read, "and");
  } else if (!absent.empty()) {
    empty.reason = "not in the log: " + listed(absent, "or");
  } else {
    empty.reason = "no record that is read fills it";
  }
  return empty;
}

std::vector<std::string> screensOf(std::uint16_t code) {
  const RecordScreens* records = findRecordScreens(code);
  if (records == nullptr) return {};
  return {records->screens.begin(), records->screens.end()};
}

// What the words or the path name; a path is told apart by its contents.
Result<SourceSpec> specOf(const std::string& words) {
  if (words.starts_with("diag:") || words.starts_with("replay:")) return SourceSpec::parse(words);
  if (words == "-") return Failure{std::string("standard input is named diag:- or replay:-")};
  const auto kind = sources::recogniseFile(words);
  if (!kind) return Failure{kind.reason()};
  return SourceSpec::parse(sources::sourceWords(*kind, words));
}

}  // namespace

std::size_t Diagnosis::filled() const {
  const auto count = std::count_if(screens.begin(), screens.end(), [](const auto& screen) { return screen.filled; });
  return static_cast<std::size_t>(count);
}

Result<Diagnosis> diagnose(const std::string& source) {
  const Result<SourceSpec> spec = specOf(source);
  if (!spec) return Failure{spec.reason()};
  Diagnosis diagnosis;
  diagnosis.name = spec->file == "-" ? "standard input" : spec->file;
  diagnosis.kind = spec->kind == SourceSpec::Kind::diag ? FileKind::modemLog : FileKind::capture;
  diagnosis.source = sources::sourceWords(diagnosis.kind, spec->file);
  Result<std::unique_ptr<EventStream>> stream = sources::makeStream(*spec);
  if (!stream) return Failure{stream.reason()};
  ScreenCoverage coverage;
  sources::Playback playback{sources::PlaybackOptions()};
  while (const std::optional<MetricEvent> event = (*stream)->next()) {
    ++diagnosis.events;
    diagnosis.playingTime = playback.schedule(event->time).value_or(diagnosis.playingTime);
    if (event->profileID != 0) diagnosis.simCards.insert(event->profileID);
    coverage.take(*event);
  }
  diagnosis.screens = coverage.screens();
  diagnosis.damage = (*stream)->failure();
  if (const auto* log = dynamic_cast<const sources::diag::DiagStream*>(stream->get())) diagnosis.report = log->counts();
  if (diagnosis.damage && diagnosis.events == 0 && !diagnosis.report) return Failure{*diagnosis.damage};
  return diagnosis;
}

std::set<std::uint16_t> codesOf(const DiagReport& report) {
  std::set<std::uint16_t> codes;
  for (const RecordCounts* counts : {&report.read, &report.skipped, &report.broken}) {
    for (const auto& [kind, count] : *counts) codes.insert(kind.code);
  }
  return codes;
}

bool hasTechnology(const DiagReport& report, const std::string& launch) {
  const std::set<std::uint16_t> codes = codesOf(report);
  return std::any_of(codes.begin(), codes.end(), [&launch](std::uint16_t code) {
    return technologyOf(code).find(launch) != std::string_view::npos;
  });
}

std::vector<EmptyScreen> emptyScreens(const std::vector<CoveredScreen>& screens, const DiagReport& report) {
  const std::vector<UnreadKind> unread = unreadKinds(report);
  std::vector<EmptyScreen> empty;
  for (const CoveredScreen& screen : screens) {
    if (!screen.filled && hasTechnology(report, screen.launch)) empty.push_back(emptyScreen(screen, report, unread));
  }
  return empty;
}

std::vector<UnreadKind> unreadKinds(const DiagReport& report) {
  std::vector<UnreadKind> unread;
  const auto take = [&unread](const RecordCounts& counts, bool broken) {
    for (const auto& [kind, count] : counts) {
      if (isOfUnknownLayout(kind)) unread.push_back({kind, count, broken, screensOf(kind.code)});
    }
  };
  take(report.skipped, false);
  take(report.partsSkipped, false);
  take(report.broken, true);
  std::stable_sort(unread.begin(), unread.end(), [](const UnreadKind& left, const UnreadKind& right) {
    if (left.screens.empty() != right.screens.empty()) return right.screens.empty();
    return left.count > right.count;
  });
  return unread;
}

}  // namespace vespscope::tools
