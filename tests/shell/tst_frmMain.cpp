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
#include <QFileDialog>
#include <QMessageBox>
#include <QPushButton>
#include <QTimer>
#include <QTreeWidget>

using namespace verbloom;
using namespace verbloom::test;

namespace {

using Answer = UiServices::Answer;
using Buttons = UiServices::Buttons;
using Icon = UiServices::Icon;

const QStringList OutputControls = {u"cmdVerifyTryAgain"_qs, u"imgReGenerate"_qs, u"lblSaveAsSQLfile"_qs,
                                    u"imgSaveAsSql"_qs,      u"imgSaveAsXML"_qs,  u"lblSaveAsxml"_qs,
                                    u"cmdSave"_qs,           u"imgSaveContents"_qs, u"cmdGenerateSite"_qs,
                                    u"imgGenerateSite"_qs};

const QString TextFilter = u"*.txt Text Files (*.txt);;*.* All Files (*)"_qs;
const QString Normal = u"button_blue"_qs;
const QString Hover = u"button_blue_hover"_qs;

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
    void nextChecksArticle_data();
    void nextChecksArticle();
    void nextFillsListsThenVerify();
    void lookupThroughWebData();
    void cancelDuringAnalysis();
    void nextIgnoredDuringAnalysis();
    void saveContents_data();
    void saveContents();
    void saveDialogReplacesWithoutAsking();
    void browseTextFile_data();
    void browseTextFile();
    void helpAndCommand1();
    void ignoredWordAdd_data();
    void ignoredWordAdd();
    void ignoredWordsRemoveAndClear();
    void hover_data();
    void hover();

private:
    void CheckEntryState(MainRig &rig);
    void CheckOutputEnabled(MainRig &rig, bool enabled);

    ThesaurusService m_thesaurus;
};

void tst_frmMain::initTestCase()
{
    if (!m_thesaurus.Start(ThesaurusService::DefaultDataPath()))
        QVERIFY(m_thesaurus.StartWithoutData());
}

void tst_frmMain::CheckOutputEnabled(MainRig &rig, bool enabled)
{
    for (const QString &name : OutputControls)
        QVERIFY2(rig.Find<QLabel>(name)->isEnabled() == enabled, qPrintable(name));
}

void tst_frmMain::CheckEntryState(MainRig &rig)
{
    QCOMPARE(rig.Command(u"cmdNext"_qs)->Caption(), frmMain::NextCaption);
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
    QCOMPARE(rig.Main->windowTitle(), u"Verbloom"_qs);
    CheckEntryState(rig);
    // The article panel and its heading, or the configuration panel and its heading.
    const auto shown = [&] {
        QList<bool> visible;
        for (const QString &name : {u"Picture1"_qs, u"lblArticle"_qs, u"Picture2"_qs, u"lblConfiguration"_qs})
            visible << rig.Find(name)->isVisible();
        return visible;
    };
    QCOMPARE(shown(), (QList<bool>{true, true, false, false}));
    rig.Click(u"imgCmdConfig"_qs);
    QCOMPARE(shown(), (QList<bool>{false, false, true, true}));
    rig.Click(u"cmdArticle"_qs);
    QCOMPARE(shown(), (QList<bool>{true, true, false, false}));

    const QList<std::pair<QString, QString>> captions = {
        {u"lblArticle"_qs, u"Enter an article Here"_qs},        {u"cmdArticle"_qs, u"Enter Article "_qs},
        {u"cmdConfig"_qs, u"Configuration"_qs},                  {u"cmdVerifyTryAgain"_qs, u"        ReGenerate"_qs},
        {u"lblSaveAsxml"_qs, u"       SaveAs XML"_qs},           {u"lblSaveAsSQLfile"_qs, u"        SaveAs SQL"_qs},
        {u"cmdHelp"_qs, u"          Help"_qs},                   {u"cmdGenerateSite"_qs, u"        Gen. Site"_qs},
        {u"cmdSave"_qs, u"      Save Cont."_qs},                 {u"cmdNext"_qs, u"        Next"_qs},
        {u"cmdBrowseURL"_qs, u"     Website "_qs},               {u"cmdBrowseTextFile"_qs, u"     Browse File"_qs},
        {u"cmdIgnoreWordsAdd"_qs, u"     Add to list"_qs},       {u"cmdIgnoreWordsRemove"_qs, u"     Remove "_qs},
        {u"cmdIgnoreWordsClear"_qs, u"     Clear list"_qs}};
    for (const auto &[name, caption] : captions)
        QCOMPARE(rig.Find<QLabel>(name)->text(), caption);
    QCOMPARE(rig.Find<QLabel>(u"imgFromWebsite"_qs)->toolTip(),
             u"Load contents from a website. You will have to enter the URL here."_qs);
    QCOMPARE(rig.Find<QLabel>(u"cmdBrowseTextFile"_qs)->toolTip(), u"Load contents from a text file from your PC"_qs);

    const auto items = [&](const QString &name) {
        auto *combo = rig.Find<QComboBox>(name);
        QStringList texts;
        for (int i = 0; i < combo->count(); ++i)
            texts << combo->itemText(i);
        return texts << u"current: "_qs + combo->currentText();
    };
    QCOMPARE(items(u"cmbCustomizationLevel"_qs), (QStringList{u"Maximum"_qs, u"Level 3"_qs, u"Level 2"_qs, u"Level 1"_qs,
                                                              u"Minimum"_qs, u"current: Level 2"_qs}));
    QCOMPARE(items(u"cmbIgnoreWords"_qs), (QStringList{u"2 Letters"_qs, u"3 Letters"_qs, u"4 Letters"_qs,
                                                       u"5 Letters"_qs, u"current: 3 Letters"_qs}));
    QCOMPARE(rig.Main->CurrentSpinSettings().CustomizationLevel, 2);
    QCOMPARE(rig.Main->CurrentWordTestSettings().MinimumWordLength, 3);
    auto *words = rig.Find<QTreeWidget>(u"lstIgnoreWords"_qs);
    QCOMPARE(words->columnCount(), 1);
    QCOMPARE(words->headerItem()->text(0), u"Ignored Words"_qs);
    QCOMPARE(words->topLevelItemCount(), 0);

    auto *articles = rig.Find<QTreeWidget>(u"lstArticles"_qs);
    QCOMPARE(articles->columnCount(), 3);
    QCOMPARE(articles->headerItem()->text(2), u"description"_qs);
    QVERIFY(!articles->isVisible());
    QVERIFY(!rig.Find<QPushButton>(u"Command1"_qs)->isVisible());
    QVERIFY(!rig.Main->webData().View()->isVisible());
}

