// A modem controlled by a test: it answers AT commands on an abstract socket, where ModemManager's test mode looks for
// one, and reports changes without a request, as modems do.
#pragma once

#include <condition_variable>
#include <map>
#include <mutex>
#include <string>
#include <string_view>
#include <thread>
#include <vector>

namespace vespscope::test {

class FakeModem {
 public:
  // The modem's answers; the numbers are those of 3GPP TS 27.007.
  struct Facts {
    int registration = 1;             // <stat> of +CREG and similar: 1 home, 2 searching, 3 denied, 5 roaming
    int technology = 7;               // <AcT>: 0 GSM, 2 UTRAN, 7 E-UTRAN
    std::string area = "1A2B";        // location or tracking area code, in hexadecimal digits
    std::string cellId = "01C3D4E5";  // in hexadecimal digits
    std::string network = "00101";    // MCC and MNC
    int rxlev = 99;                   // of +CESQ, 99 and 255 unknown
    int rscp = 255;
    int ecno = 255;
    int rsrq = 20;
    int rsrp = 60;
    std::string iccid = "8999010000000000018";
    std::string imsi = "001010123456789";
    std::string providerName = "Test Network";
    bool extendedSignal = true;  // whether it supports +CESQ
  };

  FakeModem();
  FakeModem(const FakeModem&) = delete;
  FakeModem& operator=(const FakeModem&) = delete;
  ~FakeModem();

  // The port's name for ModemManager's SetProfile.
  [[nodiscard]] std::string port() const { return name_; }

  // Changes the answers from here on; a change of registration, area or cell is also reported without a request.
  void set(const Facts& facts);
  [[nodiscard]] Facts facts() const;

  // The commands received so far.
  [[nodiscard]] std::vector<std::string> commands() const;

 private:
  void run();
  void serve(int descriptor);
  [[nodiscard]] std::string answer(const std::string& command) const;
  [[nodiscard]] std::string registrationOf(std::string_view command, bool asked) const;

  const std::string name_;
  int listening_ = -1;
  int wake_ = -1;

  mutable std::mutex mutex_;
  Facts facts_;
  std::vector<std::string> commands_;
  std::string unasked_;  // to be written
  bool stopping_ = false;

  std::thread thread_;
};

}  // namespace vespscope::test
