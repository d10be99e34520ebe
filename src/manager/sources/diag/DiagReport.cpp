#include "manager/sources/diag/DiagReport.h"

#include <array>
#include <cstdio>
#include <string_view>

namespace vespscope::manager::diag {
namespace {

std::string nameOf(const RecordKind& kind) {
  std::array<char, 8> code{};
  std::snprintf(code.data(), code.size(), "%04X", static_cast<unsigned>(kind.code));
  std::string name = code.data();
  if (kind.subpacket) name += " subpacket " + std::to_string(*kind.subpacket);
  if (kind.version) name += " v" + std::to_string(*kind.version);
  return name;
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

}  // namespace

std::string DiagReport::text() const {
  std::string text = std::to_string(frames.good) + " frames, " + std::to_string(sumOf(read)) + " records read";
  appendCounts(text, skipped, "skipped");
  if (!broken.empty()) appendCounts(text, broken, "broken");
  appendCount(text, otherFrames, "frames of another kind");
  appendCount(text, malformedFrames, "malformed frames");
  appendCount(text, otherRadios, "records of other radios");
  appendCount(text, frames.badChecksum, "frames with a bad checksum");
  appendCount(text, frames.aborted, "frames aborted");
  appendCount(text, frames.oversized, "frames too long");
  appendCount(text, frames.truncated, "frame cut at the end");
  return text;
}

}  // namespace vespscope::manager::diag
