#include "shell/ArticleModel.h"

#include <QtTest>

#include <functional>

using namespace verbloom;

namespace {

// Records what FillWordLists asks of the windows, in one log.
class FakeWindows final : public SuggestionsView, public WizardHost
{
public:
    QStringList Log;
    std::function<void(const QString &, int)> OnAddItems;

    void ShowModeless() override { Log.append(u"show"_qs); }
    void ClearLists() override { Log.append(u"clear"_qs); }
    void SetStatusVisible(bool visible) override
    {
        Log.append(visible ? u"status on"_qs : u"status off"_qs);
    }
    void SetProgressMaximum(qsizetype maximum) override
    {
        Log.append(u"max "_qs + QString::number(maximum));
    }
    void SetProgressValue(qsizetype value) override
    {
        Log.append(u"value "_qs + QString::number(value));
    }
    void SetWordCaption(const QString &caption) override { Log.append(u"caption "_qs + caption); }
    void SelectContentsTab() override { Log.append(u"tab 1"_qs); }
    void AddItems(const QString &word, int list) override
    {
        Log.append(u"add "_qs + QString::number(list) + u" "_qs + word);
        if (OnAddItems)
            OnAddItems(word, list);
    }
    void Unload() override { Log.append(u"unload"_qs); }

    void cmdNext_Click() override { Log.append(u"cmdNext_Click"_qs); }
    void SetButton(bool enabled) override
    {
        Log.append(u"SetButton "_qs + (enabled ? u"True"_qs : u"False"_qs));
    }
    void UnloadWaitWindow() override { Log.append(u"unload frmWait"_qs); }
    void ShowMainWindow() override { Log.append(u"show frmMain"_qs); }
};

QStringList TitleSteps(qsizetype i, const QString &token)
{
    return {u"show"_qs, u"value "_qs + QString::number(i), u"caption "_qs + token,
            u"add 0 "_qs + token};
}

QStringList ContentsSteps(qsizetype i, const QString &token)
{
    return {u"tab 1"_qs, u"show"_qs, u"value "_qs + QString::number(i), u"caption "_qs + token,
            u"add 1 "_qs + token};
}

const QStringList kCancelPath{u"status off"_qs,     u"unload"_qs,         u"cmdNext_Click"_qs,
                              u"SetButton False"_qs, u"unload frmWait"_qs, u"show frmMain"_qs};

} // namespace

class TestArticleModel final : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();
    void init() { StopProcessing = false; }

    void splitArticle_data();
    void splitArticle();
    void everyDelimiterIsAToken();
    void wordTest_data();
    void wordTest();
    void fillWordLists();
    void fillWordListsShortTitle();
    void cancelDuringTitleLoop();
    void cancelDuringContentsLoop();
    void loopsSurviveReanalysis();
};

void TestArticleModel::initTestCase()
{
    // Set from start-up, no article before the first analysis.
    QVERIFY(StopProcessing);
    QVERIFY(CurrentArticle().TitleTokens.isEmpty());
    QVERIFY(CurrentArticle().ContentsTokens.isEmpty());
}

