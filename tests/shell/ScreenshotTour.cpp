// Takes the documentation's screenshots of the shell windows: run it under Xvfb with the output
// folder as argument. Not a test; it walks the real windows through their states.
#include "common/ProgramFolder.h"
#include "common/TextFile.h"
#include "engine/frmConfirmOptions.h"
#include "engine/frmSuggestions.h"
#include "shell/AppStyle.h"
#include "shell/UiServices.h"
#include "shell/frmMain.h"
#include "shell/frmOpenURL.h"
#include "shell/frmSplash.h"
#include "thesaurus/ThesaurusService.h"

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QScreen>
#include <QTemporaryDir>
#include <QTimer>
#include <QTreeWidget>

#include <functional>
#include <memory>

#include <unistd.h>

using namespace verbloom;

namespace {

const QString SampleTitle = QStringLiteral("Simple Ways to Keep Your Garden Healthy");
const QString SampleContents = QStringLiteral(
    "A healthy garden starts with good soil. Before planting, work some compost into the ground so that "
    "roots find plenty of food and water.\n\n"
    "Water your plants early in the morning, when the air is cool and little moisture is lost. A thick "
    "layer of mulch keeps the soil damp and stops weeds from growing.\n\n"
    "Finally, walk through your garden every week. Small problems are easy to fix when you notice them "
    "early, and regular care will reward you with strong plants and beautiful flowers.");

void Save(QWidget *window, const QString &path)
{
    const QRect area = window->frameGeometry();
    const QPixmap shot = QGuiApplication::primaryScreen()->grabWindow(0, area.x(), area.y(), area.width(),
                                                                      area.height());
    if (!shot.save(path))
        qWarning("could not write %s", qPrintable(path));
    else
        qInfo("wrote %s", qPrintable(path));
}

/// Runs the steps one after another, each after the given pause, so pages can render.
class Tour final
{
public:
    void Then(int pauseMs, std::function<void()> step) { m_steps.append({pauseMs, std::move(step)}); }
    void Run()
    {
        if (m_next >= m_steps.size()) {
            QCoreApplication::quit();
            return;
        }
        const auto &[pause, step] = m_steps.at(m_next++);
        QTimer::singleShot(pause, [this, step = step] {
            step();
            Run();
        });
    }

private:
    QList<std::pair<int, std::function<void()>>> m_steps;
    qsizetype m_next = 0;
};

} // namespace

