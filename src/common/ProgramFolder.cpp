#include "ProgramFolder.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>

namespace verbloom {

namespace {

QString &Folder()
{
    static QString folder;
    return folder;
}

} // namespace

QString ProgramFolder()
{
    if (Folder().isEmpty() && QCoreApplication::instance())
        Folder() = QCoreApplication::applicationDirPath();
    return Folder();
}

void SetProgramFolder(const QString &folder)
{
    QString clean = QDir::cleanPath(QFileInfo(folder).absoluteFilePath());
    Folder() = clean;
}

QString HomeFolderArgument(const QStringList &arguments)
{
    const QString option = QStringLiteral("--home");
    for (qsizetype i = 0; i < arguments.size(); ++i) {
        const QString &arg = arguments[i];
        if (arg == option && i + 1 < arguments.size())
            return arguments[i + 1];
        if (arg.startsWith(option + QLatin1Char('=')))
            return arg.mid(option.size() + 1);
    }
    return {};
}

void InitProgramFolder(const QStringList &arguments)
{
    const QString home = HomeFolderArgument(arguments);
    if (home.isEmpty()) {
        SetProgramFolder(QCoreApplication::applicationDirPath());
        return;
    }
    QDir().mkpath(home);
    SetProgramFolder(home);
}

QString ProgramPath(const QString &relative)
{
    return ProgramFolder() + QLatin1Char('/') + relative;
}

QString SettingsIniPath()
{
    return ProgramPath(QStringLiteral("SETTINGS.INI"));
}

} // namespace verbloom
