#pragma once

#include <QString>

#include <optional>

namespace verbloom {

/// Rounds to the nearest integer, halves to even (0.5 -> 0, 1.5 -> 2, 2.5 -> 2).
double RoundHalfEven(double value);

/// Converts to a 16-bit integer the way typed numbers are converted: nearest, halves to even.
/// Empty when the rounded value lies outside -32768..32767 or is not finite.
std::optional<qint16> ToInt16(double value);

/// The numeric test: optional blanks, an optional sign, digits with at most one decimal point
/// (at least one digit), an optional exponent (E or D, optional sign, digits), optional blanks.
/// Blanks alone, or an empty text, are not a number.
bool IsNumeric(const QString &text, QChar decimalPoint = QLatin1Char('.'));

/// The value of a text that passes IsNumeric; empty otherwise.
std::optional<double> ParseNumber(const QString &text, QChar decimalPoint = QLatin1Char('.'));

/// A typed number converted to a 16-bit integer: empty when it is not numeric or out of range.
std::optional<qint16> TextToInt16(const QString &text, QChar decimalPoint = QLatin1Char('.'));

/// The leading number of a text, like Basic's Val: blanks, tabs and line feeds are skipped
/// anywhere, then an optional sign, digits, one "." and an exponent are read up to the first
/// character that does not fit. 0 when no digit is found.
double Val(const QString &text);

} // namespace verbloom