int main(int argc, char *argv[])
{
    if (geteuid() == 0)
        qputenv("QTWEBENGINE_DISABLE_SANDBOX", "1");
    QCoreApplication::setAttribute(Qt::AA_ShareOpenGLContexts);
    QApplication app(argc, argv);
    QApplication::setQuitOnLastWindowClosed(false);
    ApplyAppStyle(app);
    const QString out = argc > 1 ? QString::fromLocal8Bit(argv[1]) : QStringLiteral(".");
    QDir().mkpath(out);

    QTemporaryDir home;
    SetProgramFolder(home.path());
    WriteTextFile(home.filePath(QStringLiteral("SETTINGS.INI")),
                  QStringLiteral("[URL]\r\nSupportUrl=support@verbloom.example\r\n"
                                 "WebSiteUrl=https://www.verbloom.example\r\n"
                                 "[COMPANY]\r\nCompanyName=Verbloom Software\r\n"));
    QDir(home.path()).mkpath(QStringLiteral("data"));
    const QList<std::pair<QString, QString>> words = {
        {QStringLiteral("healthy"), QStringLiteral("thriving, flourishing, vigorous")},
        {QStringLiteral("garden"), QStringLiteral("yard, backyard, plot")},
        {QStringLiteral("simple"), QStringLiteral("easy, straightforward, basic")},
        {QStringLiteral("plants"), QStringLiteral("flowers, shrubs, greenery")},
        {QStringLiteral("water"), QStringLiteral("irrigate, sprinkle")},
        {QStringLiteral("early"), QStringLiteral("soon, promptly")},
        {QStringLiteral("problems"), QStringLiteral("issues, troubles")},
        {QStringLiteral("beautiful"), QStringLiteral("lovely, gorgeous, stunning")}};
    for (const auto &[word, alternatives] : words)
        WriteTextFile(home.filePath(QStringLiteral("data/") + word + QStringLiteral(".dat")), alternatives);

    ThesaurusService thesaurus;
    if (!thesaurus.Start(ThesaurusService::DefaultDataPath()))
        thesaurus.StartWithoutData();
    ScriptedUiServices ui;
    std::unique_ptr<frmMain> mainWindow;
    auto *splash = new frmSplash([&]() -> QWidget * {
        mainWindow = std::make_unique<frmMain>(ui, thesaurus.BaseUrl());
        return mainWindow.get();
    });
    splash->move(360, 220);
    splash->show();

    Tour tour;
    tour.Then(1500, [&] { Save(splash, out + QStringLiteral("/splash.png")); });
    tour.Then(3000, [&] {
        mainWindow->move(0, 0);
        mainWindow->resize(1100, 760);
        mainWindow->txtTitle->setText(SampleTitle);
        mainWindow->txtArticle->setPlainText(SampleContents);
    });
    tour.Then(1500, [&] { Save(mainWindow.get(), out + QStringLiteral("/main-entry.png")); });
    tour.Then(100, [&] {
        mainWindow->cmdConfig_Click();
        for (const QString &word : {QStringLiteral("compost"), QStringLiteral("mulch")}) {
            mainWindow->findChild<QLineEdit *>(QStringLiteral("txtIgnoreWord"))->setText(word);
            mainWindow->cmdIgnoreWordsAdd_Click();
        }
    });
    tour.Then(800, [&] { Save(mainWindow.get(), out + QStringLiteral("/main-configuration.png")); });
    tour.Then(100, [&] {
        mainWindow->cmdArticle_Click();
        mainWindow->cmbCustomizationLevel->setCurrentIndex(0); // "Maximum": a version that shows it
        frmSuggestions &suggestions = mainWindow->Suggestions();
        // The first word without a word file offers its meanings: photograph the window then, tick
        // the first meaning, and let later lookups take their last meaning without asking.
        QTimer::singleShot(2500, [&] {
            auto *confirm = qobject_cast<frmConfirmOptions *>(QApplication::activeModalWidget());
            if (!confirm)
                return;
            suggestions.move(0, 0);
            confirm->move(120, 90);
            Save(&suggestions, out + QStringLiteral("/suggestions-during-analysis.png"));
            Save(confirm, out + QStringLiteral("/confirm-meaning.png"));
            auto *meanings = confirm->findChild<QTreeWidget *>(QStringLiteral("lstSuggestionsFromWeb"));
            if (meanings && meanings->topLevelItemCount() > 0)
                meanings->topLevelItem(0)->setCheckState(0, Qt::Checked);
            suggestions.findChild<QCheckBox *>(QStringLiteral("chkDontPrompt"))->setChecked(true);
            confirm->cmdSuggestionOk_Click();
        });
        mainWindow->cmdNext_Click();
        suggestions.move(0, 0);
        suggestions.SSTab1_Click(1);
        suggestions.lstSuggestions_ItemClick(1, 11);
    });
    tour.Then(1500, [&] {
        Save(&mainWindow->Suggestions(), out + QStringLiteral("/suggestions-after-analysis.png"));
        mainWindow->Suggestions().close();
        mainWindow->move(0, 0);
    });
    tour.Then(1500, [&] { Save(mainWindow.get(), out + QStringLiteral("/main-verify.png")); });
    tour.Then(100, [&] {
        auto *loader = new frmOpenURL(*mainWindow->txtTitle, *mainWindow->txtArticle, ui, mainWindow.get());
        loader->setAttribute(Qt::WA_DeleteOnClose);
        loader->findChild<QLineEdit *>(QStringLiteral("txturl"))->setText(
            QStringLiteral("https://www.example.com/articles/garden-care.html"));
        loader->move(200, 150);
        loader->show();
    });
    tour.Then(1200, [&] {
        Save(mainWindow->findChild<frmOpenURL *>(), out + QStringLiteral("/open-url.png"));
    });
    tour.Run();
    const int result = QApplication::exec();
    mainWindow.reset();
    return result;
}
