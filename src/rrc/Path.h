// A way through a message: "message.c1.rrcConnectionRelease". The compiler refuses a name that no message has.
#pragma once

#include <array>
#include <cstddef>

#include "rrc/Names.h"

namespace vespscope::rrc {

class Path {
 public:
  template <std::size_t size>
  consteval Path(const char (&text)[size]) {  // NOLINT: a literal is a path
    std::string_view rest(text, size - 1);
    while (!rest.empty()) {
      const std::size_t length = rest.find('.') == std::string_view::npos ? rest.size() : rest.find('.');
      names_.at(count_++) = findName(rest.substr(0, length)).value();
      rest.remove_prefix(length == rest.size() ? length : length + 1);
    }
  }

  [[nodiscard]] constexpr const NameId* begin() const { return names_.data(); }
  [[nodiscard]] constexpr const NameId* end() const { return names_.data() + count_; }

 private:
  std::array<NameId, 10> names_{};
  std::size_t count_ = 0;
};

}  // namespace vespscope::rrc