void tst_frmMain::nextChecksArticle_data()
{
    QTest::addColumn<QString>("title");
    QTest::addColumn<QString>("contents");
    QTest::addColumn<QString>("message");  // "" when the analysis starts
    QTest::addColumn<QString>("focus");
    QTest::addColumn<QString>("expectedTitle");
    QTest::addColumn<QString>("expectedContents");
    const QString titleBlank = u"The title cannot be blank."_qs;
    QTest::newRow("both empty: the title first") << QString() << QString() << titleBlank << u"txtTitle"_qs
                                                 << QString() << QString();
    QTest::newRow("title of blanks") << u"   "_qs << u"Text"_qs << titleBlank << u"txtTitle"_qs << u"   "_qs
                                     << u"Text"_qs;
    const QString contentsBlank = u"The contents cannot be blank."_qs;
    QTest::newRow("contents empty") << u" a"_qs << QString() << contentsBlank << u"txtArticle"_qs << u" a"_qs
                                    << QString();
    QTest::newRow("contents of blanks") << u"Title"_qs << u"     "_qs << contentsBlank << u"txtArticle"_qs
                                        << u"Title"_qs << u"     "_qs;
    QTest::newRow("blanks appended") << u"T"_qs << u"C"_qs << QString() << QString() << u"T "_qs << u"C "_qs;
    QTest::newRow("blanks already") << u"T "_qs << u"C "_qs << QString() << QString() << u"T "_qs << u"C "_qs;
    QTest::newRow("tab title, line breaks") << u"\t"_qs << u"\n\n"_qs << QString() << QString() << u"\t "_qs
                                            << u"\n\n "_qs;
}

void tst_frmMain::nextChecksArticle()
{
    QFETCH(QString, title);
    QFETCH(QString, contents);
    QFETCH(QString, message);
    QFETCH(QString, focus);
    QFETCH(QString, expectedTitle);
    MainRig rig(m_thesaurus.BaseUrl());
    QVERIFY(QTest::qWaitForWindowActive(rig.Main.get()));
    rig.Find(u"cmdNext"_qs)->setFocus(); // the focus starts elsewhere
    rig.EnterArticle(title, contents);
    rig.Click(u"cmdNext"_qs);
    QCOMPARE(Boxes(rig.Ui), message.isEmpty() ? QStringList() : QStringList{Box(message)});
    QCOMPARE(rig.Text(u"txtTitle"_qs), expectedTitle);
    QTEST(rig.Text(u"txtArticle"_qs), "expectedContents");
    if (message.isEmpty()) {
        QCOMPARE(CurrentArticle().TitleTokens.join(QString()), expectedTitle);
        QVERIFY(!StopProcessing);
        return;
    }
    QTRY_COMPARE(QApplication::focusWidget(), rig.Find(focus));
    CheckEntryState(rig);
}

