#include "SettingsIni.h"

#include "common/IniFile.h"
#include "common/ProgramFolder.h"

namespace verbloom {

QString SettingsIniPath()
{
    return ProgramPath(u"SETTINGS.INI"_qs);
}

QString ReadSetting(const QString &iniFile, const QString &section, const QString &key)
{
    return ReadIniValue(section, key, iniFile).left(MaxSettingLength);
}

} // namespace verbloom
