// Window tests of the confirm-meaning window, shown by lookups of the suggestions window.
#include "SuggestionsRig.h"

#include <QCheckBox>
#include <QHeaderView>
#include <QLineEdit>
#include <QTreeWidget>
#include <QtTest>

using namespace verbloom;
using namespace verbloom::test;

namespace {

const QString kTwoMeanings = MeaningsPage({{u"glad"_qs, u" happy, joyful "_qs}, {u"merry"_qs, u"jolly"_qs}});
// A meaning whose entry word stands among its own synonyms.
const QString kThreeMeanings = MeaningsPage(
    {{u"glad"_qs, u" happy, joyful "_qs}, {u"merry"_qs, u"jolly"_qs}, {u"bright"_qs, u"sunny, Bright"_qs}});

QTreeWidget *Meanings(frmConfirmOptions &window)
{
    return window.findChild<QTreeWidget *>(u"lstSuggestionsFromWeb"_qs);
}

QString Label(QWidget &window, const QString &name)
{
    return window.findChild<QLabel *>(name)->text();
}

void ClickPart(QWidget &window, const QString &name)
{
    QTest::mouseClick(window.findChild<QLabel *>(name), Qt::LeftButton);
}

/// A window whose "glad" rows (title row 1, contents row 3) start with "old, stuff" from the word
/// file, and whose thesaurus offers two meanings for "glad".
struct ConfirmRig : SuggestionsRig
{
    ConfirmRig() : SuggestionsRig({{u"glad"_qs, u"old, stuff"_qs}})
    {
        Host.Page.Pages.insert(SearchUrl(u"Glad"_qs), kThreeMeanings);
        Host.Page.Pages.insert(SearchUrl(u"glad"_qs), kThreeMeanings);
    }

    /// Analyses "Glad " / "so glad " and presses "Get Suggenstion" on a "glad" row; `act` answers
    /// the confirm window. Returns the number of confirm windows shown.
    int GetSuggestion(int list, const std::function<void(frmConfirmOptions &)> &act)
    {
        if (!Analyse(u"Glad "_qs, u"so glad "_qs) || !ClickRow(list, list == 0 ? 1 : 3))
            return -1;
        int seen = 0;
        WhenConfirmShown(act, &seen);
        Click(u"lblOpenSite"_qs);
        return seen;
    }
};

} // namespace

class tst_frmConfirmOptions final : public QObject
{
    Q_OBJECT

private slots:
    void showsOfferDuringAnalysis();
    void saveSelectedComposesChoice_data();
    void saveSelectedComposesChoice();
    void ignoreAndCloseBoxWriteNothing_data();
    void ignoreAndCloseBoxWriteNothing();
    void choiceEqualToShownTextReachesItsRow();
    void doNotPromptAgainChecksManual();
    void doNotPromptAgainStopsFurtherOffers();
    void hoverSkins_data();
    void hoverSkins();
};

void tst_frmConfirmOptions::showsOfferDuringAnalysis()
{
    SuggestionsRig rig;
    rig.Host.Page.Pages.insert(SearchUrl(u"glad"_qs), kTwoMeanings);
    int seen = 0;
    WhenConfirmShown(
        [&](frmConfirmOptions &window) {
            QCOMPARE(window.windowTitle(), u"glad: confirm suggestions"_qs);
            QCOMPARE(Label(window, u"lblSuggestLabel"_qs), u"Suggest the word closest in meaning to \"glad\""_qs);
            QCOMPARE(Label(window, u"lblSuggestSentence"_qs), u" glad was I "_qs);
            QCOMPARE(Label(window, u"lblList"_qs), u"1"_qs);
            QCOMPARE(Label(window, u"lblItem"_qs), u"3"_qs);
            QCOMPARE(rig.LabelText(u"lblActiveWord"_qs), u"glad"_qs);
            QTreeWidget *list = Meanings(window);
            QCOMPARE(list->headerItem()->text(0), u"Word"_qs);
            QCOMPARE(list->headerItem()->text(1), u"Suggestions"_qs);
            QCOMPARE(list->topLevelItemCount(), 2);
            QCOMPARE(list->topLevelItem(0)->text(0), u"glad"_qs);
            QCOMPARE(list->topLevelItem(0)->text(1), u"happy, joyful"_qs);
            QCOMPARE(list->topLevelItem(1)->text(0), u"merry"_qs);
            QCOMPARE(list->topLevelItem(0)->checkState(0), Qt::Unchecked);
            QVERIFY(window.findChild<QLineEdit *>(u"txtCustom"_qs)->text().isEmpty());
            ClickPart(window, u"lblIgnore"_qs);
        },
        &seen);
    QVERIFY(rig.Analyse(u"a "_qs, u"so glad was I "_qs));
    QCOMPARE(seen, 1);
    QVERIFY(QTest::currentTestFailed() == false);

    // Ignored: the new word keeps no alternatives, and the next save marks it known with an empty file.
    QVERIFY(rig.Window->Lists().Row(1, 2).Alternatives.isEmpty());
    rig.Click(u"cmdOk"_qs);
    QVERIFY(QFile::exists(rig.WordFile(u"glad"_qs)));
    QCOMPARE(ReadTextFile(rig.WordFile(u"glad"_qs)), QString());
}