void TestArticleModel::splitArticle_data()
{
    QTest::addColumn<QString>("title");
    QTest::addColumn<QString>("contents");
    QTest::addColumn<QStringList>("titleTokens");
    QTest::addColumn<QStringList>("contentsTokens");

    const QStringList x{u"x"_qs, u" "_qs};
    QTest::newRow("hello world") << u"Hello, world "_qs << u"x "_qs
                                 << QStringList{u"Hello"_qs, u","_qs, u" "_qs, u"world"_qs,
                                                u" "_qs}
                                 << x;
    QTest::newRow("line breaks normalised in the contents")
        << u"x "_qs << u"a\r\nb\rc "_qs << x
        << QStringList{u"a"_qs, u"\n"_qs, u"b"_qs, u"\n"_qs, u"c"_qs, u" "_qs};
    QTest::newRow("CR LF then CR") << u"x "_qs << u"a\r\r\nb "_qs << x
                                   << QStringList{u"a"_qs, u"\n"_qs, u"\n"_qs, u"b"_qs, u" "_qs};
    QTest::newRow("two delimiters in a row")
        << u"x "_qs << u"end.\r\nmore "_qs << x
        << QStringList{u"end"_qs, u"."_qs, u"\n"_qs, u"more"_qs, u" "_qs};
    QTest::newRow("CR kept in the title")
        << u"a\rb\r\nc "_qs << u"x "_qs << QStringList{u"a\rb\r"_qs, u"\n"_qs, u"c"_qs, u" "_qs}
        << x;
    QTest::newRow("tab inside a word") << u"x "_qs << u"tab\tword "_qs << x
                                       << QStringList{u"tab\tword"_qs, u" "_qs};
    QTest::newRow("contraction and hyphen")
        << u"don't "_qs << u"well-known "_qs
        << QStringList{u"don"_qs, u"'"_qs, u"t"_qs, u" "_qs}
        << QStringList{u"well"_qs, u"-"_qs, u"known"_qs, u" "_qs};
    QTest::newRow("not delimiters")
        << u"a=b@c#d%e$f^g&h~i`j\\k "_qs << u"x "_qs
        << QStringList{u"a=b@c#d%e$f^g&h~i`j\\k"_qs, u" "_qs} << x;
    QTest::newRow("curly quotes")
        << u"\u201Chi\u201D \u2018yo\u2019 "_qs << u"x "_qs
        << QStringList{u"\u201C"_qs, u"hi"_qs, u"\u201D"_qs, u" "_qs, u"\u2018"_qs, u"yo"_qs,
                       u"\u2019"_qs, u" "_qs}
        << x;
}

void TestArticleModel::splitArticle()
{
    QFETCH(QString, title);
    QFETCH(QString, contents);
    QFETCH(QStringList, titleTokens);
    QFETCH(QStringList, contentsTokens);
    const ArticleTokens tokens = SplitArticle(title, contents);
    QCOMPARE(tokens.TitleTokens, titleTokens);
    QCOMPARE(tokens.ContentsTokens, contentsTokens);
}

void TestArticleModel::everyDelimiterIsAToken()
{
    const QStringList &delimiters = ArticleDelimiters();
    QCOMPARE(delimiters.size(), 28);
    QCOMPARE(delimiters.join(QString()),
             u"*,. \n:;/!?'\"()[]{}+-_<>\u201C\u201D\u2018\u2019|"_qs);
    QString contents;
    QStringList expected;
    for (const QString &delimiter : delimiters) {
        contents += u"w"_qs + delimiter;
        expected << u"w"_qs << delimiter;
    }
    const ArticleTokens tokens = SplitArticle(u"t "_qs, contents);
    QCOMPARE(tokens.ContentsTokens, expected);
    QCOMPARE(tokens.ContentsTokens.join(QString()), contents);
}

