// Runs trials and holds them against the rules.
#include <fcntl.h>
#include <poll.h>
#include <signal.h>
#include <termios.h>
#include <unistd.h>

#include <cstring>
#include <fstream>
#include <optional>
#include <string_view>
#include <thread>

#include <pty.h>

#include "programs/Trial.h"
#include "support/Child.h"
#include "values/Sanitized.h"
#include "values/Text.h"

namespace vespscope::fuzz {
namespace {

using namespace std::chrono_literals;
using test::ProcessEnd;
using Clock = std::chrono::steady_clock;

constexpr auto endLimit = sanitized ? 10s : 2s;  // from the signal to the end

// The descriptors of one trial: what the program has, and what this side reads.
class Descriptors {
 public:
  Descriptors(const Trial& trial, const Ground& ground) : ground_(ground) {
    const winsize size{.ws_row = 24, .ws_col = 80, .ws_xpixel = 0, .ws_ypixel = 0};
    ::openpty(&master_, &slave_, nullptr, nullptr, &size);
    for (const int descriptor : {master_, slave_}) ::fcntl(descriptor, F_SETFD, FD_CLOEXEC);
    ::tcgetattr(slave_, &modes_);
    for (std::size_t index = 0; index < given.size(); ++index) give(index, trial.ends[index]);
  }
  Descriptors(const Descriptors&) = delete;
  Descriptors& operator=(const Descriptors&) = delete;
  ~Descriptors() {
    closeGiven();
    for (const int descriptor : {master_, slave_, read_[1], read_[2], held_}) {
      if (descriptor >= 0) ::close(descriptor);
    }
  }

  void closeGiven() {
    for (int& descriptor : given) {
      if (descriptor >= 0 && descriptor != slave_) ::close(descriptor);
      descriptor = -1;
    }
  }

  // Reads what has come, for at most `limit`.
  void read(std::chrono::milliseconds limit) {
    std::array<pollfd, 3> ready = {{{master_, POLLIN, 0}, {read_[1], POLLIN, 0}, {read_[2], POLLIN, 0}}};
    if (::poll(ready.data(), ready.size(), static_cast<int>(limit.count())) <= 0) return;
    for (std::size_t index = 0; index < ready.size(); ++index) {
      if (ready[index].revents == 0) continue;
      std::array<char, 65536> piece;
      const ssize_t count = ::read(ready[index].fd, piece.data(), piece.size());
      if (count > 0) {
        if (texts[index].size() < most) texts[index].append(piece.data(), static_cast<std::size_t>(count));
      } else if (index != 0) {
        ::close(read_[index]);
        read_[index] = -1;
      }
    }
  }
  void readRest() {
    std::size_t size = 0;
    do {
      size = texts[0].size() + texts[1].size() + texts[2].size();
      read(5ms);
    } while (texts[0].size() + texts[1].size() + texts[2].size() != size);
    for (std::size_t index = 1; index < files_.size(); ++index) {
      if (files_[index].empty()) continue;
      std::ifstream file(files_[index], std::ios::binary);
      texts[index].assign(std::istreambuf_iterator<char>(file), {});
    }
  }

  [[nodiscard]] bool isRestored() const {
    termios now{};
    ::tcgetattr(slave_, &now);
    return now.c_iflag == modes_.c_iflag && now.c_oflag == modes_.c_oflag && now.c_lflag == modes_.c_lflag;
  }

  std::array<int, 3> given{-1, -1, -1};
  std::array<std::string, 3> texts;  // of the terminal, and of standard output and error where these are pipes or files

 private:
  static constexpr std::size_t most = std::size_t{4} << 20;

  void give(std::size_t index, End end) {
    const bool input = index == 0;
    switch (end) {
      case End::nothing:
        return;
      case End::null:
        given[index] = ::open("/dev/null", (input ? O_RDONLY : O_WRONLY) | O_CLOEXEC);
        return;
      case End::terminal:
        given[index] = slave_;
        return;
      case End::pipe:
      case End::silentPipe:
      case End::brokenPipe:
        return givePipe(index, end);
      case End::full:
        given[index] = ::open("/dev/full", O_RDWR | O_CLOEXEC);
        return;
      case End::file:
        return giveFile(index);
      case End::folder:
        given[index] = ::open("/", O_RDONLY | O_DIRECTORY | O_CLOEXEC);
        return;
      case End::otherWay:
        given[index] = ::open("/dev/null", (input ? O_WRONLY : O_RDONLY) | O_CLOEXEC);
        return;
    }
  }
  void givePipe(std::size_t index, End end) {
    std::array<int, 2> pipe{};
    if (::pipe2(pipe.data(), O_CLOEXEC) != 0) return;
    if (index != 0) {
      given[index] = pipe[1];
      // Whether the reader stands still or has left.
      if (end == End::pipe) read_[index] = pipe[0];
      if (end == End::silentPipe && held_ < 0)
        held_ = pipe[0];
      else if (end != End::pipe)
        ::close(pipe[0]);
      return;
    }
    given[0] = pipe[0];
    if (end == End::pipe) {
      std::ifstream file(ground_.captures().front(), std::ios::binary);
      const std::string text(std::istreambuf_iterator<char>(file), {});
      ::fcntl(pipe[1], F_SETFL, O_NONBLOCK);
      static_cast<void>(!::write(pipe[1], text.data(), text.size()));
    }
    if (end == End::silentPipe && held_ < 0)
      held_ = pipe[1];
    else
      ::close(pipe[1]);
  }
  void giveFile(std::size_t index) {
    if (index == 0) {
      given[0] = ::open(ground_.captures().front().c_str(), O_RDONLY | O_CLOEXEC);
      return;
    }
    files_[index] = (ground_.folder() / ("output-" + std::to_string(index))).string();
    given[index] = ::open(files_[index].c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0600);
  }

