#include "batch/BatchArguments.h"

#include <QCommandLineParser>
#include <QRegularExpression>

#include <algorithm>
#include <limits>

namespace verbloom {

namespace {

// Options that take a value; --ignore is the only one that may be repeated.
const QStringList &ValueOptions()
{
    static const QStringList names{
        u"home"_qs, u"title"_qs, u"contents"_qs, u"contents-text"_qs, u"level"_qs, u"ignore-shorter"_qs,
        u"ignore"_qs, u"seed"_qs, u"text"_qs, u"sql"_qs, u"table"_qs, u"title-field"_qs, u"article-field"_qs,
        u"count"_qs, u"rss"_qs, u"url"_qs, u"description-chars"_qs, u"site"_qs, u"pages"_qs, u"links"_qs,
        u"template"_qs, u"extension"_qs};
    return names;
}

const QStringList &FlagOptions()
{
    static const QStringList names{u"lookup"_qs, u"list-new"_qs, u"force"_qs};
    return names;
}

struct ActionOption
{
    QString Name;
    BatchAction Action;
};

const QList<ActionOption> &ActionOptions()
{
    static const QList<ActionOption> actions{{u"text"_qs, BatchAction::Text},
                                             {u"sql"_qs, BatchAction::Sql},
                                             {u"rss"_qs, BatchAction::Rss},
                                             {u"site"_qs, BatchAction::Site},
                                             {u"list-new"_qs, BatchAction::ListNew}};
    return actions;
}

// An option that belongs to some actions only.
struct OwnedOption
{
    QString Name;
    QList<BatchAction> Actions;
    QString Owners; ///< the actions as the message names them
};

const QList<OwnedOption> &OwnedOptions()
{
    const QString sql = u"--sql"_qs;
    const QString rss = u"--rss"_qs;
    const QString site = u"--site"_qs;
    static const QList<OwnedOption> options{
        {u"table"_qs, {BatchAction::Sql}, sql},
        {u"title-field"_qs, {BatchAction::Sql}, sql},
        {u"article-field"_qs, {BatchAction::Sql}, sql},
        {u"count"_qs, {BatchAction::Sql, BatchAction::Rss}, sql + u" or "_qs + rss},
        {u"url"_qs, {BatchAction::Rss}, rss},
        {u"description-chars"_qs, {BatchAction::Rss}, rss},
        {u"pages"_qs, {BatchAction::Site}, site},
        {u"links"_qs, {BatchAction::Site}, site},
        {u"template"_qs, {BatchAction::Site}, site},
        {u"extension"_qs, {BatchAction::Site}, site},
        {u"force"_qs, {BatchAction::Site}, site}};
    return options;
}

// The options an action cannot do without.
QStringList RequiredOptions(BatchAction action)
{
    switch (action) {
    case BatchAction::Sql:
        return {u"table"_qs, u"title-field"_qs, u"article-field"_qs};
    case BatchAction::Rss:
        return {u"url"_qs, u"count"_qs, u"description-chars"_qs};
    default:
        return {};
    }
}

ParsedArguments UsageError(const QString &error)
{
    ParsedArguments parsed;
    parsed.Outcome = ParsedArguments::Kind::UsageError;
    parsed.Error = error;
    return parsed;
}

// A whole number of decimal digits only (no sign, no blanks) up to `maximum`.
std::optional<qulonglong> DecimalNumber(const QString &text, qulonglong maximum)
{
    static const QRegularExpression digits(u"^[0-9]+$"_qs);
    bool ok = false;
    const qulonglong value = text.toULongLong(&ok);
    if (!digits.match(text).hasMatch() || !ok || value > maximum)
        return std::nullopt;
    return value;
}

ParsedArguments HelpRequested()
{
    ParsedArguments help;
    help.Outcome = ParsedArguments::Kind::Help;
    return help;
}

// The latest moment a date can name: 9999-12-31 23:59:59 UTC.
constexpr qulonglong kLatestEpochSecond = 253402300799;

} // namespace

ParsedArguments ParseBatchArguments(const QStringList &arguments, const std::optional<QString> &sourceDateEpoch)
{
    QCommandLineParser parser;
    for (const QString &name : ValueOptions())
        parser.addOption(QCommandLineOption(name, QString(), u"value"_qs));
    for (const QString &name : FlagOptions())
        parser.addOption(QCommandLineOption(name));
    parser.addOption(QCommandLineOption(QStringList{u"help"_qs, u"h"_qs}));

    if (!parser.parse(arguments)) {
        if (arguments.contains(u"--help"_qs) || arguments.contains(u"-h"_qs))
            return HelpRequested();
        return UsageError(parser.errorText());
    }
    if (parser.isSet(u"help"_qs))
        return HelpRequested();
    if (!parser.positionalArguments().isEmpty())
        return UsageError(u"unexpected argument \"%1\""_qs.arg(parser.positionalArguments().first()));
    const QStringList given = parser.optionNames();
    for (const QString &name : ValueOptions() + FlagOptions()) {
        if (name != u"ignore"_qs && given.count(name) > 1)
            return UsageError(u"--%1 is given more than once"_qs.arg(name));
    }

    BatchArguments args;
    QStringList actions;
    for (const ActionOption &option : ActionOptions()) {
        if (parser.isSet(option.Name)) {
            actions.append(u"--"_qs + option.Name);
            args.Action = option.Action;
        }
    }
    if (actions.isEmpty())
        return UsageError(u"no action: give one of --text, --sql, --rss, --site or --list-new"_qs);
    if (actions.size() > 1)
        return UsageError(u"one action at a time, not "_qs + actions.join(u" and "_qs));

    if (!parser.isSet(u"title"_qs))
        return UsageError(u"--title is missing"_qs);
    args.Title = parser.value(u"title"_qs);
    const bool fromFile = parser.isSet(u"contents"_qs);
    const bool fromText = parser.isSet(u"contents-text"_qs);
    if (fromFile && fromText)
        return UsageError(u"--contents and --contents-text cannot be used together"_qs);
    if (!fromFile && !fromText)
        return UsageError(u"--contents FILE or --contents-text TEXT is missing"_qs);
    args.ContentsFromFile = fromFile;
    args.ContentsFile = parser.value(u"contents"_qs);
    args.ContentsText = parser.value(u"contents-text"_qs);

    if (parser.isSet(u"home"_qs)) {
        args.Home = parser.value(u"home"_qs);
        if (args.Home.isEmpty())
            return UsageError(u"--home needs a folder"_qs);
    }
    if (parser.isSet(u"level"_qs)) {
        const QString level = parser.value(u"level"_qs);
        const QStringList &names = CustomizationLevelNames();
        const auto found = std::find_if(names.begin(), names.end(), [&](const QString &name) {
            return name.compare(level, Qt::CaseInsensitive) == 0;
        });
        if (found == names.end()) {
            return UsageError(u"unknown level \"%1\": use Maximum, \"Level 3\", \"Level 2\", \"Level 1\" "
                              "or Minimum"_qs.arg(level));
        }
        args.CustomizationLevel = int(found - names.begin());
    }
    if (parser.isSet(u"ignore-shorter"_qs)) {
        const QString length = parser.value(u"ignore-shorter"_qs);
        static const QStringList lengths{u"2"_qs, u"3"_qs, u"4"_qs, u"5"_qs};
        if (!lengths.contains(length))
            return UsageError(u"--ignore-shorter takes 2, 3, 4 or 5, not \"%1\""_qs.arg(length));
        args.MinimumWordLength = length.toInt();
    }
    args.IgnoredWords = parser.values(u"ignore"_qs);
    args.Lookup = parser.isSet(u"lookup"_qs);
    if (parser.isSet(u"seed"_qs)) {
        const QString seed = parser.value(u"seed"_qs);
        const std::optional<qulonglong> value = DecimalNumber(seed, std::numeric_limits<std::uint32_t>::max());
        if (!value)
            return UsageError(u"--seed takes a whole number from 0 to 4294967295, not \"%1\""_qs.arg(seed));
        args.Seed = std::uint32_t(*value);
    }
    if (sourceDateEpoch && !sourceDateEpoch->isEmpty()) {
        const std::optional<qulonglong> seconds = DecimalNumber(*sourceDateEpoch, kLatestEpochSecond);
        if (!seconds) {
            return UsageError(u"SOURCE_DATE_EPOCH must be a number of seconds since 1970-01-01 00:00 UTC, "
                              "not \"%1\""_qs.arg(*sourceDateEpoch));
        }
        args.FixedDate = qint64(*seconds);
    }

    for (const OwnedOption &option : OwnedOptions()) {
        if (parser.isSet(option.Name) && !option.Actions.contains(args.Action))
            return UsageError(u"--%1 is used only with %2"_qs.arg(option.Name, option.Owners));
    }
    for (const QString &name : RequiredOptions(args.Action)) {
        if (!parser.isSet(name))
            return UsageError(actions.first() + u" needs --"_qs + name);
    }

    const QString actionName = actions.first().mid(2);
    if (args.Action != BatchAction::ListNew)
        args.Output = parser.value(actionName);
    args.Sql.FileName = args.Output;
    args.Sql.TableName = parser.value(u"table"_qs);
    args.Sql.TitleFieldName = parser.value(u"title-field"_qs);
    args.Sql.ArticleFieldName = parser.value(u"article-field"_qs);
    if (args.Action == BatchAction::Sql && parser.isSet(u"count"_qs))
        args.Sql.Count = parser.value(u"count"_qs);
    args.Rss.FileName = args.Output;
    args.Rss.Count = parser.value(u"count"_qs);
    args.Rss.Url = parser.value(u"url"_qs);
    args.Rss.DescriptionChars = parser.value(u"description-chars"_qs);
    const auto optional = [&](const QString &name) {
        return parser.isSet(name) ? std::optional<QString>(parser.value(name)) : std::nullopt;
    };
    args.Site.Pages = optional(u"pages"_qs);
    args.Site.Links = optional(u"links"_qs);
    args.Site.Template = optional(u"template"_qs);
    args.Site.Extension = optional(u"extension"_qs);
    args.Force = parser.isSet(u"force"_qs);

    ParsedArguments parsed;
    parsed.Outcome = ParsedArguments::Kind::Run;
    parsed.Arguments = args;
    return parsed;
}

QString BatchUsage()
{
    return u"Usage: verbloom-batch [--home DIR] --title TEXT (--contents FILE | --contents-text TEXT)\n"
           "                      [--level LEVEL] [--ignore-shorter N] [--ignore WORD]... [--lookup]\n"
           "                      [--seed N] ACTION\n"
           "ACTION: --text FILE\n"
           "      | --sql FILE --table T --title-field F --article-field F [--count N]\n"
           "      | --rss FILE --url U --count N --description-chars M\n"
           "      | --site DIR [--pages N] [--links N] [--template NAME] [--extension EXT] [--force]\n"
           "      | --list-new\n"
           "Try 'verbloom-batch --help' for more information.\n"_qs;
}

QString BatchHelp()
{
    return u"Usage: verbloom-batch [--home DIR] --title TEXT (--contents FILE | --contents-text TEXT)\n"
           "                      [--level LEVEL] [--ignore-shorter N] [--ignore WORD]... [--lookup]\n"
           "                      [--seed N] ACTION\n"
           "\n"
           "Makes customized versions of one article without windows: the work of the Verbloom wizard\n"
           "from the command line, with the same rules, the same word files and the same output bytes.\n"
           "\n"
           "The article\n"
           "  --title TEXT            the title.\n"
           "  --contents FILE         read the contents from a text file (UTF-8, else Windows-1252),\n"
           "                          line breaks kept as they are.\n"
           "  --contents-text TEXT    the contents given on the command line.\n"
           "  As \"Next\" does in the program, a blank is appended to the title and to the contents when\n"
           "  they do not end with one, and a title or contents made only of blanks is refused\n"
           "  (\"The title cannot be blank.\", \"The contents cannot be blank.\").\n"
           "\n"
           "Settings (as on the Configuration panel)\n"
           "  --home DIR              the program folder whose data/ word files, config.txt,\n"
           "                          SETTINGS.INI and templates/ are used (default: the folder of\n"
           "                          this program; created when missing).\n"
           "  --level LEVEL           Maximum | \"Level 3\" | \"Level 2\" | \"Level 1\" | Minimum\n"
           "                          (default \"Level 2\"; names ignore case).\n"
           "  --ignore-shorter N      2 | 3 | 4 | 5: words of N letters or fewer are never replaced\n"
           "                          (default 3).\n"
           "  --ignore WORD           a word that is never replaced; repeat for more words. The checks\n"
           "                          of \"Add to list\" apply.\n"
           "  --lookup                look up words that have no word file in the thesaurus, taking the\n"
           "                          last meaning's synonyms (as with \"Manual\" checked), and write the\n"
           "                          word files of the article's words, so later runs find them. The\n"
           "                          thesaurus is the address ThesaurusUrl of SETTINGS.INI's [URL]\n"
           "                          section, else the thesaurus built into this program. Without\n"
           "                          --lookup nothing is looked up and no word file is written: a word\n"
           "                          without a word file keeps no alternatives.\n"
           "  --seed N                draw from a random sequence started with N (0..4294967295).\n"
           "                          Without it every run draws the program's one fixed sequence, so\n"
           "                          two identical runs write identical files.\n"
           "\n"
           "Actions (exactly one)\n"
           "  --text FILE             write one customized version as \"Save Cont.\" does: the title,\n"
           "                          two line breaks (CR LF), the contents.\n"
           "  --sql FILE              write INSERT statements as \"SaveAs SQL\" does, with\n"
           "      --table T --title-field F --article-field F\n"
           "      [--count N]         the number of statements (default 10).\n"
           "  --rss FILE              write an RSS 2.0 feed as \"SaveAs XML\" does, with\n"
           "      --url U --count N --description-chars M\n"
           "  --site DIR              generate a web site into the existing folder DIR as \"Gen. Site\"\n"
           "                          does. Every site option comes from config.txt of the program\n"
           "                          folder (else the defaults), except what these flags give:\n"
           "      --pages N           number of pages to generate\n"
           "      --links N           number of links in menu per page\n"
           "      --template NAME     a file of the templates folder (default: the stored one, else\n"
           "                          the first)\n"
           "      --extension EXT     file extension of the pages\n"
           "      --force             write the site although DIR/index.EXT exists (the program asks\n"
           "                          \"File already exist!!!! Do you wand to continue\"; without\n"
           "                          --force the batch refuses). Other files of DIR are overwritten.\n"
           "                          config.txt is not changed and nothing is opened.\n"
           "  --list-new              print the customizable words of the article that have no word\n"
           "                          file, one a line, in article order, each word once.\n"
           "  The first SQL statement, RSS item or site page carries the article as entered (with its\n"
           "  appended blank), every later one a fresh customized version. Counts are checked with the\n"
           "  windows' own messages; a decimal number is read with the decimal point of the locale.\n"
           "  Every file appears whole or not at all.\n"
           "\n"
           "Other\n"
           "  -h, --help              show this text.\n"
           "  SOURCE_DATE_EPOCH       when this environment variable holds a number of seconds since\n"
           "                          1970-01-01 00:00 UTC, every RSS item is dated with that moment\n"
           "                          (in the local time zone) instead of the time of writing.\n"
           "\n"
           "Exit status: 0 success; 1 the work failed (the check that failed or the file that could\n"
           "not be written is named on stderr; nothing is written when a check fails); 2 a usage error.\n"
           "While a long run works, a progress line is shown on stderr when stderr is a terminal.\n"_qs;
}

} // namespace verbloom
