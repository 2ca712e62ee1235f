#pragma once

#include <QByteArray>
#include <QString>

namespace verbloom {

/// Decodes file bytes: UTF-8 when the bytes are valid UTF-8 (a leading BOM is dropped),
/// otherwise Windows-1252, so files from older installations still load.
QString DecodeText(const QByteArray &bytes);

/// Reads a whole text file; "" when it is missing, empty or unreadable.
QString ReadTextFile(const QString &path);

/// Reads a whole text file; false when it is missing or cannot be read.
bool TryReadTextFile(const QString &path, QString &text);

/// Creates or overwrites a file with the text as UTF-8 without BOM, atomically:
/// the file appears whole or not at all. Returns false when it could not be written.
bool WriteTextFile(const QString &path, const QString &text);

/// Writes bytes atomically (see WriteTextFile).
bool WriteBinaryFile(const QString &path, const QByteArray &bytes);

} // namespace verbloom
