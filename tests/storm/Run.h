// A program of the storm: its outputs are in files, and what is done to it for a while is undone in time.
#pragma once

#include <chrono>
#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>
#include <vector>

#include "support/Child.h"

namespace vespscope::test {

using Clock = std::chrono::steady_clock;

// Where the programs are and where they work.
struct Place {
  std::filesystem::path programs;
  std::filesystem::path folder;
  [[nodiscard]] std::string operator/(const std::string& name) const { return (folder / name).string(); }
};

class Run {
 public:
  // Starts `program`; its outputs are NAME.out and NAME.err in the place's folder.
  Run(const Place& place, const std::string& name, const std::string& program,
      const std::vector<std::string>& arguments);

  [[nodiscard]] const std::string& name() const { return name_; }
  [[nodiscard]] pid_t identifier() const { return child_.identifier(); }
  [[nodiscard]] bool hasEnded() { return child_.hasEnded(); }
  // Its end, at most `limit` from now, after which it is killed.
  std::optional<ProcessEnd> waitForEnd(std::chrono::milliseconds limit);
  void signal(int number) const { child_.signal(number); }

  // Stops it until `end`.
  void stop(Clock::time_point end);
  // Files that it writes fill up at `bytes` until `end`, as on a full disk.
  void limitFiles(std::uint64_t bytes, Clock::time_point end);
  // Ends what is over by `now`.
  void recover(Clock::time_point now);

  // What it has printed since the last call.
  [[nodiscard]] std::string newOutput();
  [[nodiscard]] std::string output() const;
  [[nodiscard]] std::string errors() const;
  // The most memory that it has held (KiB); 0 once it has ended.
  [[nodiscard]] long memory() const;

 private:
  static ChildWish wishOf(const Place& place, const std::string& name, const std::string& program,
                          const std::vector<std::string>& arguments, std::array<int, 3>& descriptors);

  std::string name_;
  std::string files_;  // their path without the ending
  std::array<int, 3> descriptors_{-1, -1, -1};
  Child child_;
  std::optional<Clock::time_point> goesOn_;
  std::optional<Clock::time_point> writesOn_;
  std::uint64_t read_ = 0;  // bytes of the output
};

[[nodiscard]] std::string contentsOf(const std::string& path, std::uint64_t from = 0);

}  // namespace vespscope::test
