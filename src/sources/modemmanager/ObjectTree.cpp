#include "sources/modemmanager/ObjectTree.h"

#include <algorithm>
#include <utility>

namespace vespscope::sources::modemmanager {

void ObjectTree::replace(const ipc::Dictionary& objects) {
  objects_.clear();
  for (const auto& [path, interfaces] : objects.entries()) {
    if (interfaces.asDictionary() != nullptr) add(path, *interfaces.asDictionary());
  }
}

void ObjectTree::add(const std::string& path, const ipc::Dictionary& interfaces) {
  for (const auto& [interface, properties] : interfaces.entries()) {
    if (properties.asDictionary() != nullptr) set(path, interface, *properties.asDictionary());
  }
}

void ObjectTree::set(const std::string& path, const std::string& interface, const ipc::Dictionary& properties) {
  objects_[path][interface] = properties;
}

void ObjectTree::remove(const std::string& path, const ipc::Array& interfaces) {
  const auto object = objects_.find(path);
  if (object == objects_.end()) return;
  for (const ipc::Object& interface : interfaces) {
    if (interface.asString() != nullptr) object->second.erase(*interface.asString());
  }
  if (object->second.empty()) objects_.erase(object);
}

void ObjectTree::change(const std::string& path, const std::string& interface, const ipc::Dictionary& changed,
                        const ipc::Array& invalidated) {
  const ipc::Dictionary* known = find(path, interface);
  if (known == nullptr) return;
  ipc::Dictionary properties;
  for (const auto& [name, value] : known->entries()) {
    const bool gone = std::any_of(invalidated.begin(), invalidated.end(), [&key = name](const ipc::Object& each) {
      return each.asString() != nullptr && *each.asString() == key;
    });
    if (!gone) properties.set(name, value);
  }
  for (const auto& [name, value] : changed.entries()) properties.set(name, value);
  objects_[path][interface] = std::move(properties);
}

const ipc::Dictionary* ObjectTree::find(const std::string& path, const std::string& interface) const {
  const auto object = objects_.find(path);
  if (object == objects_.end()) return nullptr;
  const auto found = object->second.find(interface);
  return found == object->second.end() ? nullptr : &found->second;
}

Told ObjectTree::at(const std::string& path, const std::string& interface) const { return Told(find(path, interface)); }

bool ObjectTree::has(const std::string& path, const std::string& interface) const {
  return find(path, interface) != nullptr;
}

std::vector<std::string> ObjectTree::pathsWith(const std::string& interface) const {
  std::vector<std::string> paths;
  for (const auto& [path, interfaces] : objects_) {
    if (interfaces.contains(interface)) paths.push_back(path);
  }
  return paths;
}

}  // namespace vespscope::sources::modemmanager
