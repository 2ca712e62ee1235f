#include "EngineFakes.h"

#include "engine/RandomSource.h"
#include "engine/SpinGenerator.h"
#include "engine/WordStore.h"
#include "shell/ArticleModel.h"

#include <QTemporaryDir>
#include <QtTest>

using namespace verbloom;
using namespace verbloom::test;

namespace {

SpinSettings Settings(int level)
{
    SpinSettings settings;
    settings.WordTest.MinimumWordLength = 3;
    settings.WordTest.IgnoredWords = {u"brown"_qs};
    settings.CustomizationLevel = level;
    return settings;
}

// Draws of a Mersenne source behind another type, so the Spinner cannot take its inlined path.
class ForwardingRandom final : public RandomSource
{
public:
    explicit ForwardingRandom(std::uint32_t seed) : m_inner(seed) {}
    double NextUniform() override { return m_inner.NextUniform(); }

private:
    MersenneRandomSource m_inner;
};

} // namespace

class TestSpin final : public QObject
{
    Q_OBJECT

private slots:
    void replaceWord_data();
    void replaceWord();
    void titleLeavesOutClosingBlank();
    void contentsGetCrLf();
    void sameFirstVersionAfterFreshStart();
    void spinnerMatchesSpinFunctions_data();
    void spinnerMatchesSpinFunctions();
    void runReadsFilesOnceSeparateSpinsAfresh();
};

