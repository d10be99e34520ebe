#include <algorithm>
#include <cctype>
#include <string_view>

#include <nlohmann/json.hpp>

#include "screens/VespViewItems.h"
#include "tools/vespctl/Diagnosis.h"
#include "tools/vespctl/Json.h"
#include "tools/vespctl/Paragraphs.h"
#include "tools/vespctl/RecordScreens.h"

namespace vespscope::tools {
namespace {

using sources::FileKind;
using sources::diag::DiagReport;
using sources::diag::RecordCounts;
using sources::diag::RecordKind;

using Strings = std::vector<std::string>;

std::string joined(const Strings& words) {
  std::string text;
  for (const std::string& word : words) text += (text.empty() ? "" : ", ") + word;
  return text;
}

std::string counted(std::uint64_t count, std::string_view one, std::string_view several) {
  return std::to_string(count) + " " + std::string(count == 1 ? one : several);
}

std::string lengthText(std::chrono::nanoseconds length) {
  const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(length).count();
  if (seconds < 60) return std::to_string(seconds) + " s";
  if (seconds < 3600) return std::to_string(seconds / 60) + " min " + std::to_string(seconds % 60) + " s";
  return std::to_string(seconds / 3600) + " h " + std::to_string(seconds % 3600 / 60) + " min";
}

std::uint64_t sumOf(const RecordCounts& counts) {
  std::uint64_t sum = 0;
  for (const auto& [kind, count] : counts) sum += count;
  return sum;
}

std::uint64_t recordsOf(const DiagReport& report) {
  return sumOf(report.read) + sumOf(report.skipped) + sumOf(report.broken) + report.otherRadios;
}

std::uint64_t damagedFramesOf(const DiagReport& report) {
  const auto& frames = report.frames;
  return frames.badChecksum + frames.aborted + frames.oversized + frames.truncated + report.malformedFrames;
}

// The file as the shell takes it.
std::string quoted(const std::string& word) {
  const bool plain = std::all_of(word.begin(), word.end(), [](unsigned char each) {
    return std::isalnum(each) != 0 || std::string_view("/._-+:,=@%").find(static_cast<char>(each)) != std::string::npos;
  });
  if (plain && !word.empty()) return word;
  std::string text = "'";
  for (const char each : word) text += each == '\'' ? "'\\''" : std::string(1, each);
  return text + "'";
}

std::string codeName(std::uint16_t code) { return nameOf(RecordKind{code, std::nullopt, std::nullopt}); }

Strings rowsOf(const std::vector<CoveredScreen>& screens, const std::string& launch, bool filled) {
  Strings rows;
  for (const CoveredScreen& screen : screens) {
    if (screen.launch == launch && screen.filled == filled) rows.push_back(unbroken(screen.row));
  }
  return rows;
}

void appendRows(Paragraphs& out, const std::vector<CoveredScreen>& screens, bool filled) {
  for (const std::string& launch : VespViewItems::shared().launchViewItemNames) {
    const Strings rows = rowsOf(screens, launch, filled);
    if (!rows.empty()) out.item(launch + ": " + joined(rows));
  }
}

// Screens with the same reason share an item.
void appendEmpty(Paragraphs& out, const std::vector<EmptyScreen>& empty) {
  std::vector<bool> written(empty.size());
  for (std::size_t first = 0; first < empty.size(); ++first) {
    if (written[first]) continue;
    Strings rows;
    for (std::size_t other = first; other < empty.size(); ++other) {
      if (empty[other].launch != empty[first].launch || empty[other].reason != empty[first].reason) continue;
      rows.push_back(unbroken(empty[other].row));
      written[other] = true;
    }
    out.item(empty[first].launch + ": " + joined(rows) + " - " + empty[first].reason);
  }
}

void appendScreens(Paragraphs& out, const std::vector<CoveredScreen>& screens, const DiagReport& report) {
  out.heading("Screens with values");
  appendRows(out, screens, true);
  out.heading("Screens that stay empty");
  appendEmpty(out, emptyScreens(screens, report));
  Strings absent;
  for (const char* launch : {"LTE", "UMTS", "GSM"}) {
    if (!hasTechnology(report, launch)) absent.emplace_back(launch);
  }
  if (!absent.empty()) out.item(joined(absent) + ": no records of their own in the log");
  if (rowsOf(screens, "Device Info", true).empty()) out.item("Device Info: a modem log has no SIM card files");
}

// "RRC messages (B0C0), levels (B179, B193)": the records of a technology that are logged, or are not.
std::string topicsOf(std::string_view technology, const std::set<std::uint16_t>& codes, bool logged) {
  std::vector<std::pair<std::string, Strings>> topics;
  for (const RecordScreens& records : recordScreens()) {
    if (technologyOf(records.code) != technology || codes.contains(records.code) != logged) continue;
    const auto same = [&records](const auto& topic) { return topic.first == records.topic; };
    auto topic = std::find_if(topics.begin(), topics.end(), same);
    if (topic == topics.end()) topic = topics.insert(topics.end(), {std::string(records.topic), {}});
    topic->second.push_back(codeName(records.code));
  }
  Strings words;
  for (const auto& [topic, names] : topics) words.push_back(topic + " (" + joined(names) + ")");
  return joined(words);
}

// Which records were logged, and which of those that are understood were not.
void appendLogging(Paragraphs& out, const DiagReport& report) {
  out.heading("Logging");
  if (recordsOf(report) == 0) {
    out.item("was off: the log holds " + counted(report.otherFrames, "message", "messages") +
             " of the modem, but no log record");
    return;
  }
  const std::set<std::uint16_t> codes = codesOf(report);
  for (const std::string_view technology : {"LTE", "NR", "UMTS", "GSM", "UMTS and GSM"}) {
    const std::string on = topicsOf(technology, codes, true);
    const std::string off = topicsOf(technology, codes, false);
    if (on.empty()) continue;
    out.item(std::string(technology) + " on: " + on);
    if (!off.empty()) out.item(std::string(technology) + " off, or nothing to log: " + off);
  }
}

void appendFrames(Paragraphs& out, const Diagnosis& diagnosis) {
  const DiagReport& report = *diagnosis.report;
  out.heading("Contents");
  out.item(counted(recordsOf(report), "record", "records") + ", " + std::to_string(sumOf(report.read)) +
           " of them read; " + counted(diagnosis.events, "event", "events") + " for the screens");
  if (const std::uint64_t damaged = damagedFramesOf(report); damaged != 0) {
    out.item(counted(damaged, "frame is", "frames are") + " damaged and left out");
  }
  if (diagnosis.simCards.size() > 1) {
    Strings cards;
    for (const std::int32_t card : diagnosis.simCards) cards.push_back(std::to_string(card));
    out.item("SIM cards " + joined(cards) + ": the viewer shows one of them, which sim=NUMBER chooses");
  }
}

void appendUnread(Paragraphs& out, const DiagReport& report) {
  out.heading("Records that are not read");
  std::uint64_t otherRecords = 0;
  std::set<std::uint16_t> otherCodes;
  for (const UnreadKind& each : unreadKinds(report)) {
    const RecordScreens* records = findRecordScreens(each.kind.code);
    if (records == nullptr) {
      otherRecords += each.count;
      otherCodes.insert(each.kind.code);
      continue;
    }
    std::string cost;
    for (const std::string& screen : each.screens) cost += (cost.empty() ? "; they would fill " : ", ") + screen;
    out.item(nameOf(each.kind) + ": " + std::to_string(each.count) + " of the " + std::string(records->name) +
             (each.broken ? ", refused because their lengths or numbers contradict their version" : "") + cost);
  }
  if (otherRecords != 0) {
    Strings names;
    for (const std::uint16_t code : otherCodes) names.push_back(codeName(code));
    out.item(counted(otherRecords, "record", "records") + " of codes whose contents are not known: " + joined(names));
  }
}

bool hasUnread(const DiagReport& report) { return !unreadKinds(report).empty(); }

std::string answerOf(const Diagnosis& diagnosis) {
  const std::string name = diagnosis.name + ": ";
  const std::string screens =
      std::to_string(diagnosis.filled()) + " of the viewer's " + std::to_string(diagnosis.screens.size()) + " screens";
  if (!diagnosis.report) {
    if (diagnosis.events == 0) return name + "a capture without events";
    return name + "a capture that plays for " + lengthText(diagnosis.playingTime) + " and fills " + screens;
  }
  if (recordsOf(*diagnosis.report) == 0) return name + "a modem log without records: logging was off";
  const bool unread = hasUnread(*diagnosis.report);
  if (diagnosis.filled() != 0) {
    return name + "a modem log that plays for " + lengthText(diagnosis.playingTime) + " and fills " + screens;
  }
  return name + "a modem log that fills no screen" + (unread ? ": its records are not read" : "");
}

// What to do next, as a command and its purpose.
std::vector<std::pair<std::string, std::string>> nextOf(const Diagnosis& diagnosis) {
  const bool named = diagnosis.name != "standard input";
  std::vector<std::pair<std::string, std::string>> next;
  if (diagnosis.filled() != 0 && named) next.emplace_back("vespscope " + quoted(diagnosis.name), "shows it");
  if (!diagnosis.report) return next;
  if (recordsOf(*diagnosis.report) == 0) {
    next.emplace_back("rhoxd --source diag:PORT --record FOLDER --listen unix:path=SOCKET",
                      "turns the log on and records it");
  }
  if (named && hasUnread(*diagnosis.report)) {
    next.emplace_back(
        "vespctl convert --unread FOLDER " + quoted(diagnosis.source),
        "writes a sample of each kind of record that is not read, without identities and places, to share");
  }
  return next;
}

Json screenJson(const CoveredScreen& screen, const std::vector<EmptyScreen>& empty) {
  Json json = {{"launch", screen.launch}, {"row", screen.row}, {"filled", screen.filled}, {"events", screen.reports}};
  const auto found = std::find_if(empty.begin(), empty.end(), [&screen](const EmptyScreen& each) {
    return each.launch == screen.launch && each.row == screen.row;
  });
  if (found != empty.end()) json["reason"] = found->reason;
  return json;
}

Json logJson(const DiagReport& report) {
  Json unread = Json::array();
  for (const UnreadKind& each : unreadKinds(report)) {
    unread.push_back(
        {{"kind", nameOf(each.kind)}, {"records", each.count}, {"refused", each.broken}, {"screens", each.screens}});
  }
  Json codes = Json::array();
  for (const std::uint16_t code : codesOf(report)) {
    codes.push_back(codeName(code));
  }
  return {{"records", recordsOf(report)},
          {"read", sumOf(report.read)},
          {"damaged_frames", damagedFramesOf(report)},
          {"other_frames", report.otherFrames},
          {"logging", recordsOf(report) != 0},
          {"codes", std::move(codes)},
          {"unread", std::move(unread)}};
}

}  // namespace

std::string textOf(const Diagnosis& diagnosis) {
  Paragraphs out;
  out.line(answerOf(diagnosis));
  if (diagnosis.damage) out.line("Not all of it can be read: " + *diagnosis.damage);
  if (diagnosis.report) {
    appendScreens(out, diagnosis.screens, *diagnosis.report);
    appendUnread(out, *diagnosis.report);
    appendLogging(out, *diagnosis.report);
    appendFrames(out, diagnosis);
  } else {
    out.heading("Screens with values");
    appendRows(out, diagnosis.screens, true);
    out.heading("Screens that stay empty");
    appendRows(out, diagnosis.screens, false);
  }
  out.heading("Next");
  for (const auto& [command, purpose] : nextOf(diagnosis)) {
    out.verbatim(command);
    out.item("  " + purpose);
  }
  return out.text();
}

std::string screensText(const std::vector<CoveredScreen>& screens, const DiagReport& report) {
  Paragraphs out;
  appendScreens(out, screens, report);
  return out.text();
}

std::string jsonOf(const Diagnosis& diagnosis) {
  std::vector<EmptyScreen> empty;
  if (diagnosis.report) empty = emptyScreens(diagnosis.screens, *diagnosis.report);
  Json screens = Json::array();
  for (const CoveredScreen& screen : diagnosis.screens) screens.push_back(screenJson(screen, empty));
  Json next = Json::array();
  for (const auto& [command, purpose] : nextOf(diagnosis)) next.push_back({{"command", command}, {"purpose", purpose}});
  Json json = {{"name", diagnosis.name},
               {"kind", diagnosis.kind == FileKind::modemLog ? "modem log" : "capture"},
               {"answer", answerOf(diagnosis)},
               {"filled", diagnosis.filled()},
               {"screens", std::move(screens)},
               {"events", diagnosis.events},
               {"playing_seconds", std::chrono::duration<double>(diagnosis.playingTime).count()},
               {"sim_cards", diagnosis.simCards},
               {"damage", diagnosis.damage ? Json(*diagnosis.damage) : Json(nullptr)}};
  if (diagnosis.report) json["log"] = logJson(*diagnosis.report);
  json["next"] = std::move(next);
  return write(json, 2);
}

}  // namespace vespscope::tools
