#include "shell/AppIDValidator.h"

namespace vespscope {

bool AppIDValidator::check(const Record& dictionary) {
  const Value* found = dictionary.find(appIDKey);
  appID = found == nullptr ? std::nullopt : found->asInteger();
  return appID == 2;
}

}  // namespace vespscope
