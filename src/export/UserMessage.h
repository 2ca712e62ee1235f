#pragma once

#include <QList>
#include <QString>

namespace verbloom {

/// A message for the user, handed back as data: the window (or the batch tool) shows it.
struct UserMessage
{
    enum class Icon { None, Information, Exclamation, Critical, Question };
    enum class Buttons { Ok, OkCancel, YesNo };

    QString Text;
    QString Title;
    Icon IconKind = Icon::Information;
    Buttons ButtonSet = Buttons::Ok;

    friend bool operator==(const UserMessage &, const UserMessage &) = default;
};

/// The title of the export and website messages.
inline QString MessageTitle()
{
    return QStringLiteral("Message");
}

/// The program's own title, used by the questions that name no other.
inline QString ProgramTitle()
{
    return QStringLiteral("Verbloom");
}

/// An OK message titled "Message" with the information icon, as the export windows show them.
inline UserMessage InformationMessage(const QString &text)
{
    return UserMessage{text, MessageTitle(), UserMessage::Icon::Information, UserMessage::Buttons::Ok};
}

/// An OK message titled "Message" with the exclamation icon: a failure to report.
inline UserMessage FailureMessage(const QString &text)
{
    return UserMessage{text, MessageTitle(), UserMessage::Icon::Exclamation, UserMessage::Buttons::Ok};
}

} // namespace verbloom
