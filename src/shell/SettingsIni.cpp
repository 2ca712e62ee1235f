#include "SettingsIni.h"

#include "common/ProgramFolder.h"

namespace verbloom {

QString SettingsIniPath()
{
    return ProgramPath(u"SETTINGS.INI"_qs);
}

} // namespace verbloom
