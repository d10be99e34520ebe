// The three standard descriptors of a program that may have been started without them.
#pragma once

namespace vespscope::files {

// Opens those of the descriptors 0 to 2 that are closed, so that no file or socket is given their numbers and takes
// what is meant for standard output. Using one that was closed still fails: reading 0 and writing 1 or 2 return EBADF.
// Every program calls this first. Ends the process with status 1 when the system gives no descriptor.
void openStandardDescriptors();

}  // namespace vespscope::files
