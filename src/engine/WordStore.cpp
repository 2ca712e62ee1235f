#include "WordStore.h"

#include "common/TextFile.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>

namespace verbloom {

namespace {

// The longest word file name in bytes: the file systems we run on accept 255, and an atomic save
// first writes a temporary file named after it with seven more characters (".XXXXXX").
constexpr qsizetype kMaxFileNameBytes = 255 - 7;

} // namespace

WordStore::WordStore(const QString &programFolder)
    : m_dataFolder(programFolder + QLatin1String("/data"))
{
}

QString WordStore::DataFolder() const
{
    return m_dataFolder;
}

QString WordStore::GetWordFilePath(const QString &word) const
{
    const QString name = word.toLower() + QLatin1String(".dat");
    if (name.contains(QChar(0)) || name.contains(QLatin1Char('/'))
        || name.toUtf8().size() > kMaxFileNameBytes)
        return {};
    return m_dataFolder + QLatin1Char('/') + name;
}

bool WordStore::WordFileExists(const QString &word, const WordTestSettings &settings) const
{
    if (!IsCustomizableWord(word, settings))
        return false;
    QDir().mkpath(m_dataFolder);
    const QString path = GetWordFilePath(word);
    return !path.isEmpty() && QFileInfo(path).isFile();
}

QString WordStore::ReadAlternatives(const QString &word) const
{
    const QString path = GetWordFilePath(word);
    return path.isEmpty() ? QString() : ReadTextFile(path);
}

bool WordStore::WriteAlternatives(const QString &word, const QString &alternatives) const
{
    const QString path = GetWordFilePath(word);
    if (path.isEmpty())
        return false;
    QDir().mkpath(m_dataFolder);
    // Rows are saved on every click: leave a file alone when it already holds these bytes.
    const QByteArray bytes = alternatives.toUtf8();
    QFile existing(path);
    if (existing.size() == bytes.size() && existing.open(QIODevice::ReadOnly) && existing.readAll() == bytes)
        return true;
    return WriteBinaryFile(path, bytes);
}

} // namespace verbloom
