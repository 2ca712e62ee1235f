// Window tests of the suggestions window: filling, selecting, editing, lookups, closing, Cancel.
#include "SuggestionsRig.h"

#include <QBrush>
#include <QCheckBox>
#include <QFile>
#include <QFont>
#include <QHeaderView>
#include <QProgressBar>
#include <QtTest>

using namespace verbloom;
using namespace verbloom::test;

namespace {

struct ExpectedRow
{
    QString Text;
    QString Alternatives;
    bool Blue;
    bool Bold;
};

const QStringList kClosingSteps{QStringLiteral("ShowMainWindow"), QStringLiteral("SetButton(true)"),
                                QStringLiteral("ShowVerifyPage"), QStringLiteral("cmdVerifyTryAgain_Click")};

const QString kNoAlternativesNeeded =
    QStringLiteral("No alternatives needed for this word. Please select another word");
const QString kEnterAlternatives = QStringLiteral("Enter some alternatives for the word:");

} // namespace

class tst_frmSuggestions final : public QObject
{
    Q_OBJECT

private slots:
    void fillShowsOneRowPerToken();
    void selectingRowTellsWhetherWordTakesAlternatives_data();
    void selectingRowTellsWhetherWordTakesAlternatives();
    void arrowKeysSelectAsClicksDo();
    void doubleClickHasNoEffect();
    void editsReachWordFilesOnlyThroughSaveData();
    void sampleShowsPartOfShownTab_data();
    void sampleShowsPartOfShownTab();
    void tabChangeDropsSelection();
    void getSuggestionWithoutSelectedRowLooksNothingUp_data();
    void getSuggestionWithoutSelectedRowLooksNothingUp();
    void getSuggestionFindingNothingSaysSo();
    void closingStepsInOrder_data();
    void closingStepsInOrder();
    void cancelReturnsToEntryState_data();
    void cancelReturnsToEntryState();
    void newAnalysisForgetsOldSelection();
    void failedSaveIsReportedOnce();
    void hoverSkins_data();
    void hoverSkins();
};

void tst_frmSuggestions::fillShowsOneRowPerToken()
{
    SuggestionsRig rig({{QStringLiteral("happy"), QStringLiteral("glad, cheerful")}, {QStringLiteral("news"), QString()}});
    QVERIFY(rig.Analyse(QStringLiteral("Happy news "), QStringLiteral("HAPPY days, happy news. ")));

    const QList<ExpectedRow> expected[2] = {
        {{u"Happy"_qs, u"glad, cheerful"_qs, true, false},
         {u" "_qs, {}, false, false},
         {u"news"_qs, {}, true, false},
         {u" "_qs, {}, false, false}},
        {{u"HAPPY"_qs, u"glad, cheerful"_qs, true, true},
         {u" "_qs, {}, false, false},
         {u"days"_qs, {}, false, false},
         {u","_qs, {}, false, false},
         {u" "_qs, {}, false, false},
         {u"happy"_qs, u"glad, cheerful"_qs, true, true},
         {u" "_qs, {}, false, false},
         {u"news"_qs, {}, true, true},
         {u"."_qs, {}, false, false},
         {u" "_qs, {}, false, false}}};
    for (int list = 0; list < 2; ++list) {
        QAbstractItemModel *model = rig.List(list)->model();
        QTRY_COMPARE(model->rowCount(), expected[list].size());
        for (int r = 0; r < expected[list].size(); ++r) {
            const ExpectedRow &row = expected[list].at(r);
            QCOMPARE(model->index(r, 0).data().toString(), row.Text);
            QCOMPARE(model->index(r, 1).data().toString(), row.Alternatives);
            QCOMPARE(model->index(r, 2).data().toString(), QString());
            const QVariant colour = model->index(r, 0).data(Qt::ForegroundRole);
            QCOMPARE(colour.isValid() && colour.value<QBrush>().color() == QColor(0, 0, 255), row.Blue);
            const QVariant font = model->index(r, 0).data(Qt::FontRole);
            QCOMPARE(font.isValid() && font.value<QFont>().bold(), row.Bold);
        }
    }
    // Only "days" had neither a word file nor an earlier row: it and its stem were looked up.
    QCOMPARE(rig.Host.Page.Log.filter(QStringLiteral("navigate ")),
             QStringList({u"navigate "_qs + SearchUrl(u"days"_qs), u"navigate "_qs + SearchUrl(u"day"_qs)}));

    QCOMPARE(rig.LabelText(u"lblTotal"_qs), u"Working with 10 Words"_qs);
    QCOMPARE(rig.Window->windowTitle(), u"Getting alternatives for  "_qs);
    QCOMPARE(rig.LabelText(u"lblWord"_qs), u"Please enter alternate words."_qs);
    QVERIFY(!rig.Find<QWidget>(u"pctStatus"_qs)->isVisible());
    QCOMPARE(rig.Find<QProgressBar>(u"pBar"_qs)->maximum(), 9);
    QCOMPARE(rig.Find<QTabWidget>(u"SSTab1"_qs)->currentIndex(), 1);
    QVERIFY(rig.Window->isVisible());

    QTableView *view = rig.List(1);
    QCOMPARE(view->model()->headerData(0, Qt::Horizontal).toString(), u"Alternate Word"_qs);
    QCOMPARE(view->model()->headerData(1, Qt::Horizontal).toString(), u"Suggestions"_qs);
    QCOMPARE(view->model()->headerData(2, Qt::Horizontal).toString(), u"Similar Items"_qs);
    QVERIFY(view->isColumnHidden(1));
    QCOMPARE(view->horizontalHeader()->sectionSize(0), 200);
}

