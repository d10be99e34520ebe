// Bytes that a peer on a bus connection may send: the greeting, and messages with a valid frame and arbitrary contents.
#pragma once

#include "Fuzz.h"
#include "values/Value.h"

namespace vespscope::fuzz {

enum class Side { client, server };

// The peer's part before the first message, and then messages made from the input: its bytes as they are, or calls,
// replies and signals with its words, signatures and bodies.
[[nodiscard]] Bytes conversationOf(Side side, Input input);

// A connected pair of sockets, the second one closed with the object.
class Connection {
 public:
  Connection();
  Connection(const Connection&) = delete;
  Connection& operator=(const Connection&) = delete;
  ~Connection();

  // The first socket, for an end that will own it.
  [[nodiscard]] int endOfOurs() const { return ours_; }
  // Sends as much as the socket accepts.
  void send(std::span<const std::uint8_t> bytes) const;
  // Reads and discards the received bytes.
  void drain() const;

 private:
  int ours_ = -1;
  int theirs_ = -1;
};

}  // namespace vespscope::fuzz
