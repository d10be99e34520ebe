#include "manager/Places.h"

namespace vespscope::manager {
namespace {

constexpr std::uint32_t administrator = 0;

}  // namespace

std::optional<std::string> Places::take(std::uint32_t user) {
  const auto known = byUser_.find(user);
  const std::size_t own = known == byUser_.end() ? 0 : known->second;
  if (taken_ >= all) return std::to_string(all) + " clients are connected";
  if (user != administrator) {
    if (taken_ >= all - reserved) {
      return std::to_string(taken_) + " clients are connected, and the last " + std::to_string(reserved) +
             " places are reserved for the administrator";
    }
    if (user != owner_ && own >= ofAUser) {
      return "user " + std::to_string(user) + " has " + std::to_string(own) + " clients connected";
    }
  }
  byUser_[user] = own + 1;
  ++taken_;
  return std::nullopt;
}

void Places::leave(std::uint32_t user) {
  const auto known = byUser_.find(user);
  if (known == byUser_.end()) return;
  if (--known->second == 0) byUser_.erase(known);
  --taken_;
}

}  // namespace vespscope::manager
