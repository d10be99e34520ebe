#include "platform/application/ScreenAge.h"

#include "platform/application/ClockText.h"

namespace vespscope::application {

Freshness freshnessOf(const ScreenAge& age) {
  if (!age.age) return Freshness::none;
  if (age.lastKnown) return Freshness::lastKnown;
  return age.measurement && *age.age > oldAfter ? Freshness::old : Freshness::current;
}

std::string screenAgeText(const ScreenAge& age) {
  switch (freshnessOf(age)) {
    case Freshness::none:
      return {};
    case Freshness::lastKnown:
      return "last known, " + agoText(*age.age);
    case Freshness::current:
    case Freshness::old:
      break;
  }
  return "updated " + agoText(*age.age);
}

}  // namespace vespscope::application
