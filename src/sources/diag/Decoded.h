// What reading a log record gives: the record, or why not.
//
// Decoders never guess: a version that is not listed, and numbers that no modem can mean, are faults for the caller to
// count.
#pragma once

#include <variant>

namespace vespscope::sources::diag {

enum class RecordFault {
  unknownVersion,  // or another kind of layout that is not known
  tooShort,        // fields or announced lengths reach past the end
  bytesLeft,       // announced lengths end before the record does: another layout than the one known
  outOfRange,      // a number that no modem can mean, such as a physical cell identity beyond 503
};

template <class Record>
using Decoded = std::variant<Record, RecordFault>;

}  // namespace vespscope::sources::diag