void TestArticleModel::wordTest_data()
{
    QTest::addColumn<QString>("token");
    QTest::addColumn<int>("minimum");
    QTest::addColumn<QStringList>("ignored");
    QTest::addColumn<bool>("expected");

    const QStringList none;
    const QStringList list{u"Alpha"_qs, u"WORD"_qs, u"beta"_qs};
    QTest::newRow("the") << u"the"_qs << 3 << none << false;
    QTest::newRow("and") << u"and"_qs << 3 << none << false;
    QTest::newRow("was") << u"was"_qs << 3 << none << false;
    QTest::newRow("word") << u"word"_qs << 3 << none << true;
    QTest::newRow("2 letters: and") << u"and"_qs << 2 << none << true;
    QTest::newRow("2 letters: of") << u"of"_qs << 2 << none << false;
    QTest::newRow("5 letters: hello") << u"hello"_qs << 5 << none << false;
    QTest::newRow("5 letters: hellos") << u"hellos"_qs << 5 << none << true;
    QTest::newRow("delimiter") << u","_qs << 2 << none << false;
    QTest::newRow("mp3") << u"mp3"_qs << 2 << none << false;
    QTest::newRow("C#") << u"C#"_qs << 1 << none << false;
    QTest::newRow("AT&T") << u"AT&T"_qs << 3 << none << false;
    QTest::newRow("50%") << u"50%"_qs << 2 << none << false;
    QTest::newRow("1999") << u"1999"_qs << 3 << none << false;
    QTest::newRow("numeric with exponent") << u"12e5"_qs << 3 << none << false;
    QTest::newRow("digit inside") << u"abc1def"_qs << 3 << none << false;
    for (const QChar c : u"@#=%$^*&\u2026"_qs) {
        QTest::addRow("contains U+%04X", c.unicode())
            << u"wo"_qs + c + u"rd"_qs << 3 << none << false;
    }
    QTest::newRow("trailing ellipsis") << u"wait\u2026"_qs << 3 << none << false;
    QTest::newRow("other marks pass") << u"a~b`c\\d!"_qs << 3 << none << true;
    QTest::newRow("tab inside") << u"tab\tword"_qs << 3 << none << true;
    QTest::newRow("ignored, same case") << u"WORD"_qs << 3 << list << false;
    QTest::newRow("ignored, other case") << u"word"_qs << 3 << list << false;
    QTest::newRow("ignored, mixed case") << u"wOrD"_qs << 3 << list << false;
    QTest::newRow("ignored, first item") << u"ALPHA"_qs << 3 << list << false;
    QTest::newRow("ignored, last item") << u"Beta"_qs << 3 << list << false;
    QTest::newRow("longer than an ignored word") << u"words"_qs << 3 << list << true;
    QTest::newRow("ignored word with a blank") << u"word"_qs << 3 << QStringList{u"word "_qs}
                                               << true;
    QTest::newRow("sharp s upper-cases to SS")
        << u"stra\u00DFe"_qs << 3 << QStringList{u"STRASSE"_qs} << false;
    QTest::newRow("ignored sharp s") << u"strasse"_qs << 3 << QStringList{u"Stra\u00DFe"_qs}
                                     << false;
    QTest::newRow("long s upper-cases to S") << u"\u017Ftop"_qs << 3 << QStringList{u"stop"_qs}
                                             << false;
    QTest::newRow("dotless i upper-cases to I")
        << u"\u0131dea"_qs << 3 << QStringList{u"idea"_qs} << false;
    QTest::newRow("Kelvin sign is its own upper case")
        << u"\u212Aelvin"_qs << 3 << QStringList{u"kelvin"_qs} << true;
    QTest::newRow("accented letters") << u"\u00E9t\u00E9s"_qs << 3
                                      << QStringList{u"\u00C9T\u00C9S"_qs} << false;
    QTest::newRow("accented, different") << u"\u00E9t\u00E9s"_qs << 3
                                         << QStringList{u"etes"_qs} << true;
}

void TestArticleModel::wordTest()
{
    QFETCH(QString, token);
    QFETCH(int, minimum);
    QFETCH(QStringList, ignored);
    QFETCH(bool, expected);
    const WordTestSettings settings{minimum, ignored};
    QCOMPARE(IsCustomizableWord(token, settings), expected);
}

void TestArticleModel::fillWordLists()
{
    FakeWindows windows;
    ArticleTokens model;
    model.TitleTokens = QStringList{u"stale"_qs, u"stale"_qs, u"stale"_qs, u"stale"_qs,
                                    u"stale"_qs, u"stale"_qs};
    QVERIFY(FillWordLists(u"Hi there "_qs, u"a\r\nb "_qs, model, windows, windows));

    QStringList expected{u"show"_qs, u"clear"_qs, u"status on"_qs, u"max 3"_qs};
    const QStringList title{u"Hi"_qs, u" "_qs, u"there"_qs, u" "_qs};
    const QStringList contents{u"a"_qs, u"\n"_qs, u"b"_qs, u" "_qs};
    for (qsizetype i = 0; i < title.size(); ++i)
        expected += TitleSteps(i, title.at(i));
    expected += u"max 3"_qs;
    for (qsizetype i = 0; i < contents.size(); ++i)
        expected += ContentsSteps(i, contents.at(i));
    expected << u"caption Please enter alternate words."_qs << u"status off"_qs;
    QCOMPARE(windows.Log, expected);
    QCOMPARE(model.TitleTokens, title);
    QCOMPARE(model.ContentsTokens, contents);
}

