#include "site/SiteConfig.h"

#include "common/Numbers.h"
#include "common/TextFile.h"

#include <QDir>
#include <QFileInfo>

namespace verbloom {

namespace {

const QString kSeparator = QStringLiteral("$$$");

enum class Field { Text, Template, Check };

struct Record
{
    const char16_t *Key;
    const char16_t *Label; ///< the option's label in the window, used when naming it
    Field Kind;
    QString SiteOptions::*Text;
    bool SiteOptions::*Check;
};

// The records of config.txt in stored order.
const Record kRecords[] = {
    {u"OF?", u"Output Folder:", Field::Text, &SiteOptions::OutputFolder, nullptr},
    {u"WPT?", u"Template:", Field::Template, &SiteOptions::Template, nullptr},
    {u"WPE?", u"File Extension:", Field::Text, &SiteOptions::FileExtension, nullptr},
    {u"RC?", u"Replace space by:", Field::Text, &SiteOptions::ReplaceChar, nullptr},
    {u"CI?", nullptr, Field::Check, nullptr, &SiteOptions::CreateIndex},
    {u"FSC?", nullptr, Field::Check, nullptr, &SiteOptions::FileNamesSmallCase},
    {u"CSM?", nullptr, Field::Check, nullptr, &SiteOptions::CreateSiteMap},
    {u"LC?", u"Number of links in menu per page:", Field::Text, &SiteOptions::LinkCount, nullptr},
    {u"NP?", u"Number of pages to generate:", Field::Text, &SiteOptions::NoOfPages, nullptr},
    {u"TOP?", u"Ad code for top of the page", Field::Text, &SiteOptions::TopCode, nullptr},
    {u"LEFT?", u"Ad code for the left of the page", Field::Text, &SiteOptions::LeftCode, nullptr},
    {u"BoTTOM?", u"Copyright and other content for the bottom of the page", Field::Text,
     &SiteOptions::BottomCode, nullptr},
    {u"RIGHT?", u"Ad code for the right of the page", Field::Text, &SiteOptions::RightCode, nullptr},
    {u"NAVLINK?", u"Navigation Link Name:", Field::Text, &SiteOptions::NavigationLinkName, nullptr},
};

constexpr qsizetype kRecordCount = sizeof(kRecords) / sizeof(kRecords[0]);

QString ValueText(const Record &record, const SiteOptions &options)
{
    if (record.Kind == Field::Check)
        return (options.*record.Check) ? QStringLiteral("1") : QStringLiteral("0");
    return options.*record.Text;
}

void ApplyRecord(const Record &record, const QString &value, const QStringList &templates,
                 SiteOptions &options)
{
    switch (record.Kind) {
    case Field::Text:
        options.*record.Text = value;
        break;
    case Field::Template:
        if (templates.contains(value))
            options.Template = value;
        break;
    case Field::Check: {
        const std::optional<qint16> state = TextToInt16(value);
        if (state && (*state == 0 || *state == 1))
            options.*record.Check = *state == 1;
        break;
    }
    }
}

} // namespace

const QStringList &ConfigKeys()
{
    static const QStringList keys = [] {
        QStringList list;
        for (const Record &record : kRecords)
            list.append(QString::fromUtf16(record.Key));
        return list;
    }();
    return keys;
}

QString ConfigFilePath(const QString &programFolder)
{
    return programFolder + QStringLiteral("/config.txt");
}

QString TemplatesFolder(const QString &programFolder)
{
    return programFolder + QStringLiteral("/templates");
}

QStringList ListTemplates(const QString &programFolder)
{
    const QDir folder(TemplatesFolder(programFolder));
    if (!folder.exists())
        return {};
    return folder.entryList(QDir::Files, QDir::Name | QDir::IgnoreCase);
}

SiteOptions DefaultSiteOptions(const QStringList &templates)
{
    SiteOptions options;
    if (!templates.isEmpty())
        options.Template = templates.first();
    return options;
}

QString ConfigText(const SiteOptions &options)
{
    QString text;
    for (const Record &record : kRecords)
        text += QString::fromUtf16(record.Key) + ValueText(record, options) + kSeparator;
    return text;
}

std::optional<UserMessage> CheckConfigValues(const SiteOptions &options)
{
    for (const Record &record : kRecords) {
        if (record.Kind == Field::Check)
            continue;
        // A "$" at the end would join the separator that follows and be lost on reading.
        const QString value = ValueText(record, options);
        if (value.contains(kSeparator) || value.endsWith(QLatin1Char('$'))) {
            return InformationMessage(QStringLiteral("The option \"") + QString::fromUtf16(record.Label)
                                      + QStringLiteral("\" contains \"$$$\" or ends with \"$\", which "
                                                       "config.txt cannot store. Please change it; nothing "
                                                       "was saved."));
        }
    }
    return std::nullopt;
}

std::optional<UserMessage> SaveConfig(const QString &programFolder, const SiteOptions &options)
{
    if (std::optional<UserMessage> refusal = CheckConfigValues(options))
        return refusal;
    const QString path = ConfigFilePath(programFolder);
    if (!WriteTextFile(path, ConfigText(options)))
        return FailureMessage(QStringLiteral("Config setting could not be saved as ") + path);
    return std::nullopt;
}

UserMessage ConfigSavedMessage()
{
    return InformationMessage(QStringLiteral("Config setting has been saved"));
}

void ApplyConfigText(const QString &text, const QStringList &templates, SiteOptions &options)
{
    const QStringList pieces = text.split(kSeparator);
    const qsizetype records = qMin(pieces.size() - 1, kRecordCount);
    for (qsizetype p = 0; p < records; ++p) {
        const QString &piece = pieces.at(p);
        const qsizetype mark = piece.indexOf(QLatin1Char('?'));
        if (mark < 0)
            continue;
        ApplyRecord(kRecords[p], piece.mid(mark + 1), templates, options);
    }
}

void ReadConfig(const QString &programFolder, const QStringList &templates, SiteOptions &options)
{
    if (!QFileInfo(programFolder).isDir())
        return;
    QString text;
    if (!TryReadTextFile(ConfigFilePath(programFolder), text))
        return;
    ApplyConfigText(text, templates, options);
}

SiteSettings LoadSettings(const QString &programFolder)
{
    SiteSettings settings;
    settings.Templates = ListTemplates(programFolder);
    settings.Options = DefaultSiteOptions(settings.Templates);
    ReadConfig(programFolder, settings.Templates, settings.Options);
    return settings;
}

UserMessage SaveContents(const QString &programFolder, const SiteOptions &options, QChar decimalPoint)
{
    if (std::optional<UserMessage> failure = ValidateOptions(options, decimalPoint))
        return *failure;
    if (std::optional<UserMessage> failure = SaveConfig(programFolder, options))
        return *failure;
    return ConfigSavedMessage();
}

std::optional<UserMessage> ValidateOptions(const SiteOptions &options, QChar decimalPoint)
{
    if (options.OutputFolder.isEmpty())
        return InformationMessage(QStringLiteral("Please browse output folder"));
    if (!QFileInfo(options.OutputFolder).isDir())
        return InformationMessage(QStringLiteral("Output folder does't exist"));
    if (options.FileExtension.isEmpty())
        return InformationMessage(QStringLiteral("Please enter the file extension"));
    if (options.LinkCount.isEmpty())
        return InformationMessage(QStringLiteral("Please specify number of links in menu per page"));
    if (!IsNumeric(options.LinkCount, decimalPoint))
        return InformationMessage(QStringLiteral("Number of links in menu per page should be numeric"));
    if (options.NoOfPages.isEmpty())
        return InformationMessage(QStringLiteral("Please specify number of pages to generate"));
    if (!IsNumeric(options.NoOfPages, decimalPoint))
        return InformationMessage(QStringLiteral("Number of pages to generate should be numeric"));
    const std::optional<qint16> pages = TextToInt16(options.NoOfPages, decimalPoint);
    if (!pages)
        return InformationMessage(QStringLiteral("Number of pages to generate should be between 0 and 32767"));
    return std::nullopt;
}

} // namespace verbloom
