#pragma once

#include <QRandomGenerator>
#include <QString>
#include <QStringList>

namespace verbloom {
class WordStore;
}

namespace verbloom::bench {

/// A made-up word of two to four syllables, at least four letters long (so it is customizable).
QString MakeWord(QRandomGenerator &random);

/// `count` distinct made-up words.
QStringList MakeVocabulary(QRandomGenerator &random, qsizetype count);

/// Gives every word a word file of `minimum` to `maximum` alternatives; with `phrases`, about one
/// alternative in five is a phrase of two words.
void WriteWordFiles(const WordStore &store, const QStringList &words, QRandomGenerator &random, int minimum,
                    int maximum, bool phrases);

} // namespace verbloom::bench
