#include "programs/Ground.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>

#include <cstring>
#include <fstream>
#include <iterator>
#include <optional>
#include <stdexcept>

#include <stdlib.h>

#include "capture/CaptureReader.h"

namespace vespscope::fuzz {
namespace {

namespace fs = std::filesystem;

std::string contentsOf(const fs::path& path) {
  std::ifstream file(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

int listenAt(const sockaddr* address, socklen_t size, int family) {
  const int descriptor = ::socket(family, SOCK_STREAM | SOCK_CLOEXEC, 0);
  if (::bind(descriptor, address, size) != 0 || ::listen(descriptor, 64) != 0) throw std::runtime_error("no socket");
  return descriptor;
}

// Empty when the capture can be read to its end.
std::optional<std::string> problemOf(const std::string& path) {
  auto reader = capture::CaptureReader::open(path);
  if (!reader) return reader.reason();
  while (true) {
    const auto event = reader->next();
    if (!event) return event.reason();
    if (!event->has_value()) return std::nullopt;
  }
}

}  // namespace

Ground::Ground(const fs::path& corpus) {
  std::string folder = (fs::temp_directory_path() / "vespscope-ground-XXXXXX").string();
  if (::mkdtemp(folder.data()) == nullptr) throw std::runtime_error("no folder");
  folder_ = folder;
  fs::create_directories(folder_ / "in" / "folder");
  fs::create_directories(folder_ / "in" / "empty");
  // What takes the place of ssh: it reads until nobody writes, and says nothing.
  fs::create_directories(folder_ / "bin");
  std::ofstream(folder_ / "bin" / "ssh") << "#!/bin/sh\nexec cat >/dev/null\n";
  fs::permissions(folder_ / "bin" / "ssh", fs::perms::owner_all);

  const std::string drive = contentsOf(corpus / "capture" / "drive.pcap");
  add("drive.pcap", drive, true);
  add("folder/a.pcap", drive, true);
  add("folder/b\x1b]0;planted\x07.pcap", drive.substr(0, drive.size() - 3));
  add("two\nlines.pcap", drive, true);
  add("not\xff\xfeutf8\xc2\x9b.pcap", drive, true);
  add("a,comma.pcap", drive, true);
  add("cut.pcap", drive.substr(0, drive.size() / 2 + 1));
  add("-dash.pcap", drive, true);
  add(std::string(240, 'l') + ".pcap", drive, true);
  add("nothing.pcap", "");
  add("zeros.pcap", std::string(5000, '\0'));
  for (const char* kind : {"capture", "diag", "unpacked", "configuration"}) {
    for (const fs::directory_entry& entry : fs::directory_iterator(corpus / kind)) {
      add(std::string(kind) + "-" + entry.path().filename().string(), contentsOf(entry.path()));
    }
  }
  ::mkfifo((folder_ / "in" / "pipe.pcap").c_str(), 0600);
  fs::create_symlink("loop", folder_ / "in" / "loop");
  fs::create_symlink("drive.pcap", folder_ / "in" / "link.pcap");
  for (const char* name : {"pipe.pcap", "loop", "link.pcap", "folder", "empty", "absent", "absent/x.pcap"}) {
    inputs_.push_back((folder_ / "in" / name).string());
  }
  for (const char* name :
       {"/dev/null", "/dev/zero", "/dev/full", "/dev/stdin", "/dev/tty", "/proc/self/fd/0", "/", "-", ""}) {
    inputs_.emplace_back(name);
  }

  for (const char* name : {"new.pcap", "new", "link.pcap", "absent/new.pcap", "old.pcap", "esc\x1b]0;planted\x07.pcap",
                           "new.partial.pcap", "folder"}) {
    outputs_.push_back((folder_ / "out" / name).string());
  }
  for (const char* name : {"-", "/dev/null", "/dev/full", ""}) outputs_.emplace_back(name);
  clear();

  sockaddr_un name{};
  name.sun_family = AF_UNIX;
  std::strncpy(name.sun_path, silentSocket().c_str(), sizeof name.sun_path - 1);
  listening_[0] = listenAt(reinterpret_cast<const sockaddr*>(&name), sizeof name, AF_UNIX);
  sockaddr_in port{};
  port.sin_family = AF_INET;
  port.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
  listening_[1] = listenAt(reinterpret_cast<const sockaddr*>(&port), sizeof port, AF_INET);
  socklen_t size = sizeof port;
  ::getsockname(listening_[1], reinterpret_cast<sockaddr*>(&port), &size);
  silentPort_ = ntohs(port.sin_port);
  before_ = contents();
}

Ground::~Ground() {
  for (const int descriptor : listening_) ::close(descriptor);
  std::error_code ignored;
  fs::remove_all(folder_, ignored);
}

void Ground::add(const std::string& name, const std::string& contents, bool isCapture) {
  const std::string path = (folder_ / "in" / name).string();
  std::ofstream(path, std::ios::binary) << contents;
  inputs_.push_back(path);
  if (isCapture) captures_.push_back(path);
}

void Ground::clear() const {
  const fs::path out = folder_ / "out";
  fs::remove_all(out);
  fs::create_directories(out / "folder");
  fs::copy_file(folder_ / "in" / "drive.pcap", out / "old.pcap");
  fs::create_symlink(folder_ / "in" / "drive.pcap", out / "link.pcap");
}

std::map<std::string, std::string> Ground::contents() const {
  std::map<std::string, std::string> all;
  for (const fs::directory_entry& entry : fs::recursive_directory_iterator(folder_ / "in")) {
    std::string& kept = all[entry.path().string()];
    const fs::file_status status = entry.symlink_status();
    if (fs::is_regular_file(status)) kept = contentsOf(entry.path());
    kept += static_cast<char>(status.type());
  }
  return all;
}

std::string Ground::changedInput() const {
  const std::map<std::string, std::string> now = contents();
  for (const auto& [path, text] : before_) {
    const auto place = now.find(path);
    if (place == now.end()) return path + " is gone";
    if (place->second != text) return path + " has changed";
  }
  return now.size() == before_.size() ? "" : "something is new among the inputs";
}

std::string Ground::badOutput() const {
  for (const fs::directory_entry& entry : fs::recursive_directory_iterator(folder_ / "out")) {
    const std::string name = entry.path().filename().string();
    const fs::file_status status = entry.symlink_status();
    if (fs::is_socket(status)) return entry.path().string() + ": the socket is left";
    if (!fs::is_regular_file(status) || name.find(".partial") != std::string::npos) continue;
    // Configurations, and a lock beside a socket, are no captures.
    if (name.find("deviceconfig") != std::string::npos || name.find("lock") != std::string::npos) continue;
    if (const auto problem = problemOf(entry.path().string())) return *problem;
  }
  return {};
}

}  // namespace vespscope::fuzz
