// The result of reading a log record: the record, or why it cannot be read.
//
// Decoders never guess: an unlisted version and impossible numbers are faults, which the caller counts.
#pragma once

#include <variant>

namespace vespscope::sources::diag {

enum class RecordFault {
  unknownVersion,  // or another unknown layout
  tooShort,        // fields or announced lengths extend past the end
  bytesLeft,       // announced lengths end before the record does: an unknown layout
  outOfRange,      // an impossible number, such as a physical cell identity beyond 503
};

template <class Record>
using Decoded = std::variant<Record, RecordFault>;

}  // namespace vespscope::sources::diag
