#include "Numbers.h"

#include <cmath>
#include <limits>

namespace verbloom {

namespace {

bool IsBlank(QChar c)
{
    return c == QLatin1Char(' ') || c == QLatin1Char('\t');
}

bool IsDigit(QChar c)
{
    return c >= QLatin1Char('0') && c <= QLatin1Char('9');
}

// Reads "[sign]digits[.digits][E[sign]digits]" from text starting at pos into an ASCII number
// with "." as decimal point. Returns false when no mantissa digit was found; pos then is undefined.
bool ScanNumber(const QString &text, qsizetype &pos, QChar decimalPoint, QByteArray &ascii)
{
    const qsizetype n = text.size();
    if (pos < n && (text[pos] == QLatin1Char('+') || text[pos] == QLatin1Char('-')))
        ascii += static_cast<char>(text[pos++].unicode());
    bool digits = false;
    bool point = false;
    while (pos < n) {
        const QChar c = text[pos];
        if (IsDigit(c)) {
            ascii += static_cast<char>(c.unicode());
            digits = true;
        } else if (c == decimalPoint && !point) {
            ascii += '.';
            point = true;
        } else {
            break;
        }
        ++pos;
    }
    if (!digits)
        return false;
    if (pos < n && (text[pos] == QLatin1Char('e') || text[pos] == QLatin1Char('E')
                    || text[pos] == QLatin1Char('d') || text[pos] == QLatin1Char('D'))) {
        qsizetype p = pos + 1;
        QByteArray exponent = "e";
        if (p < n && (text[p] == QLatin1Char('+') || text[p] == QLatin1Char('-')))
            exponent += static_cast<char>(text[p++].unicode());
        bool expDigits = false;
        while (p < n && IsDigit(text[p])) {
            exponent += static_cast<char>(text[p++].unicode());
            expDigits = true;
        }
        if (expDigits) {
            ascii += exponent;
            pos = p;
        }
    }
    return true;
}

} // namespace

double RoundHalfEven(double value)
{
    const double floor = std::floor(value);
    const double diff = value - floor;
    if (diff < 0.5)
        return floor;
    if (diff > 0.5)
        return floor + 1.0;
    return std::fmod(floor, 2.0) == 0.0 ? floor : floor + 1.0;
}

std::optional<qint16> ToInt16(double value)
{
    if (!std::isfinite(value))
        return std::nullopt;
    const double rounded = RoundHalfEven(value);
    if (rounded < std::numeric_limits<qint16>::min() || rounded > std::numeric_limits<qint16>::max())
        return std::nullopt;
    return static_cast<qint16>(rounded);
}

std::optional<double> ParseNumber(const QString &text, QChar decimalPoint)
{
    qsizetype pos = 0;
    const qsizetype n = text.size();
    while (pos < n && IsBlank(text[pos]))
        ++pos;
    QByteArray ascii;
    if (!ScanNumber(text, pos, decimalPoint, ascii))
        return std::nullopt;
    // An exponent marker that was not followed by digits is not part of a number.
    while (pos < n && IsBlank(text[pos]))
        ++pos;
    if (pos != n)
        return std::nullopt;
    bool ok = false;
    const double value = QString::fromLatin1(ascii).toDouble(&ok);
    if (!ok)
        return std::nullopt;
    return value;
}

bool IsNumeric(const QString &text, QChar decimalPoint)
{
    return ParseNumber(text, decimalPoint).has_value();
}

std::optional<qint16> TextToInt16(const QString &text, QChar decimalPoint)
{
    const std::optional<double> value = ParseNumber(text, decimalPoint);
    if (!value)
        return std::nullopt;
    return ToInt16(*value);
}

double Val(const QString &text)
{
    QString compact;
    compact.reserve(text.size());
    for (const QChar c : text) {
        if (!IsBlank(c) && c != QLatin1Char('\n'))
            compact += c;
    }
    qsizetype pos = 0;
    QByteArray ascii;
    if (!ScanNumber(compact, pos, QLatin1Char('.'), ascii))
        return 0.0;
    bool ok = false;
    const double value = QString::fromLatin1(ascii).toDouble(&ok);
    return ok ? value : 0.0;
}

} // namespace verbloom