void tst_frmConfirmOptions::saveSelectedComposesChoice_data()
{
    QTest::addColumn<int>("list");
    QTest::addColumn<QList<int>>("ticked");
    QTest::addColumn<QString>("custom");
    QTest::addColumn<QString>("via");
    QTest::addColumn<QString>("expected");

    QTest::newRow("custom text alone") << 1 << QList<int>{} << u"  my own  "_qs << u"lblSuggestionOk"_qs
                                       << u"my own"_qs;
    QTest::newRow("two meanings, entry words first")
        << 1 << QList<int>{0, 1} << QString() << u"cmdSuggestionOk"_qs << u"glad, happy, joyful, merry, jolly"_qs;
    QTest::newRow("custom text, then a meaning")
        << 1 << QList<int>{1} << u"own"_qs << u"lblSuggestionOk"_qs << u"own, merry, jolly"_qs;
    QTest::newRow("nothing clears the row") << 1 << QList<int>{} << QString() << u"lblSuggestionOk"_qs << QString();
    QTest::newRow("title row") << 0 << QList<int>{0} << QString() << u"lblSuggestionOk"_qs
                               << u"glad, happy, joyful"_qs;
    QTest::newRow("entry word already a synonym is not repeated")
        << 1 << QList<int>{1, 2} << QString() << u"cmdSuggestionOk"_qs << u"merry, jolly, sunny, Bright"_qs;
}

void tst_frmConfirmOptions::saveSelectedComposesChoice()
{
    QFETCH(int, list);
    QFETCH(QList<int>, ticked);
    QFETCH(QString, custom);
    QFETCH(QString, via);
    QFETCH(QString, expected);

    ConfirmRig rig;
    const int row = list == 0 ? 1 : 3;
    const int seen = rig.GetSuggestion(list, [&](frmConfirmOptions &window) {
        for (int index : ticked)
            Meanings(window)->topLevelItem(index)->setCheckState(0, Qt::Checked);
        QTest::keyClicks(window.findChild<QLineEdit *>(u"txtCustom"_qs), custom);
        ClickPart(window, via);
    });
    QCOMPARE(seen, 1);

    QCOMPARE(rig.Window->Lists().Row(list, row - 1).Alternatives, expected);
    QCOMPARE(rig.Suggestions()->toPlainText(), expected);
    QCOMPARE(rig.LabelText(u"lblList"_qs), QString::number(list));
    QCOMPARE(rig.LabelText(u"lblItem"_qs), QString::number(row));
    QVERIFY(rig.Ui.Messages.isEmpty());
    QVERIFY(rig.Window->isEnabled());
    // The word file follows at the next save.
    QCOMPARE(ReadTextFile(rig.WordFile(u"glad"_qs)), u"old, stuff"_qs);
    rig.Click(u"cmdOk"_qs);
    if (list == 0)
        QCOMPARE(ReadTextFile(rig.WordFile(u"glad"_qs)), expected);
}

void tst_frmConfirmOptions::ignoreAndCloseBoxWriteNothing_data()
{
    QTest::addColumn<QString>("via");
    QTest::newRow("Ignore Word caption") << u"lblIgnore"_qs;
    QTest::newRow("Ignore Word image") << u"cmdIgnore"_qs;
    QTest::newRow("close box") << QString();
}

void tst_frmConfirmOptions::ignoreAndCloseBoxWriteNothing()
{
    QFETCH(QString, via);

    ConfirmRig rig;
    const int seen = rig.GetSuggestion(0, [&](frmConfirmOptions &window) {
        Meanings(window)->topLevelItem(0)->setCheckState(0, Qt::Checked);
        QTest::keyClicks(window.findChild<QLineEdit *>(u"txtCustom"_qs), u"unwanted"_qs);
        if (via.isEmpty())
            window.close();
        else
            ClickPart(window, via);
    });
    QCOMPARE(seen, 1);
    QCOMPARE(rig.Window->Lists().Row(0, 0).Alternatives, u"old, stuff"_qs);
    QCOMPARE(rig.Suggestions()->toPlainText(), u"old, stuff"_qs);
    QVERIFY(rig.Ui.Messages.isEmpty());
}

