#pragma once

#include <QBuffer>
#include <QDataStream>
#include <QString>
#include <QTemporaryFile>

namespace verbloom {

/// Pairs of texts kept on disk, in order, while a run collects its versions, so that memory does
/// not grow with their number. Falls back to memory when no temporary file can be made.
/// The temporary file is removed when the spool goes away.
class VersionSpool final
{
public:
    VersionSpool();
    VersionSpool(const VersionSpool &) = delete;
    VersionSpool &operator=(const VersionSpool &) = delete;

    /// Appends one pair; false when it could not be stored.
    bool Append(const QString &first, const QString &second);
    qsizetype Count() const { return m_count; }

    /// Starts reading from the first pair.
    bool Rewind();
    /// Reads the next pair; false when there is none or it could not be read.
    bool Next(QString &first, QString &second);

private:
    QTemporaryFile m_file;
    QBuffer m_buffer;
    QDataStream m_stream;
    qsizetype m_count = 0;
    qsizetype m_read = 0;
    bool m_ok = false;
};

} // namespace verbloom
