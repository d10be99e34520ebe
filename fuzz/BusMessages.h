// Bytes that a peer on a bus connection may send: the greeting, and messages whose frame is right around contents that
// need not be.
#pragma once

#include "Fuzz.h"
#include "values/Value.h"

namespace vespscope::fuzz {

enum class Side { client, server };

// What the other end says before the first message, and then messages made of the input: the input's bytes as they
// are, or calls, replies and signals with its words, signatures and bodies.
[[nodiscard]] Bytes conversationOf(Side side, Input input);

// A connected pair of sockets, the second one closed with the object.
class Connection {
 public:
  Connection();
  Connection(const Connection&) = delete;
  Connection& operator=(const Connection&) = delete;
  ~Connection();

  // The first one, for an end that will own it.
  [[nodiscard]] int endOfOurs() const { return ours_; }
  // Sends as much as the socket takes.
  void send(std::span<const std::uint8_t> bytes) const;
  // Reads and forgets what has come.
  void drain() const;

 private:
  int ours_ = -1;
  int theirs_ = -1;
};

}  // namespace vespscope::fuzz
