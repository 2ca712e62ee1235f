// The main window: loading, the wizard step and its cancel paths with the real suggestions
// window, the verify page and "Save Cont.", the panels, ignored words, and the button skins.
#include "ShellRig.h"
#include "ShellTestMain.h"

#include "engine/frmSuggestions.h"
#include "shell/ArticleModel.h"
#include "shell/WebEngineBrowser.h"
#include "shell/frmWait.h"
#include "thesaurus/ThesaurusService.h"

#include <QCheckBox>
#include <QComboBox>
#include <QFile>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTimer>
#include <QTreeWidget>

using namespace verbloom;
using namespace verbloom::test;

namespace {

const QStringList OutputControls = {
    QStringLiteral("cmdVerifyTryAgain"), QStringLiteral("imgReGenerate"),   QStringLiteral("lblSaveAsSQLfile"),
    QStringLiteral("imgSaveAsSql"),      QStringLiteral("imgSaveAsXML"),    QStringLiteral("lblSaveAsxml"),
    QStringLiteral("cmdSave"),           QStringLiteral("imgSaveContents"), QStringLiteral("cmdGenerateSite"),
    QStringLiteral("imgGenerateSite")};

const QStringList ButtonBarImages = {
    QStringLiteral("imgCmdArticle"), QStringLiteral("imgCmdConfig"),   QStringLiteral("imgReGenerate"),
    QStringLiteral("imgSaveAsXML"),  QStringLiteral("imgSaveAsSql"),   QStringLiteral("imgHelp"),
    QStringLiteral("imgGenerateSite"), QStringLiteral("imgSaveContents")};

const QString Normal = QStringLiteral("button_blue");
const QString Hover = QStringLiteral("button_blue_hover");

QByteArray ReadBytes(const QString &path)
{
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

} // namespace

class tst_frmMain final : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();
    void loadsInEntryState();
    void blankArticleRefused_data();
    void blankArticleRefused();
    void nextAppendsBlanks_data();
    void nextAppendsBlanks();
    void nextFillsListsThenVerify();
    void lookupThroughWebData();
    void cancelDuringAnalysis();
    void cancelAfterListsComplete();
    void saveContents_data();
    void saveContents();
    void saveContentsCancelledOrFailing();
    void panels();
    void browseTextFile_data();
    void browseTextFile();
    void helpAndCommand1();
    void ignoredWordAdd_data();
    void ignoredWordAdd();
    void ignoredWordsRemoveAndClear();
    void hoverButtonBar();
    void hoverPanelsAndWizardButton();

private:
    void EnterArticle(MainRig &rig, const QString &title, const QString &contents);
    void CheckEntryState(MainRig &rig);
    void CheckOutputEnabled(MainRig &rig, bool enabled);

    ThesaurusService m_thesaurus;
};

void tst_frmMain::initTestCase()
{
    if (!m_thesaurus.Start(ThesaurusService::DefaultDataPath()))
        QVERIFY(m_thesaurus.StartWithoutData());
}

void tst_frmMain::EnterArticle(MainRig &rig, const QString &title, const QString &contents)
{
    rig.Find<QLineEdit>(QStringLiteral("txtTitle"))->setText(title);
    rig.Find<QPlainTextEdit>(QStringLiteral("txtArticle"))->setPlainText(contents);
}

void tst_frmMain::CheckOutputEnabled(MainRig &rig, bool enabled)
{
    for (const QString &name : OutputControls)
        QVERIFY2(rig.Find<QLabel>(name)->isEnabled() == enabled, qPrintable(name));
}

void tst_frmMain::CheckEntryState(MainRig &rig)
{
    QCOMPARE(rig.Command(QStringLiteral("cmdNext"))->Caption(), frmMain::NextCaption);
    QCOMPARE(rig.Main->CurrentPage(), 0);
    QVERIFY(rig.Main->isVisible());
    QVERIFY(!rig.Main->VerifyPageInFront());
    QVERIFY(!rig.Main->Suggestions().isVisible());
    QVERIFY(!rig.Main->findChild<frmWait *>());
    CheckOutputEnabled(rig, false);
}