void tst_frmMain::nextFillsListsThenVerify()
{
    MainRig rig(m_thesaurus.BaseUrl());
    for (const QString &word : {u"garden"_qs, u"tips"_qs, u"plants"_qs, u"need"_qs, u"water"_qs, u"them"_qs, u"daily"_qs})
        rig.WriteWordFile(word, word.toUpper() + u"X, "_qs + word.toUpper() + u"Y"_qs);
    const QString contents = u"Plants need water.\nWater them daily."_qs;
    rig.EnterArticle(u"Garden tips"_qs, contents);

    rig.Click(u"cmdNext"_qs);
    frmSuggestions &suggestions = rig.Main->Suggestions();
    QVERIFY(!rig.Main->isVisible());
    QVERIFY(suggestions.isVisible());
    QCOMPARE(rig.Command(u"cmdNext"_qs)->Caption(), frmMain::GoBackCaption);
    QCOMPARE(rig.Main->CurrentPage(), 1);
    QCOMPARE(suggestions.Lists().Count(0), CurrentArticle().TitleTokens.size());
    QCOMPARE(suggestions.Lists().Count(1), CurrentArticle().ContentsTokens.size());
    QCOMPARE(suggestions.Lists().Row(0, 0).Text, u"Garden"_qs);
    QVERIFY(suggestions.Lists().Row(0, 0).Blue);
    QCOMPARE(suggestions.Lists().Row(0, 0).Alternatives, u"GARDENX, GARDENY"_qs);
    CheckOutputEnabled(rig, false); // until the suggestions window is closed

    suggestions.close();
    QVERIFY(!suggestions.isVisible());
    QVERIFY(rig.Main->isVisible());
    QVERIFY(rig.Main->VerifyPageInFront());
    CheckOutputEnabled(rig, true);
    const QString firstTitle = rig.Text(u"txtVerifyTitle"_qs);
    QVERIFY(firstTitle.startsWith(u"GARDEN"_qs) || firstTitle.startsWith(u"Garden"_qs));
    QVERIFY(!rig.Text(u"txtVerifyContents"_qs).isEmpty());

    // The verify page covers the wizard area but neither the button bar nor the wizard button.
    const QRect verify = rig.Find(u"pctMain(2)"_qs)->geometry();
    const auto inWindow = [&](const QString &name) {
        QWidget *widget = rig.Find(name);
        return QRect(widget->mapTo(rig.Main.get(), QPoint(0, 0)), widget->size());
    };
    QVERIFY(!verify.intersects(inWindow(u"imgNext"_qs)));
    QVERIFY(!verify.intersects(inWindow(u"fraButtons"_qs)));
    QVERIFY(verify.intersects(inWindow(u"Picture1"_qs)));

    // "Configuration" acts behind the verify page; ReGenerate makes another version.
    rig.Click(u"cmdConfig"_qs);
    QVERIFY(rig.Main->VerifyPageInFront());
    rig.Click(u"cmdVerifyTryAgain"_qs);
    QVERIFY(!rig.Text(u"txtVerifyTitle"_qs).isEmpty());

    // Go Back: the article as it was left, blanks included.
    rig.Click(u"cmdNext"_qs);
    CheckEntryState(rig);
    QCOMPARE(rig.Text(u"txtTitle"_qs), u"Garden tips "_qs);
    QCOMPARE(rig.Text(u"txtArticle"_qs), contents + QLatin1Char(' '));
    QVERIFY(!rig.Text(u"txtVerifyTitle"_qs).isEmpty()); // kept until the next version

    // A second Next analyses again and appends nothing; Cancel after the analysis goes back to
    // the entry state.
    rig.Click(u"cmdNext"_qs);
    QVERIFY(suggestions.isVisible());
    QCOMPARE(suggestions.Lists().Count(1), CurrentArticle().ContentsTokens.size());
    QTest::mouseClick(suggestions.findChild<QLabel *>(u"cmdCancel"_qs), Qt::LeftButton);
    CheckEntryState(rig);
    QCOMPARE(rig.Text(u"txtTitle"_qs), u"Garden tips "_qs);
    QCOMPARE(rig.Text(u"txtArticle"_qs), contents + QLatin1Char(' '));
}

