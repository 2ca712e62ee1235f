#pragma once

#include "export/ExportResult.h"
#include "export/UserMessage.h"
#include "export/VersionSource.h"

#include <QString>

#include <optional>

namespace verbloom {

/// The input of the "Save as SQL File" window, as its boxes hold it.
struct SqlExportOptions
{
    QString FileName;         ///< txtFileName
    QString TableName;        ///< txtTableName
    QString TitleFieldName;   ///< txtTitleFieldName
    QString ArticleFieldName; ///< txtArticleFieldName
    QString Count = QStringLiteral("10"); ///< txtnoarticletoinsert
};

/// The result of an SQL export; ArticleFieldName is what txtArticleFieldName shows afterwards
/// (its double quotes turned into "'" once a statement was written).
struct SqlExportResult : ExportResult
{
    QString ArticleFieldName;
};

/// ValidateSqlForm: the first failing check as an OK message titled "Message", or nothing.
/// Empty means exactly "". The count must be numeric (decimalPoint as the user's locale has it)
/// and convert, nearest with halves to even, to 1..32767.
std::optional<UserMessage> ValidateSqlForm(const SqlExportOptions &options,
                                           QChar decimalPoint = QLatin1Char('.'));

/// One statement, CR LF included. Names are written as typed; a double quote inside the title or
/// the contents is doubled so the statement stays one statement.
QString SqlStatement(const QString &tableName, const QString &titleFieldName,
                     const QString &articleFieldName, const QString &title, const QString &contents);

/// GenerateSqlFile: count statements, the first from the boxes as they stand, each later one from
/// the version the boxes received after the one before; a version whose title is empty gives no
/// statement. The statements are streamed into path, which appears whole only when all were
/// written; when no statement was made the file is not touched. The boxes end holding one more
/// version. A path that cannot be written is reported before any version is made.
SqlExportResult GenerateSqlFile(const QString &path, qsizetype count, const SqlExportOptions &options,
                                ArticleBoxes &boxes, VersionSource &source);

/// cmdSave_Click without the window: ValidateSqlForm, then GenerateSqlFile into options.FileName
/// (unchanged, not trimmed), then "File Saved as ..." with the question whether to open it.
/// On Yes the window opens OpenOnYes and closes; on No it stays open.
SqlExportResult ExportSql(const SqlExportOptions &options, ArticleBoxes &boxes, VersionSource &source,
                          QChar decimalPoint = QLatin1Char('.'));

} // namespace verbloom
