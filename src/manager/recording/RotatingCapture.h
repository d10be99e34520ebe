// Capture files in a folder, one after the other: a new one begins when one is large or old enough, and the oldest are
// removed when the files exceed a total size or age.
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
      std::nullopt;  // files last written before that are removed; empty: files of any age stay
};

// The clock for files; tests replace it.
struct RecordingClock {
  std::function<std::chrono::system_clock::time_point()> now = &std::chrono::system_clock::now;
  std::function<std::chrono::steady_clock::time_point()> steady = &std::chrono::steady_clock::now;
};

class RotatingCapture final : public RecordingTarget {
 public:
  // Creates `folder`, accessible to its owner only, if it does not exist, and locks it: no two recorders write into one
  // folder. The last file, which a kill or a power cut may have damaged, is repaired. The first new file begins with
  // the first event. Files of other names or other owners are never touched.
  static Result<std::unique_ptr<RotatingCapture>> open(std::filesystem::path folder, const RecordingLimits& limits,
                                                       RecordingClock clock = {});

  RotatingCapture(const RotatingCapture&) = delete;
  RotatingCapture& operator=(const RotatingCapture&) = delete;
  ~RotatingCapture() override;

  // Creates a new file where the folder or the file has vanished, or another program has changed the file. The events
  // that were cut off are counted as removed.
  RecordingOutcome write(std::span<const SharedEvent> events) override;

 private:
  struct File {
    std::uint64_t size = 0;  // bytes
    std::chrono::system_clock::time_point written;
    bool own = false;  // a regular file of this user
  };
  using Files = std::map<std::string, File>;  // by name, the oldest first
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
  Files files_;              // the recordings in the folder at `folderTime_`
  std::uint64_t total_ = 0;  // bytes of the user's own files
  timespec folderTime_{};
  std::optional<capture::CaptureWriter> file_;
  std::chrono::steady_clock::time_point begun_;  // of file_
};

}  // namespace vespscope::manager
