#include "support/ServiceBus.h"

#include <sys/stat.h>
#include <systemd/sd-bus.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <regex>
#include <stdexcept>

namespace vespscope::test {
namespace {

const std::filesystem::path packaging = std::filesystem::path(VESPSCOPE_PACKAGING);
constexpr const char* managerName = "org.vespscope.BasebandManager1";

std::string contentsOf(const std::filesystem::path& path) {
  std::ifstream file(path);
  if (!file) throw std::runtime_error("no " + path.string());
  return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

// The system's own configuration of its bus, with the test's paths.
std::string busConfiguration(const std::filesystem::path& folder) {
  std::string text = contentsOf("/usr/share/dbus-1/system.conf");
  for (const char* line :
       {"<user>[^<]*</user>", "<fork/>", "<standard_system_servicedirs/>", "<syslog/>",
        "<servicehelper>[^<]*</servicehelper>", "<pidfile>[^<]*</pidfile>", "<include[^>]*>[^<]*</include(dir)?>"}) {
    text = std::regex_replace(text, std::regex(line), "");
  }
  text = std::regex_replace(text, std::regex("<listen>[^<]*</listen>"),
                            "<listen>unix:path=" + (folder / "bus").string() + "</listen><servicedir>" +
                                (folder / "services").string() + "</servicedir>");
  return std::regex_replace(text, std::regex("</busconfig>"),
                            "<includedir>" + (folder / "policies").string() + "</includedir></busconfig>");
}

// The installed policy, for an existing group and for the user who runs the test.
std::string policy() {
  std::string text = contentsOf(packaging / "dbus/org.vespscope.BasebandManager1.conf");
  text =
      std::regex_replace(text, std::regex("group=\"vespscope\""), std::string("group=\"") + ServiceBus::group + "\"");
  return std::regex_replace(text, std::regex("user=\"root\""), "user=\"" + std::to_string(::geteuid()) + "\"");
}

std::string activation(const std::vector<std::string>& activated) {
  std::string command;
  for (const std::string& word : activated) command += (command.empty() ? "" : " ") + word;
  return std::regex_replace(contentsOf(packaging / "dbus/org.vespscope.BasebandManager1.service.in"),
                            std::regex("Exec=[^\n]*"), "Exec=" + command);
}

}  // namespace

ServiceBus::ServiceBus(const std::vector<std::string>& activated)
    : PrivateBus([&activated](const TemporaryFolder& folder) {
        // Other users of the bus must be able to reach its socket.
        ::chmod(folder.path().c_str(), 0755);
        std::filesystem::create_directory(folder.path() / "services");
        std::filesystem::create_directory(folder.path() / "policies");
        folder.write("policies/manager.conf", policy());
        if (!activated.empty())
          folder.write(std::string("services/") + managerName + ".service", activation(activated));
        return busConfiguration(folder.path());
      }) {}

pid_t ServiceBus::managerProcess() const {
  sd_bus* bus = nullptr;
  sd_bus_message* reply = nullptr;
  std::uint32_t process = 0;
  if (sd_bus_open_system(&bus) >= 0 &&
      sd_bus_call_method(bus, "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus",
                         "GetConnectionUnixProcessID", nullptr, &reply, "s", managerName) >= 0) {
    sd_bus_message_read(reply, "u", &process);
  }
  sd_bus_message_unref(reply);
  sd_bus_close_unref(bus);
  return static_cast<pid_t>(process);
}

}  // namespace vespscope::test
