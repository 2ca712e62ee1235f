#pragma once

#include <QString>
#include <QStringList>
#include <QStringView>

namespace verbloom {

/// The text without leading and trailing blanks (U+0020 only; tabs and line breaks stay).
QString TrimSpaces(QStringView text);

/// The pieces of an AlternativesList: split at every ",", empty pieces kept, nothing trimmed.
QStringList SplitAlternatives(const QString &alternatives);

} // namespace verbloom
