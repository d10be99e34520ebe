#include "messages/WireMessage.h"

#include <cinttypes>
#include <cstdio>
#include <typeinfo>

#include "messages/WireWriter.h"
#include "platform/log/Log.h"
#include "values/Text.h"

namespace vespscope {
namespace {

void requireSameClass(const WireMessage& one, const WireMessage& other) {
  if (typeid(one) == typeid(other)) return;
  log::fatal(std::string(one.messageClass()) + " cannot take fields from or give them to " +
             std::string(other.messageClass()));
}

}  // namespace

Bytes WireMessage::encoded() const {
  WireWriter writer;
  writeTo(writer);
  return writer.takeBytes();
}

std::string WireMessage::description() const {
  char identity[32];
  std::snprintf(identity, sizeof identity, ": 0x%" PRIxPTR "> ", reinterpret_cast<std::uintptr_t>(this));
  std::string text = "<";
  text += messageClass();
  text += identity;
  appendText(text, dictionaryRepresentation());
  return text;
}

void WireMessage::copyTo(WireMessage& other) const {
  requireSameClass(*this, other);
  copyToSameClass(other);
}

void WireMessage::mergeFrom(const WireMessage& other) {
  requireSameClass(*this, other);
  mergeFromSameClass(other);
}

}  // namespace vespscope
