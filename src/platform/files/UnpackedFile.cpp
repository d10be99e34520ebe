#include "platform/files/UnpackedFile.h"

#include <algorithm>
#include <utility>

namespace vespscope::files {
namespace {

constexpr std::size_t pieceLength = 65'536;

}  // namespace

Result<std::unique_ptr<UnpackedFile>> UnpackedFile::open(const std::string& path,
                                                         std::shared_ptr<const dispatch::WakeDescriptor> interruption) {
  auto file = InputFile::open(path, std::move(interruption));
  if (!file) return Failure{file.reason()};
  return std::unique_ptr<UnpackedFile>(new UnpackedFile(std::move(*file)));
}

UnpackedFile::UnpackedFile(std::unique_ptr<InputFile> file) : file_(std::move(file)), piece_(pieceLength) {}

std::optional<std::string> UnpackedFile::rewind() {
  taken_ = held_ = 0;
  ended_ = false;
  packing_.reset();
  unpacker_.reset();
  unpacked_ = 0;
  failure_.reset();
  return file_->rewind();
}

Result<bool> UnpackedFile::fill() {
  if (ended_) return false;
  std::copy(piece_.begin() + static_cast<std::ptrdiff_t>(taken_), piece_.begin() + static_cast<std::ptrdiff_t>(held_),
            piece_.begin());
  held_ -= std::exchange(taken_, 0);
  const Result<std::size_t> count = file_->read(std::span(piece_).subspan(held_));
  if (!count) return Failure{count.reason()};
  held_ += *count;
  ended_ = *count == 0 && !file_->interrupted();
  return *count != 0;
}

std::optional<std::string> UnpackedFile::examine() {
  while (!(packing_ = packingOf(waiting().first(std::min(waiting().size(), packingMarkLength))))) {
    const Result<bool> more = fill();
    if (!more) return more.reason();
    if (*more) continue;
    if (!file_->interrupted()) packing_ = Packing::none;  // shorter than any magic number
    break;
  }
  return std::nullopt;
}

Result<std::size_t> UnpackedFile::read(std::span<std::uint8_t> bytes) {
  Result<std::size_t> count = readSome(bytes);
  if (count) {
    unpacked_ += *count;
  } else {
    failure_ = count.reason();
  }
  return count;
}

Result<std::size_t> UnpackedFile::readSome(std::span<std::uint8_t> bytes) {
  if (failure_) return Failure{*failure_};
  if (!packing_) {
    if (auto reason = examine()) return Failure{*std::move(reason)};
    if (!packing_) return std::size_t{0};  // interrupted
  }
  return *packing_ == Packing::none ? copy(bytes) : unpack(bytes);
}

Result<std::size_t> UnpackedFile::copy(std::span<std::uint8_t> bytes) {
  if (taken_ == held_) return ended_ ? Result<std::size_t>(0) : file_->read(bytes);
  const std::size_t count = std::min(bytes.size(), held_ - taken_);
  std::copy_n(waiting().begin(), count, bytes.begin());
  taken_ += count;
  return count;
}

Result<std::size_t> UnpackedFile::unpack(std::span<std::uint8_t> bytes) {
  while (true) {
    if (taken_ == held_) {
      const Result<bool> more = fill();
      if (!more) return Failure{more.reason()};
      if (file_->interrupted()) return std::size_t{0};
      if (ended_ && !unpacker_) return std::size_t{0};
    }
    if (!unpacker_) {
      // Another stream of the same kind may follow, as in the output of `cat a.gz b.gz`.
      auto made = makeUnpacker(*packing_);
      if (!made) return Failure{made.reason()};
      unpacker_ = std::move(*made);
    }
    const Result<Unpacker::Step> step = unpacker_->step(waiting(), bytes, ended_);
    if (!step) return Failure{step.reason()};
    taken_ += step->taken;
    if (step->ended) unpacker_.reset();
    if (step->given != 0) return step->given;
    if (step->ended || step->taken != 0) continue;
    if (!waiting().empty()) return Failure{std::string("the compressed data is damaged")};
    if (ended_) return Failure{std::string("the compressed data is truncated")};
  }
}

}  // namespace vespscope::files
