#include "export/VersionSpool.h"

#include <QDir>

namespace verbloom {

VersionSpool::VersionSpool()
    : m_file(QDir::tempPath() + QStringLiteral("/verbloom-spool-XXXXXX"))
{
    if (m_file.open()) {
        m_stream.setDevice(&m_file);
    } else {
        m_buffer.open(QIODevice::ReadWrite);
        m_stream.setDevice(&m_buffer);
    }
    m_stream.setVersion(QDataStream::Qt_6_4);
    m_ok = true;
}

bool VersionSpool::Append(const QString &first, const QString &second)
{
    if (!m_ok)
        return false;
    m_stream << first << second;
    if (m_stream.status() != QDataStream::Ok) {
        m_ok = false;
        return false;
    }
    ++m_count;
    return true;
}

bool VersionSpool::Rewind()
{
    m_read = 0;
    m_stream.resetStatus();
    return m_ok && m_stream.device()->seek(0);
}

bool VersionSpool::Next(QString &first, QString &second)
{
    if (!m_ok || m_read >= m_count)
        return false;
    m_stream >> first >> second;
    if (m_stream.status() != QDataStream::Ok)
        return false;
    ++m_read;
    return true;
}

} // namespace verbloom
