// The properties of ModemManager's objects, as last told: path, interface, name.
#pragma once

#include <map>
#include <string>
#include <vector>

#include "platform/ipc/IpcObject.h"
#include "sources/modemmanager/Told.h"

namespace vespscope::sources::modemmanager {

class ObjectTree {
 public:
  // Takes what GetManagedObjects answers, in place of all there was.
  void replace(const ipc::Dictionary& objects);
  // Adds the interfaces of one object, as InterfacesAdded carries them.
  void add(const std::string& path, const ipc::Dictionary& interfaces);
  void set(const std::string& path, const std::string& interface, const ipc::Dictionary& properties);
  void remove(const std::string& path, const ipc::Array& interfaces);
  void remove(const std::string& path) { objects_.erase(path); }
  // Takes a PropertiesChanged: what is invalidated is no longer known. An object not known yet is left alone: who asks
  // for it is answered with the present values.
  void change(const std::string& path, const std::string& interface, const ipc::Dictionary& changed,
              const ipc::Array& invalidated);
  void clear() { objects_.clear(); }

  [[nodiscard]] Told at(const std::string& path, const std::string& interface) const;
  [[nodiscard]] bool has(const std::string& path, const std::string& interface) const;
  [[nodiscard]] std::vector<std::string> pathsWith(const std::string& interface) const;

 private:
  [[nodiscard]] const ipc::Dictionary* find(const std::string& path, const std::string& interface) const;

  std::map<std::string, std::map<std::string, ipc::Dictionary>> objects_;
};

}  // namespace vespscope::sources::modemmanager
