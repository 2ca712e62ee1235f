#pragma once

#include <QList>
#include <QString>

namespace verbloom {

/// One meaning found on a thesaurus page.
struct MeaningEntry
{
    QString EntryWord;
    QString Synonyms;
};

struct ParsedPage
{
    QList<MeaningEntry> Meanings;   ///< in page order; inflected with the suffix when one is given
    QString LastSynonyms;           ///< the last meaning's synonyms, trimmed (not inflected)
};

/// Reads the meanings of a thesaurus page whose text is CR LF separated lines. A "Main Entry:"
/// line among the last three lines, or one without ": " after its label, is skipped.
ParsedPage ParseThesaurusPage(const QString &pageText, const QString &suffix);

} // namespace verbloom
