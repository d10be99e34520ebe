// The reader of modem logs: for any log, the events are messages that decode, and the same ones every time; a live port
// that sends the log in pieces gives the same events as one that sends it at once.
#include <array>
#include <deque>
#include <vector>

#include "Fuzz.h"
#include "MemoryFile.h"
#include "metrics/EventRows.h"
#include "platform/log/Log.h"
#include "sources/diag/DiagStream.h"
#include "sources/diag/LogSession.h"

using namespace vespscope;
using namespace vespscope::sources;
using fuzz::require;

namespace {

// The codes of the known records, and an unknown one.
constexpr std::array<std::uint16_t, 20> codes = {0xB0C2, 0xB0C0, 0xB193, 0xB179, 0xB192, 0xB195, 0xB0EE,
                                                 0xB0E5, 0xB0E2, 0xB0E3, 0xB0EC, 0xB0ED, 0x7130, 0x7131,
                                                 0x7135, 0x713A, 0x512F, 0x4127, 0x412F, 0x1FFB};

void append(Bytes& bytes, std::uint64_t number, int count) {
  for (int index = 0; index < count; ++index) bytes.push_back(static_cast<std::uint8_t>(number >> (8 * index)));
}

// Appends a frame as in a log: checksum, escapes and end.
void appendFrame(Bytes& log, Bytes frame) {
  append(frame, diag::crc16X25(frame), 2);
  for (const std::uint8_t byte : frame) {
    if (byte == 0x7D || byte == 0x7E) {
      log.push_back(0x7D);
      log.push_back(byte ^ 0x20);
    } else {
      log.push_back(byte);
    }
  }
  log.push_back(0x7E);
}

// Wraps the input's bytes in records and valid frames, so that they reach the readers of records.
Bytes logOf(fuzz::Input input) {
  Bytes log;
  std::uint64_t time = 0x00F5'0000'0000'0000;
  while (!input.empty()) {
    const std::uint8_t selector = input.byte();
    if (selector % 32 == 31) {
      // Something other than a record, such as a response.
      const auto content = input.piece();
      // A frame has at least its command: an empty frame with a checksum is not valid.
      if (!content.empty()) appendFrame(log, Bytes(content.begin(), content.end()));
      continue;
    }
    const std::uint16_t code = selector % 32 < codes.size() ? codes[selector % 32] : input.word();
    time += std::uint64_t{selector} << 20;
    const auto body = input.piece();
    Bytes frame;
    if (selector >= 0xE0) {
      // The wrapper of a second SIM.
      frame = {0x98, 0x01, 0x00, 0x00, static_cast<std::uint8_t>(selector & 3), 0x00, 0x00, 0x00};
    }
    const auto length = static_cast<std::uint16_t>(body.size() + 12);
    append(frame, 0x10, 2);
    append(frame, length, 2);
    append(frame, length, 2);
    append(frame, code, 2);
    append(frame, time, 8);
    frame.insert(frame.end(), body.begin(), body.end());
    appendFrame(log, std::move(frame));
  }
  return log;
}

std::vector<MetricEvent> eventsOf(EventStream& stream) {
  std::vector<MetricEvent> events;
  while (auto event = stream.next()) {
    const EventRow* row = findEventRow(event->metricID);
    if (row != nullptr) require(row->decode(&event->payload).ok, "an event does not decode");
    events.push_back(std::move(*event));
  }
  require(!stream.summary().empty(), "a log without a summary");
  return events;
}

bool same(const MetricEvent& one, const MetricEvent& other) {
  return one.metricID == other.metricID && one.profileID == other.profileID && one.payload == other.payload &&
         one.time == other.time;
}

// A live port's output for the bytes that it is given.
struct Talk {
  std::vector<MetricEvent> events;
  Bytes sent;
  diag::LogSession::State state;
};

Talk talkInPieces(std::span<const std::uint8_t> bytes, std::size_t length) {
  const diag::LogSession::Clock::time_point begin{};
  diag::LogSession session(begin, std::chrono::seconds(1));
  Talk talk{};
  std::deque<MetricEvent> events;
  while (!bytes.empty()) {
    const auto piece = bytes.first(std::min(length, bytes.size()));
    session.take(piece, begin, events);
    const Bytes output = session.takeOutput();
    talk.sent.insert(talk.sent.end(), output.begin(), output.end());
    bytes = bytes.subspan(piece.size());
  }
  session.tick(begin + std::chrono::seconds(2));
  require(session.state() != diag::LogSession::State::asking, "a port is waited for without end");
  talk.state = session.state();
  talk.events.assign(events.begin(), events.end());
  for (const MetricEvent& event : talk.events) {
    const EventRow* row = findEventRow(event.metricID);
    if (row != nullptr) require(row->decode(&event.payload).ok, "an event of a port does not decode");
  }
  return talk;
}

void checkPort(std::span<const std::uint8_t> bytes, std::size_t length) {
  const Talk whole = talkInPieces(bytes, bytes.size());
  const Talk pieces = talkInPieces(bytes, length);
  require(whole.sent == pieces.sent, "a port's pieces are answered otherwise");
  require(whole.state == pieces.state, "a port's pieces leave another state");
  require(std::equal(whole.events.begin(), whole.events.end(), pieces.events.begin(), pieces.events.end(), same),
          "a port's pieces give other events");
}

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  log::discardOutputs();
  if (size == 0) return 0;
  const Bytes made = data[0] % 4 == 0 ? Bytes() : logOf(fuzz::Input(data + 1, size - 1));
  const auto bytes = made.empty() ? std::span(data + 1, size - 1) : std::span<const std::uint8_t>(made);
  checkPort(bytes, std::size_t{data[0]} / 4 + 1);
  const fuzz::MemoryFile file(bytes);
  auto stream = openDiagStream(file.path());
  if (!stream) {
    require(made.empty(), "a log of right frames is refused");
    return 0;
  }
  const std::vector<MetricEvent> first = eventsOf(**stream);
  require((*stream)->canRewind(), "a file cannot be read again");
  (*stream)->rewind();
  const std::vector<MetricEvent> second = eventsOf(**stream);
  require(std::equal(first.begin(), first.end(), second.begin(), second.end(), same),
          "the same log gives other events");
  return 0;
}