void tst_frmMain::lookupThroughWebData()
{
    if (!m_thesaurus.HasData())
        QSKIP("the thesaurus data is not installed");
    MainRig rig(m_thesaurus.BaseUrl());
    rig.Main->Suggestions().findChild<QCheckBox *>(u"chkDontPrompt"_qs)->setChecked(true);
    rig.EnterArticle(u"happy"_qs, u"a"_qs);
    rig.Click(u"cmdNext"_qs);
    const WordRow &row = rig.Main->Suggestions().Lists().Row(0, 0);
    QCOMPARE(row.Text, u"happy"_qs);
    QVERIFY2(!row.Alternatives.isEmpty(), "the lookup through webData found nothing");
    QVERIFY(!row.Blue);
    QCOMPARE(rig.Main->webData().ReadyState(), 4);
    QVERIFY(rig.Main->webData().RootInnerText().contains(u"\r\n"_qs));
}

void tst_frmMain::cancelDuringAnalysis()
{
    MainRig rig(m_thesaurus.BaseUrl());
    for (const QString &word : {u"long"_qs, u"article"_qs, u"alpha"_qs, u"bravo"_qs, u"charlie"_qs})
        rig.WriteWordFile(word, u"one, two"_qs);
    rig.EnterArticle(u"Long article"_qs, u"alpha bravo charlie. "_qs.repeated(1500));

    bool cancelled = false;
    QTimer canceller;
    connect(&canceller, &QTimer::timeout, this, [&] {
        if (cancelled || !rig.Main->AnalysisRunning() || rig.Main->Suggestions().Lists().Count(1) < 10)
            return;
        cancelled = true;
        QTest::mouseClick(rig.Main->Suggestions().findChild<QLabel *>(u"cmdCancel"_qs), Qt::LeftButton);
    });
    canceller.start(0);
    rig.Click(u"cmdNext"_qs);
    canceller.stop();

    QVERIFY(cancelled);
    QVERIFY(StopProcessing);
    QVERIFY(rig.Main->Suggestions().Lists().Count(1) < CurrentArticle().ContentsTokens.size());
    CheckEntryState(rig);
    QVERIFY(!rig.Main->AnalysisRunning());
}

void tst_frmMain::nextIgnoredDuringAnalysis()
{
    // Ok in the suggestions window shows the main window while the lists still fill; Go Back
    // works there, but Next must not start a second analysis inside the running one.
    MainRig rig(m_thesaurus.BaseUrl());
    for (const QString &word : {u"long"_qs, u"article"_qs, u"alpha"_qs, u"bravo"_qs, u"charlie"_qs})
        rig.WriteWordFile(word, u"one, two"_qs);
    rig.EnterArticle(u"Long article"_qs, u"alpha bravo charlie. "_qs.repeated(1500));

    bool done = false;
    QString captionAfterGoBack, captionAfterNext;
    int pageAfterNext = -1;
    QTimer driver;
    connect(&driver, &QTimer::timeout, this, [&] {
        if (done || !rig.Main->AnalysisRunning() || rig.Main->Suggestions().Lists().Count(1) < 10)
            return;
        done = true;
        QTest::mouseClick(rig.Main->Suggestions().findChild<QLabel *>(u"cmdOk"_qs), Qt::LeftButton);
        rig.Click(u"cmdNext"_qs); // Go Back
        captionAfterGoBack = rig.Command(u"cmdNext"_qs)->Caption();
        rig.Click(u"cmdNext"_qs); // Next, ignored
        captionAfterNext = rig.Command(u"cmdNext"_qs)->Caption();
        pageAfterNext = rig.Main->CurrentPage();
    });
    driver.start(0);
    rig.Click(u"cmdNext"_qs);
    driver.stop();

    QVERIFY(done);
    QCOMPARE(captionAfterGoBack, frmMain::NextCaption);
    QCOMPARE(captionAfterNext, frmMain::NextCaption);
    QCOMPARE(pageAfterNext, 0);
    QVERIFY(!rig.Main->AnalysisRunning());
    QCOMPARE(rig.Main->CurrentPage(), 0);
    QCOMPARE(rig.Command(u"cmdNext"_qs)->Caption(), frmMain::NextCaption);
    QCOMPARE(rig.Main->Suggestions().Lists().Count(1), CurrentArticle().ContentsTokens.size());
    QCOMPARE(rig.Text(u"txtTitle"_qs), u"Long article "_qs);

    // Once the analysis is over, Next works again.
    rig.Click(u"cmdNext"_qs);
    QCOMPARE(rig.Main->CurrentPage(), 1);
    QCOMPARE(rig.Command(u"cmdNext"_qs)->Caption(), frmMain::GoBackCaption);
}

