#pragma once

#include "engine/SpinGenerator.h"
#include "export/RssExport.h"
#include "export/SqlExport.h"

#include <QString>
#include <QStringList>

#include <cstdint>
#include <optional>

namespace verbloom {

/// What one run of verbloom-batch makes.
enum class BatchAction { None, Text, Sql, Rss, Site, ListNew };

/// The site options given on the command line; the others come from config.txt.
struct SiteOverrides
{
    std::optional<QString> Pages;     ///< --pages: "Number of pages to generate:"
    std::optional<QString> Links;     ///< --links: "Number of links in menu per page:"
    std::optional<QString> Template;  ///< --template: a file name of the templates folder
    std::optional<QString> Extension; ///< --extension: "File Extension:"
};

/// The command line of verbloom-batch, checked for form only (the values are checked later with
/// the windows' own rules).
struct BatchArguments
{
    QString Home;                  ///< --home; empty: the folder of the executable
    QString Title;                 ///< --title
    QString ContentsFile;          ///< --contents
    QString ContentsText;          ///< --contents-text
    bool ContentsFromFile = false;
    int CustomizationLevel = 2;    ///< --level as the list index: 0 "Maximum" .. 4 "Minimum"
    int MinimumWordLength = 3;     ///< --ignore-shorter
    QStringList IgnoredWords;      ///< --ignore, in the order given
    bool Lookup = false;           ///< --lookup
    std::optional<std::uint32_t> Seed; ///< --seed
    /// SOURCE_DATE_EPOCH: the moment every RSS item is stamped with, instead of the clock.
    std::optional<qint64> FixedDate;

    BatchAction Action = BatchAction::None;
    QString Output;                ///< the file of --text, --sql and --rss, the folder of --site
    SqlExportOptions Sql;          ///< --table, --title-field, --article-field, --count (FileName = Output)
    RssExportOptions Rss;          ///< --url, --count, --description-chars (FileName = Output)
    SiteOverrides Site;
    bool Force = false;            ///< --force: write a site over an existing index page
};

/// The result of reading the command line.
struct ParsedArguments
{
    enum class Kind { Run, Help, UsageError };
    Kind Outcome = Kind::UsageError;
    BatchArguments Arguments;
    QString Error; ///< what is wrong with the command line (UsageError)
};

/// Reads the arguments (the first one is the program). `sourceDateEpoch` is the value of the
/// environment variable SOURCE_DATE_EPOCH, or nothing when it is not set.
ParsedArguments ParseBatchArguments(const QStringList &arguments,
                                    const std::optional<QString> &sourceDateEpoch = std::nullopt);

/// The short usage text printed after a usage error.
QString BatchUsage();

/// The text of --help.
QString BatchHelp();

} // namespace verbloom
