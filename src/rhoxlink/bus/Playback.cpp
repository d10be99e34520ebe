#include "rhoxlink/bus/Playback.h"

#include <cstdint>
#include <string_view>

#include "rhoxlink/bus/Names.h"

namespace vespscope::bus {
namespace {

using std::chrono::nanoseconds;

ipc::Object integer(nanoseconds duration) { return ipc::Object(std::int64_t{duration.count()}); }

// Returns the entry's value if it is a duration that is not negative.
std::optional<nanoseconds> durationIn(const ipc::Dictionary& dictionary, std::string_view key) {
  const ipc::Object* object = dictionary.find(key);
  const std::int64_t* count = object == nullptr ? nullptr : object->asInt64();
  if (count == nullptr || *count < 0) return std::nullopt;
  return nanoseconds(*count);
}

}  // namespace

ipc::Object toObject(const PlaybackPosition& position) {
  ipc::Dictionary dictionary;
  dictionary.set(rhox::kKeyPosition, integer(position.position));
  if (position.length) dictionary.set(rhox::kKeyLength, integer(*position.length));
  dictionary.set(rhox::kKeyClock, integer(position.clock));
  dictionary.set(rhox::kKeySpeed, ipc::Object(position.speed));
  dictionary.set(rhox::kKeyEnded, ipc::Object(position.ended));
  return ipc::Object(std::move(dictionary));
}

std::optional<PlaybackPosition> playbackIn(const ipc::Dictionary& reply) {
  const ipc::Object* object = reply.find(rhox::kKeyPlayback);
  const ipc::Dictionary* dictionary = object == nullptr ? nullptr : object->asDictionary();
  if (dictionary == nullptr) return std::nullopt;
  const std::optional<nanoseconds> position = durationIn(*dictionary, rhox::kKeyPosition);
  const std::optional<nanoseconds> clock = durationIn(*dictionary, rhox::kKeyClock);
  const ipc::Object* speed = dictionary->find(rhox::kKeySpeed);
  const double* factor = speed == nullptr ? nullptr : std::get_if<double>(&speed->data());
  const ipc::Object* ended = dictionary->find(rhox::kKeyEnded);
  const bool* over = ended == nullptr ? nullptr : ended->asBool();
  // A NaN is not greater than zero either.
  if (!position || !clock || factor == nullptr || !(*factor > 0) || over == nullptr) return std::nullopt;
  return PlaybackPosition{*position, durationIn(*dictionary, rhox::kKeyLength), *clock, *factor, *over};
}

}  // namespace vespscope::bus
