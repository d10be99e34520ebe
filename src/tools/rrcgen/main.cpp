// rrcgen DEFINITIONS_FOLDER SELECTION TABLES_FOLDER: writes the reader's tables from the ASN.1 definitions of RRC.
#include <cstdio>

#include "rrcgen/Writer.h"

int main(int argc, char** argv) {
  using namespace vespscope::rrcgen;
  if (argc != 4) {
    std::fputs("usage: rrcgen DEFINITIONS_FOLDER SELECTION TABLES_FOLDER\n", stderr);
    return 2;
  }
  const auto files = generateFrom(argv[1], argv[2]);
  if (!files) {
    std::fprintf(stderr, "rrcgen: %s\n", files.reason().c_str());
    return 2;
  }
  const auto written = writeFiles(*files, argv[3]);
  if (!written) {
    std::fprintf(stderr, "rrcgen: %s\n", written.reason().c_str());
    return 2;
  }
  std::printf("%zu files, %zu written\n", files->size(), *written);
  return 0;
}
