#pragma once

#include <QList>
#include <QString>
#include <QStringList>

#include <memory>

class MyThes;

namespace verbloom {

/// One meaning of a word as the thesaurus page shows it.
struct ThesaurusMeaning
{
    QString HeadTerm;      ///< the meaning's first plain term, else the looked-up word
    QString PartOfSpeech;  ///< "noun", "verb", "adjective" or "adverb"
    QStringList Synonyms;  ///< plain, similar and related terms, marks removed, no duplicates
};

/// The MyThes thesaurus files (PATH.idx and PATH.dat) opened for lookups.
class ThesaurusData final
{
public:
    ThesaurusData();
    ~ThesaurusData();
    ThesaurusData(const ThesaurusData &) = delete;
    ThesaurusData &operator=(const ThesaurusData &) = delete;

    /// Opens PATH.idx and PATH.dat; false with a message in `error` when either cannot be read.
    bool Open(const QString &pathWithoutExtension, QString *error = nullptr);

    /// The meanings of the word, looked up in lower case, in the order of the data file.
    /// Meanings left without synonyms are dropped. Empty for an unknown word.
    QList<ThesaurusMeaning> Lookup(const QString &word);

    /// Longest word (in encoded bytes) that is looked up at all; longer words have no entry.
    static constexpr int MaxWordBytes = 200;

    /// Builds one meaning from a data line: `rawPartOfSpeech` such as "(adj)" and the terms with
    /// their marks ("glad (related term)"). Antonyms, "(generic term)" entries, terms holding
    /// ":" or ",", repeats (ignoring case) and the word itself are left out.
    static ThesaurusMeaning BuildMeaning(const QString &word, const QString &rawPartOfSpeech,
                                         const QStringList &rawTerms);

private:
    std::unique_ptr<MyThes> m_thes;
    QByteArray m_encoding;
};

} // namespace verbloom
