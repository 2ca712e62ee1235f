#include "site/modGenerateWebPages.h"

#include "common/Numbers.h"
#include "common/TextFile.h"
#include "export/VersionSpool.h"
#include "site/TemplateFiles.h"

#include <QFileInfo>

namespace verbloom {

namespace {

// The cleaner's steps; the opening brace comes twice.
constexpr char16_t kCleanedCharacters[] = u" ',&~!@#$%^*)-=+{}[]:<{>.?/\\";
constexpr qsizetype kCleanedSteps = sizeof(kCleanedCharacters) / sizeof(char16_t) - 1;
static_assert(kCleanedSteps == 28);

constexpr qsizetype kMaxCleanedLength = 65536;
constexpr qsizetype kMaxListedFailures = 10;

bool WritePage(const QString &path, const QString &text, SiteRunResult &result)
{
    const bool ok = WriteTextFile(path, text);
    if (ok)
        ++result.FilesWritten;
    else
        result.FailedFiles.append(path);
    return ok;
}

UserMessage FailedFilesMessage(const SiteRunResult &result)
{
    const qsizetype total = result.FilesWritten + result.FailedFiles.size();
    QString text = QString::number(result.FailedFiles.size()) + QStringLiteral(" of ") + QString::number(total)
        + QStringLiteral(" files could not be written:");
    for (qsizetype i = 0; i < result.FailedFiles.size() && i < kMaxListedFailures; ++i)
        text += QStringLiteral("\r\n") + result.FailedFiles.at(i);
    if (result.FailedFiles.size() > kMaxListedFailures)
        text += QStringLiteral("\r\n...");
    return FailureMessage(text);
}

SiteRunResult Refusal(const QString &text)
{
    SiteRunResult result;
    result.Refused = true;
    result.Messages.append(InformationMessage(text));
    return result;
}

} // namespace

QString CleanFileName(const QString &text, const QString &replacement, bool *tooLong)
{
    if (tooLong)
        *tooLong = false;
    QString cleaned = text;
    for (qsizetype step = 0; step < kCleanedSteps; ++step) {
        const QChar c(kCleanedCharacters[step]);
        const qsizetype occurrences = cleaned.count(c);
        if (occurrences == 0)
            continue;
        if (cleaned.size() + occurrences * (replacement.size() - 1) > kMaxCleanedLength) {
            if (tooLong)
                *tooLong = true;
            break;
        }
        cleaned.replace(c, replacement);
    }
    return cleaned;
}

QString LineBreaksToHtml(const QString &text)
{
    QString html = text;
    html.replace(QStringLiteral("\r\n"), QStringLiteral("<br>"));
    html.replace(QLatin1Char('\n'), QStringLiteral("<br>"));
    return html;
}

QString FillTemplate(const QString &templateText, const SiteOptions &options, const QString &title,
                     const QString &content, const QString &navigation)
{
    QString page = templateText;
    page.replace(QStringLiteral("#TITLE#"), title);
    page.replace(QStringLiteral("#LEFTADCODE#"), options.LeftCode);
    page.replace(QStringLiteral("#BOTTOMADCODE#"), options.BottomCode);
    page.replace(QStringLiteral("#TOPADCODE#"), options.TopCode);
    page.replace(QStringLiteral("#RIGHTADCODE#"), options.RightCode);
    page.replace(QStringLiteral("#CONTENT#"), content);
    page.replace(QStringLiteral("#NAV_LINK#"), navigation);
    return page;
}

qsizetype LinksPerPage(const QString &linkCountText)
{
    return ToInt16(Val(linkCountText)).value_or(0);
}

QString BuildNavigationMenu(const QStringList &pageNames, qsizetype &menuPosition, const QString &caption,
                            const QString &extension, qsizetype linksPerPage, const QString &replacement)
{
    QString menu;
    if (pageNames.isEmpty())
        return menu;
    for (qsizetype link = 0; link < linksPerPage; ++link) {
        if (menuPosition < 0 || menuPosition >= pageNames.size())
            menuPosition = 0;
        const QString &name = pageNames.at(menuPosition);
        if (name.isEmpty())
            continue;
        menu += QStringLiteral("&rsaquo;&rsaquo;<a href ='") + CleanFileName(name, replacement) + QLatin1Char('.')
            + extension + QStringLiteral("'>") + caption + QString::number(menuPosition + 1)
            + QStringLiteral("</a><br>");
        menuPosition = menuPosition + 1 == pageNames.size() ? 0 : menuPosition + 1;
    }
    return menu;
}

QString SiteMapLink(const QString &extension)
{
    return QStringLiteral("<br><a href ='sitemap.") + extension
        + QStringLiteral("' style='text-decoration:none;'>&nbsp;&nbsp;&nbsp;&nbsp;&nbsp;Site Map</a><br>");
}

QString SiteMapList(const QStringList &pageNames, const QString &caption, const QString &extension)
{
    QString list;
    for (qsizetype j = 0; j < pageNames.size(); ++j) {
        list += QStringLiteral("<li><a href ='") + pageNames.at(j) + QLatin1Char('.') + extension
            + QStringLiteral("'>") + caption + QString::number(j + 1) + QStringLiteral("</a><br>");
    }
    return list;
}

SiteGenerationCheck CheckSiteGeneration(const SiteOptions &options, QChar decimalPoint)
{
    SiteGenerationCheck check;
    std::optional<UserMessage> failure = ValidateOptions(options, decimalPoint);
    if (!failure)
        failure = CheckConfigValues(options);
    if (failure)
        check.Messages.append(*failure);
    check.Valid = !failure;
    if (QFileInfo::exists(options.OutputFolder + QStringLiteral("/index.") + options.FileExtension)) {
        check.Messages.append(UserMessage{QStringLiteral("File already exist!!!! Do you wand to continue"),
                                          ProgramTitle(), UserMessage::Icon::Critical,
                                          UserMessage::Buttons::YesNo});
    }
    return check;
}

UserMessage WebPagesQuestion(const SiteOptions &options)
{
    return UserMessage{QStringLiteral("Web pages will be generated in \r\n") + options.OutputFolder, MessageTitle(),
                       UserMessage::Icon::Information, UserMessage::Buttons::OkCancel};
}

std::optional<UserMessage> CheckNavigationLinkName(const SiteOptions &options, QString *caption)
{
    bool tooLong = false;
    const QString cleaned = CleanFileName(options.NavigationLinkName, options.ReplaceChar, &tooLong);
    if (caption)
        *caption = cleaned;
    if (!tooLong)
        return std::nullopt;
    return InformationMessage(QStringLiteral("The navigation link name grows too long when its characters are "
                                             "replaced by \"")
                              + options.ReplaceChar + QLatin1Char('"'));
}

SiteRunResult GenerateWebSite(const QString &programFolder, const SiteOptions &options, ArticleBoxes &boxes,
                              VersionSource &source, QChar decimalPoint)
{
    // A count below 0 makes no pages, as 0 does; only one outside 16 bits is refused.
    const std::optional<qint16> pages = TextToInt16(options.NoOfPages, decimalPoint);
    if (!pages)
        return Refusal(QStringLiteral("Number of pages to generate should be between 0 and 32767"));
    QString caption;
    if (const std::optional<UserMessage> refusal = CheckNavigationLinkName(options, &caption))
        return Refusal(refusal->Text);

    SiteRunResult result;
    const QString folder = options.OutputFolder + QLatin1Char('/');
    const QString extension = options.FileExtension;

    // GeneratePageVersions and CollectPageNames: the versions wait in the spool, the names stay
    // in memory so that every menu can link forward.
    VersionSpool versions;
    for (qsizetype i = 1; i <= *pages; ++i) {
        if (!boxes.Title.isEmpty() && !boxes.Contents.isEmpty()) {
            const QString name = QStringLiteral("page") + QString::number(i);
            if (versions.Append(boxes.Title, boxes.Contents))
                result.PageNames.append(name);
            else
                result.FailedFiles.append(folder + name + QLatin1Char('.') + extension);
        }
        AdvanceBoxes(boxes, source);
    }

    // WritePages.
    const QString templateText = ReadTemplate(programFolder, options.Template);
    const qsizetype linksPerPage = LinksPerPage(options.LinkCount);
    if (options.FileNamesSmallCase)
        caption = caption.toLower();

    QString title;
    QString contents;
    QString menu;
    QString firstPagePath;
    bool firstPageWritten = false;
    versions.Rewind();
    for (qsizetype row = 0; row < result.PageNames.size(); ++row) {
        QString rowTitle;
        QString rowContents;
        const QString path = folder + result.PageNames.at(row) + QLatin1Char('.') + extension;
        if (!versions.Next(rowTitle, rowContents)) {
            result.FailedFiles.append(path);
            continue;
        }
        menu = BuildNavigationMenu(result.PageNames, result.MenuPosition, caption, extension, linksPerPage,
                                   options.ReplaceChar);
        if (options.CreateSiteMap)
            menu += SiteMapLink(extension);
        title = LineBreaksToHtml(rowTitle);
        contents = LineBreaksToHtml(rowContents);
        const bool written = WritePage(path, FillTemplate(templateText, options, title, contents, menu), result);
        if (row == 0) {
            firstPagePath = path;
            firstPageWritten = written;
        }
    }

    QString indexPath;
    bool indexWritten = false;
    if (options.CreateIndex) {
        indexPath = folder + QStringLiteral("index.") + extension;
        indexWritten = WritePage(indexPath, FillTemplate(templateText, options, title, contents, menu), result);
    }
    if (options.CreateSiteMap) {
        WritePage(folder + QStringLiteral("sitemap.") + extension,
                  FillTemplate(templateText, options, QStringLiteral("Site map"),
                               SiteMapList(result.PageNames, caption, extension), QString()),
                  result);
    }

    if (options.CreateIndex ? indexWritten : firstPageWritten)
        result.OpenPath = options.CreateIndex ? indexPath : firstPagePath;
    if (!result.FailedFiles.isEmpty())
        result.Messages.append(FailedFilesMessage(result));
    return result;
}

} // namespace verbloom
