#include "export/ExportResult.h"

namespace verbloom {

UserMessage FileSavedQuestion(const QString &path)
{
    return UserMessage{QStringLiteral("File Saved as ") + path + QStringLiteral("\r\nDo you want to open it?"),
                       ProgramTitle(), UserMessage::Icon::Information, UserMessage::Buttons::YesNo};
}

UserMessage WriteFailedMessage(const QString &path, const QString &reason)
{
    QString text = QStringLiteral("File could not be saved as ") + path;
    if (!reason.isEmpty())
        text += QStringLiteral("\r\n") + reason;
    return FailureMessage(text);
}

} // namespace verbloom
