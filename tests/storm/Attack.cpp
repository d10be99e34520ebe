#include "storm/Attack.h"

#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <random>
#include <utility>
#include <vector>

#include "storm/Way.h"
#include "support/HostileMessages.h"

namespace vespscope::test {
namespace {

using Clock = std::chrono::steady_clock;

// What is sent behind the greeting.
std::string harm(std::mt19937_64& random) {
  switch (random() % 5) {
    case 0:  // the beginning of a message that does not end
      return callOf("sa{sv}", std::string(random() % 200'000, 'x'), 1'000'000);
    case 1: {  // what is no message
      std::string bytes(random() % 4096 + 1, '\0');
      for (char& byte : bytes) byte = static_cast<char>(random());
      return bytes;
    }
    case 2: {  // configurations
      std::string toml = "[metrics]\nK_LTE_RLF = { period_ms = 1 }\n";
      while (toml.size() < 60'000) toml += "# a comment as long as others are\n";
      const std::string body = configurationBody(toml);
      std::string flood;
      for (std::uint32_t serial = 1; serial <= 8; ++serial) flood += callOf("sa{sv}", body, body.size(), serial);
      return flood;
    }
    case 3: {  // a configuration nested without end
      std::string toml = "x=";
      toml.append(20'000, '[');
      const std::string body = configurationBody(toml);
      return callOf("sa{sv}", body, body.size());
    }
    default: {  // a message that is whole but for a byte
      const std::string body = configurationBody("[metrics]\n");
      std::string call = callOf("sa{sv}", body, body.size());
      call[random() % call.size()] = static_cast<char>(random());
      return call;
    }
  }
}

// Sends as much as is taken at once.
void push(int descriptor, const std::string& bytes) {
  constexpr int pause = 20;  // ms
  for (std::size_t sent = 0; sent < bytes.size();) {
    pollfd ready{descriptor, POLLOUT, 0};
    if (::poll(&ready, 1, pause) != 1) return;
    const ssize_t count = ::send(descriptor, bytes.data() + sent, bytes.size() - sent, MSG_NOSIGNAL | MSG_DONTWAIT);
    if (count <= 0) return;
    sent += static_cast<std::size_t>(count);
  }
}

}  // namespace

Attack::Attack(std::string path, std::uint64_t seed, std::chrono::milliseconds length)
    : thread_([this, path = std::move(path), seed, length] { run(path, seed, length); }) {}

Attack::~Attack() {
  stopping_ = true;
  thread_.join();
}

void Attack::run(const std::string& path, std::uint64_t seed, std::chrono::milliseconds length) {
  std::mt19937_64 random(seed);
  constexpr std::size_t mostHeld = 24;  // of 32 places
  std::vector<int> held;
  const auto release = [&held](std::size_t index) {
    ::close(held[index]);
    held.erase(held.begin() + static_cast<std::ptrdiff_t>(index));
  };
  for (const Clock::time_point end = Clock::now() + length; Clock::now() < end && !stopping_;) {
    const int descriptor = connectTo(path);
    if (descriptor < 0) {
      std::this_thread::sleep_for(std::chrono::milliseconds(10));
      continue;
    }
    held.push_back(descriptor);
    if (random() % 4 != 0) {
      push(descriptor, std::string("\0AUTH EXTERNAL\r\nDATA\r\nBEGIN\r\n", 29));
      push(descriptor, harm(random));
    }
    if (held.size() > mostHeld) release(random() % held.size());
    if (random() % 3 == 0) std::this_thread::sleep_for(std::chrono::milliseconds(random() % 10));
  }
  while (!held.empty()) release(held.size() - 1);
  over_ = true;
}

}  // namespace vespscope::test