void tst_frmSuggestions::selectingRowTellsWhetherWordTakesAlternatives_data()
{
    QTest::addColumn<int>("row");
    QTest::addColumn<QString>("word");
    QTest::addColumn<bool>("customizable");

    // Contents "Sunny, the 1999 AT&T weather\nTODAY " with "today" ignored.
    QTest::newRow("word") << 1 << u"Sunny"_qs << true;
    QTest::newRow("punctuation") << 2 << u","_qs << false;
    QTest::newRow("blank") << 3 << u" "_qs << false;
    QTest::newRow("short word") << 4 << u"the"_qs << false;
    QTest::newRow("number") << 6 << u"1999"_qs << false;
    QTest::newRow("special character") << 8 << u"AT&T"_qs << false;
    QTest::newRow("second word") << 10 << u"weather"_qs << true;
    QTest::newRow("line break") << 11 << u"\n"_qs << false;
    QTest::newRow("ignored word") << 12 << u"TODAY"_qs << false;
}

void tst_frmSuggestions::selectingRowTellsWhetherWordTakesAlternatives()
{
    QFETCH(int, row);
    QFETCH(QString, word);
    QFETCH(bool, customizable);

    SuggestionsRig rig({{u"sunny"_qs, u"bright"_qs}, {u"weather"_qs, u"climate, skies"_qs}});
    rig.Host.Settings.IgnoredWords = QStringList{u"today"_qs};
    QVERIFY(rig.Analyse(u"a "_qs, u"Sunny, the 1999 AT&T weather\nTODAY "_qs));
    QVERIFY(rig.ClickRow(1, row));

    QCOMPARE(rig.LabelText(u"lblList"_qs), u"1"_qs);
    QCOMPARE(rig.LabelText(u"lblItem"_qs), QString::number(row));
    QCOMPARE(rig.LabelText(u"lblActiveWord"_qs), word);
    QCOMPARE(rig.Find<QLabel>(u"lblActiveWord"_qs)->isVisible(), customizable);
    QCOMPARE(rig.Suggestions()->isEnabled(), customizable);
    QCOMPARE(rig.LabelText(u"lblMessage"_qs), customizable ? kEnterAlternatives : kNoAlternativesNeeded);
    QCOMPARE(rig.Suggestions()->toPlainText(), rig.Window->Lists().Row(1, row - 1).Alternatives);
}

