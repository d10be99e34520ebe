#include "sources/diag/PortProbe.h"

#include <poll.h>

#include <algorithm>
#include <optional>
#include <span>
#include <variant>

#include "sources/diag/FrameReader.h"
#include "sources/diag/LogCommands.h"
#include "sources/diag/LogRecord.h"
#include "sources/diag/PortConnection.h"

namespace vespscope::sources::diag {
namespace {

using Clock = std::chrono::steady_clock;
using Kind = PortAnswer::Kind;

class Listener {
 public:
  explicit Listener(PortAnswer& answer) : answer_(answer) {}

  // Whether the modem has answered with these bytes.
  bool take(std::span<const std::uint8_t> bytes) {
    if (!bytes.empty() && answer_.kind == Kind::silent) answer_.kind = Kind::garbled;
    bool answered = false;
    frames_.feed(bytes);
    while (const auto frame = frames_.next()) {
      if (const auto told = logAnswerOf(*frame)) {
        answered = true;
        if (answer_.kind != Kind::logging) {
          answer_.kind = told->kind == LogAnswer::Kind::refused ? Kind::refuses : Kind::answers;
        }
      } else if (std::holds_alternative<LogRecord>(logRecordOf(*frame))) {
        ++answer_.records;
        answer_.kind = Kind::logging;
      }
    }
    return answered;
  }

 private:
  PortAnswer& answer_;
  FrameReader frames_;
};

// A port that has been closed does not answer, whatever came before.
std::optional<std::string> exchange(PortConnection& connection, Bytes& output, Listener& listener,
                                    Clock::time_point& end, std::chrono::milliseconds listening) {
  if (!output.empty()) {
    if (const auto written = connection.write(output); !written) return written.reason();
  }
  pollfd ready{connection.descriptor(), static_cast<short>(output.empty() ? POLLIN : POLLIN | POLLOUT), 0};
  const auto left = std::chrono::ceil<std::chrono::milliseconds>(end - Clock::now()).count();
  ::poll(&ready, 1, static_cast<int>(std::max<std::chrono::milliseconds::rep>(left, 0)));
  Bytes buffer(65'536);
  const auto count = connection.read(buffer);
  if (!count) return count.reason();
  if (listener.take({buffer.data(), *count})) end = std::min(end, Clock::now() + listening);
  return std::nullopt;
}

}  // namespace

PortAnswer askPort(const std::string& port, std::chrono::milliseconds patience, std::chrono::milliseconds listening) {
  PortAnswer answer;
  Result<PortConnection> connection = PortConnection::open(port);
  if (!connection) return {Kind::failed, 0, connection.reason()};
  // The end of a frame first: whatever was sent before by another ends there.
  Bytes output = {0x7E};
  const Bytes question = askForCodeCounts();
  output.insert(output.end(), question.begin(), question.end());
  Listener listener(answer);
  Clock::time_point end = Clock::now() + patience;
  while (Clock::now() < end) {
    if (const auto reason = exchange(*connection, output, listener, end, listening)) {
      return {Kind::failed, answer.records, *reason};
    }
  }
  return answer;
}

}  // namespace vespscope::sources::diag
