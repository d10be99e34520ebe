#include "platform/files/Unpacker.h"

#ifdef VESPSCOPE_GZIP

#include <algorithm>
#include <limits>
#include <new>

// Makes zlib's input pointers const.
#define ZLIB_CONST
#include <zlib.h>

namespace vespscope::files {
namespace {

constexpr int gzipOnly = 16;  // added to the window's bits

class GzipUnpacker final : public Unpacker {
 public:
  GzipUnpacker() {
    if (::inflateInit2(&stream_, MAX_WBITS + gzipOnly) != Z_OK) throw std::bad_alloc();
  }
  GzipUnpacker(const GzipUnpacker&) = delete;
  GzipUnpacker& operator=(const GzipUnpacker&) = delete;
  ~GzipUnpacker() override { ::inflateEnd(&stream_); }

  Result<Step> step(std::span<const std::uint8_t> input, std::span<std::uint8_t> output, bool /*last*/) override {
    constexpr std::size_t most = std::numeric_limits<uInt>::max();
    const auto inputLength = static_cast<uInt>(std::min(input.size(), most));
    const auto outputLength = static_cast<uInt>(std::min(output.size(), most));
    stream_.next_in = input.data();
    stream_.avail_in = inputLength;
    stream_.next_out = output.data();
    stream_.avail_out = outputLength;
    const int result = ::inflate(&stream_, Z_NO_FLUSH);
    if (result != Z_OK && result != Z_STREAM_END && result != Z_BUF_ERROR) {
      return Failure{std::string("the gzip data is damaged")};
    }
    return Step{inputLength - stream_.avail_in, outputLength - stream_.avail_out, result == Z_STREAM_END};
  }

 private:
  z_stream stream_{};
};

}  // namespace

Result<std::unique_ptr<Unpacker>> makeGzipUnpacker() { return std::unique_ptr<Unpacker>(new GzipUnpacker); }

}  // namespace vespscope::files

#else

namespace vespscope::files {

Result<std::unique_ptr<Unpacker>> makeGzipUnpacker() {
  return Failure{std::string("is compressed with gzip, which this build cannot read (it was built without zlib)")};
}

}  // namespace vespscope::files

#endif
