#pragma once

#include <QString>

namespace verbloom {

struct StemAndSuffix
{
    QString Stem;
    QString Suffix;
};

/// Splits "ing", "ed" or "s" off a word (tested lowered, in that order; a later match wins).
StemAndSuffix SplitSuffix(const QString &word);

/// Lowers every alternative, drops phrases and puts the suffix on each (e -> drop for "ed"/"ing",
/// y -> ie for "s"); entries joined with ", ".
QString InflectAlternatives(const QString &alternatives, const QString &suffix);

} // namespace verbloom