  const Ground& ground_;
  int master_ = -1;
  int slave_ = -1;
  termios modes_{};
  std::array<int, 3> read_{-1, -1, -1};
  int held_ = -1;  // open, and neither read nor written
  std::array<std::string, 3> files_;
};

// A text for people: printable, in lines. Returns what it holds besides.
std::string rawBytes(const std::string& text, const std::string& name) {
  std::string lines;
  for (const char character : text) {
    if (character != '\n') lines += character;
  }
  if (printable(lines) == lines) return {};
  for (std::size_t place = 0; place < lines.size(); ++place) {
    const auto byte = static_cast<unsigned char>(lines[place]);
    if (byte < 0x20 || byte == 0x7F) return name + " holds the control character " + std::to_string(byte);
  }
  return name + " holds a character that acts on a terminal, or no UTF-8";
}

std::string checkTexts(const Trial& trial, const Descriptors& descriptors) {
  for (const std::string& text : descriptors.texts) {
    if (!trial.writesData() && text.find("\x1b]0;planted") != std::string::npos)
      return "a name's escapes are printed raw";
  }
  // The interface owns the terminal; elsewhere there are lines.
  const bool cut = trial.room != 0 || trial.time < 1s;
  for (std::size_t index = 1; index < 3; ++index) {
    if (index == 1 && trial.writesData()) continue;
    std::string text = descriptors.texts[index];
    // The end may stand within a character.
    if (cut) text.erase(text.rfind('\n') == std::string::npos ? 0 : text.rfind('\n'));
    if (std::string fault = rawBytes(text, index == 1 ? "standard output" : "standard error"); !fault.empty())
      return fault;
  }
  return {};
}

std::string checkTerminal(const Descriptors& descriptors) {
  if (!descriptors.isRestored()) return "the terminal's modes are not restored";
  const std::string& text = descriptors.texts[0];
  const std::size_t entered = text.rfind("\x1b[?1049h");
  if (entered != std::string::npos && text.find("\x1b[?1049l", entered) == std::string::npos) {
    return "the terminal's screen is not restored";
  }
  return {};
}

std::string checkEnd(const Trial& trial, const ProcessEnd& end) {
  constexpr int notStarted = 127;
  const bool starved = trial.descriptors != 0;  // too few for the libraries
  if (!end.signalled) {
    return end.number <= 2 || (starved && end.number == notStarted) ? "" : "ended by " + test::wordsOf(end);
  }
  // With too few descriptors a program stops on purpose, with a line that says so.
  if (end.number == trial.signal || end.number == SIGPIPE || (starved && end.number == SIGABRT)) return {};
  return "ended by " + test::wordsOf(end);
}

}  // namespace

std::string run(const Trial& trial, const std::filesystem::path& bin, const Ground& ground) {
  ground.clear();
  Descriptors descriptors(trial, ground);
  test::ChildWish wish{.program = bin / trial.program,
                       .arguments = trial.arguments,
                       .variables = trial.variables,
                       .descriptors = descriptors.given,
                       .folder = ground.folder() / "out",
                       .controllingTerminal = trial.ends[0] == End::terminal};
  if (trial.descriptors != 0) wish.limits.emplace_back(RLIMIT_NOFILE, trial.descriptors);
  if (trial.room != 0) wish.limits.emplace_back(RLIMIT_FSIZE, trial.room);
  test::Child child(wish);
  descriptors.closeGiven();
  for (const Clock::time_point end = Clock::now() + trial.time; Clock::now() < end && !child.hasEnded();) {
    descriptors.read(2ms);
  }
  child.signal(trial.signal);
  const Clock::time_point deadline = Clock::now() + endLimit;
  while (!child.hasEnded() && Clock::now() < deadline) descriptors.read(5ms);
  const std::optional<ProcessEnd> end = child.waitForEnd(0ms);
  if (!end) return "does not end within " + std::to_string(std::chrono::seconds(endLimit).count()) + " s of the signal";
  descriptors.readRest();
  std::string fault = checkEnd(trial, *end);
  if (fault.empty()) fault = checkTexts(trial, descriptors);
  if (fault.empty()) fault = checkTerminal(descriptors);
  if (fault.empty()) fault = ground.changedInput();
  if (fault.empty()) fault = ground.badOutput();
  if (!fault.empty()) fault += "\n" + printable(descriptors.texts[2].substr(0, 2000));
  return fault;
}

}  // namespace vespscope::fuzz