void tst_frmSuggestions::arrowKeysSelectAsClicksDo()
{
    SuggestionsRig rig({{u"sunny"_qs, u"bright"_qs}, {u"days"_qs, u"times"_qs}});
    QVERIFY(rig.Analyse(u"a "_qs, u"Sunny days "_qs));
    QVERIFY(rig.ClickRow(1, 2));
    QCOMPARE(rig.LabelText(u"lblMessage"_qs), kNoAlternativesNeeded);

    QTest::keyClick(rig.List(1), Qt::Key_Down);
    QCOMPARE(rig.LabelText(u"lblItem"_qs), u"3"_qs);
    QCOMPARE(rig.LabelText(u"lblActiveWord"_qs), u"days"_qs);
    QCOMPARE(rig.Suggestions()->toPlainText(), u"times"_qs);
    QCOMPARE(rig.LabelText(u"lblMessage"_qs), kEnterAlternatives);
}

void tst_frmSuggestions::doubleClickHasNoEffect()
{
    SuggestionsRig rig({{u"sunny"_qs, u"bright"_qs}});
    QVERIFY(rig.Analyse(u"a "_qs, u"Sunny days "_qs));
    QVERIFY(rig.ClickRow(1, 1)); // the first click of the double click selects and saves
    // A save would write the row back over this.
    QVERIFY(WriteTextFile(rig.WordFile(u"sunny"_qs), u"changed"_qs));

    QTableView *view = rig.List(1);
    const QPoint at = view->visualRect(view->model()->index(0, 0)).center();
    QTest::mousePress(view->viewport(), Qt::LeftButton, {}, at);
    QTest::mouseDClick(view->viewport(), Qt::LeftButton, {}, at);
    QTest::mouseRelease(view->viewport(), Qt::LeftButton, {}, at);
    QCOMPARE(ReadTextFile(rig.WordFile(u"sunny"_qs)), u"changed"_qs);

    QVERIFY(rig.ClickRow(1, 1)); // a later click selects again
    QCOMPARE(ReadTextFile(rig.WordFile(u"sunny"_qs)), u"bright"_qs);
}

void tst_frmSuggestions::editsReachWordFilesOnlyThroughSaveData()
{
    SuggestionsRig rig({{u"sunny"_qs, u"bright"_qs}, {u"days"_qs, u"times"_qs}});
    QVERIFY(rig.Analyse(u"a "_qs, u"Sunny days, sunny "_qs));

    QVERIFY(rig.ClickRow(1, 1));
    QCOMPARE(rig.Suggestions()->toPlainText(), u"bright"_qs);
    rig.Suggestions()->setPlainText(u"bright, clear"_qs);
    QCOMPARE(rig.Window->Lists().Row(1, 0).Alternatives, u"bright, clear"_qs);
    QTRY_COMPARE(rig.List(1)->model()->index(0, 1).data().toString(), u"bright, clear"_qs);
    QCOMPARE(ReadTextFile(rig.WordFile(u"sunny"_qs)), u"bright"_qs);

    // The bold repeat takes edits, but its word file is written from the first row only.
    QVERIFY(rig.ClickRow(1, 6));
    QCOMPARE(ReadTextFile(rig.WordFile(u"sunny"_qs)), u"bright, clear"_qs);
    QCOMPARE(rig.Suggestions()->toPlainText(), u"bright"_qs);
    rig.Suggestions()->setPlainText(u"radiant"_qs);
    QCOMPARE(rig.Window->Lists().Row(1, 5).Alternatives, u"radiant"_qs);

    QVERIFY(rig.ClickRow(1, 3));
    QCOMPARE(ReadTextFile(rig.WordFile(u"sunny"_qs)), u"bright, clear"_qs);
    QCOMPARE(ReadTextFile(rig.WordFile(u"days"_qs)), u"times"_qs);
    QVERIFY(!QFile::exists(rig.WordFile(u","_qs)));
}

void tst_frmSuggestions::sampleShowsPartOfShownTab_data()
{
    QTest::addColumn<int>("list");
    QTest::addColumn<QString>("sample");

    // Three-letter words are never replaced, so the samples are the parts themselves.
    QTest::newRow("title without its closing blank") << 0 << u"Red sky"_qs;
    QTest::newRow("contents with line breaks") << 1 << u"one\ntwo "_qs;
}

