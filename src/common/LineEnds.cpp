#include "LineEnds.h"

namespace verbloom {

QString LfToCrLf(QString text)
{
    return text.replace(QLatin1Char('\n'), QLatin1String("\r\n"));
}

QString NormalizeToCrLf(QString text)
{
    text.replace(QLatin1String("\r\n"), QLatin1String("\n"));
    text.replace(QLatin1Char('\r'), QLatin1Char('\n'));
    return LfToCrLf(std::move(text));
}

} // namespace verbloom
