#include "support/FakeModem.h"

#include <poll.h>
#include <sys/eventfd.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <array>
#include <atomic>
#include <cstdint>
#include <cstring>
#include <stdexcept>
#include <utility>

namespace vespscope::test {
namespace {

// All processes in the machine's network namespace share these names.
std::string uniqueName() {
  static std::atomic<int> count = 0;
  return "abstract:vespscope-" + std::to_string(::getpid()) + "-" + std::to_string(++count);
}

int listenAt(const std::string& name) {
  sockaddr_un address{};
  address.sun_family = AF_UNIX;
  std::memcpy(address.sun_path + 1, name.data(), name.size());  // the preceding zero byte makes the name abstract
  const auto size = static_cast<socklen_t>(offsetof(sockaddr_un, sun_path) + 1 + name.size());
  const int descriptor = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
  if (::bind(descriptor, reinterpret_cast<const sockaddr*>(&address), size) != 0 || ::listen(descriptor, 8) != 0) {
    throw std::runtime_error("no socket for the fake modem");
  }
  return descriptor;
}

std::string hexadecimal(std::string_view bytes) {
  constexpr std::string_view digits = "0123456789ABCDEF";
  std::string text;
  for (const char each : bytes) {
    const auto byte = static_cast<unsigned char>(each);
    text += digits[byte >> 4U];
    text += digits[byte & 15U];
  }
  return text;
}

// A card's file as in the answer to +CRSM.
std::string fileAnswer(const std::string& hexadecimals) { return "+CRSM: 144,0,\"" + hexadecimals + "\""; }

std::string swapped(std::string digits) {
  if (digits.size() % 2 == 1) digits += 'F';
  for (std::size_t index = 0; index + 1 < digits.size(); index += 2) std::swap(digits[index], digits[index + 1]);
  return digits;
}

// Commands without an effect here.
bool isSetting(const std::string& command) {
  for (const std::string_view each :
       {"ATE0", "ATV1", "ATX4", "AT&C1", "ATZ", "AT+CMEE=1", "AT+CFUN=1", "AT+CREG=2", "AT+CGREG=2", "AT+CEREG=2",
        "AT+CREG=0", "AT+CGREG=0", "AT+CEREG=0", "AT+COPS=3,2", "AT+COPS=3,0", "AT"}) {
    if (command == each) return true;
  }
  return false;
}

}  // namespace

FakeModem::FakeModem() : name_(uniqueName()), listening_(listenAt(name_)), wake_(::eventfd(0, EFD_CLOEXEC)) {
  thread_ = std::thread([this] { run(); });
}

FakeModem::~FakeModem() {
  {
    const std::lock_guard lock(mutex_);
    stopping_ = true;
  }
  const std::uint64_t one = 1;
  [[maybe_unused]] const ssize_t ignored = ::write(wake_, &one, sizeof one);
  thread_.join();
  ::close(listening_);
  ::close(wake_);
}

void FakeModem::set(const Facts& facts) {
  {
    const std::lock_guard lock(mutex_);
    const bool moved = facts.registration != facts_.registration || facts.technology != facts_.technology ||
                       facts.area != facts_.area || facts.cellId != facts_.cellId;
    facts_ = facts;
    if (moved) {
      for (const char* command : {"+CREG", "+CGREG", "+CEREG"}) {
        unasked_ += "\r\n" + registrationOf(command, false) + "\r\n";
      }
    }
  }
  const std::uint64_t one = 1;
  [[maybe_unused]] const ssize_t ignored = ::write(wake_, &one, sizeof one);
}

FakeModem::Facts FakeModem::facts() const {
  const std::lock_guard lock(mutex_);
  return facts_;
}

std::vector<std::string> FakeModem::commands() const {
  const std::lock_guard lock(mutex_);
  return commands_;
}

// Accepts again after each close: ModemManager reopens the port for each stage.
void FakeModem::run() {
  while (true) {
    std::array<pollfd, 2> ready = {{{listening_, POLLIN, 0}, {wake_, POLLIN, 0}}};
    ::poll(ready.data(), ready.size(), -1);
    if (ready[1].revents != 0) {
      std::uint64_t wakes = 0;
      [[maybe_unused]] const ssize_t ignored = ::read(wake_, &wakes, sizeof wakes);
      const std::lock_guard lock(mutex_);
      if (stopping_) return;
      unasked_.clear();  // no client is connected
    }
    if (ready[0].revents == 0) continue;
    const int descriptor = ::accept4(listening_, nullptr, nullptr, SOCK_CLOEXEC);
    if (descriptor < 0) continue;
    serve(descriptor);
    ::close(descriptor);
  }
}

void FakeModem::serve(int descriptor) {
  std::string received;
  while (true) {
    std::array<pollfd, 2> ready = {{{descriptor, POLLIN, 0}, {wake_, POLLIN, 0}}};
    ::poll(ready.data(), ready.size(), -1);
    std::string reply;
    if (ready[1].revents != 0) {
      const std::lock_guard lock(mutex_);
      if (stopping_) return;  // run() reads the wake-up
      std::uint64_t wakes = 0;
      [[maybe_unused]] const ssize_t ignored = ::read(wake_, &wakes, sizeof wakes);
      reply = std::exchange(unasked_, {});
    }
    if (ready[0].revents != 0) {
      std::array<char, 512> buffer;
      const ssize_t count = ::read(descriptor, buffer.data(), buffer.size());
      if (count <= 0) return;
      received.append(buffer.data(), static_cast<std::size_t>(count));
    }
    for (std::size_t end = received.find('\r'); end != std::string::npos; end = received.find('\r')) {
      std::string command = received.substr(0, end);
      received.erase(0, end + 1);
      command.erase(0, command.find_first_not_of('\n'));
      const std::lock_guard lock(mutex_);
      commands_.push_back(command);
      reply += answer(command);
    }
    [[maybe_unused]] const ssize_t ignored = ::send(descriptor, reply.data(), reply.size(), MSG_NOSIGNAL);
  }
}

std::string FakeModem::registrationOf(std::string_view command, bool asked) const {
  // Packet and EPS registration have separate answers; only that of the technology in use reports more than "not
  // registered".
  const bool lte = facts_.technology == 7;
  const bool concerned = command == "+CREG" || (command == "+CEREG") == lte;
  const int state = concerned ? facts_.registration : 0;
  std::string text = std::string(command) + (asked ? ": 2," : ": ") + std::to_string(state);
  if (state == 1 || state == 5) {
    text += ",\"" + facts_.area + "\",\"" + facts_.cellId + "\"," + std::to_string(facts_.technology);
  }
  return text;
}

std::string FakeModem::answer(const std::string& command) const {
  const auto content = [&]() -> std::string {
    if (command == "AT+GCAP") return "+GCAP: +CGSM";
    if (command == "AT+CGMI") return "Vespscope";
    if (command == "AT+CGMM") return "Fake Modem";
    if (command == "AT+CGMR") return "1";
    if (command == "AT+CGSN") return "490154203237518";
    if (command == "ATI") return "Vespscope Fake Modem";
    if (command == "AT+WS46=?") return "+WS46: (12,22,25,28,29)";
    if (command == "AT+CFUN?") return "+CFUN: 1";
    if (command == "AT+CPIN?") return "+CPIN: READY";
    if (command == "AT+CIMI") return facts_.imsi;
    if (command == "AT+CSQ") return "+CSQ: 20,99";
    if (command == "AT+CREG?" || command == "AT+CGREG?" || command == "AT+CEREG?") {
      return registrationOf(command.substr(2, command.size() - 3), true);
    }
    if (command == "AT+COPS?") {
      const bool registered = facts_.registration == 1 || facts_.registration == 5;
      if (!registered) return "+COPS: 0";
      return "+COPS: 0,2,\"" + facts_.network + "\"," + std::to_string(facts_.technology);
    }
    if (command == "AT+CESQ=?" && facts_.extendedSignal) {
      return "+CESQ: (0-63,99),(0-7,99),(0-96,255),(0-49,255),(0-34,255),(0-97,255)";
    }
    if (command == "AT+CESQ" && facts_.extendedSignal) {
      return "+CESQ: " + std::to_string(facts_.rxlev) + ",99," + std::to_string(facts_.rscp) + "," +
             std::to_string(facts_.ecno) + "," + std::to_string(facts_.rsrq) + "," + std::to_string(facts_.rsrp);
    }
    if (command == "AT+CRSM=176,12258,0,0,10") return fileAnswer(swapped(facts_.iccid + "F"));  // EF_ICCID
    if (command == "AT+CRSM=176,28589,0,0,4") return fileAnswer("00000002");                    // EF_AD
    if (command == "AT+CRSM=176,28486,0,0,17") {                                                // EF_SPN
      std::string name = facts_.providerName;
      name.resize(16, '\xFF');
      return fileAnswer("01" + hexadecimal(name));
    }
    return {};
  }();
  if (!content.empty()) return "\r\n" + content + "\r\n\r\nOK\r\n";
  return isSetting(command) ? "\r\nOK\r\n" : "\r\nERROR\r\n";
}

}  // namespace vespscope::test
