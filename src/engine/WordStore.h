#pragma once

#include "shell/ArticleModel.h"

#include <QString>

namespace verbloom {

/// The word files: one file per customizable word in the data folder below the program folder,
/// named after the word in lower case, holding the word's AlternativesList.
class WordStore final
{
public:
    /// Uses programFolder + "/data".
    explicit WordStore(const QString &programFolder);

    QString DataFolder() const;

    /// The word file's path; empty when the word cannot be a file name (a NUL, a "/", or a name
    /// longer than the file system allows). Such a word reads as no file and is never written.
    QString GetWordFilePath(const QString &word) const;

    /// False at once when the word is not customizable; otherwise creates the data folder when
    /// missing and tells whether the word file exists.
    bool WordFileExists(const QString &word, const WordTestSettings &settings) const;

    /// The word file's text; "" when it is missing, empty or the word has no file name.
    QString ReadAlternatives(const QString &word) const;

    /// Writes the word file atomically; false when it could not be written or has no file name.
    bool WriteAlternatives(const QString &word, const QString &alternatives) const;

private:
    QString m_dataFolder;
};

} // namespace verbloom
