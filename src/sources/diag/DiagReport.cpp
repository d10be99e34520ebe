#include "sources/diag/DiagReport.h"

#include <array>
#include <cstdio>
#include <string_view>

#include "sources/diag/GsmSystemInformation.h"
#include "sources/diag/NasRecords.h"
#include "sources/diag/WcdmaRecords.h"

namespace vespscope::sources::diag {
namespace {

std::string_view partNameOf(std::uint16_t code) {
  switch (code) {
    case wcdmaRrcCode:
      return "channel";
    case esmMessageInCode:
    case esmMessageOutCode:
    case emmMessageInCode:
    case emmMessageOutCode:
    case gprsMessageCode:
    case gsmMessageCode:
      return "message";
    default:
      return "subpacket";
  }
}

std::uint64_t sumOf(const RecordCounts& counts) {
  std::uint64_t sum = 0;
  for (const auto& [kind, count] : counts) sum += count;
  return sum;
}

void appendCounts(std::string& text, const RecordCounts& counts, std::string_view what) {
  text += ", " + std::to_string(sumOf(counts)) + " ";
  text += what;
  std::string_view separator = " (";
  for (const auto& [kind, count] : counts) {
    text += separator;
    text += nameOf(kind) + ": " + std::to_string(count);
    separator = ", ";
  }
  if (!counts.empty()) text += ")";
}

void appendCount(std::string& text, std::uint64_t count, std::string_view what) {
  if (count == 0) return;
  text += ", " + std::to_string(count) + " ";
  text += what;
}

std::string_view reasonOf(const RecordKind& kind) {
  if (kind.part) {
    const std::string_view part = partNameOf(kind.code);
    if (part == "channel") return "not mapped: no message of the phone's own connection";
    if (part == "message") return "not mapped: contains nothing that a metric has";
    return "not mapped: the layout of this subpacket is not known";
  }
  if (kind.version) return "not mapped: the layout of this version is not known";
  return "not mapped: the layout of this code is not known";
}

void appendRow(std::string& text, const std::string& name, std::uint64_t count, std::string_view what) {
  std::array<char, 64> row{};
  std::snprintf(row.data(), row.size(), "  %-24s %10llu", name.c_str(), static_cast<unsigned long long>(count));
  text += row.data();
  if (!what.empty()) text += "  ";
  text += what;
  text += '\n';
}

// Appends the rows of all counts, in the order of the codes.
void appendRows(std::string& text, const DiagReport& report) {
  struct Row {
    std::uint64_t count;
    std::string_view what;
  };
  std::multimap<RecordKind, Row> rows;
  for (const auto& [kind, count] : report.read) rows.insert({kind, {count, "mapped"}});
  for (const auto& [kind, count] : report.skipped) rows.insert({kind, {count, reasonOf(kind)}});
  for (const auto& [kind, count] : report.broken) {
    rows.insert({kind, {count, "broken: too short, or numbers out of range"}});
  }
  for (const auto& [kind, row] : rows) appendRow(text, nameOf(kind), row.count, row.what);
}

}  // namespace

std::string nameOf(const RecordKind& kind) {
  std::array<char, 8> code{};
  std::snprintf(code.data(), code.size(), "%04X", static_cast<unsigned>(kind.code));
  std::string name = code.data();
  if (kind.part) name += " " + std::string(partNameOf(kind.code)) + " " + std::to_string(*kind.part);
  if (kind.version) name += " v" + std::to_string(*kind.version);
  return name;
}

bool isOfUnknownLayout(const RecordKind& kind) { return !kind.part || partNameOf(kind.code) == "subpacket"; }

std::string DiagReport::table() const {
  const std::uint64_t dropped = frames.badChecksum + frames.aborted + frames.oversized + frames.truncated;
  std::string text = "frames\n";
  appendRow(text, "good", frames.good, "");
  appendRow(text, "bad checksum", frames.badChecksum, "dropped");
  appendRow(text, "aborted", frames.aborted, "dropped: an escape before the end");
  appendRow(text, "too long", frames.oversized, "dropped");
  appendRow(text, "cut at the end", frames.truncated, "dropped");
  appendRow(text, "all", frames.good + dropped, "");
  text += "good frames\n";
  const std::uint64_t records = sumOf(read) + sumOf(skipped) + sumOf(broken) + otherRadios;
  appendRow(text, "log records", records, "");
  appendRow(text, "of another kind", otherFrames, "not mapped: no log record");
  appendRow(text, "malformed", malformedFrames, "not mapped: wrong lengths, or an impossible time");
  appendRow(text, "all", records + otherFrames + malformedFrames, "");
  text += "log records\n";
  appendRows(text, *this);
  if (otherRadios != 0) appendRow(text, "of other radios", otherRadios, "not mapped: more radios than a phone has");
  appendRow(text, "all", records,
            std::to_string(sumOf(read)) + " mapped, " + std::to_string(sumOf(skipped) + otherRadios) + " not mapped, " +
                std::to_string(sumOf(broken)) + " broken");
  if (!partsSkipped.empty()) text += "parts of mapped records\n";
  for (const auto& [kind, count] : partsSkipped) appendRow(text, nameOf(kind), count, reasonOf(kind));
  return text;
}

std::string DiagReport::text() const {
  std::string text = std::to_string(frames.good) + " frames, " + std::to_string(sumOf(read)) + " records read";
  appendCounts(text, skipped, "skipped");
  if (!broken.empty()) appendCounts(text, broken, "broken");
  if (!partsSkipped.empty()) appendCounts(text, partsSkipped, "parts skipped");
  appendCount(text, otherFrames, "frames of another kind");
  appendCount(text, malformedFrames, "malformed frames");
  appendCount(text, otherRadios, "records of other radios");
  appendCount(text, frames.badChecksum, "frames with a bad checksum");
  appendCount(text, frames.aborted, "frames aborted");
  appendCount(text, frames.oversized, "frames too long");
  appendCount(text, frames.truncated, "frame cut at the end");
  return text;
}

}  // namespace vespscope::sources::diag
