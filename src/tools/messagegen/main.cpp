// messagegen SCHEMA_FOLDER MESSAGE_FOLDER: writes the message headers from their schema.
#include <cstdio>

#include "messagegen/Generator.h"
#include "tools/GeneratedFiles.h"

int main(int argc, char** argv) {
  using namespace vespscope::messagegen;
  if (argc != 3) {
    std::fputs("usage: messagegen SCHEMA_FOLDER MESSAGE_FOLDER\n", stderr);
    return 2;
  }
  return vespscope::generation::finish("messagegen", generateFrom(argv[1]), argv[2]);
}
