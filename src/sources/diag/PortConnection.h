// An open log port of a modem: a serial line, or a TCP connection to a program that forwards one.
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
  // `name` is the path of a device, or "tcp:ADDRESS:PORT" with a numeric address (in brackets if it has colons). Never
  // blocks: a TCP connection may not be established yet, and its failure is reported by the first read or write.
  static Result<PortConnection> open(const std::string& name);

  PortConnection(PortConnection&& other) noexcept;
  PortConnection& operator=(PortConnection&&) = delete;
  ~PortConnection();

  // For poll().
  [[nodiscard]] int descriptor() const { return descriptor_; }
  // Reads the available bytes into `buffer`; returns 0 when there are none. Fails when the port is lost.
  Result<std::size_t> read(std::span<std::uint8_t> buffer);
  // Writes as many of `bytes` as possible without blocking, and removes them. Fails when the port is lost.
  Result<std::size_t> write(Bytes& bytes);

 private:
  explicit PortConnection(int descriptor) : descriptor_(descriptor) {}

  int descriptor_;
};

// Why "tcp:…" is not a valid TCP port; empty when it is.
[[nodiscard]] std::optional<std::string> problemWithTcpPort(const std::string& name);

}  // namespace vespscope::sources::diag
