#include "batch/BatchActions.h"

#include "batch/BatchConsole.h"
#include "common/Numbers.h"
#include "common/TextFile.h"
#include "engine/SpinGenerator.h"
#include "export/ExportResult.h"
#include "export/RssExport.h"
#include "export/SpinnerVersionSource.h"
#include "export/SqlExport.h"
#include "site/modGenerateWebPages.h"

#include <QDateTime>
#include <QFileInfo>
#include <QSaveFile>

namespace verbloom {

namespace {

/// Hands the spinner's versions on and shows how many were made.
class ProgressVersionSource final : public VersionSource
{
public:
    ProgressVersionSource(VersionSource &versions, BatchConsole &console, qsizetype total)
        : m_versions(versions)
        , m_console(console)
        , m_total(total)
    {
    }
    QString NextTitle() override
    {
        m_console.Progress(u"Making versions"_qs, ++m_made, m_total);
        return m_versions.NextTitle();
    }
    QString NextContents() override { return m_versions.NextContents(); }

private:
    VersionSource &m_versions;
    BatchConsole &m_console;
    qsizetype m_total;
    qsizetype m_made = 0;
};

/// Whether a file can be created at path, found by starting (and dropping) an atomic write:
/// the file itself is not touched.
std::optional<QString> CheckWritable(const QString &path)
{
    if (QFileInfo(path).isDir())
        return WriteFailedMessage(path, u"It is a folder."_qs).Text;
    QSaveFile probe(path);
    if (path.isEmpty() || path.contains(QChar(0)) || !probe.open(QIODevice::WriteOnly))
        return WriteFailedMessage(path, path.isEmpty() ? QString() : probe.errorString()).Text;
    probe.cancelWriting();
    return std::nullopt;
}

std::optional<QString> Failure(const ExportResult &result)
{
    if (result.Outcome == ExportResult::Status::Written)
        return std::nullopt;
    return result.Messages.isEmpty() ? u"Nothing was written."_qs : result.Messages.first().Text;
}

} // namespace

BatchActions::BatchActions(const BatchArguments &arguments, const QString &programFolder, QChar decimalPoint,
                           BatchConsole &console)
    : m_arguments(arguments)
    , m_programFolder(programFolder)
    , m_decimalPoint(decimalPoint)
    , m_console(console)
{
}

std::optional<QString> BatchActions::Check()
{
    switch (m_arguments.Action) {
    case BatchAction::Text:
        return CheckWritable(m_arguments.Output);
    case BatchAction::Sql:
        if (const std::optional<UserMessage> failure = ValidateSqlForm(m_arguments.Sql, m_decimalPoint))
            return failure->Text;
        return CheckWritable(m_arguments.Sql.FileName);
    case BatchAction::Rss:
        return CheckRss();
    case BatchAction::Site:
        return CheckSite();
    case BatchAction::ListNew:
    case BatchAction::None:
        break;
    }
    return std::nullopt;
}

std::optional<QString> BatchActions::CheckRss() const
{
    const RssExportOptions &options = m_arguments.Rss;
    if (const std::optional<UserMessage> failure = ValidateXmlForm(options, m_decimalPoint))
        return failure->Text;
    const RssItemCount count = ReadRssItemCount(options, m_decimalPoint);
    if (count.Refusal)
        return count.Refusal->Text;
    // The window does nothing for a count of 0 or less; a batch run says so.
    if (count.Items <= 0)
        return u"No of record should be between 1 and 32767"_qs;
    const QString path = options.FileName.trimmed();
    if (path.isEmpty())
        return u"Please enter file name"_qs;
    return CheckWritable(path);
}

std::optional<QString> BatchActions::CheckSite()
{
    const SiteSettings settings = LoadSettings(m_programFolder);
    const SiteOverrides &overrides = m_arguments.Site;
    m_site = settings.Options;
    m_site.OutputFolder = m_arguments.Output;
    while (m_site.OutputFolder.size() > 1 && m_site.OutputFolder.endsWith(QLatin1Char('/')))
        m_site.OutputFolder.chop(1);
    m_site.NoOfPages = overrides.Pages.value_or(m_site.NoOfPages);
    m_site.LinkCount = overrides.Links.value_or(m_site.LinkCount);
    m_site.FileExtension = overrides.Extension.value_or(m_site.FileExtension);
    if (overrides.Template) {
        if (!settings.Templates.contains(*overrides.Template)) {
            return u"The template \"%1\" is not in the folder %2"_qs.arg(*overrides.Template,
                                                                         TemplatesFolder(m_programFolder));
        }
        m_site.Template = *overrides.Template;
    } else if (settings.Templates.isEmpty()) {
        return u"There is no template in the folder "_qs + TemplatesFolder(m_programFolder);
    }

    const SiteGenerationCheck check = CheckSiteGeneration(m_site, m_decimalPoint);
    if (!check.Valid)
        return check.Messages.first().Text;
    if (const std::optional<UserMessage> refusal = CheckNavigationLinkName(m_site))
        return refusal->Text;
    // The window asks whether to go on; a batch run goes on only when told to.
    if (!check.Messages.isEmpty() && !m_arguments.Force) {
        return u"File already exist: %1/index.%2 (add --force to write the site over it)"_qs.arg(
            m_site.OutputFolder, m_site.FileExtension);
    }
    return std::nullopt;
}

std::optional<QString> BatchActions::Run(ArticleBoxes boxes, Spinner &spinner, const QStringList &newWords)
{
    SpinnerVersionSource versions(spinner);
    switch (m_arguments.Action) {
    case BatchAction::Text: {
        const QString text = spinner.SpinTitle() + u"\r\n\r\n"_qs + spinner.SpinContents();
        if (!WriteTextFile(m_arguments.Output, text))
            return WriteFailedMessage(m_arguments.Output, QString()).Text;
        return std::nullopt;
    }
    case BatchAction::Sql: {
        const qsizetype count = TextToInt16(m_arguments.Sql.Count, m_decimalPoint).value_or(0);
        ProgressVersionSource progress(versions, m_console, count);
        return Failure(ExportSql(m_arguments.Sql, boxes, progress, m_decimalPoint));
    }
    case BatchAction::Rss: {
        const qsizetype count = TextToInt16(m_arguments.Rss.Count.trimmed(), m_decimalPoint).value_or(0);
        ProgressVersionSource progress(versions, m_console, count);
        Clock clock = &QDateTime::currentDateTime;
        if (const std::optional<qint64> fixed = m_arguments.FixedDate)
            clock = [moment = *fixed] { return QDateTime::fromSecsSinceEpoch(moment); };
        return Failure(ExportRss(m_arguments.Rss, boxes, progress, clock, m_decimalPoint));
    }
    case BatchAction::Site: {
        const qsizetype count = TextToInt16(m_site.NoOfPages, m_decimalPoint).value_or(0);
        ProgressVersionSource progress(versions, m_console, count);
        const SiteRunResult result = GenerateWebSite(m_programFolder, m_site, boxes, progress, m_decimalPoint);
        if (!result.Messages.isEmpty())
            return result.Messages.first().Text;
        return std::nullopt;
    }
    case BatchAction::ListNew:
        for (const QString &word : newWords)
            m_console.Print(word + QLatin1Char('\n'));
        return std::nullopt;
    case BatchAction::None:
        break;
    }
    return std::nullopt;
}

} // namespace verbloom