void TestArticleModel::fillWordListsShortTitle()
{
    // A title of one token sets no maximum before the title loop.
    FakeWindows windows;
    ArticleTokens model;
    QVERIFY(FillWordLists(u"Hi"_qs, u"a b"_qs, model, windows, windows));
    QStringList expected{u"show"_qs, u"clear"_qs, u"status on"_qs};
    expected += TitleSteps(0, u"Hi"_qs);
    expected += u"max 2"_qs;
    expected += ContentsSteps(0, u"a"_qs);
    QCOMPARE(windows.Log.mid(0, expected.size()), expected);
}

void TestArticleModel::cancelDuringTitleLoop()
{
    FakeWindows windows;
    windows.OnAddItems = [](const QString &, int list) {
        QCOMPARE(list, 0);
        StopProcessing = true;
    };
    ArticleTokens model;
    QVERIFY(!FillWordLists(u"Hi there "_qs, u"a b "_qs, model, windows, windows));
    QStringList expected{u"show"_qs, u"clear"_qs, u"status on"_qs, u"max 3"_qs};
    expected += TitleSteps(0, u"Hi"_qs);
    expected += TitleSteps(1, u" "_qs); // the title loop does not test the flag
    expected += TitleSteps(2, u"there"_qs);
    expected += TitleSteps(3, u" "_qs);
    expected += u"max 3"_qs;
    expected += kCancelPath;
    QCOMPARE(windows.Log, expected);
    QCOMPARE(model.ContentsTokens.size(), 4); // the model is complete
}

void TestArticleModel::cancelDuringContentsLoop()
{
    FakeWindows windows;
    windows.OnAddItems = [](const QString &word, int list) {
        if (list == 1 && word == u"\n"_qs)
            StopProcessing = true;
    };
    ArticleTokens model;
    QVERIFY(!FillWordLists(u"T "_qs, u"a\nb c "_qs, model, windows, windows));
    QStringList expected{u"show"_qs, u"clear"_qs, u"status on"_qs, u"max 1"_qs};
    expected += TitleSteps(0, u"T"_qs);
    expected += TitleSteps(1, u" "_qs);
    expected += u"max 5"_qs;
    expected += ContentsSteps(0, u"a"_qs);
    expected += ContentsSteps(1, u"\n"_qs);
    expected += kCancelPath;
    QCOMPARE(windows.Log, expected);
}

void TestArticleModel::loopsSurviveReanalysis()
{
    // A handler running while AddItems waits may analyse another article into the same model.
    FakeWindows windows;
    ArticleTokens model;
    bool reentered = false;
    windows.OnAddItems = [&](const QString &, int) {
        if (!reentered) {
            reentered = true;
            model = SplitArticle(u"x "_qs, u"y "_qs);
        }
    };
    QVERIFY(FillWordLists(u"one two "_qs, u"three four "_qs, model, windows, windows));
    QStringList added;
    for (const QString &line : std::as_const(windows.Log)) {
        if (line.startsWith(u"add "_qs))
            added.append(line);
    }
    QCOMPARE(added, (QStringList{u"add 0 one"_qs, u"add 0  "_qs, u"add 0 two"_qs, u"add 0  "_qs,
                                 u"add 1 three"_qs, u"add 1  "_qs, u"add 1 four"_qs,
                                 u"add 1  "_qs}));
}

QTEST_GUILESS_MAIN(TestArticleModel)
#include "tst_articlemodel.moc"
