#pragma once

#include "export/UserMessage.h"
#include "export/VersionSource.h"
#include "site/SiteConfig.h"

#include <QList>
#include <QString>
#include <QStringList>

#include <optional>

namespace verbloom {

/// CleanFileName: replaces, in 28 steps in this order, every blank, "'", ",", "&", "~", "!", "@",
/// "#", "$", "%", "^", "*", ")", "-", "=", "+", "{", "}", "[", "]", ":", "<", "{", ">", ".", "?",
/// "/" and "\" by the replacement, one pass per step (later steps see what earlier ones put in).
/// A replacement that would make the text longer than 65536 characters stops the cleaning
/// there and sets *tooLong.
QString CleanFileName(const QString &text, const QString &replacement, bool *tooLong = nullptr);

/// Refuses a navigation link name that cleaning would grow beyond what a page can hold; gives the
/// cleaned caption through `caption` when asked.
std::optional<UserMessage> CheckNavigationLinkName(const SiteOptions &options, QString *caption = nullptr);

/// Every CR LF, then every remaining LF, as "<br>".
QString LineBreaksToHtml(const QString &text);

/// The template with its seven placeholders replaced in this order, each on the result of the one
/// before: "#TITLE#", "#LEFTADCODE#", "#BOTTOMADCODE#", "#TOPADCODE#", "#RIGHTADCODE#",
/// "#CONTENT#", "#NAV_LINK#". The HTML blocks come from the options as typed.
QString FillTemplate(const QString &templateText, const SiteOptions &options, const QString &title,
                     const QString &content, const QString &navigation);

/// The links per page: the leading number of the text (Val) rounded halves to even; 0 when it
/// does not fit 16 bits.
qsizetype LinksPerPage(const QString &linkCountText);

/// BuildNavigationMenu: linksPerPage links from pageNames starting at menuPosition, which moves on
/// and wraps round; each link is "&rsaquo;&rsaquo;<a href ='" + cleaned name + "." + extension +
/// "'>" + caption + (position + 1) + "</a><br>". No page names give an empty menu.
QString BuildNavigationMenu(const QStringList &pageNames, qsizetype &menuPosition, const QString &caption,
                            const QString &extension, qsizetype linksPerPage, const QString &replacement);

/// The link to the site map appended to every content page's menu when the site map is made.
QString SiteMapLink(const QString &extension);

/// The site map's list: one "<li><a href ='name.ext'>" + caption + j + "</a><br>" per page.
QString SiteMapList(const QStringList &pageNames, const QString &caption, const QString &extension);

/// The checks of the generation command before anything is done.
struct SiteGenerationCheck
{
    /// In order: the failure of ValidateOptions or of the "$$$" check (OK, "Message"), then, when
    /// output folder + "/index." + extension exists, the question "File already exist!!!! Do you
    /// wand to continue" (Yes/No, critical icon, the program's title), asked whatever the checks gave.
    QList<UserMessage> Messages;
    /// The run may go on when this is true and the question, if asked, was not answered No.
    bool Valid = false;
};

SiteGenerationCheck CheckSiteGeneration(const SiteOptions &options, QChar decimalPoint = QLatin1Char('.'));

/// "Web pages will be generated in " CR LF + output folder, OK/Cancel, titled "Message": asked
/// after SaveConfig; the run goes on with OK.
UserMessage WebPagesQuestion(const SiteOptions &options);

/// What a site run did.
struct SiteRunResult
{
    bool Refused = false;       ///< the page count or link name was refused; nothing was done
    QStringList PageNames;      ///< PageNames after the run ("page1", "page2", ...)
    qsizetype MenuPosition = 0; ///< MenuPosition after the run
    qsizetype FilesWritten = 0;
    QStringList FailedFiles;    ///< files that could not be written
    QList<UserMessage> Messages; ///< to show at the end: a refusal, or the count of failed files
    /// To hand to the shell's "open" at the end (no question): the index page, or without the
    /// index option the first content page; empty when that file was not written.
    QString OpenPath;
};

/// GenerateWebSite: GeneratePageVersions (one page "page" + i per version i = 1..N whose title and
/// contents are both non-empty; the first from the boxes as they stand, which end holding one
/// more version), CollectPageNames, then WritePages: every content page from the template read
/// once, its menu, the site map link, its title and contents; the index page (the last content
/// page again) and the site map when their options are on. Versions are kept on disk between the
/// two passes, so memory does not grow with the number of pages. Each file is written whole;
/// files that fail are counted and reported.
SiteRunResult GenerateWebSite(const QString &programFolder, const SiteOptions &options, ArticleBoxes &boxes,
                              VersionSource &source, QChar decimalPoint = QLatin1Char('.'));

} // namespace verbloom
