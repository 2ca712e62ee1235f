#include "UiServices.h"

#include <QDesktopServices>
#include <QFileDialog>
#include <QFileInfo>
#include <QMessageBox>
#include <QUrl>

namespace verbloom {

namespace {

QMessageBox::StandardButton ToStandard(UiServices::Answer answer)
{
    switch (answer) {
    case UiServices::Answer::Ok: return QMessageBox::Ok;
    case UiServices::Answer::Cancel: return QMessageBox::Cancel;
    case UiServices::Answer::Yes: return QMessageBox::Yes;
    case UiServices::Answer::No: return QMessageBox::No;
    }
    return QMessageBox::Ok;
}

QMessageBox::StandardButtons ButtonSet(UiServices::Buttons buttons)
{
    switch (buttons) {
    case UiServices::Buttons::Ok: return QMessageBox::Ok;
    case UiServices::Buttons::OkCancel: return QMessageBox::Ok | QMessageBox::Cancel;
    case UiServices::Buttons::YesNo: return QMessageBox::Yes | QMessageBox::No;
    case UiServices::Buttons::YesNoCancel: return QMessageBox::Yes | QMessageBox::No | QMessageBox::Cancel;
    }
    return QMessageBox::Ok;
}

QMessageBox::Icon ToQtIcon(UiServices::Icon icon)
{
    switch (icon) {
    case UiServices::Icon::None: return QMessageBox::NoIcon;
    case UiServices::Icon::Information: return QMessageBox::Information;
    case UiServices::Icon::Exclamation: return QMessageBox::Warning;
    case UiServices::Icon::Critical: return QMessageBox::Critical;
    case UiServices::Icon::Question: return QMessageBox::Question;
    }
    return QMessageBox::NoIcon;
}

UiServices::Answer FromStandard(int button, UiServices::Buttons set)
{
    switch (button) {
    case QMessageBox::Ok: return UiServices::Answer::Ok;
    case QMessageBox::Yes: return UiServices::Answer::Yes;
    case QMessageBox::No: return UiServices::Answer::No;
    case QMessageBox::Cancel: return UiServices::Answer::Cancel;
    default: break;
    }
    // The close box: Cancel where there is one, else No, else Ok.
    if (set == UiServices::Buttons::OkCancel || set == UiServices::Buttons::YesNoCancel)
        return UiServices::Answer::Cancel;
    return set == UiServices::Buttons::YesNo ? UiServices::Answer::No : UiServices::Answer::Ok;
}

QString DefaultTitle(const QString &title)
{
    return title.isEmpty() ? QStringLiteral("Verbloom") : title;
}

} // namespace

UiServices::Answer UiServices::Show(QWidget *parent, const UserMessage &message)
{
    static constexpr Icon kIcons[] = {Icon::None, Icon::Information, Icon::Exclamation, Icon::Critical,
                                      Icon::Question};
    static constexpr Buttons kButtons[] = {Buttons::Ok, Buttons::OkCancel, Buttons::YesNo};
    Message shown;
    shown.Text = message.Text;
    shown.Title = DefaultTitle(message.Title);
    shown.IconKind = kIcons[static_cast<int>(message.IconKind)];
    shown.ButtonSet = kButtons[static_cast<int>(message.ButtonSet)];
    shown.DefaultButton = shown.ButtonSet == Buttons::YesNo ? Answer::Yes : Answer::Ok;
    return ShowMessage(parent, shown);
}

UiServices::Answer UiServices::Say(QWidget *parent, const QString &text, Icon icon, Buttons buttons,
                                   const QString &title)
{
    Message message;
    message.Text = text;
    message.Title = DefaultTitle(title);
    message.ButtonSet = buttons;
    message.IconKind = icon;
    message.DefaultButton = buttons == Buttons::Ok || buttons == Buttons::OkCancel ? Answer::Ok : Answer::Yes;
    return ShowMessage(parent, message);
}

UiServices::Answer QtUiServices::ShowMessage(QWidget *parent, const Message &message)
{
    QMessageBox box(ToQtIcon(message.IconKind), DefaultTitle(message.Title), message.Text,
                    ButtonSet(message.ButtonSet), parent);
    box.setDefaultButton(ToStandard(message.DefaultButton));
    return FromStandard(box.exec(), message.ButtonSet);
}

QString QtUiServices::GetOpenFileName(QWidget *parent, const FileDialog &dialog)
{
    return QFileDialog::getOpenFileName(parent, dialog.Title,
                                        dialog.Directory.isEmpty() ? dialog.FileName : dialog.Directory,
                                        dialog.Filter);
}

QString QtUiServices::GetSaveFileName(QWidget *parent, const FileDialog &dialog)
{
    QFileDialog box(parent, dialog.Title, dialog.Directory, dialog.Filter);
    box.setAcceptMode(QFileDialog::AcceptSave);
    // The program's saves replace an existing file of the chosen name without a question.
    box.setOption(QFileDialog::DontConfirmOverwrite);
    box.setDefaultSuffix(dialog.DefaultSuffix);
    if (!dialog.FileName.isEmpty())
        box.selectFile(dialog.FileName);
    if (box.exec() != QDialog::Accepted || box.selectedFiles().isEmpty())
        return {};
    return box.selectedFiles().constFirst();
}

QString QtUiServices::GetExistingDirectory(QWidget *parent, const QString &title, const QString &start)
{
    return QFileDialog::getExistingDirectory(parent, title, start);
}

bool QtUiServices::OpenWithShell(const QString &pathOrUrl)
{
    const QUrl url = QFileInfo::exists(pathOrUrl) ? QUrl::fromLocalFile(pathOrUrl)
                                                   : QUrl::fromUserInput(pathOrUrl);
    return QDesktopServices::openUrl(url);
}

UiServices::Answer ScriptedUiServices::ShowMessage(QWidget *, const Message &message)
{
    Messages.append(message);
    return NextAnswers.isEmpty() ? message.DefaultButton : NextAnswers.takeFirst();
}

QString ScriptedUiServices::GetOpenFileName(QWidget *, const FileDialog &dialog)
{
    FileDialogs.append(dialog);
    return NextFileNames.isEmpty() ? QString() : NextFileNames.takeFirst();
}

QString ScriptedUiServices::GetSaveFileName(QWidget *, const FileDialog &dialog)
{
    FileDialogs.append(dialog);
    return NextFileNames.isEmpty() ? QString() : NextFileNames.takeFirst();
}

QString ScriptedUiServices::GetExistingDirectory(QWidget *, const QString &, const QString &)
{
    return NextDirectories.isEmpty() ? QString() : NextDirectories.takeFirst();
}

bool ScriptedUiServices::OpenWithShell(const QString &pathOrUrl)
{
    Opened.append(pathOrUrl);
    return OpenSucceeds;
}

} // namespace verbloom