void tst_frmConfirmOptions::choiceEqualToShownTextReachesItsRow()
{
    // While "merry" is looked up the user selects "glad", whose alternatives are then shown; the
    // choice for "merry" is the same text and must still reach the row of "merry".
    SuggestionsRig rig({{u"glad"_qs, u"jolly"_qs}});
    rig.Host.Page.Pages.insert(SearchUrl(u"merry"_qs), MeaningsPage({{u"merry"_qs, u"jolly"_qs}}));
    rig.Host.Page.OnWait = [&] { QVERIFY(rig.ClickRow(1, 1)); };
    int seen = 0;
    WhenConfirmShown(
        [](frmConfirmOptions &window) {
            QTest::keyClicks(window.findChild<QLineEdit *>(u"txtCustom"_qs), u"jolly"_qs);
            ClickPart(window, u"cmdSuggestionOk"_qs);
        },
        &seen);
    QVERIFY(rig.Analyse(u"a "_qs, u"glad merry "_qs));
    QCOMPARE(seen, 1);
    QCOMPARE(rig.Window->Lists().Row(1, 2).Alternatives, u"jolly"_qs);
    QCOMPARE(rig.LabelText(u"lblItem"_qs), u"3"_qs);
}

void tst_frmConfirmOptions::doNotPromptAgainChecksManual()
{
    ConfirmRig rig;
    auto *manual = rig.Find<QCheckBox>(u"chkDontPrompt"_qs);
    bool checkedAtOnce = false;
    bool stillChecked = false;
    const int seen = rig.GetSuggestion(1, [&](frmConfirmOptions &window) {
        auto *box = window.findChild<QCheckBox *>(u"chkSuggestionDoNotPrompt"_qs);
        QTest::mouseClick(box, Qt::LeftButton);
        checkedAtOnce = manual->isChecked();
        QTest::mouseClick(box, Qt::LeftButton); // clearing it again does not clear "Manual"
        stillChecked = manual->isChecked();
        ClickPart(window, u"lblIgnore"_qs);
    });
    QCOMPARE(seen, 1);
    QVERIFY(checkedAtOnce);
    QVERIFY(stillChecked);
    QVERIFY(manual->isChecked());

    // "Get Suggenstion" clears "Manual" first, so the meanings are offered again.
    int again = 0;
    WhenConfirmShown([](frmConfirmOptions &window) { ClickPart(window, u"lblIgnore"_qs); }, &again);
    rig.Click(u"lblOpenSite"_qs);
    QCOMPARE(again, 1);
    QVERIFY(!manual->isChecked());
}

void tst_frmConfirmOptions::doNotPromptAgainStopsFurtherOffers()
{
    SuggestionsRig rig;
    rig.Host.Page.Pages.insert(SearchUrl(u"glad"_qs), kTwoMeanings);
    rig.Host.Page.Pages.insert(SearchUrl(u"merry"_qs),
                               MeaningsPage({{u"merry"_qs, u"jolly"_qs}, {u"festive"_qs, u"jovial, gay"_qs}}));
    int seen = 0;
    WhenConfirmShown(
        [](frmConfirmOptions &window) {
            QTest::mouseClick(window.findChild<QCheckBox *>(u"chkSuggestionDoNotPrompt"_qs), Qt::LeftButton);
            Meanings(window)->topLevelItem(0)->setCheckState(0, Qt::Checked);
            ClickPart(window, u"cmdSuggestionOk"_qs);
        },
        &seen);
    QVERIFY(rig.Analyse(u"a "_qs, u"glad merry "_qs));
    QCOMPARE(seen, 1);
    QCOMPARE(rig.Window->Lists().Row(1, 0).Alternatives, u"glad, happy, joyful"_qs);
    // Without asking, the last meaning of the page is taken.
    QCOMPARE(rig.Window->Lists().Row(1, 2).Alternatives, u"jovial, gay"_qs);
}

void tst_frmConfirmOptions::hoverSkins_data()
{
    QTest::addColumn<QString>("part");
    QTest::addColumn<QString>("image");
    QTest::newRow("Save Selected caption") << u"lblSuggestionOk"_qs << u"cmdSuggestionOk"_qs;
    QTest::newRow("Save Selected image") << u"cmdSuggestionOk"_qs << u"cmdSuggestionOk"_qs;
    QTest::newRow("Ignore Word caption") << u"lblIgnore"_qs << u"cmdIgnore"_qs;
    QTest::newRow("Ignore Word image") << u"cmdIgnore"_qs << u"cmdIgnore"_qs;
}

void tst_frmConfirmOptions::hoverSkins()
{
    QFETCH(QString, part);
    QFETCH(QString, image);

    SuggestionsRig rig;
    frmConfirmOptions window(*rig.Window);
    window.show();
    const QStringList images{u"cmdSuggestionOk"_qs, u"cmdIgnore"_qs};
    const auto skin = [&](const QString &name) {
        return CommandOf(window.findChild<QLabel *>(name))->Skin();
    };
    MoveMouseOver(window.findChild<QLabel *>(part));
    for (const QString &name : images)
        QCOMPARE(skin(name), name == image ? u"pic2"_qs : u"pic1"_qs);
    MoveMouseOver(window.findChild<QWidget *>(u"pctOptions"_qs));
    for (const QString &name : images)
        QCOMPARE(skin(name), u"pic1"_qs);
}

QTEST_MAIN(tst_frmConfirmOptions)
#include "tst_frmConfirmOptions.moc"
