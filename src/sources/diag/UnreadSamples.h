// Keeps one sample of each kind of log record that is not read, without what identifies a phone, its user or a place,
// so that it can be shared.
//
// Of a layout that is not known nobody can say where an identity lies, so a sample keeps only what cannot be one:
// - the code, and the length of the record;
// - the first byte of LTE and NR records, which is the version in all that are known;
// - of the LTE measurement records (B1xx), if they consist of subpackets that use the record up exactly, their number
//   and the identifier, version and size of each;
// - of other LTE and NR records, the first two bytes that hold the number of all bytes behind them: a length field,
//   whose value follows from its place.
// Every other byte is zero, and so is the time.
#pragma once

#include <cstdint>
#include <map>
#include <set>
#include <string>

#include "sources/diag/DiagReport.h"
#include "sources/diag/LogRecord.h"
#include "values/Value.h"

namespace vespscope::sources::diag {

// What a sample keeps of a record's payload: of the same length, the rest zero.
[[nodiscard]] Bytes redactedPayload(const LogRecord& record);

class UnreadSamples {
 public:
  // A log with more kinds is no phone's.
  static constexpr std::size_t maximum = 512;

  struct Kind {
    RecordKind record;
    bool broken = false;  // of a known version, which its lengths or numbers contradict
    auto operator<=>(const Kind&) const = default;
  };

  // Takes the record if `report`, which counts it already, has it under a kind that is new here.
  void take(const LogRecord& record, const DiagReport& report);

  // A log of one record for each kind, as a modem writes it. Of a code that is not known in any version, LTE and NR
  // records are of one kind for each first byte.
  [[nodiscard]] const std::map<Kind, Bytes>& samples() const { return samples_; }
  // Kinds beyond the maximum.
  [[nodiscard]] std::size_t leftOut() const { return leftOut_; }

 private:
  void takeNewKinds(const LogRecord& record, const DiagReport& report);
  void add(const Kind& kind, const LogRecord& record);

  std::map<Kind, Bytes> samples_;
  std::set<std::uint16_t> unknownCodes_;
  std::size_t kindsInReport_ = 0;
  std::size_t leftOut_ = 0;
};

// "B0C0-v32", "B193-subpacket-26-v5", "1FFE", "B0C0-v30-refused".
[[nodiscard]] std::string fileNameOf(const UnreadSamples::Kind& kind);

}  // namespace vespscope::sources::diag
