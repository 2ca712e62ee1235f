#include "AlternativesList.h"

namespace verbloom {

QString TrimSpaces(QStringView text)
{
    qsizetype begin = 0;
    qsizetype end = text.size();
    while (begin < end && text[begin] == QLatin1Char(' '))
        ++begin;
    while (end > begin && text[end - 1] == QLatin1Char(' '))
        --end;
    return text.sliced(begin, end - begin).toString();
}

QStringList SplitAlternatives(const QString &alternatives)
{
    return alternatives.split(QLatin1Char(','), Qt::KeepEmptyParts);
}

} // namespace verbloom
