// What a recording holds for the viewer: which screens it fills, and why the others stay empty.
#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "sources/RecogniseFile.h"
#include "sources/diag/DiagReport.h"
#include "tools/vespctl/Commands.h"
#include "tools/vespctl/ScreenCoverage.h"
#include "values/Result.h"

namespace vespscope::tools {

// A screen without values, and why.
struct EmptyScreen {
  std::string launch;
  std::string row;
  std::string reason;
  bool unread = false;  // records that could fill it are in the log, but not read
};

// Records of one kind that are left out because their layout is not known.
struct UnreadKind {
  sources::diag::RecordKind kind;
  std::uint64_t count = 0;
  bool broken = false;               // of a known version, but its lengths or numbers contradict it
  std::vector<std::string> screens;  // keys of those that such records reach in the versions that are read
};

struct Diagnosis {
  std::string name;    // as the user gave it
  std::string source;  // the words that name it as a source
  sources::FileKind kind = sources::FileKind::capture;
  std::vector<CoveredScreen> screens;
  std::uint64_t events = 0;
  std::chrono::nanoseconds playingTime{0};          // its silences shortened, as the viewer plays it
  std::set<std::int32_t> simCards;                  // by the modem's numbers
  Problem damage;                                   // what of it could not be read
  std::optional<sources::diag::DiagReport> report;  // of a modem log

  [[nodiscard]] std::size_t filled() const;
};

// Reads the recording to its end. `source` is a path, or the words of a source that is a recording.
[[nodiscard]] Result<Diagnosis> diagnose(const std::string& source);

// Those screens whose technology the recording has at all; of a capture none.
[[nodiscard]] std::vector<EmptyScreen> emptyScreens(const std::vector<CoveredScreen>& screens,
                                                    const sources::diag::DiagReport& report);
// Most numerous first: those that a screen would show, then the others.
[[nodiscard]] std::vector<UnreadKind> unreadKinds(const sources::diag::DiagReport& report);
// The codes of the log's records, read or not.
[[nodiscard]] std::set<std::uint16_t> codesOf(const sources::diag::DiagReport& report);
// Whether a record of the technology of this launch row is in the log.
[[nodiscard]] bool hasTechnology(const sources::diag::DiagReport& report, const std::string& launch);

// For a user, lines of at most 80 columns; the first one is the answer.
[[nodiscard]] std::string textOf(const Diagnosis& diagnosis);
// The screens with their reasons, as the report of a conversion has them.
[[nodiscard]] std::string screensText(const std::vector<CoveredScreen>& screens,
                                      const sources::diag::DiagReport& report);
[[nodiscard]] std::string jsonOf(const Diagnosis& diagnosis);

}  // namespace vespscope::tools