void tst_frmMain::loadsInEntryState()
{
    MainRig rig(m_thesaurus.BaseUrl());
    QCOMPARE(rig.Main->windowTitle(), QStringLiteral("Verbloom"));
    CheckEntryState(rig);
    QVERIFY(rig.Find<QLabel>(QStringLiteral("lblArticle"))->isVisible());
    QVERIFY(!rig.Find<QLabel>(QStringLiteral("lblConfiguration"))->isVisible());
    QCOMPARE(rig.Find<QLabel>(QStringLiteral("lblArticle"))->text(), QStringLiteral("Enter an article Here"));
    QVERIFY(rig.Find(QStringLiteral("Picture1"))->isVisible());
    QVERIFY(!rig.Find(QStringLiteral("Picture2"))->isVisible());

    const QList<std::pair<QString, QString>> captions = {
        {QStringLiteral("cmdArticle"), QStringLiteral("Enter Article ")},
        {QStringLiteral("cmdConfig"), QStringLiteral("Configuration")},
        {QStringLiteral("cmdVerifyTryAgain"), QStringLiteral("        ReGenerate")},
        {QStringLiteral("lblSaveAsxml"), QStringLiteral("       SaveAs XML")},
        {QStringLiteral("lblSaveAsSQLfile"), QStringLiteral("        SaveAs SQL")},
        {QStringLiteral("cmdHelp"), QStringLiteral("          Help")},
        {QStringLiteral("cmdGenerateSite"), QStringLiteral("        Gen. Site")},
        {QStringLiteral("cmdSave"), QStringLiteral("      Save Cont.")},
        {QStringLiteral("cmdNext"), QStringLiteral("        Next")},
        {QStringLiteral("cmdBrowseURL"), QStringLiteral("     Website ")},
        {QStringLiteral("cmdBrowseTextFile"), QStringLiteral("     Browse File")},
        {QStringLiteral("cmdIgnoreWordsAdd"), QStringLiteral("     Add to list")},
        {QStringLiteral("cmdIgnoreWordsRemove"), QStringLiteral("     Remove ")},
        {QStringLiteral("cmdIgnoreWordsClear"), QStringLiteral("     Clear list")}};
    for (const auto &[name, caption] : captions)
        QCOMPARE(rig.Find<QLabel>(name)->text(), caption);

    auto *level = rig.Find<QComboBox>(QStringLiteral("cmbCustomizationLevel"));
    QCOMPARE(level->count(), 5);
    QCOMPARE(level->itemText(0), QStringLiteral("Maximum"));
    QCOMPARE(level->itemText(4), QStringLiteral("Minimum"));
    QCOMPARE(level->currentText(), QStringLiteral("Level 2"));
    auto *ignore = rig.Find<QComboBox>(QStringLiteral("cmbIgnoreWords"));
    QCOMPARE(ignore->count(), 4);
    QCOMPARE(ignore->itemText(0), QStringLiteral("2 Letters"));
    QCOMPARE(ignore->currentText(), QStringLiteral("3 Letters"));
    auto *words = rig.Find<QTreeWidget>(QStringLiteral("lstIgnoreWords"));
    QCOMPARE(words->columnCount(), 1);
    QCOMPARE(words->headerItem()->text(0), QStringLiteral("Ignored Words"));
    QCOMPARE(words->topLevelItemCount(), 0);
    QCOMPARE(rig.Main->CurrentSpinSettings().CustomizationLevel, 2);
    QCOMPARE(rig.Main->CurrentWordTestSettings().MinimumWordLength, 3);

    auto *articles = rig.Find<QTreeWidget>(QStringLiteral("lstArticles"));
    QCOMPARE(articles->columnCount(), 3);
    QCOMPARE(articles->headerItem()->text(2), QStringLiteral("description"));
    QVERIFY(!articles->isVisible());
    QVERIFY(!rig.Find<QPushButton>(QStringLiteral("Command1"))->isVisible());
    QVERIFY(!rig.Main->webData().View()->isVisible());
    QCOMPARE(rig.Find<QLabel>(QStringLiteral("imgFromWebsite"))->toolTip(),
             QStringLiteral("Load contents from a website. You will have to enter the URL here."));
    QCOMPARE(rig.Find<QLabel>(QStringLiteral("cmdBrowseTextFile"))->toolTip(),
             QStringLiteral("Load contents from a text file from your PC"));
    for (const QString &image : ButtonBarImages)
        QCOMPARE(rig.Skin(image), Normal);
}

void tst_frmMain::blankArticleRefused_data()
{
    QTest::addColumn<QString>("title");
    QTest::addColumn<QString>("contents");
    QTest::addColumn<QString>("message");
    QTest::addColumn<QString>("focus");
    const QString titleBlank = QStringLiteral("The title cannot be blank.");
    const QString contentsBlank = QStringLiteral("The contents cannot be blank.");
    QTest::newRow("both empty") << QString() << QString() << titleBlank << QStringLiteral("txtTitle");
    QTest::newRow("title of blanks") << QStringLiteral("   ") << QStringLiteral("Text") << titleBlank
                                     << QStringLiteral("txtTitle");
    QTest::newRow("contents empty") << QStringLiteral(" a") << QString() << contentsBlank
                                    << QStringLiteral("txtArticle");
    QTest::newRow("contents of blanks") << QStringLiteral("Title") << QStringLiteral("     ") << contentsBlank
                                        << QStringLiteral("txtArticle");
}

