#include "WordForms.h"

#include "engine/AlternativesList.h"

namespace verbloom {

StemAndSuffix SplitSuffix(const QString &word)
{
    // Lowering never changes the length of these endings, so the stem can be cut from the word.
    const QString lowered = word.toLower();
    StemAndSuffix result;
    for (const QLatin1String ending : {QLatin1String("ing"), QLatin1String("ed"), QLatin1String("s")}) {
        if (lowered.endsWith(ending) && word.size() >= ending.size()) {
            result.Stem = word.left(word.size() - ending.size());
            result.Suffix = ending;
        }
    }
    return result;
}

QString InflectAlternatives(const QString &alternatives, const QString &suffix)
{
    const bool dropsFinalE = suffix == QLatin1String("ed") || suffix == QLatin1String("ing");
    const bool yToIe = suffix == QLatin1String("s");
    QString result;
    bool first = true;
    for (const QString &piece : SplitAlternatives(alternatives)) {
        QString w = TrimSpaces(piece).toLower();
        if (w.contains(QLatin1Char(' ')))
            continue;
        if (dropsFinalE && w.endsWith(QLatin1Char('e')))
            w.chop(1);
        else if (yToIe && w.endsWith(QLatin1Char('y')))
            w = w.left(w.size() - 1) + QLatin1String("ie");
        if (!first)
            result += QLatin1String(", ");
        result += w + suffix;
        first = false;
    }
    return result;
}

} // namespace verbloom
