#include "storm/Run.h"

#include <fcntl.h>
#include <sys/resource.h>
#include <unistd.h>

#include <csignal>
#include <fstream>
#include <iterator>

namespace vespscope::test {

std::string contentsOf(const std::string& path, std::uint64_t from) {
  std::ifstream file(path, std::ios::binary);
  file.seekg(static_cast<std::streamoff>(from));
  return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

ChildWish Run::wishOf(const Place& place, const std::string& name, const std::string& program,
                      const std::vector<std::string>& arguments, std::array<int, 3>& descriptors) {
  constexpr int forOutput = O_WRONLY | O_CREAT | O_TRUNC | O_APPEND | O_CLOEXEC;
  descriptors = {::open("/dev/null", O_RDONLY | O_CLOEXEC), ::open((place / (name + ".out")).c_str(), forOutput, 0600),
                 ::open((place / (name + ".err")).c_str(), forOutput, 0600)};
  return {.program = place.programs / program, .arguments = arguments, .descriptors = descriptors};
}

Run::Run(const Place& place, const std::string& name, const std::string& program,
         const std::vector<std::string>& arguments)
    : name_(name), files_(place / name), child_(wishOf(place, name, program, arguments, descriptors_)) {
  for (const int descriptor : descriptors_) ::close(descriptor);
}

std::optional<ProcessEnd> Run::waitForEnd(std::chrono::milliseconds limit) {
  const std::optional<ProcessEnd> end = child_.waitForEnd(limit);
  if (!end) {
    child_.signal(SIGKILL);
    static_cast<void>(child_.waitForEnd(std::chrono::seconds(10)));
  }
  return end;
}

void Run::stop(Clock::time_point end) {
  child_.signal(SIGSTOP);
  goesOn_ = end;
}

void Run::limitFiles(std::uint64_t bytes, Clock::time_point end) {
  const rlimit limit{bytes, RLIM_INFINITY};
  if (::prlimit(child_.identifier(), RLIMIT_FSIZE, &limit, nullptr) == 0) writesOn_ = end;
}

void Run::recover(Clock::time_point now) {
  if (goesOn_ && *goesOn_ <= now) {
    child_.signal(SIGCONT);
    goesOn_.reset();
  }
  if (writesOn_ && *writesOn_ <= now) {
    const rlimit none{RLIM_INFINITY, RLIM_INFINITY};
    ::prlimit(child_.identifier(), RLIMIT_FSIZE, &none, nullptr);
    writesOn_.reset();
  }
}

std::string Run::newOutput() {
  std::string text = contentsOf(files_ + ".out", read_);
  read_ += text.size();
  return text;
}

std::string Run::output() const { return contentsOf(files_ + ".out"); }
std::string Run::errors() const { return contentsOf(files_ + ".err"); }

long Run::memory() const {
  std::ifstream file("/proc/" + std::to_string(child_.identifier()) + "/status");
  for (std::string word; file >> word;) {
    long size = 0;
    if (word == "VmHWM:" && file >> size) return size;
  }
  return 0;
}

}  // namespace vespscope::test
