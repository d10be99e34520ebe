#include "screens/VespViewItems.h"

#include "platform/log/Log.h"

namespace vespscope {

const VespViewItems& VespViewItems::shared() {
  static const VespViewItems items;
  return items;
}

std::map<std::string, VespViewItems::Rows> VespViewItems::dictionaryOf(
    std::vector<std::pair<std::string, Rows>> pairs) {
  std::map<std::string, Rows> dictionary;
  for (auto& [key, rows] : pairs) {
    if (!dictionary.emplace(key, std::move(rows)).second) log::fatal("the catalogue has \"" + key + "\" twice");
  }
  return dictionary;
}

}  // namespace vespscope