void tst_frmMain::blankArticleRefused()
{
    QFETCH(QString, title);
    QFETCH(QString, contents);
    QFETCH(QString, message);
    QFETCH(QString, focus);
    MainRig rig(m_thesaurus.BaseUrl());
    QVERIFY(QTest::qWaitForWindowActive(rig.Main.get()));
    rig.Find(QStringLiteral("cmdNext"))->setFocus(); // the focus starts elsewhere
    EnterArticle(rig, title, contents);
    rig.Click(QStringLiteral("cmdNext"));
    QCOMPARE(rig.Ui.Messages.size(), 1);
    QCOMPARE(rig.Ui.Messages[0].Text, message);
    QCOMPARE(rig.Ui.Messages[0].Title, QStringLiteral("Verbloom"));
    QCOMPARE(rig.Ui.Messages[0].ButtonSet, UiServices::Buttons::Ok);
    QCOMPARE(rig.Ui.Messages[0].IconKind, UiServices::Icon::None);
    QTRY_COMPARE(QApplication::focusWidget(), rig.Find(focus));
    CheckEntryState(rig);
    QCOMPARE(rig.Find<QLineEdit>(QStringLiteral("txtTitle"))->text(), title); // nothing appended
}

void tst_frmMain::nextAppendsBlanks_data()
{
    QTest::addColumn<QString>("title");
    QTest::addColumn<QString>("contents");
    QTest::addColumn<QString>("expectedTitle");
    QTest::addColumn<QString>("expectedContents");
    QTest::newRow("no blanks") << QStringLiteral("T") << QStringLiteral("C") << QStringLiteral("T ")
                               << QStringLiteral("C ");
    QTest::newRow("blanks already") << QStringLiteral("T ") << QStringLiteral("C ") << QStringLiteral("T ")
                                    << QStringLiteral("C ");
    QTest::newRow("line break last") << QStringLiteral("T") << QStringLiteral("C\n") << QStringLiteral("T ")
                                     << QStringLiteral("C\n ");
    QTest::newRow("tab title passes") << QStringLiteral("\t") << QStringLiteral("\n\n")
                                      << QStringLiteral("\t ") << QStringLiteral("\n\n ");
}

void tst_frmMain::nextAppendsBlanks()
{
    QFETCH(QString, title);
    QFETCH(QString, contents);
    QFETCH(QString, expectedTitle);
    QFETCH(QString, expectedContents);
    MainRig rig(m_thesaurus.BaseUrl());
    EnterArticle(rig, title, contents);
    rig.Click(QStringLiteral("cmdNext"));
    QVERIFY(rig.Ui.Messages.isEmpty());
    QCOMPARE(rig.Find<QLineEdit>(QStringLiteral("txtTitle"))->text(), expectedTitle);
    QCOMPARE(rig.Find<QPlainTextEdit>(QStringLiteral("txtArticle"))->toPlainText(), expectedContents);
    QCOMPARE(CurrentArticle().TitleTokens.join(QString()), expectedTitle);
    QVERIFY(!StopProcessing);
}

void tst_frmMain::nextFillsListsThenVerify()
{
    MainRig rig(m_thesaurus.BaseUrl());
    for (const QString &word : {QStringLiteral("garden"), QStringLiteral("tips"), QStringLiteral("plants"),
                                QStringLiteral("need"), QStringLiteral("water"), QStringLiteral("them"),
                                QStringLiteral("daily")})
        rig.WriteWordFile(word, word.toUpper() + QStringLiteral("X, ") + word.toUpper() + QStringLiteral("Y"));
    const QString contents = QStringLiteral("Plants need water.\nWater them daily.");
    EnterArticle(rig, QStringLiteral("Garden tips"), contents);

    rig.Click(QStringLiteral("cmdNext"));
    frmSuggestions &suggestions = rig.Main->Suggestions();
    QVERIFY(!rig.Main->isVisible());
    QVERIFY(suggestions.isVisible());
    QCOMPARE(rig.Command(QStringLiteral("cmdNext"))->Caption(), frmMain::GoBackCaption);
    QCOMPARE(rig.Main->CurrentPage(), 1);
    QCOMPARE(suggestions.Lists().Count(0), CurrentArticle().TitleTokens.size());
    QCOMPARE(suggestions.Lists().Count(1), CurrentArticle().ContentsTokens.size());
    QCOMPARE(suggestions.Lists().Row(0, 0).Text, QStringLiteral("Garden"));
    QVERIFY(suggestions.Lists().Row(0, 0).Blue);
    QCOMPARE(suggestions.Lists().Row(0, 0).Alternatives, QStringLiteral("GARDENX, GARDENY"));
    CheckOutputEnabled(rig, false); // until the suggestions window is closed

    suggestions.close();
    QVERIFY(!suggestions.isVisible());
    QVERIFY(rig.Main->isVisible());
    QVERIFY(rig.Main->VerifyPageInFront());
    CheckOutputEnabled(rig, true);
    const QString firstTitle = rig.Find<QLineEdit>(QStringLiteral("txtVerifyTitle"))->text();
    QVERIFY(firstTitle.startsWith(QStringLiteral("GARDEN")) || firstTitle.startsWith(QStringLiteral("Garden")));
    QVERIFY(!rig.Find<QPlainTextEdit>(QStringLiteral("txtVerifyContents"))->toPlainText().isEmpty());

    // The verify page covers the wizard area but neither the button bar nor the wizard button.
    const QRect verify = rig.Find(QStringLiteral("pctMain(2)"))->geometry();
    const auto inWindow = [&](const QString &name) {
        QWidget *widget = rig.Find(name);
        return QRect(widget->mapTo(rig.Main.get(), QPoint(0, 0)), widget->size());
    };
    QVERIFY(!verify.intersects(inWindow(QStringLiteral("imgNext"))));
    QVERIFY(!verify.intersects(inWindow(QStringLiteral("fraButtons"))));
    QVERIFY(verify.intersects(inWindow(QStringLiteral("Picture1"))));

    // "Enter Article" and "Configuration" act behind the verify page.
    rig.Click(QStringLiteral("cmdConfig"));
    QVERIFY(rig.Main->VerifyPageInFront());

    rig.Click(QStringLiteral("cmdVerifyTryAgain"));
    QVERIFY(!rig.Find<QLineEdit>(QStringLiteral("txtVerifyTitle"))->text().isEmpty());

    // Go Back: the article as it was left, blanks included.
    rig.Click(QStringLiteral("cmdNext"));
    CheckEntryState(rig);
    QCOMPARE(rig.Find<QLineEdit>(QStringLiteral("txtTitle"))->text(), QStringLiteral("Garden tips "));
    QCOMPARE(rig.Find<QPlainTextEdit>(QStringLiteral("txtArticle"))->toPlainText(), contents + QLatin1Char(' '));
    QVERIFY(!rig.Find<QLineEdit>(QStringLiteral("txtVerifyTitle"))->text().isEmpty()); // kept until the next version

    // A second Next analyses again and appends nothing.
    rig.Click(QStringLiteral("cmdNext"));
    QVERIFY(suggestions.isVisible());
    QCOMPARE(rig.Find<QLineEdit>(QStringLiteral("txtTitle"))->text(), QStringLiteral("Garden tips "));
    QCOMPARE(rig.Find<QPlainTextEdit>(QStringLiteral("txtArticle"))->toPlainText(), contents + QLatin1Char(' '));
    QCOMPARE(suggestions.Lists().Count(1), CurrentArticle().ContentsTokens.size());
    rig.Click(QStringLiteral("cmdOk")); // the suggestions window's Ok
    QVERIFY(rig.Main->VerifyPageInFront());
    CheckOutputEnabled(rig, true);
}