void TestSpin::replaceWord_data()
{
    QTest::addColumn<QString>("token");
    QTest::addColumn<QString>("alternatives");
    QTest::addColumn<int>("level");
    QTest::addColumn<QList<double>>("draws");
    QTest::addColumn<QString>("expected");
    QTest::addColumn<int>("drawsTaken");

    const QList<double> noDraws;
    // No draw at all: nothing to choose from, or the token may not be replaced.
    QTest::newRow("empty alternatives") << u"quick"_qs << QString() << 0 << noDraws << u"quick"_qs << 0;
    QTest::newRow("blank alternatives") << u"quick"_qs << u"   "_qs << 0 << noDraws << u"quick"_qs << 0;
    QTest::newRow("short word") << u"the"_qs << u"a, b"_qs << 0 << noDraws << u"the"_qs << 0;
    QTest::newRow("ignored word") << u"Brown"_qs << u"tan"_qs << 0 << noDraws << u"Brown"_qs << 0;
    QTest::newRow("digits") << u"mp3s"_qs << u"x"_qs << 0 << noDraws << u"mp3s"_qs << 0;
    QTest::newRow("blank token") << u" "_qs << u"x"_qs << 0 << noDraws << u" "_qs << 0;

    // Level skip: r = round(u * 100) must be divisible by level + 1; a skip costs one draw.
    QTest::newRow("level 2 skips r 1")
        << u"quick"_qs << u"fast, speedy"_qs << 2 << QList<double>{0.01, 0.0} << u"quick"_qs << 1;
    QTest::newRow("level 2 r 12.5 halves to 12")
        << u"quick"_qs << u"fast, speedy"_qs << 2 << QList<double>{0.125, 0.0} << u"fast"_qs << 2;
    QTest::newRow("level 3 r 100 goes on")
        << u"quick"_qs << u"fast, speedy"_qs << 1 << QList<double>{0.999, 0.2} << u"fast"_qs << 2;
    QTest::newRow("level 1 skips r 2")
        << u"quick"_qs << u"fast"_qs << 3 << QList<double>{0.02, 0.0} << u"quick"_qs << 1;
    QTest::newRow("minimum r 5 goes on")
        << u"quick"_qs << u"fast"_qs << 4 << QList<double>{0.05, 0.0} << u"fast"_qs << 2;
    QTest::newRow("minimum skips r 4")
        << u"quick"_qs << u"fast"_qs << 4 << QList<double>{0.04, 0.0} << u"quick"_qs << 1;
    QTest::newRow("no level selected acts as maximum")
        << u"quick"_qs << u"fast"_qs << -1 << QList<double>{0.37, 0.0} << u"fast"_qs << 2;

    // Candidate k = round(u * n), halves to even; candidate n is the token.
    const QString four = u"one, two, three, four"_qs;
    QTest::newRow("k 2.5 halves to 2") << u"quick"_qs << four << 0 << QList<double>{0.0, 0.625}
                                      << u"three"_qs << 2;
    QTest::newRow("k 3.5 halves to 4 = token") << u"quick"_qs << four << 0
                                              << QList<double>{0.0, 0.875} << u"quick"_qs << 2;
    QTest::newRow("k 0") << u"quick"_qs << four << 0 << QList<double>{0.0, 0.1} << u"one"_qs << 2;
    QTest::newRow("k above n clamps to the token")
        << u"quick"_qs << four << 0 << QList<double>{0.0, 1.5} << u"quick"_qs << 2;
    QTest::newRow("u near 1 gives the token") << u"quick"_qs << u"fast"_qs << 0
                                             << QList<double>{0.0, 0.99999} << u"quick"_qs << 2;

    // Pieces: trimmed, empty ones fall back to the token.
    QTest::newRow("pieces trimmed") << u"quick"_qs << u"  fast ,  speedy  "_qs << 0
                                    << QList<double>{0.0, 0.5} << u"speedy"_qs << 2;
    QTest::newRow("one comma, first piece") << u"quick"_qs << u","_qs << 0
                                            << QList<double>{0.0, 0.0} << u"quick"_qs << 2;
    QTest::newRow("one comma, second piece") << u"quick"_qs << u","_qs << 0
                                             << QList<double>{0.0, 0.5} << u"quick"_qs << 2;
    QTest::newRow("blank piece") << u"quick"_qs << u"fast,   , slow"_qs << 0
                                 << QList<double>{0.0, 0.4} << u"quick"_qs << 2;

    // Capitals follow the token's first letter only; alternatives are never lowered.
    QTest::newRow("Quick fast") << u"Quick"_qs << u"fast, speedy"_qs << 0
                                << QList<double>{0.0, 0.0} << u"Fast"_qs << 2;
    QTest::newRow("Quick speedy") << u"Quick"_qs << u"fast, speedy"_qs << 0
                                  << QList<double>{0.0, 0.5} << u"Speedy"_qs << 2;
    QTest::newRow("Quick itself") << u"Quick"_qs << u"fast, speedy"_qs << 0
                                  << QList<double>{0.0, 0.9} << u"Quick"_qs << 2;
    QTest::newRow("quick Fast") << u"quick"_qs << u"Fast"_qs << 0 << QList<double>{0.0, 0.0}
                                << u"Fast"_qs << 2;
    QTest::newRow("quick itself") << u"quick"_qs << u"Fast"_qs << 0 << QList<double>{0.0, 0.9}
                                  << u"quick"_qs << 2;
    QTest::newRow("not lowered") << u"quick"_qs << u"FAST"_qs << 0 << QList<double>{0.0, 0.0}
                                 << u"FAST"_qs << 2;
    QTest::newRow("phrase") << u"Quick"_qs << u"very fast, rapid"_qs << 0
                            << QList<double>{0.0, 0.0} << u"Very fast"_qs << 2;
    QTest::newRow("phrase rest kept") << u"Quick"_qs << u"very FAST"_qs << 0
                                      << QList<double>{0.0, 0.0} << u"Very FAST"_qs << 2;
    QTest::newRow("accented capital") << u"\u00C9lan"_qs << u"verve"_qs << 0
                                      << QList<double>{0.0, 0.0} << u"Verve"_qs << 2;
    QTest::newRow("capital on empty fallback") << u"Quick"_qs << u","_qs << 0
                                               << QList<double>{0.0, 0.0} << u"Quick"_qs << 2;
}

void TestSpin::replaceWord()
{
    QFETCH(QString, token);
    QFETCH(QString, alternatives);
    QFETCH(int, level);
    QFETCH(QList<double>, draws);
    QFETCH(QString, expected);
    QFETCH(int, drawsTaken);

    ScriptedRandomSource random(draws);
    QCOMPARE(ReplaceWord(token, alternatives, Settings(level), random), expected);
    QCOMPARE(random.Taken(), drawsTaken);
}

