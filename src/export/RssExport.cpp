#include "export/RssExport.h"

#include "common/Numbers.h"
#include "export/VersionSpool.h"

#include <QSaveFile>

namespace verbloom {

namespace {

const QString kCrLf = QStringLiteral("\r\n");

QString FeedStart(const QString &channelTitle, const QString &url)
{
    return QStringLiteral("<rss version='2.0'>\r\n  <channel>\r\n      <title>") + RssEscape(channelTitle)
        + QStringLiteral("</title>\r\n      <link>") + RssEscape(url) + QStringLiteral("</link>\r\n");
}

QString FeedEnd()
{
    return QStringLiteral("\r\n  </channel>\r\n</rss>\r\n");
}

bool WriteUtf8(QSaveFile &file, const QString &text)
{
    const QByteArray bytes = text.toUtf8();
    return file.write(bytes) == bytes.size();
}

ExportResult Refused(const QString &path, const QString &text)
{
    ExportResult result;
    result.FileName = path;
    result.Outcome = ExportResult::Status::Invalid;
    result.Messages.append(InformationMessage(text));
    return result;
}

} // namespace

std::optional<UserMessage> ValidateXmlForm(const RssExportOptions &options, QChar decimalPoint)
{
    if (options.FileName.isEmpty())
        return InformationMessage(QStringLiteral("Please enter file name"));
    if (options.Count.isEmpty())
        return InformationMessage(QStringLiteral("Please enter no of record"));
    if (!IsNumeric(options.Count, decimalPoint))
        return InformationMessage(QStringLiteral("No of record should be numeric"));
    if (options.Url.isEmpty())
        return InformationMessage(QStringLiteral("Please enter url"));
    if (options.DescriptionChars.isEmpty())
        return InformationMessage(QStringLiteral("Please enter no of character for description"));
    if (!IsNumeric(options.DescriptionChars, decimalPoint))
        return InformationMessage(QStringLiteral("no of character for description should be numeric"));
    return std::nullopt;
}

QString RssDescription(const QString &contents, double limit)
{
    if (static_cast<double>(contents.size()) <= limit)
        return contents;
    const double rounded = RoundHalfEven(limit);
    if (!(rounded > 0))
        return QString();
    qsizetype length = static_cast<qsizetype>(rounded);
    if (contents.at(length - 1).isHighSurrogate())
        --length;
    return contents.left(length);
}

QString RssEscape(const QString &text)
{
    QString escaped;
    escaped.reserve(text.size());
    for (const QChar c : text) {
        if (c == QLatin1Char('&'))
            escaped += QStringLiteral("&amp;");
        else if (c == QLatin1Char('<'))
            escaped += QStringLiteral("&lt;");
        else if (c == QLatin1Char('>'))
            escaped += QStringLiteral("&gt;");
        else
            escaped += c;
    }
    return escaped;
}

QString RssDate(const QDateTime &when)
{
    static const char *const kDays[] = {"Mon", "Tue", "Wed", "Thu", "Fri", "Sat", "Sun"};
    static const char *const kMonths[] = {"Jan", "Feb", "Mar", "Apr", "May", "Jun",
                                          "Jul", "Aug", "Sep", "Oct", "Nov", "Dec"};
    const QDate date = when.date();
    const QTime time = when.time();
    const int offsetMinutes = when.offsetFromUtc() / 60;
    const int absMinutes = offsetMinutes < 0 ? -offsetMinutes : offsetMinutes;
    const auto twoDigits = [](int value) { return QString::number(value).rightJustified(2, QLatin1Char('0')); };
    return QLatin1String(kDays[date.dayOfWeek() - 1]) + QStringLiteral(", ") + twoDigits(date.day())
        + QLatin1Char(' ') + QLatin1String(kMonths[date.month() - 1]) + QLatin1Char(' ')
        + QString::number(date.year()).rightJustified(4, QLatin1Char('0')) + QLatin1Char(' ')
        + twoDigits(time.hour()) + QLatin1Char(':') + twoDigits(time.minute()) + QLatin1Char(':')
        + twoDigits(time.second()) + QLatin1Char(' ') + QLatin1Char(offsetMinutes < 0 ? '-' : '+')
        + twoDigits(absMinutes / 60) + twoDigits(absMinutes % 60);
}

QString RssItem(const QString &title, const QString &url, const QString &description,
                const QDateTime &when)
{
    QString safeDescription = description;
    safeDescription.replace(QStringLiteral("]]>"), QStringLiteral("]]]]><![CDATA[>"));
    return QStringLiteral("      <item>\r\n         <title>") + RssEscape(title)
        + QStringLiteral("</title>\r\n         <link>") + RssEscape(url)
        + QStringLiteral("</link>\r\n         <description><![CDATA[ \r\n") + safeDescription
        + QStringLiteral("\r\n]]></description>\r\n         <pubDate>") + RssDate(when)
        + QStringLiteral("</pubDate>\r\n      </item>\r\n");
}

RssItemCount ReadRssItemCount(const RssExportOptions &options, QChar decimalPoint)
{
    const double value = ParseNumber(options.Count.trimmed(), decimalPoint).value_or(0.0);
    const std::optional<qint16> count = ToInt16(value);
    RssItemCount result;
    if (!count && value > 0)
        result.Refusal = InformationMessage(QStringLiteral("No of record should not be more than 32767"));
    else
        result.Items = count.value_or(0);
    return result;
}

ExportResult ExportRss(const RssExportOptions &options, ArticleBoxes &boxes, VersionSource &source,
                       const Clock &clock, QChar decimalPoint)
{
    const QString path = options.FileName.trimmed();
    if (const std::optional<UserMessage> failure = ValidateXmlForm(options, decimalPoint)) {
        ExportResult result;
        result.FileName = path;
        result.Messages.append(*failure);
        return result;
    }
    const RssItemCount count = ReadRssItemCount(options, decimalPoint);
    if (count.Refusal)
        return Refused(path, count.Refusal->Text);
    if (count.Items <= 0) {
        ExportResult result;
        result.FileName = path;
        result.Outcome = ExportResult::Status::NothingToDo;
        return result;
    }
    if (path.isEmpty())
        return Refused(path, QStringLiteral("Please enter file name"));

    ExportResult result;
    result.FileName = path;
    QSaveFile file(path);
    if (path.contains(QChar(0)) || !file.open(QIODevice::WriteOnly)) {
        result.Outcome = ExportResult::Status::WriteFailed;
        result.Messages.append(WriteFailedMessage(path, file.errorString()));
        return result;
    }

    // FillArticleList: the rows go to a spool; only the last two titles stay in memory.
    const double limit = ParseNumber(options.DescriptionChars, decimalPoint).value_or(0.0);
    VersionSpool rows;
    QString lastTitle;
    QString channelTitle;
    bool spoolOk = true;
    // An iteration whose title or contents is empty does nothing, the boxes included, so every
    // later one does nothing either.
    for (qsizetype k = 1; k <= count.Items; ++k) {
        if (boxes.Title.isEmpty() || boxes.Contents.isEmpty())
            break;
        spoolOk = spoolOk && rows.Append(boxes.Title, RssDescription(boxes.Contents, limit));
        channelTitle = lastTitle;
        lastTitle = boxes.Title;
        AdvanceBoxes(boxes, source);
    }

    // BuildRssItems and WriteRssFile.
    spoolOk = spoolOk && rows.Rewind();
    bool ok = spoolOk && WriteUtf8(file, FeedStart(channelTitle, options.Url));
    QString title;
    QString description;
    for (qsizetype row = 0; ok && row < rows.Count(); ++row) {
        spoolOk = rows.Next(title, description);
        ok = spoolOk && WriteUtf8(file, RssItem(title, options.Url, description, clock()));
    }
    ok = ok && WriteUtf8(file, FeedEnd());
    if (!ok || !file.commit()) {
        const QString reason = spoolOk ? file.errorString()
                                       : QStringLiteral("The versions could not be kept in a temporary file.");
        file.cancelWriting();
        result.Outcome = ExportResult::Status::WriteFailed;
        result.Messages.append(WriteFailedMessage(path, reason));
        return result;
    }
    result.Outcome = ExportResult::Status::Written;
    result.Versions = rows.Count();
    result.OpenOnYes = path;
    result.Messages.append(FileSavedQuestion(path));
    return result;
}

} // namespace verbloom