void tst_frmSuggestions::sampleShowsPartOfShownTab()
{
    QFETCH(int, list);
    QFETCH(QString, sample);

    SuggestionsRig rig;
    QVERIFY(rig.Analyse(u"Red sky "_qs, u"one\r\ntwo "_qs));
    QVERIFY(rig.ClickRow(list, 1));
    QCOMPARE(rig.Find<QPlainTextEdit>(u"txtSample"_qs)->toPlainText(), sample);
}

void tst_frmSuggestions::tabChangeDropsSelection()
{
    SuggestionsRig rig({{u"sunny"_qs, u"bright"_qs}, {u"days"_qs, u"times"_qs}});
    QVERIFY(rig.Analyse(u"Sunny days "_qs, u"Sunny days "_qs));
    QVERIFY(rig.ClickRow(1, 3));
    QCOMPARE(rig.LabelText(u"lblItem"_qs), u"3"_qs);

    rig.Find<QTabWidget>(u"SSTab1"_qs)->setCurrentIndex(0);
    QCOMPARE(rig.LabelText(u"lblList"_qs), u"0"_qs);
    QCOMPARE(rig.LabelText(u"lblItem"_qs), u"-1"_qs);
    rig.Suggestions()->setPlainText(u"period"_qs);
    for (int list = 0; list < 2; ++list)
        QCOMPARE(rig.Window->Lists().Row(list, 2).Alternatives, u"times"_qs);
}

void tst_frmSuggestions::getSuggestionWithoutSelectedRowLooksNothingUp_data()
{
    QTest::addColumn<bool>("afterTabChange");
    QTest::newRow("before any row is clicked") << false;
    QTest::newRow("after a tab change") << true;
}

void tst_frmSuggestions::getSuggestionWithoutSelectedRowLooksNothingUp()
{
    QFETCH(bool, afterTabChange);

    SuggestionsRig rig({{u"sunny"_qs, u"bright"_qs}});
    QVERIFY(rig.Analyse(u"Sunny "_qs, u"Sunny "_qs));
    QCOMPARE(rig.LabelText(u"lblItem"_qs), u"-1"_qs); // the analysis switched to "Contents"
    QVERIFY(rig.Analyse(u"Sunny "_qs, u"Sunny "_qs));
    QCOMPARE(rig.LabelText(u"lblItem"_qs), u"0"_qs);
    if (afterTabChange) {
        QVERIFY(rig.ClickRow(1, 1));
        rig.Find<QTabWidget>(u"SSTab1"_qs)->setCurrentIndex(0);
    }
    auto *manual = rig.Find<QCheckBox>(u"chkDontPrompt"_qs);
    manual->setChecked(true);
    rig.Host.Page.Log.clear();

    rig.Click(u"lblOpenSite"_qs);
    QVERIFY(rig.Host.Page.Log.isEmpty());
    QVERIFY(rig.Ui.Messages.isEmpty());
    QVERIFY(!manual->isChecked());
    QVERIFY(rig.Window->isEnabled());
}

void tst_frmSuggestions::getSuggestionFindingNothingSaysSo()
{
    SuggestionsRig rig({{u"sunny"_qs, u"bright"_qs}});
    QVERIFY(rig.Analyse(u"Sunny "_qs, u"Sunny "_qs));
    QVERIFY(rig.ClickRow(0, 1));
    bool enabledDuringLookup = true;
    rig.Host.Page.OnWait = [&] { enabledDuringLookup = rig.Window->isEnabled(); };

    rig.Click(u"imglblOpenSite"_qs);
    QVERIFY(!enabledDuringLookup);
    QVERIFY(rig.Window->isEnabled());
    QCOMPARE(rig.Host.Page.Log.filter(u"navigate "_qs), QStringList{u"navigate "_qs + SearchUrl(u"Sunny"_qs)});
    QCOMPARE(rig.Ui.Messages.size(), 1);
    const UiServices::Message &message = rig.Ui.Messages.first();
    QCOMPARE(message.Text, u"Could not think of an alternative. You will have to type one yourself."_qs);
    QCOMPARE(message.Title, u"Verbloom"_qs);
    QCOMPARE(message.IconKind, UiServices::Icon::None);
    QCOMPARE(message.ButtonSet, UiServices::Buttons::Ok);
    QCOMPARE(rig.Window->Lists().Row(0, 0).Alternatives, u"bright"_qs);
}

