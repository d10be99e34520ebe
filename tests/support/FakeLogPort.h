// A modem's log port controlled by a test, on a pseudo terminal or a TCP socket: it checks the commands that turn the
// log on, answers them, and then sends the bytes of a log. It shares no code with the source that it tests.
#pragma once

#include <atomic>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include "values/Value.h"

namespace vespscope::test {

class FakeLogPort {
 public:
  enum class Manner {
    proper,    // answers each command; the log follows the last one
    silent,    // does not answer
    nonsense,  // answers with bytes that are not frames
    refusing,  // rejects the commands
    already,   // does not answer, but sends the log without a request
  };
  enum class Line { terminal, tcp };

  // Sends `log` once the equipments 4, 5, 7 and 11 are turned on.
  FakeLogPort(Line line, Manner manner, Bytes log);
  FakeLogPort(const FakeLogPort&) = delete;
  FakeLogPort& operator=(const FakeLogPort&) = delete;
  ~FakeLogPort();

  // The name of the port: the path of a terminal, or "tcp:127.0.0.1:PORT".
  [[nodiscard]] std::string name() const { return name_; }
  // The commands so far, in words: "counts", "on 11: 0B0C0 …", "off"; an invalid one as "bad: why".
  [[nodiscard]] std::vector<std::string> commands() const;
  // Closes the current connection, and over TCP accepts the next one.
  void unplug();

 private:
  void run();
  void serve(int descriptor);
  void take(std::uint8_t byte, int descriptor);
  void takeCommand(const Bytes& frame, int descriptor);
  void note(std::string command);

  const Line line_;
  const Manner manner_;
  const Bytes log_;
  int listening_ = -1;
  int terminal_ = -1;
  std::string name_;
  std::atomic<bool> stopping_ = false;
  std::atomic<bool> unplugging_ = false;

  // Used by the thread only, for one connection.
  Bytes frame_;
  bool escaped_ = false;
  unsigned equipmentsOn_ = 0;

  mutable std::mutex mutex_;
  std::vector<std::string> commands_;
  std::thread thread_;
};

}  // namespace vespscope::test
