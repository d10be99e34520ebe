#include "sources/diag/LogSession.h"

#include <algorithm>
#include <utility>

namespace vespscope::sources::diag {
namespace {

bool isLogFrame(std::span<const std::uint8_t> frame) {
  constexpr std::uint8_t record = 0x10;
  constexpr std::uint8_t wrapper = 0x98;
  return !frame.empty() && (frame[0] == record || frame[0] == wrapper);
}

// The mapped codes of one equipment.
std::vector<std::uint16_t> codesOf(std::size_t equipment) {
  std::vector<std::uint16_t> codes;
  for (const std::uint16_t code : mappedCodes()) {
    if (code >> 12U == equipment) codes.push_back(code);
  }
  return codes;
}

}  // namespace

LogSession::LogSession(Clock::time_point now, std::chrono::milliseconds patience) : patience_(patience) {
  // Begins with a frame end, which terminates whatever another program has sent before.
  output_.push_back(0x7E);
  send(askForCodeCounts(), now);
}

void LogSession::take(std::span<const std::uint8_t> bytes, Clock::time_point now, std::deque<MetricEvent>& events) {
  bytesCame_ = bytesCame_ || !bytes.empty();
  frames_.feed(bytes);
  while (const auto frame = frames_.next()) {
    if (isLogFrame(*frame)) {
      recordsCame_ = true;
      mapper_.take(*frame, events);
    } else if (const auto told = logAnswerOf(*frame)) {
      answer(*told, now);
    }
  }
  if (recordsCame_ && (state_ == State::silent || state_ == State::garbled || state_ == State::refused)) {
    state_ = State::logging;
  }
}

void LogSession::tick(Clock::time_point now) {
  if (!deadline_ || now < *deadline_) return;
  deadline_.reset();
  // Another program may have turned the log on, on a connection that only receives.
  if (recordsCame_) {
    state_ = State::logging;
  } else {
    state_ = bytesCame_ ? State::garbled : State::silent;
  }
}

std::optional<LogSession::Clock::time_point> LogSession::deadline() const { return deadline_; }

void LogSession::answer(const LogAnswer& answer, Clock::time_point now) {
  if (state_ != State::asking) return;
  switch (answer.kind) {
    case LogAnswer::Kind::codeCounts:
      counts_ = answer.counts;
      nextEquipment_ = 0;
      turnOnNext(now);
      break;
    case LogAnswer::Kind::turnedOn:
      if (answer.equipment + std::size_t{1} == nextEquipment_) turnOnNext(now);
      break;
    case LogAnswer::Kind::refused:
      deadline_.reset();
      state_ = State::refused;
      break;
    case LogAnswer::Kind::turnedOff:
      break;
  }
}

void LogSession::turnOnNext(Clock::time_point now) {
  constexpr std::uint32_t mostCodes = 0x1000;
  for (; nextEquipment_ < equipmentCount; ++nextEquipment_) {
    const std::vector<std::uint16_t> codes = codesOf(nextEquipment_);
    const std::uint32_t count = std::min(counts_[nextEquipment_], mostCodes);
    if (codes.empty() || count == 0) continue;
    send(turnOn(static_cast<std::uint8_t>(nextEquipment_), count, codes), now);
    ++nextEquipment_;
    return;
  }
  deadline_.reset();
  state_ = State::logging;
}

void LogSession::send(const Bytes& frame, Clock::time_point now) {
  output_.insert(output_.end(), frame.begin(), frame.end());
  deadline_ = now + patience_;
}

}  // namespace vespscope::sources::diag