void tst_frmMain::saveContents_data()
{
    QTest::addColumn<QString>("contents");
    QTest::addColumn<QString>("file");       // "" when the dialog is cancelled
    QTest::addColumn<bool>("open");
    QTest::addColumn<QByteArray>("bytes");   // of saved.txt afterwards
    QTest::addColumn<QStringList>("boxes");  // PATH stands for the chosen file
    const QStringList saved{Box(u"File Saved as PATH\r\nDo you want to open it?"_qs, Buttons::YesNo, Icon::Information)};
    const QByteArray older = "an older, longer file that is replaced";
    QTest::newRow("T and C, opened") << u"C"_qs << u"saved.txt"_qs << true << QByteArray("T\r\n\r\nC") << saved;
    QTest::newRow("CR LF lines, UTF-8") << u"na\u00efve\r\nLine 2\r\n"_qs << u"saved.txt"_qs << false
                                        << QByteArray("T\r\n\r\nna\xc3\xafve\r\nLine 2\r\n") << saved;
    QTest::newRow("cancelled") << u"C"_qs << QString() << false << older << QStringList();
    QTest::newRow("unwritable: an error, nothing written")
        << u"C"_qs << u"no-such-folder/saved.txt"_qs << false << older
        << QStringList{Box(u"The file could not be saved as PATH\r\nPlease choose another name or folder."_qs,
                           Buttons::Ok, Icon::Critical)};
}

void tst_frmMain::saveContents()
{
    QFETCH(QString, contents);
    QFETCH(QString, file);
    QFETCH(bool, open);
    QFETCH(QStringList, boxes);
    MainRig rig(m_thesaurus.BaseUrl());
    QVERIFY(WriteTextFile(rig.Home.filePath(u"saved.txt"_qs), u"an older, longer file that is replaced"_qs));
    rig.Find<QLineEdit>(u"txtVerifyTitle"_qs)->setText(u"T"_qs);
    rig.Find<QPlainTextEdit>(u"txtVerifyContents"_qs)->setPlainText(contents);
    const QString path = file.isEmpty() ? QString() : rig.Home.filePath(file);
    rig.Ui.NextFileNames = {path};
    rig.Ui.NextAnswers = {open ? Answer::Yes : Answer::No};
    rig.Main->cmdSave_Click();

    QTEST(ReadBytes(rig.Home.filePath(u"saved.txt"_qs)), "bytes");
    QCOMPARE(QDir(rig.Home.path()).entryList(QDir::Files), QStringList{u"saved.txt"_qs});
    QCOMPARE(rig.Ui.FileDialogs.size(), 1);
    QCOMPARE(rig.Ui.FileDialogs[0].Title, u"Save this content"_qs);
    QCOMPARE(rig.Ui.FileDialogs[0].Filter, TextFilter);
    QCOMPARE(rig.Ui.FileDialogs[0].DefaultSuffix, u"txt"_qs);
    QCOMPARE(Boxes(rig.Ui), boxes.replaceInStrings(u"PATH"_qs, path));
    QCOMPARE(rig.Ui.Opened, open ? QStringList{path} : QStringList());
}

void tst_frmMain::saveDialogReplacesWithoutAsking()
{
    // The real save dialog: accepting an existing file returns it at once, with no question.
    QTemporaryDir dir;
    const QString existing = dir.filePath(u"older.txt"_qs);
    QVERIFY(WriteTextFile(existing, u"older"_qs));
    bool asked = false;
    QTimer driver;
    connect(&driver, &QTimer::timeout, this, [&] {
        QWidget *modal = QApplication::activeModalWidget();
        if (auto *question = qobject_cast<QMessageBox *>(modal)) {
            asked = true;
            question->done(QMessageBox::No);
        } else if (auto *dialog = qobject_cast<QFileDialog *>(modal)) {
            if (asked)
                dialog->reject();
            else // queued, so that a question it may ask leaves this timer free to answer it
                QMetaObject::invokeMethod(dialog, [dialog] { static_cast<QDialog *>(dialog)->accept(); },
                                          Qt::QueuedConnection);
        }
    });
    driver.start(20);
    QtUiServices ui;
    UiServices::FileDialog request;
    request.Title = u"Save this content"_qs;
    request.Filter = TextFilter;
    request.DefaultSuffix = u"txt"_qs;
    request.FileName = existing;
    const QString chosen = ui.GetSaveFileName(nullptr, request);
    QVERIFY(!asked);
    QCOMPARE(chosen, existing);
}

