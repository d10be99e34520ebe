// A socket between clients and a manager that passes everything on, until it is cut in the middle of a message or
// stands still.
#pragma once

#include <atomic>
#include <cstdint>
#include <list>
#include <mutex>
#include <string>
#include <thread>

namespace vespscope::test {

class Way {
 public:
  // Clients connect to `path`; each is passed on to the manager at `manager`.
  Way(std::string path, std::string manager);
  Way(const Way&) = delete;
  Way& operator=(const Way&) = delete;
  ~Way();

  // Cuts every connection behind the next bytes that come from the manager: all but a part of them are lost.
  void cut() { cutting_ = true; }
  void stand(bool still) { still_ = still; }
  [[nodiscard]] std::uint64_t cuts() const { return cuts_; }

 private:
  // Bytes on their way from one end to the other.
  struct Stream {
    int from = -1;
    int to = -1;
    std::string waiting;
  };
  struct Pair {
    Stream up;    // to the manager
    Stream down;  // to the client
  };

  void run();
  void accept();
  // False when the connection is over.
  bool move(Stream& stream, bool cut) const;

  const std::string path_;
  const std::string manager_;
  int listening_ = -1;
  std::list<Pair> pairs_;
  std::atomic<bool> cutting_ = false;
  std::atomic<bool> still_ = false;
  std::atomic<bool> stopping_ = false;
  std::atomic<std::uint64_t> cuts_ = 0;
  std::thread thread_;
};

// A stream socket that is connected to `path`; -1 when it cannot be.
[[nodiscard]] int connectTo(const std::string& path);

}  // namespace vespscope::test
