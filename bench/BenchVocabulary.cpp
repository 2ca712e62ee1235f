#include "BenchVocabulary.h"

#include "engine/WordStore.h"

#include <QSet>

#include <iterator>

namespace verbloom::bench {

QString MakeWord(QRandomGenerator &random)
{
    static const char *const kSyllables[] = {"ba", "ker", "lo", "mint", "sa", "tor", "vi", "den",
                                             "qua", "rel", "po", "shen", "tu", "mar", "gle", "fi",
                                             "nos", "ca", "dre", "ul", "pin", "ro", "tes", "mo"};
    QString word;
    while (word.size() < 4) {
        word.clear();
        for (int i = 0, n = 2 + random.bounded(3); i < n; ++i)
            word += QLatin1String(kSyllables[random.bounded(int(std::size(kSyllables)))]);
    }
    return word;
}

QStringList MakeVocabulary(QRandomGenerator &random, qsizetype count)
{
    QStringList words;
    QSet<QString> taken;
    while (words.size() < count) {
        const QString word = MakeWord(random);
        if (!taken.contains(word)) {
            taken.insert(word);
            words.append(word);
        }
    }
    return words;
}

void WriteWordFiles(const WordStore &store, const QStringList &words, QRandomGenerator &random, int minimum,
                    int maximum, bool phrases)
{
    for (const QString &word : words) {
        QStringList alternatives;
        for (int i = 0, n = minimum + random.bounded(maximum - minimum + 1); i < n; ++i) {
            alternatives.append(phrases && random.bounded(5) == 0 ? MakeWord(random) + u' ' + MakeWord(random)
                                                                 : MakeWord(random));
        }
        store.WriteAlternatives(word, alternatives.join(QLatin1String(", ")));
    }
}

} // namespace verbloom::bench