void TestSpin::titleLeavesOutClosingBlank()
{
    TableAlternatives source({{u"Quick"_qs, u"fast"_qs}, {u"brown"_qs, u"tan"_qs},
                              {u"jumps"_qs, QString()}, {u"over"_qs, u"above"_qs}});
    const QStringList tokens = {u"Quick"_qs, u" "_qs, u"brown"_qs, u" "_qs, u"fox"_qs, u" "_qs,
                                u"jumps"_qs, u" "_qs, u"over"_qs, u" "_qs};
    // "over" is the last word: it is spun, but the blank after it is left out.
    ScriptedRandomSource random({0.0, 0.0, 0.0, 0.0});
    QCOMPARE(SpinTitle(tokens, Settings(0), source, random), u"Fast brown fox jumps above"_qs);
    QCOMPARE(random.Taken(), 4);
    // Only customizable words are read; "brown" is ignored and "fox" too short.
    QCOMPARE(source.Asked, (QStringList{u"Quick"_qs, u"jumps"_qs, u"over"_qs}));

    ScriptedRandomSource none;
    QCOMPARE(SpinTitle({u" "_qs}, Settings(0), source, none), QString());
    QCOMPARE(SpinTitle({}, Settings(0), source, none), QString());
}

void TestSpin::contentsGetCrLf()
{
    TableAlternatives source({{u"Slow"_qs, u"calm"_qs}, {u"steady"_qs, u"firm, even"_qs}});
    const QStringList tokens = {u"Slow"_qs, u"\n"_qs, u"and"_qs, u"\n"_qs, u"\n"_qs,
                                u"steady"_qs, u"."_qs, u" "_qs};
    ScriptedRandomSource random({0.0, 0.0, 0.0, 0.5});
    QCOMPARE(SpinContents(tokens, Settings(0), source, random), u"Calm\r\nand\r\n\r\neven. "_qs);
    QCOMPARE(random.Taken(), 4);
}

void TestSpin::sameFirstVersionAfterFreshStart()
{
    // The draws are fixed by the formula over the default-seeded Mersenne Twister.
    MersenneRandomSource first;
    QCOMPARE(first.NextUniform(), 0.8147236863931789);
    QCOMPARE(first.NextUniform(), 0.9057919370756192);
    QCOMPARE(first.NextUniform(), 0.12698681629350606);

    const ArticleTokens article = SplitArticle(u"The Quick brown fox "_qs,
                                               u"A quick fox jumps over\r\nthe lazy dog. "_qs);
    TableAlternatives source({{u"Quick"_qs, u"fast, rapid, swift"_qs},
                              {u"quick"_qs, u"fast, rapid, swift"_qs},
                              {u"jumps"_qs, u"leaps, hops, springs"_qs},
                              {u"over"_qs, u"above, across"_qs},
                              {u"lazy"_qs, u"idle, slack, sleepy"_qs}});
    QStringList versions[2];
    for (QStringList &version : versions) {
        MersenneRandomSource start;
        version << SpinTitle(article.TitleTokens, Settings(0), source, start)
                << SpinContents(article.ContentsTokens, Settings(0), source, start);
    }
    QCOMPARE(versions[0], versions[1]);
}

void TestSpin::spinnerMatchesSpinFunctions_data()
{
    QTest::addColumn<int>("level");
    QTest::addColumn<bool>("cached");
    QTest::addColumn<bool>("mersenne");
    for (int level = 0; level <= 4; ++level) {
        QTest::addRow("level %d, run", level) << level << true << true;
        QTest::addRow("level %d, afresh", level) << level << false << true;
        QTest::addRow("level %d, run, other source", level) << level << true << false;
        QTest::addRow("level %d, afresh, other source", level) << level << false << false;
    }
}

