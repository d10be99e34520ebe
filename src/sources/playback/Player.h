// Plays a stream of events as a running source, at its own speed or another.
#pragma once

#include <atomic>
#include <memory>
#include <mutex>
#include <optional>
#include <stop_token>
#include <string>
#include <thread>
#include <utility>

#include "sources/playback/Playback.h"
#include "sources/playback/PlayerClock.h"
#include "sources/playback/SimCardSearch.h"
#include "sources/playback/Source.h"
#include "sources/playback/StateBefore.h"

namespace vespscope::sources {

class Player final : public Source {
 public:
  Player(std::unique_ptr<EventStream> stream, const PlaybackOptions& options,
         std::unique_ptr<PlayerClock> clock = std::make_unique<SteadyPlayerClock>());
  Player(const Player&) = delete;
  Player& operator=(const Player&) = delete;
  ~Player() override;

  // The stream's label, with a remark if the stream could not be read or the start is after its end.
  [[nodiscard]] std::string label() const override;
  [[nodiscard]] SourceKind kind() const override { return kind_; }
  [[nodiscard]] std::optional<std::int32_t> simCard() const override { return simCard_; }
  // Makes `card` the one that viewers show first; before the start.
  void preferSimCard(std::optional<std::int32_t> card) { simCard_ = card; }
  // Empty until the first event is played. The length is known once a parallel scan, or playing, has reached the end;
  // never for a pipe.
  [[nodiscard]] std::optional<PlaybackPosition> playback() const override;
  void start(EventSink& sink) override;
  void stop() override;
  void findSimCardFiles(SimCardFilesHandler found) override { search_.find(std::move(found)); }

 private:
  void run(EventSink& sink);
  // Plays the stream once; returns false when playing was interrupted, or when the stream has no event at or after the
  // start.
  bool playRound(EventSink& sink);
  void deliverStateBefore(EventSink& sink);
  void explainStartBehindTheEnd();
  void remark(const std::string& remark);
  void end(EventSink& sink, bool played);
  // Reads the whole stream in parallel to determine its length.
  void measure(const std::stop_token& stop);
  void moveTo(std::chrono::nanoseconds position, std::chrono::nanoseconds clock);

  const std::string label_;
  const SourceKind kind_;
  const PlaybackOptions options_;
  const std::unique_ptr<PlayerClock> clock_;
  const std::unique_ptr<EventStream> stream_;  // played on the player's thread, searched and measured on others
  SimCardSearch search_;
  std::optional<std::int32_t> simCard_;

  // Used by the player's thread only.
  Playback playback_;
  StateBefore before_;
  bool begun_ = false;  // the clock has been started

  std::atomic<bool> stopping_ = false;

  mutable std::mutex mutex_;
  std::string remark_;
  std::optional<PlaybackPosition> position_;  // without its length
  std::optional<std::chrono::nanoseconds> length_;

  std::jthread measuring_;
  std::thread thread_;
};

}  // namespace vespscope::sources
