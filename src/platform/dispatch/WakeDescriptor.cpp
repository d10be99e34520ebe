#include "platform/dispatch/WakeDescriptor.h"

#include <sys/eventfd.h>
#include <unistd.h>

#include <cerrno>
#include <cstdint>
#include <cstring>
#include <string>

#include "platform/log/Log.h"

namespace vespscope::dispatch {

WakeDescriptor::WakeDescriptor() : descriptor_(::eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK)) {
  if (descriptor_ < 0) log::fatal(std::string("eventfd: ") + std::strerror(errno));
}

WakeDescriptor::~WakeDescriptor() { ::close(descriptor_); }

void WakeDescriptor::wake() const {
  const int saved = errno;
  const std::uint64_t one = 1;
  // Any other failure means that the counter is full: the descriptor is readable.
  while (::write(descriptor_, &one, sizeof one) < 0 && errno == EINTR) {
  }
  errno = saved;
}

bool WakeDescriptor::clear() const {
  std::uint64_t count = 0;
  return ::read(descriptor_, &count, sizeof count) > 0;
}

}  // namespace vespscope::dispatch
