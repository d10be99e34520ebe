// The names of ModemManager on the bus.
#pragma once

#include <string>

namespace vespscope::sources::modemmanager {

inline const std::string service = "org.freedesktop.ModemManager1";
inline const std::string rootPath = "/org/freedesktop/ModemManager1";

inline const std::string objectManagerInterface = "org.freedesktop.DBus.ObjectManager";
inline const std::string propertiesInterface = "org.freedesktop.DBus.Properties";

inline const std::string modemInterface = "org.freedesktop.ModemManager1.Modem";
inline const std::string modem3gppInterface = "org.freedesktop.ModemManager1.Modem.Modem3gpp";
inline const std::string locationInterface = "org.freedesktop.ModemManager1.Modem.Location";
inline const std::string signalInterface = "org.freedesktop.ModemManager1.Modem.Signal";
inline const std::string bearerInterface = "org.freedesktop.ModemManager1.Bearer";
inline const std::string simInterface = "org.freedesktop.ModemManager1.Sim";

}  // namespace vespscope::sources::modemmanager