void tst_frmMain::lookupThroughWebData()
{
    if (!m_thesaurus.HasData())
        QSKIP("the thesaurus data is not installed");
    MainRig rig(m_thesaurus.BaseUrl());
    rig.Main->Suggestions().findChild<QCheckBox *>(QStringLiteral("chkDontPrompt"))->setChecked(true);
    EnterArticle(rig, QStringLiteral("happy"), QStringLiteral("a"));
    rig.Click(QStringLiteral("cmdNext"));
    const WordRow &row = rig.Main->Suggestions().Lists().Row(0, 0);
    QCOMPARE(row.Text, QStringLiteral("happy"));
    QVERIFY2(!row.Alternatives.isEmpty(), "the lookup through webData found nothing");
    QVERIFY(!row.Blue);
    QCOMPARE(rig.Main->webData().ReadyState(), 4);
    QVERIFY(rig.Main->webData().RootInnerText().contains(QStringLiteral("\r\n")));
}

void tst_frmMain::cancelDuringAnalysis()
{
    MainRig rig(m_thesaurus.BaseUrl());
    for (const QString &word : {QStringLiteral("alpha"), QStringLiteral("bravo"), QStringLiteral("charlie")})
        rig.WriteWordFile(word, QStringLiteral("one, two"));
    EnterArticle(rig, QStringLiteral("Long article"),
                 QStringLiteral("alpha bravo charlie. ").repeated(1500));
    rig.WriteWordFile(QStringLiteral("long"), QStringLiteral("lengthy"));
    rig.WriteWordFile(QStringLiteral("article"), QStringLiteral("story"));

    bool cancelled = false;
    QTimer canceller;
    connect(&canceller, &QTimer::timeout, this, [&] {
        if (cancelled || !rig.Main->AnalysisRunning() || rig.Main->Suggestions().Lists().Count(1) < 10)
            return;
        cancelled = true;
        QTest::mouseClick(rig.Main->Suggestions().findChild<QLabel *>(QStringLiteral("cmdCancel")), Qt::LeftButton);
    });
    canceller.start(0);
    rig.Click(QStringLiteral("cmdNext"));
    canceller.stop();

    QVERIFY(cancelled);
    QVERIFY(StopProcessing);
    QVERIFY(rig.Main->Suggestions().Lists().Count(1) < CurrentArticle().ContentsTokens.size());
    CheckEntryState(rig);
    QVERIFY(!rig.Main->AnalysisRunning());
}

