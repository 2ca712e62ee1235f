#pragma once

#include <QString>
#include <QStringList>

namespace verbloom {

/// The folder every relative path of the program starts from: the executable's folder,
/// or the folder named with "--home DIR". No trailing separator.
QString ProgramFolder();

/// Sets the program folder explicitly (start-up and tests).
void SetProgramFolder(const QString &folder);

/// The value of "--home DIR" (or "--home=DIR") in the arguments; empty when absent.
QString HomeFolderArgument(const QStringList &arguments);

/// Sets the program folder from the arguments: "--home DIR" when given, else the folder that
/// holds the executable. The folder is created when it does not exist.
void InitProgramFolder(const QStringList &arguments);

/// ProgramFolder() + "/" + relative.
QString ProgramPath(const QString &relative);

/// The program folder's SETTINGS.INI (read with ReadIniValue; values are taken whole).
QString SettingsIniPath();

} // namespace verbloom
