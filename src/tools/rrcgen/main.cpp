// rrcgen DEFINITIONS_FOLDER SELECTION TABLES_FOLDER: writes the reader's tables from the ASN.1 definitions of RRC.
#include <cstdio>

#include "rrcgen/Writer.h"
#include "tools/GeneratedFiles.h"

int main(int argc, char** argv) {
  using namespace vespscope::rrcgen;
  if (argc != 4) {
    std::fputs("usage: rrcgen DEFINITIONS_FOLDER SELECTION TABLES_FOLDER\n", stderr);
    return 2;
  }
  return vespscope::generation::finish("rrcgen", generateFrom(argv[1], argv[2]), argv[3]);
}
