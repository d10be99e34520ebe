// Baseband managers that run inside the process of their only client.
#pragma once

#include <memory>
#include <optional>
#include <string>

#include "rhoxlink/bus/Embedded.h"
#include "values/Result.h"

namespace vespscope::manager {

// The managers of one program, one for each source. Each opens its source once and serves every connection that the
// program's client makes, also after a lost one: standard input cannot be opened twice, and playback continues.
class EmbeddedManagers {
 public:
  EmbeddedManagers();
  EmbeddedManagers(const EmbeddedManagers&) = delete;
  EmbeddedManagers& operator=(const EmbeddedManagers&) = delete;
  // Stops the managers that no connection uses any more; the others stop with their last connection.
  ~EmbeddedManagers();

  // Opens the source that `words` name ("scenario:seed=3", "replay:drive.pcap,loop") and keeps it for the first
  // connection. Returns why it cannot be opened.
  [[nodiscard]] std::optional<std::string> open(const std::string& words);
  // For the client library: returns the client's end of a new connection, or why there is no manager. It fails once
  // this object is gone.
  [[nodiscard]] bus::EmbeddedFactory factory() const;

 private:
  class Servers;
  std::shared_ptr<Servers> servers_;
};

}  // namespace vespscope::manager
