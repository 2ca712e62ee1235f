#pragma once

#include <QString>

namespace verbloom {

/// Longest value taken from SETTINGS.INI; longer values are cut.
inline constexpr qsizetype MaxSettingLength = 79;

/// The program folder's SETTINGS.INI.
QString SettingsIniPath();

/// One value of SETTINGS.INI as the program shows or opens it: "" when missing, at most
/// MaxSettingLength characters.
QString ReadSetting(const QString &iniFile, const QString &section, const QString &key);

} // namespace verbloom
