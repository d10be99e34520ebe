// The last reported properties of ModemManager's objects: path, interface, name.
#pragma once

#include <map>
#include <string>
#include <vector>

#include "platform/ipc/IpcObject.h"
#include "sources/modemmanager/Told.h"

namespace vespscope::sources::modemmanager {

class ObjectTree {
 public:
  // Replaces all objects by the answer to GetManagedObjects.
  void replace(const ipc::Dictionary& objects);
  // Adds the interfaces of one object, from InterfacesAdded.
  void add(const std::string& path, const ipc::Dictionary& interfaces);
  void set(const std::string& path, const std::string& interface, const ipc::Dictionary& properties);
  void remove(const std::string& path, const ipc::Array& interfaces);
  void remove(const std::string& path) { objects_.erase(path); }
  // Applies a PropertiesChanged: invalidated properties become unknown. An unknown object is ignored: the answer to the
  // pending request contains its present values.
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