void tst_frmMain::cancelAfterListsComplete()
{
    MainRig rig(m_thesaurus.BaseUrl());
    EnterArticle(rig, QStringLiteral("A"), QStringLiteral("B"));
    rig.Click(QStringLiteral("cmdNext"));
    QVERIFY(rig.Main->Suggestions().isVisible());
    QTest::mouseClick(rig.Main->Suggestions().findChild<QLabel *>(QStringLiteral("cmdCancel")), Qt::LeftButton);
    CheckEntryState(rig);
    QCOMPARE(rig.Find<QLineEdit>(QStringLiteral("txtTitle"))->text(), QStringLiteral("A "));
}

void tst_frmMain::saveContents_data()
{
    QTest::addColumn<QString>("title");
    QTest::addColumn<QString>("contents");
    QTest::addColumn<bool>("open");
    QTest::addColumn<QByteArray>("bytes");
    QTest::newRow("T and C") << QStringLiteral("T") << QStringLiteral("C") << false << QByteArray("T\r\n\r\nC");
    QTest::newRow("lines keep CR LF") << QStringLiteral("Title") << QStringLiteral("Line 1\r\nLine 2\r\n") << false
                                      << QByteArray("Title\r\n\r\nLine 1\r\nLine 2\r\n");
    QTest::newRow("open it") << QStringLiteral("T") << QStringLiteral("C") << true << QByteArray("T\r\n\r\nC");
    QTest::newRow("non-ASCII") << QStringLiteral("Caf\u00e9") << QStringLiteral("na\u00efve") << false
                               << QByteArray("Caf\xc3\xa9\r\n\r\nna\xc3\xafve");
}

void tst_frmMain::saveContents()
{
    QFETCH(QString, title);
    QFETCH(QString, contents);
    QFETCH(bool, open);
    QFETCH(QByteArray, bytes);
    MainRig rig(m_thesaurus.BaseUrl());
    const QString path = rig.Home.filePath(QStringLiteral("saved.txt"));
    QVERIFY(WriteTextFile(path, QStringLiteral("an older, longer file that is replaced")));
    rig.Find<QLineEdit>(QStringLiteral("txtVerifyTitle"))->setText(title);
    rig.Find<QPlainTextEdit>(QStringLiteral("txtVerifyContents"))->setPlainText(contents);
    rig.Ui.NextFileNames = {path};
    rig.Ui.NextAnswers = {open ? UiServices::Answer::Yes : UiServices::Answer::No};
    rig.Main->cmdSave_Click();

    QCOMPARE(ReadBytes(path), bytes);
    QCOMPARE(rig.Ui.FileDialogs.size(), 1);
    QCOMPARE(rig.Ui.FileDialogs[0].Title, QStringLiteral("Save this content"));
    QCOMPARE(rig.Ui.FileDialogs[0].DefaultSuffix, QStringLiteral("txt"));
    QCOMPARE(rig.Ui.Messages.size(), 1);
    QCOMPARE(rig.Ui.Messages[0].Text, QStringLiteral("File Saved as ") + path + QStringLiteral("\r\nDo you want to open it?"));
    QCOMPARE(rig.Ui.Messages[0].ButtonSet, UiServices::Buttons::YesNo);
    QCOMPARE(rig.Ui.Messages[0].IconKind, UiServices::Icon::Information);
    QCOMPARE(rig.Ui.Opened, open ? QStringList{path} : QStringList());
}

void tst_frmMain::saveContentsCancelledOrFailing()
{
    MainRig rig(m_thesaurus.BaseUrl());
    rig.Find<QLineEdit>(QStringLiteral("txtVerifyTitle"))->setText(QStringLiteral("T"));
    rig.Main->cmdSave_Click(); // the dialog is cancelled
    QVERIFY(rig.Ui.Messages.isEmpty());
    QCOMPARE(QDir(rig.Home.path()).entryList(QDir::Files), QStringList());

    const QString unwritable = rig.Home.filePath(QStringLiteral("no-such-folder/saved.txt"));
    rig.Ui.NextFileNames = {unwritable};
    rig.Main->cmdSave_Click();
    QVERIFY(!QFile::exists(unwritable));
    QCOMPARE(rig.Ui.Messages.size(), 1);
    QVERIFY(rig.Ui.Messages[0].Text.startsWith(QStringLiteral("The file could not be saved as ") + unwritable));
    QCOMPARE(rig.Ui.Messages[0].IconKind, UiServices::Icon::Critical);
    QVERIFY(rig.Ui.Opened.isEmpty());
}

void tst_frmMain::panels()
{
    MainRig rig(m_thesaurus.BaseUrl());
    rig.Click(QStringLiteral("imgCmdConfig"));
    QVERIFY(rig.Find(QStringLiteral("Picture2"))->isVisible());
    QVERIFY(!rig.Find(QStringLiteral("Picture1"))->isVisible());
    QVERIFY(rig.Find(QStringLiteral("lblConfiguration"))->isVisible());
    QVERIFY(!rig.Find(QStringLiteral("lblArticle"))->isVisible());
    rig.Click(QStringLiteral("cmdArticle"));
    QVERIFY(rig.Find(QStringLiteral("Picture1"))->isVisible());
    QVERIFY(!rig.Find(QStringLiteral("Picture2"))->isVisible());
    QVERIFY(rig.Find(QStringLiteral("lblArticle"))->isVisible());
    QVERIFY(!rig.Find(QStringLiteral("lblConfiguration"))->isVisible());
    // The export commands exist but stay disabled in the entry state and open nothing.
    rig.Click(QStringLiteral("lblSaveAsxml"));
    rig.Click(QStringLiteral("lblSaveAsSQLfile"));
    rig.Click(QStringLiteral("cmdGenerateSite"));
    QVERIFY(rig.Ui.Messages.isEmpty());
    QCOMPARE(QApplication::topLevelWidgets().count(QApplication::activeModalWidget()), 0);
}

