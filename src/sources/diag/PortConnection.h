// A modem's log port, open: a serial line, or a TCP connection to something that passes one on.
#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>

#include "values/Result.h"
#include "values/Value.h"

namespace vespscope::sources::diag {

class PortConnection {
 public:
  // `name` is the path of a device, or "tcp:ADDRESS:PORT" with a numeric address, in brackets where it has colons.
  // Never waits: a TCP connection may still be on its way, and its failure shows in the first read or write.
  static Result<PortConnection> open(const std::string& name);

  PortConnection(PortConnection&& other) noexcept;
  PortConnection& operator=(PortConnection&&) = delete;
  ~PortConnection();

  // For poll().
  [[nodiscard]] int descriptor() const { return descriptor_; }
  // Reads what has come into `buffer`, none when nothing has. Fails when the port is gone.
  Result<std::size_t> read(std::span<std::uint8_t> buffer);
  // Writes as much of `bytes` as goes without waiting, and takes that away from it. Fails when the port is gone.
  Result<std::size_t> write(Bytes& bytes);

 private:
  explicit PortConnection(int descriptor) : descriptor_(descriptor) {}

  int descriptor_;
};

// Why "tcp:…" names no TCP port; empty when it does.
[[nodiscard]] std::optional<std::string> problemWithTcpPort(const std::string& name);

}  // namespace vespscope::sources::diag
