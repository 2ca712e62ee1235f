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

    void ShowModeless() override { Log << u"show"_qs; }
    void ClearLists() override { Log << u"clear"_qs; }
    void SetStatusVisible(bool visible) override { Log << (visible ? u"status on"_qs : u"status off"_qs); }
    void SetProgressMaximum(qsizetype maximum) override { Log << u"max "_qs + QString::number(maximum); }
    void SetProgressValue(qsizetype value) override { Log << u"value "_qs + QString::number(value); }
    void SetWordCaption(const QString &caption) override { Log << u"caption "_qs + caption; }
    void SelectContentsTab() override { Log << u"tab 1"_qs; }
    void AddItems(const QString &word, int list) override
    {
        Log << u"add "_qs + QString::number(list) + u" "_qs + word;
        if (OnAddItems)
            OnAddItems(word, list);
    }
    void Unload() override { Log << u"unload"_qs; }

    void cmdNext_Click() override { Log << u"cmdNext_Click"_qs; }
    void SetButton(bool enabled) override { Log << (enabled ? u"SetButton True"_qs : u"SetButton False"_qs); }
    void UnloadWaitWindow() override { Log << u"unload frmWait"_qs; }
    void ShowMainWindow() override { Log << u"show frmMain"_qs; }
};

// The calls FillWordLists should make for these tokens; with `cancelAt` >= 0 the contents loop
// finds StopProcessing set before that token and takes the cancel path.
QStringList ExpectedLog(const QStringList &title, const QStringList &contents, qsizetype cancelAt)
{
    QStringList log{u"show"_qs, u"clear"_qs, u"status on"_qs};
    if (title.size() > 1) // a title of one token sets no maximum
        log << u"max "_qs + QString::number(title.size() - 1);
    for (qsizetype i = 0; i < title.size(); ++i) // the title loop does not test the flag
        log << u"show"_qs << u"value "_qs + QString::number(i) << u"caption "_qs + title[i] << u"add 0 "_qs + title[i];
    log << u"max "_qs + QString::number(contents.size() - 1);
    for (qsizetype i = 0; i < (cancelAt < 0 ? contents.size() : cancelAt); ++i) {
        log << u"tab 1"_qs << u"show"_qs << u"value "_qs + QString::number(i) << u"caption "_qs + contents[i]
            << u"add 1 "_qs + contents[i];
    }
    if (cancelAt >= 0) {
        return log << u"status off"_qs << u"unload"_qs << u"cmdNext_Click"_qs << u"SetButton False"_qs
                   << u"unload frmWait"_qs << u"show frmMain"_qs;
    }
    return log << u"caption Please enter alternate words."_qs << u"status off"_qs;
}

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
    void fillWordLists_data();
    void fillWordLists();
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
                                 << QStringList{u"Hello"_qs, u","_qs, u" "_qs, u"world"_qs, u" "_qs} << x;
    QTest::newRow("line breaks normalised in the contents")
        << u"x "_qs << u"a\r\nb\rc "_qs << x << QStringList{u"a"_qs, u"\n"_qs, u"b"_qs, u"\n"_qs, u"c"_qs, u" "_qs};
    QTest::newRow("CR LF then CR") << u"x "_qs << u"a\r\r\nb "_qs << x
                                   << QStringList{u"a"_qs, u"\n"_qs, u"\n"_qs, u"b"_qs, u" "_qs};
    QTest::newRow("CR kept in the title")
        << u"a\rb\r\nc "_qs << u"x "_qs << QStringList{u"a\rb\r"_qs, u"\n"_qs, u"c"_qs, u" "_qs} << x;
    QTest::newRow("not delimiters") << u"a=b@c#d%e$f^g&h~i`j\\k\tl "_qs << u"x "_qs
                                    << QStringList{u"a=b@c#d%e$f^g&h~i`j\\k\tl"_qs, u" "_qs} << x;
}

void TestArticleModel::splitArticle()
{
    QFETCH(QString, title);
    QFETCH(QString, contents);
    const ArticleTokens tokens = SplitArticle(title, contents);
    QTEST(tokens.TitleTokens, "titleTokens");
    QTEST(tokens.ContentsTokens, "contentsTokens");
}

void TestArticleModel::everyDelimiterIsAToken()
{
    const QStringList &delimiters = ArticleDelimiters();
    QCOMPARE(delimiters.join(QString()), u"*,. \n:;/!?'\"()[]{}+-_<>\u201C\u201D\u2018\u2019|"_qs);
    QCOMPARE(delimiters.size(), 28);
    QString contents;
    QStringList expected;
    for (const QString &delimiter : delimiters) {
        contents += u"w"_qs + delimiter;
        expected << u"w"_qs << delimiter;
    }
    QCOMPARE(SplitArticle(u"t "_qs, contents).ContentsTokens, expected);
}

