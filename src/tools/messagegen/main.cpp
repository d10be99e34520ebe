// messagegen SCHEMA_FOLDER MESSAGE_FOLDER: writes the message headers from their schema.
#include <cstdio>

#include "messagegen/Generator.h"

int main(int argc, char** argv) {
  using namespace vespscope::messagegen;
  if (argc != 3) {
    std::fputs("usage: messagegen SCHEMA_FOLDER MESSAGE_FOLDER\n", stderr);
    return 2;
  }
  const auto files = generateFrom(argv[1]);
  if (!files) {
    std::fprintf(stderr, "messagegen: %s\n", files.reason().c_str());
    return 2;
  }
  const auto written = writeFiles(*files, argv[2]);
  if (!written) {
    std::fprintf(stderr, "messagegen: %s\n", written.reason().c_str());
    return 2;
  }
  std::printf("%zu files, %zu written\n", files->size(), *written);
  return 0;
}
