// A running ssh at whose far end `rhoxd --stdio` speaks the manager's protocol.
#pragma once

#include <condition_variable>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <thread>

#include "values/Result.h"

namespace rhox::client {

class SshProcess {
 public:
  // Starts `ssh` to `destination`, as ssh takes it: HOST, USER@HOST or ssh://USER@HOST:PORT. It asks nobody for a
  // password: keys or an agent have to open the door.
  static vespscope::Result<std::shared_ptr<SshProcess>> start(const std::string& destination);

  SshProcess(const SshProcess&) = delete;
  SshProcess& operator=(const SshProcess&) = delete;
  // Ends it.
  ~SshProcess();

  // Our end of its standard input and output, a stream socket; to be taken once.
  [[nodiscard]] int takeDescriptor();
  // Why it ended, in its own words where it had any; waits a little for it to end.
  [[nodiscard]] std::string explainEnd();

 private:
  SshProcess(std::string destination, pid_t process, int processDescriptor, int descriptor, int errors);
  void watch();
  void readErrors();

  const std::string destination_;
  const pid_t process_;
  const int processDescriptor_;
  int descriptor_;
  const int errors_;
  std::string lastErrors_;  // the end of what it wrote; the watching thread's until it has ended

  std::mutex mutex_;
  std::condition_variable changed_;
  std::optional<int> status_;  // as waitpid gives it, when it has ended
  std::thread thread_;
};

}  // namespace rhox::client
