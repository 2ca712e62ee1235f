#pragma once

#include "common/ProgramFolder.h"
#include "common/TextFile.h"
#include "shell/ImageCommand.h"
#include "shell/UiServices.h"
#include "shell/frmMain.h"

#include <QDir>
#include <QLabel>
#include <QLineEdit>
#include <QMouseEvent>
#include <QPlainTextEdit>
#include <QTemporaryDir>
#include <QTest>

#include <memory>

namespace verbloom::test {

/// Sends a plain mouse move (no button) to the widget, as the pointer crossing it would.
inline void MoveMouseOver(QWidget *widget)
{
    const QPointF at(1, 1);
    QMouseEvent move(QEvent::MouseMove, at, widget->mapToGlobal(at), Qt::NoButton, Qt::NoButton,
                     Qt::NoModifier);
    QCoreApplication::sendEvent(widget, &move);
}

/// A message box as one line, so that a test compares the boxes shown with those it expects.
inline QString Box(const QString &text, UiServices::Buttons buttons = UiServices::Buttons::Ok,
                   UiServices::Icon icon = UiServices::Icon::None, const QString &title = u"Verbloom"_qs)
{
    return title + u": "_qs + text + u" [buttons "_qs + QString::number(int(buttons)) + u", icon "_qs
        + QString::number(int(icon)) + u"]"_qs;
}

inline QStringList Boxes(const ScriptedUiServices &ui)
{
    QStringList boxes;
    for (const UiServices::Message &message : ui.Messages)
        boxes << Box(message.Text, message.ButtonSet, message.IconKind, message.Title);
    return boxes;
}

/// A main window over a fresh program folder, with scripted dialogs, shown on screen.
class MainRig
{
public:
    explicit MainRig(const QString &thesaurusHost, const QByteArray &settingsIni = QByteArray())
    {
        SetProgramFolder(Home.path());
        if (!settingsIni.isEmpty())
            WriteBinaryFile(Home.filePath(u"SETTINGS.INI"_qs), settingsIni);
        Main = std::make_unique<frmMain>(Ui, thesaurusHost);
        Main->show();
        QVERIFY(QTest::qWaitForWindowExposed(Main.get()));
    }

    template<typename T = QWidget> T *Find(const QString &name) const
    {
        T *child = Main->findChild<T *>(name);
        if (!child)
            qWarning("no child named %s", qPrintable(name));
        return child;
    }

    /// The command whose label or image has this name.
    ImageCommand *Command(const QString &partName) const
    {
        return qobject_cast<ImageCommand *>(Find<QLabel>(partName)->parentWidget());
    }
    QString Skin(const QString &imageName) const { return Command(imageName)->Skin(); }

    void Click(const QString &labelOrImage) { QTest::mouseClick(Find<QLabel>(labelOrImage), Qt::LeftButton); }

    QString Text(const QString &box) const
    {
        if (auto *line = Main->findChild<QLineEdit *>(box))
            return line->text();
        return Find<QPlainTextEdit>(box)->toPlainText();
    }
    void EnterArticle(const QString &title, const QString &contents)
    {
        Find<QLineEdit>(u"txtTitle"_qs)->setText(title);
        Find<QPlainTextEdit>(u"txtArticle"_qs)->setPlainText(contents);
    }

    void WriteWordFile(const QString &word, const QString &alternatives)
    {
        QDir(Home.path()).mkpath(u"data"_qs);
        QVERIFY(WriteTextFile(Home.filePath(u"data/"_qs + word + u".dat"_qs), alternatives));
    }

    QTemporaryDir Home;
    ScriptedUiServices Ui;
    std::unique_ptr<frmMain> Main;
};

} // namespace verbloom::test
