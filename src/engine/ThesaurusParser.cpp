#include "ThesaurusParser.h"

#include "common/Numbers.h"
#include "engine/AlternativesList.h"
#include "engine/WordForms.h"

#include <QStringList>

#include <optional>

namespace verbloom {

namespace {

// The text between the first and the second separator; all of the rest when there is no second.
// Empty optional when the separator does not occur at all.
std::optional<QString> SecondField(const QString &line, QLatin1String separator)
{
    const qsizetype first = line.indexOf(separator);
    if (first < 0)
        return std::nullopt;
    const qsizetype begin = first + separator.size();
    const qsizetype second = line.indexOf(separator, begin);
    return second < 0 ? line.mid(begin) : line.mid(begin, second - begin);
}

// "bank 2" names the homograph "bank"; other entry words stay as they are.
QString WithoutHomographNumber(const QString &entryWord)
{
    const QStringList parts = TrimSpaces(entryWord).split(QLatin1Char(' '));
    if (parts.size() >= 2 && IsNumeric(parts.at(1)))
        return parts.at(0);
    return entryWord;
}

} // namespace

ParsedPage ParseThesaurusPage(const QString &pageText, const QString &suffix)
{
    static const QLatin1String kEntryLabel("Main Entry:");
    static const QLatin1String kSynonymsLabel("Synonyms:");

    ParsedPage page;
    const QStringList lines = pageText.split(QLatin1String("\r\n"));
    for (qsizetype i = 0; i + 3 < lines.size(); ++i) {
        const QString &line = lines.at(i);
        if (!line.startsWith(kEntryLabel))
            continue;
        const std::optional<QString> entryField = SecondField(line, QLatin1String(": "));
        if (!entryField)
            continue;
        const QString &synonymsLine = lines.at(i + 3);
        if (!synonymsLine.startsWith(kSynonymsLabel))
            continue;
        MeaningEntry meaning;
        meaning.EntryWord = WithoutHomographNumber(*entryField);
        meaning.Synonyms = SecondField(synonymsLine, QLatin1String(":")).value_or(QString());
        page.LastSynonyms = TrimSpaces(meaning.Synonyms);
        if (!suffix.isEmpty()) {
            meaning.EntryWord = InflectAlternatives(meaning.EntryWord, suffix);
            meaning.Synonyms = InflectAlternatives(meaning.Synonyms, suffix);
        }
        page.Meanings.append(meaning);
    }
    return page;
}

} // namespace verbloom