void tst_frmMain::browseTextFile_data()
{
    QTest::addColumn<QByteArray>("bytes");
    QTest::addColumn<bool>("cancel");
    QTest::addColumn<QString>("expected");
    QTest::newRow("CR LF text") << QByteArray("Line 1\r\nLine 2") << false << QStringLiteral("Line 1\nLine 2");
    QTest::newRow("Windows-1252") << QByteArray("Caf\xe9") << false << QStringLiteral("Caf\u00e9");
    QTest::newRow("zero bytes") << QByteArray() << false << QString();
    QTest::newRow("cancelled") << QByteArray("unused") << true << QStringLiteral("Typed contents");
}

void tst_frmMain::browseTextFile()
{
    QFETCH(QByteArray, bytes);
    QFETCH(bool, cancel);
    QFETCH(QString, expected);
    MainRig rig(m_thesaurus.BaseUrl());
    EnterArticle(rig, QStringLiteral("Typed title"), QStringLiteral("Typed contents"));
    const QString path = rig.Home.filePath(QStringLiteral("article.txt"));
    QVERIFY(WriteBinaryFile(path, bytes));
    if (!cancel)
        rig.Ui.NextFileNames = {path};
    rig.Click(QStringLiteral("imgBrowseFile"));
    QCOMPARE(rig.Ui.FileDialogs.size(), 1);
    QCOMPARE(rig.Ui.FileDialogs[0].Title, QStringLiteral("Select a text file to open"));
    QCOMPARE(rig.Find<QPlainTextEdit>(QStringLiteral("txtArticle"))->toPlainText(), expected);
    QCOMPARE(rig.Find<QLineEdit>(QStringLiteral("txtTitle"))->text(), QStringLiteral("Typed title"));
}

void tst_frmMain::helpAndCommand1()
{
    MainRig rig(m_thesaurus.BaseUrl());
    rig.Click(QStringLiteral("imgHelp"));
    QCOMPARE(rig.Ui.Opened, QStringList{rig.Home.path() + QStringLiteral("/Help/Verbloom_Help.htm")});

    rig.WriteWordFile(QStringLiteral("zeta"), QString());
    rig.WriteWordFile(QStringLiteral("alpha"), QString());
    rig.WriteWordFile(QStringLiteral("beta"), QStringLiteral("b"));
    EnterArticle(rig, QStringLiteral("T"), QStringLiteral("old"));
    QTest::mouseClick(rig.Find<QPushButton>(QStringLiteral("Command1")), Qt::LeftButton);
    QCOMPARE(rig.Find<QPlainTextEdit>(QStringLiteral("txtArticle"))->toPlainText(), QStringLiteral(" alpha zeta"));
}

void tst_frmMain::ignoredWordAdd_data()
{
    QTest::addColumn<int>("level");
    QTest::addColumn<QString>("word");
    QTest::addColumn<QString>("message");
    const QString length = QStringLiteral("Please make sure that the number of letters in ignore word is more than ");
    const auto letter = [](const QString &c) -> QString {
        return QStringLiteral("Please make sure that the letter \"") + c + QStringLiteral("\" is NOT there in your word");
    };
    QTest::newRow("empty") << 1 << QString() << QStringLiteral("Please make sure that the ignore word is not empty");
    QTest::newRow("seo, 3 letters") << 1 << QStringLiteral("seo") << QString(length + QLatin1Char('3'));
    QTest::newRow("seos, 3 letters") << 1 << QStringLiteral("seos") << QString();
    QTest::newRow("ab, 2 letters") << 0 << QStringLiteral("ab") << QString(length + QLatin1Char('2'));
    QTest::newRow("abc, 2 letters") << 0 << QStringLiteral("abc") << QString();
    QTest::newRow("abcde, 5 letters") << 3 << QStringLiteral("abcde") << QString(length + QLatin1Char('5'));
    QTest::newRow("blanks are letters") << 1 << QStringLiteral("   ") << QString(length + QLatin1Char('3'));
    QTest::newRow("key word") << 1 << QStringLiteral("key word") << letter(QStringLiteral(" "));
    QTest::newRow("a.b,c") << 1 << QStringLiteral("a.b,c") << letter(QStringLiteral(","));
    QTest::newRow("it's") << 1 << QStringLiteral("it's") << letter(QStringLiteral("'"));
    QTest::newRow("x.y z: the dot is last") << 1 << QStringLiteral("x.y z") << letter(QStringLiteral("."));
    QTest::newRow("all four") << 1 << QStringLiteral("a'b,c.d e") << letter(QStringLiteral("'"));
    QTest::newRow("colon accepted") << 1 << QStringLiteral("key:word") << QString();
}

