#pragma once

#include "common/ProgramFolder.h"
#include "common/TextFile.h"
#include "shell/ImageCommand.h"
#include "shell/UiServices.h"
#include "shell/frmMain.h"

#include <QDir>
#include <QLabel>
#include <QMouseEvent>
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

/// A main window over a fresh program folder, with scripted dialogs, shown on screen.
class MainRig
{
public:
    explicit MainRig(const QString &thesaurusHost, const QByteArray &settingsIni = QByteArray())
    {
        SetProgramFolder(Home.path());
        if (!settingsIni.isEmpty())
            WriteBinaryFile(Home.filePath(QStringLiteral("SETTINGS.INI")), settingsIni);
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

    void WriteWordFile(const QString &word, const QString &alternatives)
    {
        QDir(Home.path()).mkpath(QStringLiteral("data"));
        QVERIFY(WriteTextFile(Home.filePath(QStringLiteral("data/") + word + QStringLiteral(".dat")), alternatives));
    }

    QTemporaryDir Home;
    ScriptedUiServices Ui;
    std::unique_ptr<frmMain> Main;
};

} // namespace verbloom::test
