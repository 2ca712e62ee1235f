#pragma once

#include <QString>

namespace verbloom {

/// The program folder's SETTINGS.INI, read with ReadIniValue (values are taken whole).
QString SettingsIniPath();

} // namespace verbloom
