#include "ThesaurusData.h"

#include <QFile>
#include <QFileInfo>
#include <QSet>
#include <QStringDecoder>
#include <QStringEncoder>

#include <mythes.hxx>

namespace verbloom {

namespace {

enum class TermKind { Plain, Kept, Dropped };

/// Splits off a trailing mark such as " (similar term)" and tells what the term is worth.
TermKind ClassifyTerm(const QString &raw, QString &term)
{
    term = raw.trimmed();
    if (!term.endsWith(QLatin1Char(')')))
        return TermKind::Plain;
    const qsizetype open = term.lastIndexOf(QLatin1String(" ("));
    if (open < 0)
        return TermKind::Plain;
    const QString mark = term.mid(open + 2, term.size() - open - 3);
    term = term.left(open).trimmed();
    if (mark == QLatin1String("similar term") || mark == QLatin1String("related term"))
        return TermKind::Kept;
    if (mark == QLatin1String("antonym") || mark.endsWith(QLatin1String(" term")))
        return TermKind::Dropped;
    term = raw.trimmed(); // a parenthesis that is part of the term itself
    return TermKind::Plain;
}

bool IsListable(const QString &term)
{
    return !term.isEmpty() && !term.contains(QLatin1Char(':')) && !term.contains(QLatin1Char(','));
}

QString PartOfSpeechName(const QString &raw)
{
    QString pos = raw.trimmed();
    if (pos.startsWith(QLatin1Char('(')) && pos.endsWith(QLatin1Char(')')))
        pos = pos.mid(1, pos.size() - 2).trimmed();
    if (pos == QLatin1String("adj"))
        return u"adjective"_qs;
    if (pos == QLatin1String("adv"))
        return u"adverb"_qs;
    return pos; // "noun" and "verb" are already full names
}

} // namespace

ThesaurusData::ThesaurusData() = default;
ThesaurusData::~ThesaurusData() = default;

bool ThesaurusData::Open(const QString &pathWithoutExtension, QString *error)
{
    m_thes.reset();
    const QString idx = pathWithoutExtension + u".idx"_qs;
    const QString dat = pathWithoutExtension + u".dat"_qs;
    for (const QString &path : {idx, dat}) {
        QFile file(path);
        if (!QFileInfo(path).isFile() || !file.open(QIODevice::ReadOnly)) {
            if (error)
                *error = u"The thesaurus data file \"%1\" cannot be read."_qs.arg(path);
            return false;
        }
    }
    m_thes = std::make_unique<MyThes>(QFile::encodeName(idx).constData(),
                                      QFile::encodeName(dat).constData());
    const char *encoding = m_thes->get_th_encoding();
    m_encoding = encoding ? QByteArray(encoding).trimmed() : QByteArray("UTF-8");
    if (!QStringDecoder(m_encoding.constData()).isValid())
        m_encoding = "UTF-8";
    return true;
}

QList<ThesaurusMeaning> ThesaurusData::Lookup(const QString &word)
{
    QList<ThesaurusMeaning> meanings;
    const QString lower = word.toLower();
    if (!m_thes || lower.isEmpty())
        return meanings;
    QStringEncoder encode(m_encoding.constData(), QStringConverter::Flag::Stateless);
    const QByteArray key = encode(lower);
    if (encode.hasError() || key.size() > MaxWordBytes || key.contains('\0'))
        return meanings;

    mentry *entries = nullptr;
    const int count = m_thes->Lookup(key.constData(), int(key.size()), &entries);
    QStringDecoder decode(m_encoding.constData(), QStringConverter::Flag::Stateless);
    for (int i = 0; i < count; ++i) {
        const mentry &entry = entries[i];
        QStringList terms;
        for (int j = 0; j < entry.count; ++j)
            terms.append(decode(entry.psyns[j]));
        // MyThes builds the definition as "(pos) first term"; the part before the blank is the pos.
        const QString definition = entry.defn ? decode(entry.defn) : QString();
        const QString pos = definition.startsWith(QLatin1Char('('))
            ? definition.left(definition.indexOf(QLatin1Char(')')) + 1)
            : QString();
        ThesaurusMeaning meaning = BuildMeaning(lower, pos, terms);
        if (!meaning.Synonyms.isEmpty())
            meanings.append(meaning);
    }
    if (entries)
        m_thes->CleanUpAfterLookup(&entries, count);
    return meanings;
}

ThesaurusMeaning ThesaurusData::BuildMeaning(const QString &word, const QString &rawPartOfSpeech,
                                             const QStringList &rawTerms)
{
    ThesaurusMeaning meaning;
    meaning.PartOfSpeech = PartOfSpeechName(rawPartOfSpeech);
    QSet<QString> seen{word.toLower()};
    bool first = true;
    for (const QString &raw : rawTerms) {
        QString term;
        const TermKind kind = ClassifyTerm(raw, term);
        if (first && kind == TermKind::Plain && IsListable(term))
            meaning.HeadTerm = term;
        first = false;
        if (kind == TermKind::Dropped || !IsListable(term))
            continue;
        const QString folded = term.toLower();
        if (seen.contains(folded))
            continue;
        seen.insert(folded);
        meaning.Synonyms.append(term);
    }
    if (meaning.HeadTerm.isEmpty())
        meaning.HeadTerm = word;
    return meaning;
}

} // namespace verbloom