void tst_frmMain::browseTextFile_data()
{
    QTest::addColumn<QByteArray>("bytes");
    QTest::addColumn<bool>("cancel");
    QTest::addColumn<QString>("file");      // chosen in the dialog; PATH is the file written
    QTest::addColumn<QString>("expected");
    QTest::addColumn<QStringList>("boxes"); // PATH stands for the chosen file
    const QString typed = u"Typed contents"_qs;
    const QString path = u"PATH"_qs;
    QTest::newRow("CR LF text") << QByteArray("Line 1\r\nLine 2") << false << path << u"Line 1\nLine 2"_qs
                                << QStringList();
    QTest::newRow("Windows-1252") << QByteArray("Caf\xe9") << false << path << u"Caf\u00e9"_qs << QStringList();
    QTest::newRow("zero bytes") << QByteArray() << false << path << QString() << QStringList();
    QTest::newRow("cancelled") << QByteArray("unused") << true << path << typed << QStringList();
    QTest::newRow("missing file: an error, the article kept")
        << QByteArray("unused") << false << u"PATH.gone"_qs << typed
        << QStringList{Box(u"The file could not be read: PATH"_qs, Buttons::Ok, Icon::Critical)};
    QTest::newRow("a folder: an error, the article kept")
        << QByteArray("unused") << false << u"PATH.d"_qs << typed
        << QStringList{Box(u"The file could not be read: PATH"_qs, Buttons::Ok, Icon::Critical)};
}

void tst_frmMain::browseTextFile()
{
    QFETCH(QByteArray, bytes);
    QFETCH(bool, cancel);
    QFETCH(QString, file);
    QFETCH(QStringList, boxes);
    MainRig rig(m_thesaurus.BaseUrl());
    rig.EnterArticle(u"Typed title"_qs, u"Typed contents"_qs);
    const QString written = rig.Home.filePath(u"article.txt"_qs);
    QVERIFY(WriteBinaryFile(written, bytes));
    QVERIFY(QDir(rig.Home.path()).mkdir(u"article.txt.d"_qs));
    const QString path = QString(file).replace(u"PATH"_qs, written);
    if (!cancel)
        rig.Ui.NextFileNames = {path};
    rig.Click(u"imgBrowseFile"_qs);
    QCOMPARE(rig.Ui.FileDialogs.size(), 1);
    QCOMPARE(rig.Ui.FileDialogs[0].Title, u"Select a text file to open"_qs);
    QCOMPARE(rig.Ui.FileDialogs[0].Filter, TextFilter);
    QTEST(rig.Text(u"txtArticle"_qs), "expected");
    QCOMPARE(rig.Text(u"txtTitle"_qs), u"Typed title"_qs);
    QCOMPARE(Boxes(rig.Ui), boxes.replaceInStrings(u"PATH"_qs, path));
}

void tst_frmMain::helpAndCommand1()
{
    MainRig rig(m_thesaurus.BaseUrl());
    const QString help = rig.Home.path() + u"/Help/Verbloom_Help.htm"_qs;
    rig.Click(u"imgHelp"_qs);
    QCOMPARE(rig.Ui.Opened, QStringList{help});
    QVERIFY(rig.Ui.Messages.isEmpty());
    rig.Ui.OpenSucceeds = false;
    rig.Click(u"imgHelp"_qs);
    QCOMPARE(rig.Ui.Opened, (QStringList{help, help}));
    QCOMPARE(Boxes(rig.Ui),
             QStringList{Box(u"The help page could not be opened: "_qs + help, Buttons::Ok, Icon::Exclamation)});

    // The hidden command lists the known words without alternatives.
    rig.WriteWordFile(u"zeta"_qs, QString());
    rig.WriteWordFile(u"alpha"_qs, QString());
    rig.WriteWordFile(u"beta"_qs, u"b"_qs);
    rig.EnterArticle(u"T"_qs, u"old"_qs);
    QTest::mouseClick(rig.Find<QPushButton>(u"Command1"_qs), Qt::LeftButton);
    QCOMPARE(rig.Text(u"txtArticle"_qs), u" alpha zeta"_qs);
}

