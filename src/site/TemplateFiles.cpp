#include "site/TemplateFiles.h"

#include "common/TextFile.h"
#include "site/SiteConfig.h"

#include <QDir>
#include <QFileInfo>

namespace verbloom {

namespace {

QString TemplatePath(const QString &programFolder, const QString &name)
{
    if (name.isEmpty() || name.contains(QLatin1Char('/')) || name.contains(QChar(0))
        || name == QLatin1String(".") || name == QLatin1String(".."))
        return QString();
    return TemplatesFolder(programFolder) + QLatin1Char('/') + name;
}

} // namespace

QString TemplateFilePath(const QString &programFolder, const QString &templateName)
{
    return TemplatePath(programFolder, templateName.trimmed());
}

QString TemplateReadPath(const QString &programFolder, const QString &templateName)
{
    return TemplatePath(programFolder, templateName);
}

QString ReadOrCreateTemplate(const QString &path)
{
    if (path.isEmpty())
        return QString();
    const QFileInfo info(path);
    if (!info.exists()) {
        if (info.dir().exists())
            WriteBinaryFile(path, QByteArray());
        return QString();
    }
    return ReadTextFile(path);
}

QString ReadTemplate(const QString &programFolder, const QString &templateName)
{
    return ReadOrCreateTemplate(TemplateReadPath(programFolder, templateName));
}

UserMessage SaveTemplate(const QString &path, const QString &text)
{
    if (!WriteTextFile(path, text))
        return FailureMessage(QStringLiteral("Template could not be saved as ") + path);
    return InformationMessage(QStringLiteral("Template has been Saved"));
}

QString PreviewFilePathFor(const QString &programFolder)
{
    return programFolder + QStringLiteral("/temp.htm");
}

QString WritePreviewFile(const QString &programFolder, const QString &text)
{
    const QString path = PreviewFilePathFor(programFolder);
    WriteTextFile(path, text);
    return path;
}

} // namespace verbloom
