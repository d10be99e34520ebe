// Baseband managers that run inside the process of their only client.
#pragma once

#include <memory>
#include <optional>
#include <string>

#include "rhoxlink/bus/Embedded.h"
#include "values/Result.h"

namespace vespscope::manager {

// The managers of one program, one per source. Each opens its source once and serves every connection of the program's
// client, also after a lost one: standard input cannot be opened twice, and playback continues.
class EmbeddedManagers {
 public:
  EmbeddedManagers();
  EmbeddedManagers(const EmbeddedManagers&) = delete;
  EmbeddedManagers& operator=(const EmbeddedManagers&) = delete;
  // Stops the managers without connections; the others stop with their last connection.
  ~EmbeddedManagers();

  // Opens the source that `words` name ("scenario:seed=3", "replay:drive.pcap,loop") and keeps it for the first
  // connection. Returns the error if it cannot be opened.
  [[nodiscard]] std::optional<std::string> open(const std::string& words);
  // For the client library: returns the client's end of a new connection, or the error if there is no manager. Calls
  // after this object's end fail.
  [[nodiscard]] bus::EmbeddedFactory factory() const;

 private:
  class Servers;
  std::shared_ptr<Servers> servers_;
};

}  // namespace vespscope::manager
