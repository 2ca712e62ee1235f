#pragma once

#include <QString>

namespace verbloom {

/// One value of an INI file. Section and key names ignore case; blanks around "=" and around
/// the value are trimmed, and a value enclosed in one pair of double quotes loses them.
/// A missing file, section or key gives "". Lines starting with ";" are comments.
/// The whole value is returned (no length cut).
QString ReadIniValue(const QString &section, const QString &key, const QString &file);

} // namespace verbloom