void tst_frmSuggestions::closingStepsInOrder_data()
{
    QTest::addColumn<QString>("how");
    QTest::addColumn<bool>("saves");
    QTest::newRow("Ok caption") << u"cmdOk"_qs << true;
    QTest::newRow("Ok image") << u"imgCmdOk"_qs << true;
    QTest::newRow("close box") << QString() << false;
}

void tst_frmSuggestions::closingStepsInOrder()
{
    QFETCH(QString, how);
    QFETCH(bool, saves);

    SuggestionsRig rig;
    rig.Host.Page.Pages.insert(SearchUrl(u"Sunny"_qs), MeaningsPage({{u"bright"_qs, u"clear, fair"_qs}}));
    rig.Find<QCheckBox>(u"chkDontPrompt"_qs)->setChecked(true);
    QVERIFY(rig.Analyse(u"a "_qs, u"Sunny "_qs));
    QCOMPARE(rig.Window->Lists().Row(1, 0).Alternatives, u"clear, fair"_qs);
    rig.Host.Calls.clear();

    if (how.isEmpty())
        QVERIFY(!rig.Window->close());
    else
        rig.Click(how);
    QCOMPARE(rig.Host.Calls, kClosingSteps);
    QVERIFY(!rig.Window->isVisible());
    QCOMPARE(rig.Window->Lists().Count(1), 2);
    QVERIFY(!StopProcessing);
    QCOMPARE(QFile::exists(rig.WordFile(u"sunny"_qs)), saves);
    if (saves)
        QCOMPARE(ReadTextFile(rig.WordFile(u"sunny"_qs)), u"clear, fair"_qs);
}

void tst_frmSuggestions::cancelReturnsToEntryState_data()
{
    QTest::addColumn<QString>("contents");
    QTest::addColumn<int>("cancelAtLookup"); // Cancel during this lookup (from 1); 0: after the analysis
    QTest::addColumn<int>("rows");           // contents rows at the end
    QTest::addColumn<int>("lookups");

    QTest::newRow("during the analysis") << u"Alpha Beta Gamma "_qs << 1 << 1 << 1;
    QTest::newRow("during the last token") << u"Alpha Beta Gamma"_qs << 3 << 5 << 3;
    // Nothing more is looked up once Cancel was pressed (the stem of "Alpha" has no suffix).
    QTest::newRow("after the analysis") << u"Alpha Beta Gamma "_qs << 0 << 6 << 3;
}

void tst_frmSuggestions::cancelReturnsToEntryState()
{
    QFETCH(QString, contents);
    QFETCH(int, cancelAtLookup);
    QFETCH(int, rows);
    QFETCH(int, lookups);

    SuggestionsRig rig;
    int waits = 0;
    rig.Host.Page.OnWait = [&] {
        if (++waits == cancelAtLookup)
            rig.Click(u"cmdCancel"_qs);
    };
    const bool completed = rig.Analyse(u"a "_qs, contents);
    QCOMPARE(completed, cancelAtLookup == 0);
    if (cancelAtLookup == 0) {
        rig.Host.Calls.clear();
        rig.Click(u"imgcmdCancel"_qs);
    }

    QVERIFY(StopProcessing);
    const QStringList wayBack{u"ShowWaitWindow"_qs,   u"HideMainWindow"_qs,   u"cmdNext_Click"_qs,
                              u"SetButton(false)"_qs, u"UnloadWaitWindow"_qs, u"ShowMainWindow"_qs};
    QCOMPARE(rig.Host.Calls, kClosingSteps + wayBack);
    QVERIFY(!rig.Window->isVisible());
    QVERIFY(!rig.Find<QWidget>(u"pctStatus"_qs)->isVisibleTo(rig.Window.get()));
    QCOMPARE(rig.Window->Lists().Count(1), rows);
    QCOMPARE(rig.Host.Page.Log.filter(u"navigate "_qs).size(), lookups);
}

