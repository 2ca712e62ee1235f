#pragma once

#include "export/VersionSource.h"

#include <QByteArray>
#include <QFile>
#include <QString>

#include <functional>

namespace verbloom {

/// Deterministic versions for tests: version k (k = 2, 3, ...) is made by two functions of k,
/// so a test knows which version each statement, item or page must carry.
class NumberedVersions final : public VersionSource
{
public:
    NumberedVersions(std::function<QString(int)> title, std::function<QString(int)> contents)
        : m_title(std::move(title))
        , m_contents(std::move(contents))
    {
    }
    QString NextTitle() override { return m_title(m_nextTitle++); }
    QString NextContents() override { return m_contents(m_nextContents++); }
    int TitlesMade() const { return m_nextTitle - 2; }

private:
    std::function<QString(int)> m_title;
    std::function<QString(int)> m_contents;
    int m_nextTitle = 2;
    int m_nextContents = 2;
};

inline QByteArray ReadBytes(const QString &path)
{
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

} // namespace verbloom
