#include "basStringArrayNdx.h"

#include <algorithm>
#include <numeric>

namespace verbloom {

namespace {

bool IsEqual(const QStringList &S, const QList<qsizetype> &X, qsizetype k, QStringView value,
             int compareMethod)
{
    return CompareByMethod(S.at(X.at(k)), value, compareMethod) == 0;
}

} // namespace

int CompareByMethod(QStringView a, QStringView b, int compareMethod)
{
    return a.compare(b, compareMethod == 1 ? Qt::CaseInsensitive : Qt::CaseSensitive);
}

void BuildSortIndex(const QStringList &S, QList<qsizetype> &X, int compareMethod)
{
    // A stable sort gives the same index as inserting each string after its equals, in
    // n log n time instead of shifting the index once per insertion.
    X.resize(S.size());
    std::iota(X.begin(), X.end(), qsizetype(0));
    std::stable_sort(X.begin(), X.end(), [&](qsizetype a, qsizetype b) {
        return CompareByMethod(S.at(a), S.at(b), compareMethod) < 0;
    });
}

qsizetype SearchSortedIndex(const QStringList &S, const QList<qsizetype> &X, qsizetype low,
                            qsizetype middle, qsizetype high, QStringView value,
                            int compareMethod, qsizetype &outLow)
{
    while (high - low >= 2) {
        const int c = CompareByMethod(value, S.at(X.at(middle)), compareMethod);
        if (c < 0) {
            high = middle;
            middle = low + (middle - low) / 2;
        } else if (c == 0) {
            outLow = low;
            return middle;
        } else {
            low = middle;
            middle = middle + (high - middle) / 2;
        }
    }
    qsizetype found = -1;
    for (qsizetype k = low; k <= high; ++k) {
        if (IsEqual(S, X, k, value, compareMethod))
            found = k;
    }
    outLow = low;
    return found;
}

qsizetype FindFirstInIndex(const QStringList &S, const QList<qsizetype> &X, qsizetype low,
                           qsizetype middle, qsizetype high, QStringView value,
                           qsizetype &position, int compareMethod)
{
    const bool resume = position >= 0 && position < X.size() && S.at(X.at(position)) == value;
    if (!resume) {
        qsizetype outLow = 0;
        position = X.isEmpty() ? -1
                               : SearchSortedIndex(S, X, low, middle, high, value, compareMethod,
                                                   outLow);
    }
    if (position == -1)
        return -1;
    while (position > 0 && IsEqual(S, X, position - 1, value, compareMethod))
        --position;
    return X.at(position);
}

qsizetype FindNextInIndex(const QStringList &S, const QList<qsizetype> &X, qsizetype high,
                          QStringView value, qsizetype &position, int compareMethod)
{
    if (position >= 0 && position < high && position + 1 < X.size()
        && IsEqual(S, X, position + 1, value, compareMethod)) {
        ++position;
        return X.at(position);
    }
    position = -1;
    return -1;
}

qsizetype IndexEntry(const QList<qsizetype> &X, qsizetype position)
{
    return position >= 0 && position < X.size() ? X.at(position) : -1;
}

SequenceSearch FindSequence(const QStringList &S, const QList<qsizetype> &X, qsizetype low,
                            qsizetype middle, qsizetype high, qsizetype &position,
                            int compareMethod, qsizetype n, const QStringList &sequence,
                            qsizetype lastSequenceIndex)
{
    SequenceSearch result;
    if (sequence.isEmpty())
        return result;
    const qsizetype m = std::min(lastSequenceIndex, sequence.size() - 1);
    const QString &first = sequence.first();
    qsizetype c = FindFirstInIndex(S, X, low, middle, high, first, position, compareMethod);
    while (c != -1) {
        bool matches = true;
        if (m > 0) {
            matches = c + m <= high;
            for (qsizetype q = 1; matches && q <= m; ++q)
                matches = CompareByMethod(S.at(c + q), sequence.at(q), compareMethod) == 0;
        }
        if (matches) {
            ++result.Count;
            if (result.Count == n) {
                result.Position = c;
                return result;
            }
        }
        c = FindNextInIndex(S, X, high, first, position, compareMethod);
    }
    return result;
}

} // namespace verbloom
