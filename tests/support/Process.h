// A program run as a child process, with its two outputs collected.
#pragma once

#include <sys/types.h>

#include <chrono>
#include <filesystem>
#include <map>
#include <optional>
#include <string>
#include <vector>

namespace vespscope::test {

// The end of a process.
struct ProcessEnd {
  bool signalled = false;
  int number = 0;  // the exit status, or the signal that ended it
  friend bool operator==(const ProcessEnd&, const ProcessEnd&) = default;
};

inline constexpr std::chrono::seconds processPatience{20};

class Process {
 public:
  // Starts `program` with the environment of this process and `variables`. Its standard input is the file `input`. It
  // is killed when this process ends.
  Process(const std::filesystem::path& program, const std::vector<std::string>& arguments,
          const std::map<std::string, std::string>& variables = {}, const std::filesystem::path& input = "/dev/null");
  Process(const Process&) = delete;
  Process& operator=(const Process&) = delete;
  // Kills the process if it is still running.
  ~Process();

  // Reads the outputs until standard output (standard error) contains `text` at or after the position `from`; returns
  // false when the process ended or on a timeout.
  bool waitForOutput(const std::string& text, std::size_t from = 0);
  bool waitForErrors(const std::string& text);
  // Reads the outputs for this time.
  void readFor(std::chrono::milliseconds duration);
  // Reads the outputs until the process has ended; empty on a timeout.
  std::optional<ProcessEnd> wait();

  // The output read so far.
  [[nodiscard]] const std::string& output() const { return output_.text; }
  [[nodiscard]] const std::string& errors() const { return errors_.text; }

  void signal(int number) const;
  [[nodiscard]] pid_t identifier() const { return process_; }
  // Closes the reading end of its standard output, so that its next write there fails.
  void closeOutput();

 private:
  struct Pipe {
    int descriptor = -1;
    std::string text;
  };
  // Reads the available output, waiting at most `limit`; returns false when both outputs are closed.
  bool read(std::chrono::milliseconds limit);
  bool waitFor(const Pipe& pipe, const std::string& text, std::size_t from);
  static void readInto(Pipe& pipe);
  static void close(Pipe& pipe);

  pid_t process_ = -1;
  Pipe output_;
  Pipe errors_;
  std::optional<ProcessEnd> end_;
};

}  // namespace vespscope::test
