// The three standard descriptors, which the parent process may have closed.
#pragma once

namespace vespscope::files {

// Opens those of the descriptors 0 to 2 that are closed, so that no other file or socket gets their numbers and
// receives standard output. Using them still fails: reading 0 and writing 1 or 2 return EBADF. Every program calls this
// first. Exits with status 1 when no descriptor is available.
void openStandardDescriptors();

}  // namespace vespscope::files
