#pragma once

#include "export/ExportResult.h"
#include "export/UserMessage.h"
#include "export/VersionSource.h"

#include <QDateTime>
#include <QString>

#include <functional>
#include <optional>

namespace verbloom {

/// The input of the "Save As XML file" window, as its boxes hold it.
struct RssExportOptions
{
    QString FileName;         ///< txtFileName
    QString Count;            ///< txtnoofrecord
    QString Url;              ///< txturl
    QString DescriptionChars; ///< txtnoofchr
};

/// The clock that stamps each item (QDateTime::currentDateTime in the program).
using Clock = std::function<QDateTime()>;

/// ValidateXmlForm: the first failing check as an OK message titled "Message", or nothing.
/// Empty means exactly ""; numbers are read with the given decimal point.
std::optional<UserMessage> ValidateXmlForm(const RssExportOptions &options,
                                           QChar decimalPoint = QLatin1Char('.'));

/// The description of an item: the whole contents when it has at most limit characters, else its
/// first limit characters (rounded halves to even; a cut never splits a surrogate pair); a
/// negative limit gives "".
QString RssDescription(const QString &contents, double limit);

/// "&", "<" and ">" as entities, for titles and links.
QString RssEscape(const QString &text);

/// The RFC 822 date of RSS 2.0 with English names and a numeric offset,
/// such as "Sun, 06 Dec 2026 14:03:09 +0100".
QString RssDate(const QDateTime &when);

/// The lines of one item, CR LF after each. A "]]>" inside the description is split across two
/// CDATA sections.
QString RssItem(const QString &title, const QString &url, const QString &description,
                const QDateTime &when);

/// The number of items of a form that passed ValidateXmlForm: 0 or less means nothing to do; a
/// number above 32767 is refused with "No of record should not be more than 32767".
struct RssItemCount
{
    qint16 Items = 0;
    std::optional<UserMessage> Refusal;
};
RssItemCount ReadRssItemCount(const RssExportOptions &options, QChar decimalPoint = QLatin1Char('.'));

/// cmdSave_Click without the window. XmlFileName is the trimmed file name; then ValidateXmlForm;
/// a count of 0 or less does nothing (NothingToDo, no message); a count above 32767 and a
/// file name of blanks are refused. FillArticleList then makes count rows, the first from the
/// boxes as they stand, the boxes receiving the next version after each row; once the title or
/// the contents is empty nothing more happens (no row, the boxes unchanged). The feed is
/// streamed into the file, which appears whole only when complete. The channel title is the
/// title of the next-to-last row. The last message asks whether to open the file; the window
/// closes whatever the answer.
ExportResult ExportRss(const RssExportOptions &options, ArticleBoxes &boxes, VersionSource &source,
                       const Clock &clock = &QDateTime::currentDateTime,
                       QChar decimalPoint = QLatin1Char('.'));

} // namespace verbloom
