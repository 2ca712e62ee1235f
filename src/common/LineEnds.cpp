#include "LineEnds.h"

namespace verbloom {

QString LfToCrLf(QString text)
{
    return text.replace(QLatin1Char('\n'), QLatin1String("\r\n"));
}

QString NormalizeToLf(QString text)
{
    text.replace(QLatin1String("\r\n"), QLatin1String("\n"));
    text.replace(QLatin1Char('\r'), QLatin1Char('\n'));
    return text;
}

QString NormalizeToCrLf(QString text)
{
    return LfToCrLf(NormalizeToLf(std::move(text)));
}

} // namespace verbloom
