// The two log channels, the system log and standard output, and the stop on a programming error.
//
// Any thread may log; lines keep their order within a channel. A line is made printable (one line of valid UTF-8
// without control characters) before it is written.
#pragma once

#include <cstdint>
#include <functional>
#include <source_location>
#include <string>
#include <string_view>

namespace vespscope::log {

enum class Channel { systemLog, standardOutput };

// Writes one line to the system log: syslog when its socket exists, else standard error. A separate thread writes, so a
// stuck log daemon never blocks the caller; lines beyond a bounded queue are dropped and counted.
void system(std::string_view line);

// Writes one line to standard output. If the output is closed or broken, the failure is counted and the program
// continues.
void print(std::string_view line);

// While any such object lives, lines of standard output are gathered and written together: when a block is full, and
// when the last object ends. Code that logs many lines at a time makes one for each turn.
class OutputBatch {
 public:
  OutputBatch();
  OutputBatch(const OutputBatch&) = delete;
  OutputBatch& operator=(const OutputBatch&) = delete;
  ~OutputBatch();
};

// Called with every line of both channels, on the thread that logged it.
using Observer = std::function<void(Channel, std::string_view line)>;

// Adds an observer for as long as the object lives.
class Observation {
 public:
  explicit Observation(Observer observer);
  Observation(const Observation&) = delete;
  Observation& operator=(const Observation&) = delete;
  ~Observation();

 private:
  std::uint64_t identifier_;
};

// While true, lines go only to observers and to outputs that are not the terminal, because a frontend draws there.
void setTerminalOwned(bool owned);

// While true, nothing is written to standard output or the system log; observers still receive the lines.
void discardOutputs(bool discard = true);

// Waits until the writer thread has written everything logged so far, at most one second.
void flush();

struct Counters {
  std::uint64_t systemLinesDropped = 0;
  std::uint64_t outputFailures = 0;
};
[[nodiscard]] Counters counters();

// Called before the process stops on a programming error, newest first: frontends restore the terminal here.
class FatalHook {
 public:
  explicit FatalHook(std::function<void()> hook);
  FatalHook(const FatalHook&) = delete;
  FatalHook& operator=(const FatalHook&) = delete;
  ~FatalHook();

 private:
  std::uint64_t identifier_;
};

// Reports a programming error: runs the hooks, writes one line with the reason and the place to the system log and to
// standard error, and aborts.
[[noreturn]] void fatal(std::string_view what, std::source_location where = std::source_location::current());

}  // namespace vespscope::log