void tst_frmMain::ignoredWordAdd_data()
{
    QTest::addColumn<int>("level");
    QTest::addColumn<QString>("word");
    QTest::addColumn<QString>("message"); // "" when the word is added
    const QString length = u"Please make sure that the number of letters in ignore word is more than "_qs;
    const auto letter = [](const QString &c) -> QString {
        return u"Please make sure that the letter \""_qs + c + u"\" is NOT there in your word"_qs;
    };
    QTest::newRow("empty") << 1 << QString() << u"Please make sure that the ignore word is not empty"_qs;
    QTest::newRow("seo, 3 letters") << 1 << u"seo"_qs << QString(length + u"3"_qs);
    QTest::newRow("seos, 3 letters") << 1 << u"seos"_qs << QString();
    QTest::newRow("ab, 2 letters") << 0 << u"ab"_qs << QString(length + u"2"_qs);
    QTest::newRow("abcde, 5 letters") << 3 << u"abcde"_qs << QString(length + u"5"_qs);
    QTest::newRow("blanks are letters") << 1 << u"   "_qs << QString(length + u"3"_qs);
    // The last of blank, dot, comma and apostrophe that occurs is named.
    QTest::newRow("key word") << 1 << u"key word"_qs << letter(u" "_qs);
    QTest::newRow("x.y z") << 1 << u"x.y z"_qs << letter(u"."_qs);
    QTest::newRow("a.b,c") << 1 << u"a.b,c"_qs << letter(u","_qs);
    QTest::newRow("all four") << 1 << u"a'b,c.d e"_qs << letter(u"'"_qs);
    QTest::newRow("colon accepted") << 1 << u"key:word"_qs << QString();
}

void tst_frmMain::ignoredWordAdd()
{
    QFETCH(int, level);
    QFETCH(QString, word);
    QFETCH(QString, message);
    MainRig rig(m_thesaurus.BaseUrl());
    rig.Find<QComboBox>(u"cmbIgnoreWords"_qs)->setCurrentIndex(level);
    auto *list = rig.Find<QTreeWidget>(u"lstIgnoreWords"_qs);
    rig.Find<QLineEdit>(u"txtIgnoreWord"_qs)->setText(word);
    rig.Click(u"cmdIgnoreWordsAdd"_qs);
    const bool added = message.isEmpty();
    QCOMPARE(Boxes(rig.Ui), added ? QStringList() : QStringList{Box(message)});
    QCOMPARE(list->topLevelItemCount(), added ? 1 : 0);
    QCOMPARE(rig.Text(u"txtIgnoreWord"_qs), added ? QString() : word);
    QCOMPARE(rig.Main->CurrentWordTestSettings().IgnoredWords, added ? QStringList{word} : QStringList());
    if (added)
        QCOMPARE(list->topLevelItem(0)->text(0), word);
}

void tst_frmMain::ignoredWordsRemoveAndClear()
{
    MainRig rig(m_thesaurus.BaseUrl());
    auto *list = rig.Find<QTreeWidget>(u"lstIgnoreWords"_qs);
    const QString clear = Box(u"Are you sure you want to remove ALL THE WORDS from the list"_qs, Buttons::YesNo,
                              Icon::Information);

    // "Clear list" asks even when the list is empty.
    rig.Ui.NextAnswers = {Answer::Yes};
    rig.Click(u"Image21"_qs);
    QCOMPARE(Boxes(rig.Ui), QStringList{clear});

    for (const QString &word : {u"Word"_qs, u"beta"_qs, u"Word"_qs}) {
        rig.Find<QLineEdit>(u"txtIgnoreWord"_qs)->setText(word);
        rig.Click(u"Image19"_qs);
    }
    QCOMPARE(list->topLevelItemCount(), 3); // duplicates allowed
    QCOMPARE(rig.Main->CurrentWordTestSettings().IgnoredWords, (QStringList{u"Word"_qs, u"beta"_qs, u"Word"_qs}));
    QVERIFY(!IsCustomizableWord(u"WORD"_qs, rig.Main->CurrentWordTestSettings()));

    // "Remove" with nothing selected only tells; with a selection it asks, and No keeps the word.
    rig.Ui.Messages.clear();
    list->clearSelection();
    rig.Click(u"cmdIgnoreWordsRemove"_qs);
    list->setCurrentItem(list->topLevelItem(1));
    rig.Ui.NextAnswers = {Answer::No, Answer::Yes};
    rig.Click(u"Image20"_qs);
    QCOMPARE(list->topLevelItemCount(), 3);
    rig.Click(u"cmdIgnoreWordsRemove"_qs);
    const QString remove = Box(u"Are you sure you want to remove the word \"beta\" from the Ignored Words List"_qs,
                               Buttons::YesNo, Icon::Information);
    QCOMPARE(Boxes(rig.Ui), (QStringList{Box(u"Please select a word from the list on the left"_qs), remove, remove}));
    QCOMPARE(list->topLevelItemCount(), 2);
    QCOMPARE(list->topLevelItem(1)->text(0), u"Word"_qs);

    rig.Ui.NextAnswers = {Answer::No, Answer::Yes};
    rig.Click(u"cmdIgnoreWordsClear"_qs);
    QCOMPARE(list->topLevelItemCount(), 2);
    rig.Click(u"cmdIgnoreWordsClear"_qs);
    QCOMPARE(list->topLevelItemCount(), 0);
    QCOMPARE(Boxes(rig.Ui).mid(3), (QStringList{clear, clear}));
}

