#include "messages/Storage.h"

#include <string>

#include "platform/log/Log.h"

namespace vespscope {

RangeException::RangeException(std::size_t index, std::size_t count)
    : std::out_of_range("idx (" + std::to_string(index) + ") is out of range (" + std::to_string(count) + ")") {}

void stopOnAbsentElement() { log::fatal("an absent message was added to a repeated field"); }

}  // namespace vespscope
