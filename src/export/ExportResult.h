#pragma once

#include "export/UserMessage.h"

#include <QList>
#include <QString>

namespace verbloom {

/// What an export run did and what the window shows afterwards.
struct ExportResult
{
    enum class Status {
        Invalid,        ///< a check failed; nothing was generated or written
        NothingToDo,    ///< the count asks for no version; nothing happened, no message
        NothingWritten, ///< versions were made but none had the text needed; the file is untouched
        WriteFailed,    ///< the file could not be written; an existing file is untouched
        Written         ///< the file was written whole
    };

    Status Outcome = Status::Invalid;
    /// Messages to show, in this order. A message with Buttons::YesNo asks whether to open the
    /// file: on Yes the window hands OpenOnYes to the shell's "open".
    QList<UserMessage> Messages;
    QString OpenOnYes;
    /// The path the run used (SqlFileName / XmlFileName).
    QString FileName;
    /// Statements or feed items written.
    qsizetype Versions = 0;
};

/// "File Saved as " + path + CR LF + "Do you want to open it?", Yes/No, the program's title.
UserMessage FileSavedQuestion(const QString &path);

/// The report of a file that could not be written, with the system's reason when there is one.
UserMessage WriteFailedMessage(const QString &path, const QString &reason);

} // namespace verbloom