void TestSpin::spinnerMatchesSpinFunctions()
{
    QFETCH(int, level);
    QFETCH(bool, cached);
    QFETCH(bool, mersenne);

    QTemporaryDir home;
    QVERIFY(home.isValid());
    const WordStore store(home.path());
    const QHash<QString, QString> files = {
        {u"quick"_qs, u"fast, very rapid, swift"_qs}, {u"jumps"_qs, u"leaps,hops ,"_qs},
        {u"over"_qs, u","_qs}, {u"lazy"_qs, QString()}, {u"sleeps"_qs, u"Naps, dozes"_qs},
        {u"garden"_qs, u"yard\nlawn, park"_qs}, {u"wall"_qs, u"  "_qs}};
    for (auto it = files.cbegin(); it != files.cend(); ++it)
        QVERIFY(store.WriteAlternatives(it.key(), it.value()));

    const ArticleTokens article = SplitArticle(
        u"The Quick fox jumps over the Wall "_qs,
        u"A quick fox jumps over the lazy dog, QUICK!\r\nIt sleeps in 3 gardens; the garden "
        "wall is brown.\r\n\r\nOver and over: quick, quick, quick. "_qs);
    const SpinSettings settings = Settings(level);

    MersenneRandomSource plainRandom(1234);
    MersenneRandomSource mersenneRandom(1234);
    ForwardingRandom otherRandom(1234);
    RandomSource &spinnerRandom =
        mersenne ? static_cast<RandomSource &>(mersenneRandom) : otherRandom;
    WordFileAlternatives plainSource(store);
    CachedWordFileAlternatives cachedSource(store);
    WordFileAlternatives afreshSource(store);
    AlternativesSource &spinnerSource =
        cached ? static_cast<AlternativesSource &>(cachedSource) : afreshSource;
    Spinner spinner(article, settings, spinnerSource, spinnerRandom);
    for (int version = 0; version < 40; ++version) {
        QCOMPARE(spinner.SpinTitle(), SpinTitle(article.TitleTokens, settings, plainSource, plainRandom));
        QCOMPARE(spinner.SpinContents(),
                 SpinContents(article.ContentsTokens, settings, plainSource, plainRandom));
    }
    // Both used exactly the same draws.
    QCOMPARE(spinnerRandom.NextUniform(), plainRandom.NextUniform());
    // One read per file of a customizable word, whatever its capitals: quick, jumps, over, wall,
    // lazy, sleeps, gardens, garden ("fox" is short, "brown" ignored).
    if (cached)
        QCOMPARE(cachedSource.FileReads(), 8);
}

void TestSpin::runReadsFilesOnceSeparateSpinsAfresh()
{
    QTemporaryDir home;
    QVERIFY(home.isValid());
    const WordStore store(home.path());
    QVERIFY(store.WriteAlternatives(u"quick"_qs, u"fast"_qs));
    const ArticleTokens article = SplitArticle(u"Quick "_qs, u"quick quick "_qs);

    MersenneRandomSource random;
    CachedWordFileAlternatives run(store);
    WordFileAlternatives afresh(store);
    Spinner inRun(article, Settings(0), run, random);
    Spinner separate(article, Settings(0), afresh, random);
    inRun.SpinContents();
    separate.SpinContents();

    // An edit saved between spins reaches the next separate spin, not the running export.
    QVERIFY(store.WriteAlternatives(u"QUICK"_qs, u"rapid, rapid"_qs));
    QStringList inRunWords;
    QStringList separateWords;
    for (int i = 0; i < 50; ++i) {
        inRunWords += inRun.SpinContents().split(u' ', Qt::SkipEmptyParts);
        separateWords += separate.SpinContents().split(u' ', Qt::SkipEmptyParts);
    }
    inRunWords.removeDuplicates();
    separateWords.removeDuplicates();
    inRunWords.sort();
    separateWords.sort();
    QCOMPARE(inRunWords, (QStringList{u"fast"_qs, u"quick"_qs}));
    QCOMPARE(separateWords, (QStringList{u"quick"_qs, u"rapid"_qs}));
    QCOMPARE(run.FileReads(), 1);
}

QTEST_GUILESS_MAIN(TestSpin)
#include "tst_spin.moc"
