// Capture files in a folder, one after the other: a new one begins when one is large or old enough, and the oldest are
// removed when all together are too large or too old.
#pragma once

#include <sys/types.h>

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>

#include <time.h>

#include "capture/CaptureWriter.h"
#include "manager/recording/Recorder.h"
#include "manager/recording/RecordingName.h"
#include "values/Result.h"

namespace vespscope::manager {

struct RecordingLimits {
  std::uint64_t fileSize = std::uint64_t{16} << 20;      // bytes of one file, unless a single event is larger
  std::chrono::seconds fileAge = std::chrono::hours(1);  // from one file's beginning to the next one's
  std::uint64_t totalSize = std::uint64_t{1} << 30;      // bytes of all files together; at least fileSize
  std::optional<std::chrono::seconds> keep =
      std::nullopt;  // files written to last before that go; empty: age is no reason
};

// The time that the files go by; tests give another.
struct RecordingClock {
  std::function<std::chrono::system_clock::time_point()> now = &std::chrono::system_clock::now;
  std::function<std::chrono::steady_clock::time_point()> steady = &std::chrono::steady_clock::now;
};

class RotatingCapture final : public RecordingTarget {
 public:
  // Makes `folder`, for its owner alone, if it is not there, and takes it for itself: no two record into one folder.
  // The last file in it, which a kill or a power cut may have left damaged, is made whole. The first new file begins
  // with the first event. Files of other names or other owners are never touched.
  static Result<std::unique_ptr<RotatingCapture>> open(std::filesystem::path folder, const RecordingLimits& limits,
                                                       RecordingClock clock = {});

  RotatingCapture(const RotatingCapture&) = delete;
  RotatingCapture& operator=(const RotatingCapture&) = delete;
  ~RotatingCapture() override;

  // Where a folder or a file has vanished, or another program has changed the file, another is made. The events that
  // were cut off are counted as removed.
  RecordingOutcome write(std::span<const SharedEvent> events) override;

 private:
  struct File {
    std::uint64_t size = 0;  // bytes
    std::chrono::system_clock::time_point written;
    bool own = false;  // this user's regular file
  };
  using Files = std::map<std::string, File>;  // by name: the oldest first
  using Problem = std::optional<std::string>;

  RotatingCapture(std::filesystem::path folder, const RecordingLimits& limits, RecordingClock clock)
      : folder_(std::move(folder)), limits_(limits), clock_(std::move(clock)) {}
  Problem holdFolder();
  [[nodiscard]] bool holdsFolder() const;
  void readFolder();
  [[nodiscard]] bool folderChanged() const;
  void rememberFolder();
  void repairLast();
  Problem begin();
  void end();
  void makeRoom();
  [[nodiscard]] RecordingTime nextTime() const;
  std::uint64_t leaveChangedFile();
  [[nodiscard]] bool mustBegin(const MetricEvent& next) const;
  RecordingOutcome writeToFile(std::span<const SharedEvent> events);

  const std::filesystem::path folder_;
  const RecordingLimits limits_;
  const RecordingClock clock_;
  int held_ = -1;            // the folder, locked
  Files files_;              // the recordings in the folder as it was when `folderTime_` was taken
  std::uint64_t total_ = 0;  // bytes of those that are its own
  timespec folderTime_{};
  std::optional<capture::CaptureWriter> file_;
  std::chrono::steady_clock::time_point begun_;  // of file_
};

}  // namespace vespscope::manager
