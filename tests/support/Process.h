// A program run as a process of its own, with its two outputs collected.
#pragma once

#include <sys/types.h>

#include <chrono>
#include <filesystem>
#include <map>
#include <optional>
#include <string>
#include <vector>

namespace vespscope::test {

// How a process ended.
struct ProcessEnd {
  bool signalled = false;
  int number = 0;  // the exit status, or the signal that ended it
  friend bool operator==(const ProcessEnd&, const ProcessEnd&) = default;
};

inline constexpr std::chrono::seconds processPatience{20};

class Process {
 public:
  // Starts `program` with the environment of this process and `variables`. Its standard input is the file `input`. It
  // dies with this process.
  Process(const std::filesystem::path& program, const std::vector<std::string>& arguments,
          const std::map<std::string, std::string>& variables = {}, const std::filesystem::path& input = "/dev/null");
  Process(const Process&) = delete;
  Process& operator=(const Process&) = delete;
  // Kills the process if it still runs.
  ~Process();

  // Reads the outputs until standard output (standard error) holds `text`, at or behind the position `from`; false when
  // it ended or took too long.
  bool waitForOutput(const std::string& text, std::size_t from = 0);
  bool waitForErrors(const std::string& text);
  // Reads the outputs for so long.
  void readFor(std::chrono::milliseconds duration);
  // Reads the outputs until the process has ended; empty when that takes too long.
  std::optional<ProcessEnd> wait();

  // What has been read so far.
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
  // Reads what has come, waiting at most `limit`; false when both outputs have ended.
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