void tst_frmMain::ignoredWordAdd()
{
    QFETCH(int, level);
    QFETCH(QString, word);
    QFETCH(QString, message);
    MainRig rig(m_thesaurus.BaseUrl());
    rig.Find<QComboBox>(QStringLiteral("cmbIgnoreWords"))->setCurrentIndex(level);
    auto *box = rig.Find<QLineEdit>(QStringLiteral("txtIgnoreWord"));
    auto *list = rig.Find<QTreeWidget>(QStringLiteral("lstIgnoreWords"));
    box->setText(word);
    rig.Click(QStringLiteral("cmdIgnoreWordsAdd"));
    if (message.isEmpty()) {
        QVERIFY(rig.Ui.Messages.isEmpty());
        QCOMPARE(list->topLevelItemCount(), 1);
        QCOMPARE(list->topLevelItem(0)->text(0), word);
        QVERIFY(box->text().isEmpty());
        QCOMPARE(rig.Main->CurrentWordTestSettings().IgnoredWords, QStringList{word});
        return;
    }
    QCOMPARE(rig.Ui.Messages.size(), 1);
    QCOMPARE(rig.Ui.Messages[0].Text, message);
    QCOMPARE(rig.Ui.Messages[0].Title, QStringLiteral("Verbloom"));
    QCOMPARE(rig.Ui.Messages[0].ButtonSet, UiServices::Buttons::Ok);
    QCOMPARE(rig.Ui.Messages[0].IconKind, UiServices::Icon::None);
    QCOMPARE(list->topLevelItemCount(), 0);
    QCOMPARE(box->text(), word);
}

void tst_frmMain::ignoredWordsRemoveAndClear()
{
    MainRig rig(m_thesaurus.BaseUrl());
    auto *box = rig.Find<QLineEdit>(QStringLiteral("txtIgnoreWord"));
    auto *list = rig.Find<QTreeWidget>(QStringLiteral("lstIgnoreWords"));
    const QString clearQuestion = QStringLiteral("Are you sure you want to remove ALL THE WORDS from the list");

    // "Clear list" asks even when the list is empty.
    rig.Ui.NextAnswers = {UiServices::Answer::Yes};
    rig.Click(QStringLiteral("Image21"));
    QCOMPARE(rig.Ui.Messages.size(), 1);
    QCOMPARE(rig.Ui.Messages[0].Text, clearQuestion);
    QCOMPARE(rig.Ui.Messages[0].ButtonSet, UiServices::Buttons::YesNo);
    QCOMPARE(rig.Ui.Messages[0].IconKind, UiServices::Icon::Information);

    for (const QString &word : {QStringLiteral("Word"), QStringLiteral("beta"), QStringLiteral("Word")}) {
        box->setText(word);
        rig.Click(QStringLiteral("Image19"));
    }
    QCOMPARE(list->topLevelItemCount(), 3); // duplicates allowed
    QCOMPARE(rig.Main->CurrentWordTestSettings().IgnoredWords,
             (QStringList{QStringLiteral("Word"), QStringLiteral("beta"), QStringLiteral("Word")}));
    QVERIFY(!IsCustomizableWord(QStringLiteral("WORD"), rig.Main->CurrentWordTestSettings()));

    // "Remove" with nothing selected only tells; it asks nothing.
    rig.Ui.Messages.clear();
    list->clearSelection();
    rig.Click(QStringLiteral("cmdIgnoreWordsRemove"));
    QCOMPARE(rig.Ui.Messages.size(), 1);
    QCOMPARE(rig.Ui.Messages[0].Text, QStringLiteral("Please select a word from the list on the left"));
    QCOMPARE(rig.Ui.Messages[0].ButtonSet, UiServices::Buttons::Ok);

    list->setCurrentItem(list->topLevelItem(1));
    rig.Ui.Messages.clear();
    rig.Ui.NextAnswers = {UiServices::Answer::No};
    rig.Click(QStringLiteral("Image20"));
    QCOMPARE(rig.Ui.Messages.size(), 1);
    QCOMPARE(rig.Ui.Messages[0].Text,
             QStringLiteral("Are you sure you want to remove the word \"beta\" from the Ignored Words List"));
    QCOMPARE(rig.Ui.Messages[0].ButtonSet, UiServices::Buttons::YesNo);
    QCOMPARE(rig.Ui.Messages[0].IconKind, UiServices::Icon::Information);
    QCOMPARE(list->topLevelItemCount(), 3);
    rig.Ui.NextAnswers = {UiServices::Answer::Yes};
    rig.Click(QStringLiteral("cmdIgnoreWordsRemove"));
    QCOMPARE(list->topLevelItemCount(), 2);
    QCOMPARE(list->topLevelItem(1)->text(0), QStringLiteral("Word"));

    rig.Ui.NextAnswers = {UiServices::Answer::No};
    rig.Click(QStringLiteral("cmdIgnoreWordsClear"));
    QCOMPARE(list->topLevelItemCount(), 2);
    rig.Ui.NextAnswers = {UiServices::Answer::Yes};
    rig.Click(QStringLiteral("cmdIgnoreWordsClear"));
    QCOMPARE(list->topLevelItemCount(), 0);
    QCOMPARE(rig.Ui.Messages.last().Text, clearQuestion);
}

