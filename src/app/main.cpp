// Start-up of the desktop program.
#include "common/ProgramFolder.h"
#include "shell/AppStyle.h"
#include "shell/SplitterMessageBox.h"
#include "shell/UiServices.h"
#include "shell/frmMain.h"
#include "shell/frmSplash.h"
#include "thesaurus/ThesaurusService.h"

#include <QApplication>

#include <memory>

#include <unistd.h>

int main(int argc, char *argv[])
{
    // WebEngine refuses to run as root with its sandbox on.
    if (geteuid() == 0)
        qputenv("QTWEBENGINE_DISABLE_SANDBOX", "1");
    QCoreApplication::setAttribute(Qt::AA_ShareOpenGLContexts);
    QApplication app(argc, argv);
    QApplication::setApplicationName(QStringLiteral("Verbloom"));
    // The main window is hidden while the suggestions window works; closing it ends the program.
    QApplication::setQuitOnLastWindowClosed(false);
    verbloom::InitProgramFolder(QCoreApplication::arguments());
    verbloom::ApplyAppStyle(app);

    verbloom::QtUiServices ui;
    verbloom::SplitterMessageBox splitterBox(ui);
    verbloom::SetSplitterMessageSink(&splitterBox);

    const verbloom::ThesaurusHost thesaurus = verbloom::StartThesaurusHost(verbloom::SettingsIniPath(), &app);

    std::unique_ptr<verbloom::frmMain> mainWindow;
    auto *splash = new verbloom::frmSplash([&]() -> QWidget * {
        mainWindow = std::make_unique<verbloom::frmMain>(ui, thesaurus.Url);
        mainWindow->SetStartupNotice(thesaurus.Message);
        return mainWindow.get();
    });
    splash->show();

    const int result = QApplication::exec();
    mainWindow.reset();
    verbloom::SetSplitterMessageSink(nullptr);
    return result;
}
