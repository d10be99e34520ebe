// A running ssh that starts `rhoxd --stdio` at its far end.
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
  // Starts `ssh` to `destination`: HOST, USER@HOST or ssh://USER@HOST:PORT. ssh does not ask for a password:
  // authentication needs keys or an agent.
  static vespscope::Result<std::shared_ptr<SshProcess>> start(const std::string& destination);

  SshProcess(const SshProcess&) = delete;
  SshProcess& operator=(const SshProcess&) = delete;
  // Ends ssh.
  ~SshProcess();

  // Returns our end of its standard input and output, a stream socket; called once.
  [[nodiscard]] int takeDescriptor();
  // Returns why ssh ended, in its own words if it printed any; waits briefly for its end.
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
  std::string lastErrors_;  // the last part of its error output; used by the watching thread until ssh has ended

  std::mutex mutex_;
  std::condition_variable changed_;
  std::optional<int> status_;  // the status from waitpid, once ssh has ended
  std::thread thread_;
};

}  // namespace rhox::client
