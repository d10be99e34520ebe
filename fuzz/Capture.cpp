// The reader of captures: a capture that it has read can be written and read again with the same result, also after the
// file was truncated.
#include <vector>

#include "Fuzz.h"
#include "MemoryFile.h"
#include "capture/CaptureReader.h"
#include "capture/CaptureWriter.h"

using namespace vespscope;
using fuzz::MemoryFile;
using fuzz::require;

namespace {

constexpr std::chrono::nanoseconds firstTooLate = std::chrono::seconds(std::int64_t{1} << 32);

// The events of a file, and whether it was read to its end.
struct Reading {
  std::vector<MetricEvent> events;
  bool whole = false;
};

Reading read(const MemoryFile& file) {
  Reading reading;
  auto reader = capture::CaptureReader::open(file.path());
  if (!reader) {
    require(reader.reason().starts_with(file.path() + ": "), "a refusal does not name the file");
    return reading;
  }
  while (true) {
    auto event = reader->next();
    if (!event) {
      require(reader->next().ok(), "reading continues behind a failure");
      return reading;
    }
    if (!event->has_value()) break;
    reading.events.push_back(std::move(**event));
    require(reader->count() == reading.events.size(), "events are miscounted");
  }
  reading.whole = true;
  return reading;
}

bool same(const MetricEvent& one, const MetricEvent& other) {
  return one.metricID == other.metricID && one.profileID == other.profileID && one.payload == other.payload &&
         one.time == other.time;
}

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const MemoryFile file({data, size});
  const Reading first = read(file);
  if (const auto whole = capture::cutToWholePackets(file.descriptor()); whole && whole->bytes > 0) {
    require(static_cast<std::uint64_t>(file.size()) == whole->bytes, "a file is longer than its whole packets");
    require(capture::cutToWholePackets(file.descriptor())->bytes == whole->bytes, "a file that is whole is cut again");
  }
  if (first.events.empty()) return 0;
  const MemoryFile copy;
  std::vector<MetricEvent> written;
  {
    auto writer = capture::CaptureWriter::create(copy.path(), capture::Flushing::inBlocks);
    require(writer.ok(), "a file in memory cannot be created");
    for (const MetricEvent& event : first.events) {
      // Only what our files cannot hold is rejected: seconds beyond 32 bits, as pcapng has them, and bytes beyond the
      // limit once the fields are written in full.
      if (!writer->write(event)) {
        written.push_back(event);
      } else {
        require(event.payload.size() + 32 > capture::maximumPacketLength || event.time >= firstTooLate,
                "an event that was read is refused");
      }
    }
  }
  Reading second = read(copy);
  require(second.whole, "what was written cannot be read");
  require(std::equal(written.begin(), written.end(), second.events.begin(), second.events.end(), same),
          "what was written reads differently");
  // As a kill may leave it.
  copy.cut(copy.size() - data[size - 1] % (copy.size() + 1));
  const auto whole = capture::cutToWholePackets(copy.descriptor());
  require(whole.ok(), "a recording is not known as one");
  require(whole->bytes == 0 || read(copy).whole, "a recording that was made whole cannot be read");
  return 0;
}
