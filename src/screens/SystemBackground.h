// The background of every screen on platforms whose background adapts to light and dark.
#pragma once

#include "platform/application/System.h"
#include "platform/application/TableViewController.h"

namespace vespscope {

inline void adoptSystemBackground(application::ViewController& screen) {
  if (application::isPlatformAtLeast({13, 0, 0})) screen.setBackgroundColour(application::Colour::systemBackground);
}

}  // namespace vespscope