void tst_frmMain::hover_data()
{
    QTest::addColumn<QString>("page");             // "verify" puts a generated version on hand
    QTest::addColumn<QStringList>("over");         // moved over in this order
    QTest::addColumn<QStringList>("hot");          // highlighted afterwards
    QTest::addColumn<QStringList>("cold");         // still normal afterwards
    QTest::addColumn<QString>("background");       // resets every hot image
    QTest::newRow("button bar neighbours") << QString() << QStringList{u"cmdArticle"_qs, u"imgCmdConfig"_qs}
                                           << QStringList{u"imgCmdArticle"_qs, u"imgCmdConfig"_qs} << QStringList()
                                           << u"fraButtons"_qs;
    QTest::newRow("Help and Next labels, disabled commands")
        << QString() << QStringList{u"cmdHelp"_qs, u"cmdNext"_qs, u"cmdVerifyTryAgain"_qs, u"imgSaveContents"_qs}
        << QStringList() << QStringList{u"imgHelp"_qs, u"imgNext"_qs, u"imgReGenerate"_qs, u"imgSaveContents"_qs}
        << QString();
    QTest::newRow("verify page resets only the wizard button")
        << u"verify"_qs << QStringList{u"cmdSave"_qs, u"imgHelp"_qs, u"imgNext"_qs, u"pctMain(2)"_qs}
        << QStringList{u"imgSaveContents"_qs, u"imgHelp"_qs} << QStringList{u"imgNext"_qs} << u"fraButtons"_qs;
    QTest::newRow("wizard button") << QString() << QStringList{u"imgNext"_qs} << QStringList{u"imgNext"_qs}
                                   << QStringList() << u"pctMain(0)"_qs;
    QTest::newRow("article panel") << QString() << QStringList{u"cmdBrowseURL"_qs, u"imgBrowseFile"_qs}
                                   << QStringList{u"imgFromWebsite"_qs, u"imgBrowseFile"_qs} << QStringList()
                                   << u"Picture1"_qs;
    QTest::newRow("configuration panel")
        << u"config"_qs << QStringList{u"cmdIgnoreWordsAdd"_qs, u"Image20"_qs, u"cmdIgnoreWordsClear"_qs}
        << QStringList{u"Image19"_qs, u"Image20"_qs, u"Image21"_qs} << QStringList() << u"Picture2"_qs;
}

void tst_frmMain::hover()
{
    QFETCH(QString, page);
    QFETCH(QStringList, over);
    QFETCH(QStringList, hot);
    QFETCH(QStringList, cold);
    QFETCH(QString, background);
    MainRig rig(m_thesaurus.BaseUrl());
    if (page == u"config"_qs)
        rig.Click(u"cmdConfig"_qs);
    if (page == u"verify"_qs) {
        rig.Main->SetButton(true);
        rig.Main->ShowVerifyPage();
    }
    for (const QString &image : hot + cold)
        QCOMPARE(rig.Skin(image), Normal);
    for (const QString &part : over)
        MoveMouseOver(rig.Find(part));
    for (const QString &image : hot)
        QVERIFY2(rig.Skin(image) == Hover, qPrintable(image));
    for (const QString &image : cold)
        QVERIFY2(rig.Skin(image) == Normal, qPrintable(image));
    if (background.isEmpty())
        return;
    MoveMouseOver(rig.Find(background));
    for (const QString &image : hot)
        QVERIFY2(rig.Skin(image) == Normal, qPrintable(image));
}

VERBLOOM_SHELL_TEST_MAIN(tst_frmMain)
#include "tst_frmMain.moc"