void TestArticleModel::wordTest_data()
{
    QTest::addColumn<QString>("token");
    QTest::addColumn<int>("minimum");
    QTest::addColumn<QStringList>("ignored");
    QTest::addColumn<bool>("expected");

    const QStringList none;
    const QStringList list{u"Alpha"_qs, u"WORD"_qs, u"beta"_qs};
    // Length first: a word must be longer than the minimum.
    QTest::newRow("the, 3") << u"the"_qs << 3 << none << false;
    QTest::newRow("word, 3") << u"word"_qs << 3 << none << true;
    QTest::newRow("of, 2") << u"of"_qs << 2 << none << false;
    QTest::newRow("and, 2") << u"and"_qs << 2 << none << true;
    QTest::newRow("hello, 5") << u"hello"_qs << 5 << none << false;
    QTest::newRow("hellos, 5") << u"hellos"_qs << 5 << none << true;
    // Numbers, digits, the excluded characters.
    QTest::newRow("1999") << u"1999"_qs << 3 << none << false;
    QTest::newRow("digit inside") << u"abc1def"_qs << 3 << none << false;
    for (const QChar c : u"@#=%$^*&\u2026"_qs)
        QTest::addRow("contains U+%04X", c.unicode()) << u"wo"_qs + c + u"rd"_qs << 3 << none << false;
    QTest::newRow("other marks pass") << u"a~b`c\\d!\te"_qs << 3 << none << true;
    // The ignored words, compared upper-cased.
    QTest::newRow("ignored, other case") << u"word"_qs << 3 << list << false;
    QTest::newRow("ignored, first item") << u"ALPHA"_qs << 3 << list << false;
    QTest::newRow("ignored, last item") << u"Beta"_qs << 3 << list << false;
    QTest::newRow("longer than an ignored word") << u"words"_qs << 3 << list << true;
    QTest::newRow("ignored word with a blank") << u"word"_qs << 3 << QStringList{u"word "_qs} << true;
    QTest::newRow("sharp s upper-cases to SS") << u"stra\u00DFe"_qs << 3 << QStringList{u"STRASSE"_qs} << false;
    QTest::newRow("ignored sharp s") << u"strasse"_qs << 3 << QStringList{u"Stra\u00DFe"_qs} << false;
    QTest::newRow("dotless i upper-cases to I") << u"\u0131dea"_qs << 3 << QStringList{u"idea"_qs} << false;
    QTest::newRow("Kelvin sign is its own upper case") << u"\u212Aelvin"_qs << 3 << QStringList{u"kelvin"_qs} << true;
    QTest::newRow("accented letters") << u"\u00E9t\u00E9s"_qs << 3 << QStringList{u"\u00C9T\u00C9S"_qs} << false;
}

void TestArticleModel::wordTest()
{
    QFETCH(QString, token);
    QFETCH(int, minimum);
    QFETCH(QStringList, ignored);
    QTEST(IsCustomizableWord(token, WordTestSettings{minimum, ignored}), "expected");
}

void TestArticleModel::fillWordLists_data()
{
    QTest::addColumn<QString>("title");
    QTest::addColumn<QString>("contents");
    QTest::addColumn<int>("stopList");      // Cancel while this list adds `stopWord`; -1: never
    QTest::addColumn<QString>("stopWord");
    QTest::addColumn<qsizetype>("cancelAt"); // the contents token the cancel path is taken at

    QTest::newRow("complete") << u"Hi there "_qs << u"a\r\nb "_qs << -1 << QString() << qsizetype(-1);
    QTest::newRow("one-token title") << u"Hi"_qs << u"a b"_qs << -1 << QString() << qsizetype(-1);
    QTest::newRow("cancel in the title loop") << u"Hi there "_qs << u"a b "_qs << 0 << u"Hi"_qs << qsizetype(0);
    QTest::newRow("cancel in the contents loop") << u"T "_qs << u"a\nb c "_qs << 1 << u"\n"_qs << qsizetype(2);
    QTest::newRow("cancel at the last contents token") << u"T "_qs << u"a b."_qs << 1 << u"."_qs << qsizetype(4);
}

void TestArticleModel::fillWordLists()
{
    QFETCH(QString, title);
    QFETCH(QString, contents);
    QFETCH(int, stopList);
    QFETCH(QString, stopWord);
    QFETCH(qsizetype, cancelAt);
    FakeWindows windows;
    windows.OnAddItems = [&](const QString &word, int list) {
        if (list == stopList && word == stopWord)
            StopProcessing = true;
    };
    ArticleTokens model;
    model.TitleTokens = QStringList(6, u"stale"_qs);
    QCOMPARE(FillWordLists(title, contents, model, windows, windows), cancelAt < 0);

    const ArticleTokens expected = SplitArticle(title, contents);
    QCOMPARE(windows.Log, ExpectedLog(expected.TitleTokens, expected.ContentsTokens, cancelAt));
    QCOMPARE(model.TitleTokens, expected.TitleTokens); // the model is complete even when cancelled
    QCOMPARE(model.ContentsTokens, expected.ContentsTokens);
}

void TestArticleModel::loopsSurviveReanalysis()
{
    // A handler running while AddItems waits may analyse another article into the same model.
    FakeWindows windows;
    ArticleTokens model;
    windows.OnAddItems = [&](const QString &, int) { model = SplitArticle(u"x "_qs, u"y "_qs); };
    QVERIFY(FillWordLists(u"one two "_qs, u"three four "_qs, model, windows, windows));
    const QStringList added = windows.Log.filter(QRegularExpression(u"^add "_qs));
    QCOMPARE(added, (QStringList{u"add 0 one"_qs, u"add 0  "_qs, u"add 0 two"_qs, u"add 0  "_qs, u"add 1 three"_qs,
                                 u"add 1  "_qs, u"add 1 four"_qs, u"add 1  "_qs}));
}

QTEST_GUILESS_MAIN(TestArticleModel)
#include "tst_articlemodel.moc"
