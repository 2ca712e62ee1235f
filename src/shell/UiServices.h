#pragma once

#include "export/UserMessage.h"

#include <QList>
#include <QString>
#include <QStringList>

class QWidget;

namespace verbloom {

/// Message boxes, file dialogs, the folder picker and the shell's "open", behind one seam so that
/// tests can script the answers and record what was shown.
class UiServices
{
public:
    enum class Icon { None, Information, Exclamation, Critical, Question };
    enum class Buttons { Ok, OkCancel, YesNo, YesNoCancel };
    enum class Answer { Ok, Cancel, Yes, No };

    struct Message
    {
        QString Text;
        QString Title;
        Buttons ButtonSet = Buttons::Ok;
        Icon IconKind = Icon::None;
        Answer DefaultButton = Answer::Ok;
    };

    struct FileDialog
    {
        QString Title;
        QString Filter;           ///< Qt filter, such as "Text Files (*.txt);;All Files (*)"
        QString DefaultSuffix;    ///< without the dot
        QString Directory;
        QString FileName;         ///< proposed name
    };

    virtual ~UiServices() = default;

    virtual Answer ShowMessage(QWidget *parent, const Message &message) = 0;
    /// The chosen file; empty when cancelled.
    virtual QString GetOpenFileName(QWidget *parent, const FileDialog &dialog) = 0;
    /// The file to save; an existing file is chosen without a question about replacing it.
    virtual QString GetSaveFileName(QWidget *parent, const FileDialog &dialog) = 0;
    /// The chosen folder; empty when cancelled.
    virtual QString GetExistingDirectory(QWidget *parent, const QString &title, const QString &start) = 0;
    /// Opens a file, folder or address with the user's default program; false when that failed.
    virtual bool OpenWithShell(const QString &pathOrUrl) = 0;

    /// Shows a message the core handed back (default button: Ok, or Yes for a question).
    Answer Show(QWidget *parent, const UserMessage &message);

    /// Shorthand for a message with the program's title "Verbloom" unless another is given.
    Answer Say(QWidget *parent, const QString &text, Icon icon = Icon::None,
               Buttons buttons = Buttons::Ok, const QString &title = QString());
};

/// The real dialogs (QMessageBox, QFileDialog, QDesktopServices).
class QtUiServices final : public UiServices
{
public:
    Answer ShowMessage(QWidget *parent, const Message &message) override;
    QString GetOpenFileName(QWidget *parent, const FileDialog &dialog) override;
    QString GetSaveFileName(QWidget *parent, const FileDialog &dialog) override;
    QString GetExistingDirectory(QWidget *parent, const QString &title, const QString &start) override;
    bool OpenWithShell(const QString &pathOrUrl) override;
};

/// Scripted answers for tests; records everything shown. An unscripted message answers its
/// default button, an unscripted dialog answers "cancelled".
class ScriptedUiServices final : public UiServices
{
public:
    QList<Message> Messages;
    QList<FileDialog> FileDialogs;
    QStringList Opened;
    QList<Answer> NextAnswers;
    QStringList NextFileNames;
    QStringList NextDirectories;
    bool OpenSucceeds = true; ///< what OpenWithShell answers

    Answer ShowMessage(QWidget *parent, const Message &message) override;
    QString GetOpenFileName(QWidget *parent, const FileDialog &dialog) override;
    QString GetSaveFileName(QWidget *parent, const FileDialog &dialog) override;
    QString GetExistingDirectory(QWidget *parent, const QString &title, const QString &start) override;
    bool OpenWithShell(const QString &pathOrUrl) override;
};

} // namespace verbloom
