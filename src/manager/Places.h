// The manager's places for clients: no user can take all of them, and some are reserved for the administrator.
#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <string>

namespace vespscope::manager {

class Places {
 public:
  static constexpr std::size_t all = 32;
  static constexpr std::size_t reserved = 4;  // for the administrator (user 0)
  static constexpr std::size_t ofAUser = 8;   // of each user other than the administrator and the manager's own

  // `owner` is the user that the manager runs as.
  explicit Places(std::uint32_t owner) : owner_(owner) {}

  // Takes a place for a client of `user`; returns the error if none is free.
  [[nodiscard]] std::optional<std::string> take(std::uint32_t user);
  // Returns a place that `user` took.
  void leave(std::uint32_t user);
  [[nodiscard]] std::size_t taken() const { return taken_; }

 private:
  const std::uint32_t owner_;
  std::size_t taken_ = 0;
  std::map<std::uint32_t, std::size_t> byUser_;
};

}  // namespace vespscope::manager