void tst_frmMain::hoverButtonBar()
{
    MainRig rig(m_thesaurus.BaseUrl());
    MoveMouseOver(rig.Find(QStringLiteral("cmdArticle")));
    QCOMPARE(rig.Skin(QStringLiteral("imgCmdArticle")), Hover);
    // On to the neighbour without crossing the background: both stay highlighted.
    MoveMouseOver(rig.Find(QStringLiteral("imgCmdConfig")));
    QCOMPARE(rig.Skin(QStringLiteral("imgCmdArticle")), Hover);
    QCOMPARE(rig.Skin(QStringLiteral("imgCmdConfig")), Hover);
    // The Help label does not highlight; its image does.
    MoveMouseOver(rig.Find(QStringLiteral("cmdHelp")));
    QCOMPARE(rig.Skin(QStringLiteral("imgHelp")), Normal);
    MoveMouseOver(rig.Find(QStringLiteral("imgHelp")));
    QCOMPARE(rig.Skin(QStringLiteral("imgHelp")), Hover);
    // A disabled command does not highlight.
    MoveMouseOver(rig.Find(QStringLiteral("cmdVerifyTryAgain")));
    MoveMouseOver(rig.Find(QStringLiteral("imgSaveContents")));
    QCOMPARE(rig.Skin(QStringLiteral("imgReGenerate")), Normal);
    QCOMPARE(rig.Skin(QStringLiteral("imgSaveContents")), Normal);

    // The verify page resets only the wizard button.
    rig.Main->SetButton(true);
    rig.Main->ShowVerifyPage();
    MoveMouseOver(rig.Find(QStringLiteral("cmdSave")));
    MoveMouseOver(rig.Find(QStringLiteral("imgNext")));
    MoveMouseOver(rig.Find(QStringLiteral("pctMain(2)")));
    QCOMPARE(rig.Skin(QStringLiteral("imgSaveContents")), Hover);
    QCOMPARE(rig.Skin(QStringLiteral("imgNext")), Normal);

    MoveMouseOver(rig.Find(QStringLiteral("fraButtons")));
    for (const QString &image : ButtonBarImages)
        QCOMPARE(rig.Skin(image), Normal);
}

void tst_frmMain::hoverPanelsAndWizardButton()
{
    MainRig rig(m_thesaurus.BaseUrl());
    MoveMouseOver(rig.Find(QStringLiteral("cmdNext")));
    QCOMPARE(rig.Skin(QStringLiteral("imgNext")), Normal);
    QCOMPARE(rig.Find<QLabel>(QStringLiteral("cmdNext"))->frameShape(), QFrame::NoFrame);
    MoveMouseOver(rig.Find(QStringLiteral("imgNext")));
    QCOMPARE(rig.Skin(QStringLiteral("imgNext")), Hover);
    MoveMouseOver(rig.Find(QStringLiteral("pctMain(0)")));
    QCOMPARE(rig.Skin(QStringLiteral("imgNext")), Normal);

    MoveMouseOver(rig.Find(QStringLiteral("cmdBrowseURL")));
    MoveMouseOver(rig.Find(QStringLiteral("imgBrowseFile")));
    QCOMPARE(rig.Skin(QStringLiteral("imgFromWebsite")), Hover);
    QCOMPARE(rig.Skin(QStringLiteral("imgBrowseFile")), Hover);
    MoveMouseOver(rig.Find(QStringLiteral("Picture1")));
    QCOMPARE(rig.Skin(QStringLiteral("imgFromWebsite")), Normal);
    QCOMPARE(rig.Skin(QStringLiteral("imgBrowseFile")), Normal);

    rig.Click(QStringLiteral("cmdConfig"));
    for (const QString &part : {QStringLiteral("cmdIgnoreWordsAdd"), QStringLiteral("Image20"), QStringLiteral("cmdIgnoreWordsClear")})
        MoveMouseOver(rig.Find(part));
    for (const QString &image : {QStringLiteral("Image19"), QStringLiteral("Image20"), QStringLiteral("Image21")})
        QCOMPARE(rig.Skin(image), Hover);
    MoveMouseOver(rig.Find(QStringLiteral("Picture2")));
    for (const QString &image : {QStringLiteral("Image19"), QStringLiteral("Image20"), QStringLiteral("Image21")})
        QCOMPARE(rig.Skin(image), Normal);
}

VERBLOOM_SHELL_TEST_MAIN(tst_frmMain)
#include "tst_frmMain.moc"