void tst_frmSuggestions::newAnalysisForgetsOldSelection()
{
    SuggestionsRig rig({{u"sunny"_qs, u"bright"_qs}, {u"days"_qs, u"times"_qs}});
    QVERIFY(rig.Analyse(u"a "_qs, u"Sunny days "_qs));
    QVERIFY(rig.ClickRow(1, 3));

    QVERIFY(rig.Analyse(u"a "_qs, u"Sunny ever after "_qs));
    QCOMPARE(rig.LabelText(u"lblItem"_qs), u"0"_qs);
    QVERIFY(rig.Suggestions()->toPlainText().isEmpty());
    rig.Suggestions()->setPlainText(u"period"_qs);
    QVERIFY(rig.Window->Lists().Row(1, 2).Alternatives.isEmpty()); // "ever" keeps no stray text
}

void tst_frmSuggestions::failedSaveIsReportedOnce()
{
    SuggestionsRig rig;
    // A file where the data folder belongs: no word file can be written.
    QVERIFY(WriteTextFile(rig.Folder.path() + u"/data"_qs, QString()));
    rig.Find<QCheckBox>(u"chkDontPrompt"_qs)->setChecked(true);
    QVERIFY(rig.Analyse(u"a "_qs, u"Sunny days "_qs));

    QVERIFY(rig.ClickRow(1, 1));
    QVERIFY(rig.ClickRow(1, 3));
    QCOMPARE(rig.Ui.Messages.size(), 1);
    QVERIFY(rig.Ui.Messages.first().Text.contains(u"could not be saved"_qs));
    QCOMPARE(rig.Ui.Messages.first().IconKind, UiServices::Icon::Exclamation);
    QVERIFY(rig.Window->isVisible());
}

void tst_frmSuggestions::hoverSkins_data()
{
    QTest::addColumn<QString>("part");
    QTest::addColumn<QString>("image");
    QTest::addColumn<QString>("background"); // where the mouse goes last: the window or a panel on it

    QTest::newRow("Get Suggenstion caption") << u"lblOpenSite"_qs << u"imglblOpenSite"_qs << u"fraAlternatives"_qs;
    QTest::newRow("Get Suggenstion image") << u"imglblOpenSite"_qs << u"imglblOpenSite"_qs << u"Picture1"_qs;
    QTest::newRow("Ok caption") << u"cmdOk"_qs << u"imgCmdOk"_qs << u"fraWords"_qs;
    QTest::newRow("Ok image") << u"imgCmdOk"_qs << u"imgCmdOk"_qs << u"Picture1"_qs;
    QTest::newRow("Cancel caption") << u"cmdCancel"_qs << u"imgcmdCancel"_qs << u"Picture1"_qs;
    QTest::newRow("Cancel image") << u"imgcmdCancel"_qs << u"imgcmdCancel"_qs << u"fraAlternatives"_qs;
}

void tst_frmSuggestions::hoverSkins()
{
    QFETCH(QString, part);
    QFETCH(QString, image);
    QFETCH(QString, background);

    SuggestionsRig rig;
    rig.Window->show();
    const QStringList images{u"imglblOpenSite"_qs, u"imgCmdOk"_qs, u"imgcmdCancel"_qs};
    const auto skin = [&](const QString &name) { return CommandOf(rig.Find<QLabel>(name))->Skin(); };
    for (const QString &name : images)
        QCOMPARE(skin(name), u"pic1"_qs);

    MoveMouseOver(rig.Find<QLabel>(part));
    for (const QString &name : images)
        QCOMPARE(skin(name), name == image ? u"pic2"_qs : u"pic1"_qs);
    // Moving on to the neighbour without crossing the background highlights both.
    const QString other = image == images.first() ? images.last() : images.first();
    MoveMouseOver(rig.Find<QLabel>(other));
    QCOMPARE(skin(image), u"pic2"_qs);
    QCOMPARE(skin(other), u"pic2"_qs);

    MoveMouseOver(rig.Find<QWidget>(background));
    for (const QString &name : images)
        QCOMPARE(skin(name), u"pic1"_qs);
}

QTEST_MAIN(tst_frmSuggestions)
#include "tst_frmSuggestions.moc"
