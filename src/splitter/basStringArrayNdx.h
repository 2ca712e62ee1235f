#pragma once

#include <QList>
#include <QStringList>
#include <QStringView>

namespace verbloom {

/// Sorted index and search over a zero-based string array S with an index array X, where X(k)
/// is the position in S of the string that is k-th in sorted order. Compare method 0 compares
/// character codes (case-sensitive), 1 compares case-insensitively. Positions count from 0;
/// -1 means "none".

/// Compares a with b under the compare method: negative, 0 or positive.
int CompareByMethod(QStringView a, QStringView b, int compareMethod);

/// Fills X for all strings of S in ascending order; strings that compare equal keep their
/// order in S.
void BuildSortIndex(const QStringList &S, QList<qsizetype> &X, int compareMethod);

/// Binary search of X(low..high) for a string equal to value. Returns the index position of an
/// equal entry (not necessarily the first of its run) or -1; outLow gets the final low bound.
qsizetype SearchSortedIndex(const QStringList &S, const QList<qsizetype> &X, qsizetype low,
                            qsizetype middle, qsizetype high, QStringView value,
                            int compareMethod, qsizetype &outLow);

/// First entry equal to value. Starts from `position` when the string there is identical to
/// value, else searches; then steps back to the first of the equal run. Leaves the index position
/// in `position` and returns the position in S, or -1 (position -1) when none is equal.
qsizetype FindFirstInIndex(const QStringList &S, const QList<qsizetype> &X, qsizetype low,
                           qsizetype middle, qsizetype high, QStringView value,
                           qsizetype &position, int compareMethod);

/// The entry after `position` when it is equal to value: advances `position` and returns its
/// position in S. Otherwise `position` becomes -1 and the result is -1.
qsizetype FindNextInIndex(const QStringList &S, const QList<qsizetype> &X, qsizetype high,
                          QStringView value, qsizetype &position, int compareMethod);

/// X(position), or -1 when position is -1 (or outside X).
qsizetype IndexEntry(const QList<qsizetype> &X, qsizetype position);

/// Result of FindSequence.
struct SequenceSearch
{
    qsizetype Count = 0;     ///< matching places counted
    qsizetype Position = -1; ///< start of the n-th matching place, or -1
};

/// Walks the places of S where sequence(0..lastSequenceIndex) starts, in text order (places
/// may overlap), counting those that match. Stops at the n-th match (n < 1: counts all).
/// Uses and moves `position` like FindFirstInIndex / FindNextInIndex. A lastSequenceIndex beyond
/// the sequence is taken as its last index; an empty sequence matches nowhere.
SequenceSearch FindSequence(const QStringList &S, const QList<qsizetype> &X, qsizetype low,
                            qsizetype middle, qsizetype high, qsizetype &position,
                            int compareMethod, qsizetype n, const QStringList &sequence,
                            qsizetype lastSequenceIndex);

} // namespace verbloom
