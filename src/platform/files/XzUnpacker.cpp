#include "platform/files/Unpacker.h"

#ifdef VESPSCOPE_XZ

#include <new>

#include <lzma.h>

namespace vespscope::files {
namespace {

class XzUnpacker final : public Unpacker {
 public:
  XzUnpacker() {
    if (::lzma_stream_decoder(&stream_, xzMemoryLimit, 0) != LZMA_OK) throw std::bad_alloc();
  }
  XzUnpacker(const XzUnpacker&) = delete;
  XzUnpacker& operator=(const XzUnpacker&) = delete;
  ~XzUnpacker() override { ::lzma_end(&stream_); }

  Result<Step> step(std::span<const std::uint8_t> input, std::span<std::uint8_t> output, bool last) override {
    stream_.next_in = input.data();
    stream_.avail_in = input.size();
    stream_.next_out = output.data();
    stream_.avail_out = output.size();
    const lzma_ret result = ::lzma_code(&stream_, last ? LZMA_FINISH : LZMA_RUN);
    if (result == LZMA_MEMLIMIT_ERROR) {
      return Failure{"the xz data needs more than " + std::to_string(xzMemoryLimit >> 20) + " MiB of memory to unpack"};
    }
    if (result != LZMA_OK && result != LZMA_STREAM_END && result != LZMA_BUF_ERROR) {
      return Failure{std::string("the xz data is damaged")};
    }
    return Step{input.size() - stream_.avail_in, output.size() - stream_.avail_out, result == LZMA_STREAM_END};
  }

 private:
  lzma_stream stream_ = LZMA_STREAM_INIT;
};

}  // namespace

Result<std::unique_ptr<Unpacker>> makeXzUnpacker() { return std::unique_ptr<Unpacker>(new XzUnpacker); }

}  // namespace vespscope::files

#else

namespace vespscope::files {

Result<std::unique_ptr<Unpacker>> makeXzUnpacker() {
  return Failure{std::string("is compressed with xz, which this build cannot read (it was built without liblzma)")};
}

}  // namespace vespscope::files

#endif
