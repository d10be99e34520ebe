#include "platform/files/StandardDescriptors.h"

#include <fcntl.h>
#include <unistd.h>

#include <cstdlib>
#include <initializer_list>

namespace vespscope::files {

void openStandardDescriptors() {
  for (const int descriptor : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO}) {
    if (::fcntl(descriptor, F_GETFD) >= 0) continue;
    // open() returns the lowest free number, which is this one. Opened in the wrong direction, it fails like a closed
    // descriptor.
    const int opened = ::open("/dev/null", descriptor == STDIN_FILENO ? O_WRONLY : O_RDONLY);
    if (opened != descriptor) std::_Exit(EXIT_FAILURE);
  }
}

}  // namespace vespscope::files
