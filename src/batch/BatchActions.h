#pragma once

#include "batch/BatchArguments.h"
#include "export/VersionSource.h"
#include "site/SiteConfig.h"

#include <QString>

#include <optional>

namespace verbloom {

class BatchConsole;
class Spinner;

/// The action of one batch run, with the checks of its window.
class BatchActions final
{
public:
    BatchActions(const BatchArguments &arguments, const QString &programFolder, QChar decimalPoint,
                 BatchConsole &console);

    /// The checks the action's window makes before it writes, and that the output can be written;
    /// the first failure's message, or nothing. Writes nothing.
    std::optional<QString> Check();

    /// Runs the action on the analysed article: `boxes` hold the article as entered (with its
    /// closing blanks), `spinner` makes the later versions. The failure's message, or nothing.
    std::optional<QString> Run(ArticleBoxes boxes, Spinner &spinner, const QStringList &newWords);

private:
    std::optional<QString> CheckRss() const;
    std::optional<QString> CheckSite();

    const BatchArguments &m_arguments;
    QString m_programFolder;
    QChar m_decimalPoint;
    BatchConsole &m_console;
    SiteOptions m_site; ///< the site options after Check
};

} // namespace verbloom
