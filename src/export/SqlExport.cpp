#include "export/SqlExport.h"

#include "common/Numbers.h"

#include <QSaveFile>

namespace verbloom {

namespace {

QString DoubleQuotes(const QString &text)
{
    if (!text.contains(QLatin1Char('"')))
        return text;
    QString doubled = text;
    doubled.replace(QLatin1Char('"'), QStringLiteral("\"\""));
    return doubled;
}

} // namespace

std::optional<UserMessage> ValidateSqlForm(const SqlExportOptions &options, QChar decimalPoint)
{
    if (options.FileName.isEmpty())
        return InformationMessage(QStringLiteral("Please enter file name"));
    if (options.TableName.isEmpty())
        return InformationMessage(QStringLiteral("Please enter Table name"));
    if (options.TitleFieldName.isEmpty())
        return InformationMessage(QStringLiteral("Please enter Title field name"));
    if (options.ArticleFieldName.isEmpty())
        return InformationMessage(QStringLiteral("Please enter Article field name"));
    if (options.Count.isEmpty())
        return InformationMessage(QStringLiteral("Please specify No of article to insert"));
    if (!IsNumeric(options.Count, decimalPoint))
        return InformationMessage(QStringLiteral("No of article to insert should be numeric"));
    const std::optional<qint16> count = TextToInt16(options.Count, decimalPoint);
    if (!count || *count < 1)
        return InformationMessage(QStringLiteral("No of article to insert should be between 1 and 32767"));
    return std::nullopt;
}

QString SqlStatement(const QString &tableName, const QString &titleFieldName,
                     const QString &articleFieldName, const QString &title, const QString &contents)
{
    return QStringLiteral("INSERT INTO ") + tableName + QStringLiteral(" (") + titleFieldName
        + QLatin1Char(',') + articleFieldName + QStringLiteral(") VALUES (\"") + DoubleQuotes(title)
        + QStringLiteral("\",\"") + DoubleQuotes(contents) + QStringLiteral("\");\r\n");
}

SqlExportResult GenerateSqlFile(const QString &path, qsizetype count, const SqlExportOptions &options,
                                ArticleBoxes &boxes, VersionSource &source)
{
    SqlExportResult result;
    result.FileName = path;
    result.ArticleFieldName = options.ArticleFieldName;

    QSaveFile file(path);
    if (path.isEmpty() || path.contains(QChar(0)) || !file.open(QIODevice::WriteOnly)) {
        result.Outcome = ExportResult::Status::WriteFailed;
        result.Messages.append(WriteFailedMessage(path, path.isEmpty() ? QString() : file.errorString()));
        return result;
    }

    QString articleFieldName = options.ArticleFieldName;
    articleFieldName.replace(QLatin1Char('"'), QLatin1Char('\''));
    bool writeOk = true;
    for (qsizetype k = 1; k <= count; ++k) {
        if (!boxes.Title.isEmpty()) {
            result.ArticleFieldName = articleFieldName;
            if (writeOk) {
                const QByteArray bytes = SqlStatement(options.TableName, options.TitleFieldName,
                                                      articleFieldName, boxes.Title, boxes.Contents)
                                             .toUtf8();
                writeOk = file.write(bytes) == bytes.size();
            }
            ++result.Versions;
        }
        AdvanceBoxes(boxes, source);
    }

    if (result.Versions == 0) {
        file.cancelWriting();
        result.Outcome = ExportResult::Status::NothingWritten;
        result.Messages.append(
            InformationMessage(QStringLiteral("Nothing was saved: every version had an empty title")));
        return result;
    }
    if (!writeOk || !file.commit()) {
        const QString reason = file.errorString();
        file.cancelWriting();
        result.Outcome = ExportResult::Status::WriteFailed;
        result.Versions = 0;
        result.Messages.append(WriteFailedMessage(path, reason));
        return result;
    }
    result.Outcome = ExportResult::Status::Written;
    result.OpenOnYes = path;
    result.Messages.append(FileSavedQuestion(path));
    return result;
}

SqlExportResult ExportSql(const SqlExportOptions &options, ArticleBoxes &boxes, VersionSource &source,
                          QChar decimalPoint)
{
    if (const std::optional<UserMessage> failure = ValidateSqlForm(options, decimalPoint)) {
        SqlExportResult result;
        result.Outcome = ExportResult::Status::Invalid;
        result.ArticleFieldName = options.ArticleFieldName;
        result.Messages.append(*failure);
        return result;
    }
    const qsizetype count = TextToInt16(options.Count, decimalPoint).value_or(0);
    return GenerateSqlFile(options.FileName, count, options, boxes, source);
}

} // namespace verbloom
