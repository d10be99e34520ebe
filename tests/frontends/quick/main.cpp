// Runs the tests of the phone interface without a display: offscreen windows with software rendering.
#include <QGuiApplication>
#include <clocale>
#include <cstdlib>

#include <gtest/gtest.h>

#include "platform/log/Log.h"

int main(int argc, char** argv) {
  ::testing::InitGoogleTest(&argc, argv);
  for (const char* variable :
       {"QT_SCALE_FACTOR", "QT_FONT_DPI", "QT_QUICK_CONTROLS_STYLE", "DBUS_SESSION_BUS_ADDRESS"}) {
    ::unsetenv(variable);
  }
  ::setenv("QT_QPA_PLATFORM", "offscreen", 1);
  ::setenv("QT_QUICK_BACKEND", "software", 1);
  ::setenv("LC_ALL", "C.UTF-8", 1);
  ::setenv("TZ", "UTC", 1);
  const QGuiApplication gui(argc, argv);
  vespscope::log::discardOutputs();
  return RUN_ALL_TESTS();
}
