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
    return {.WordTest = {.MinimumWordLength = 3, .IgnoredWords = {u"brown"_qs}}, .CustomizationLevel = level};
}

} // namespace

class TestSpin final : public QObject
{
    Q_OBJECT

private slots:
    void replaceWord_data();
    void replaceWord();
    void titleAndContents();
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
    const auto row = [](const char *name, const QString &token, const QString &alternatives, int level,
                        const QList<double> &draws, const QString &expected, int taken) {
        QTest::newRow(name) << token << alternatives << level << draws << expected << taken;
    };
    const QString four = u"one, two, three, four"_qs;

    // No draw: nothing to choose from, or a token that may not be replaced.
    row("blank alternatives", u"quick"_qs, u"   "_qs, 0, {}, u"quick"_qs, 0);
    row("short word", u"the"_qs, u"a, b"_qs, 0, {}, u"the"_qs, 0);
    // Level skip: r = round(u * 100), halves to even, must be divisible by level + 1; a skip
    // costs one draw.
    row("level 2 skips r 1", u"quick"_qs, u"fast"_qs, 2, {0.01, 0.0}, u"quick"_qs, 1);
    row("level 2 r 12.5 halves to 12", u"quick"_qs, u"fast"_qs, 2, {0.125, 0.0}, u"fast"_qs, 2);
    row("level 3 r 99.9 rounds to 100", u"quick"_qs, u"fast"_qs, 1, {0.999, 0.0}, u"fast"_qs, 2);
    row("minimum r 5 goes on", u"quick"_qs, u"fast"_qs, 4, {0.05, 0.0}, u"fast"_qs, 2);
    row("minimum skips r 4", u"quick"_qs, u"fast"_qs, 4, {0.04, 0.0}, u"quick"_qs, 1);
    row("no level acts as maximum", u"quick"_qs, u"fast"_qs, -1, {0.37, 0.0}, u"fast"_qs, 2);
    // Candidate k = round(u * n), halves to even, at most n; candidate n is the token.
    row("k 2.5 halves to 2", u"quick"_qs, four, 0, {0.0, 0.625}, u"three"_qs, 2);
    row("k 3.5 halves to 4 = token", u"quick"_qs, four, 0, {0.0, 0.875}, u"quick"_qs, 2);
    row("k above n clamps", u"quick"_qs, four, 0, {0.0, 1.5}, u"quick"_qs, 2);
    // Pieces are trimmed; an empty one falls back to the token.
    row("pieces trimmed", u"quick"_qs, u"  fast ,  speedy  "_qs, 0, {0.0, 0.5}, u"speedy"_qs, 2);
    row("one comma", u"quick"_qs, u","_qs, 0, {0.0, 0.0}, u"quick"_qs, 2);
    row("blank piece", u"quick"_qs, u"fast,   , slow"_qs, 0, {0.0, 0.4}, u"quick"_qs, 2);
    // Only the first letter follows the token's capital; alternatives are never lowered.
    row("capital", u"Quick"_qs, u"fast, speedy"_qs, 0, {0.0, 0.0}, u"Fast"_qs, 2);
    row("not lowered", u"quick"_qs, u"FAST"_qs, 0, {0.0, 0.0}, u"FAST"_qs, 2);
    row("phrase", u"Quick"_qs, u"very FAST"_qs, 0, {0.0, 0.0}, u"Very FAST"_qs, 2);
    row("accented capital", u"\u00C9lan"_qs, u"verve"_qs, 0, {0.0, 0.0}, u"Verve"_qs, 2);
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

void TestSpin::titleAndContents()
{
    TableAlternatives source({{u"Quick"_qs, u"fast"_qs}, {u"brown"_qs, u"tan"_qs},
                              {u"jumps"_qs, QString()}, {u"over"_qs, u"above"_qs}});
    const QStringList tokens = {u"Quick"_qs, u" "_qs, u"brown"_qs, u" "_qs, u"fox"_qs, u" "_qs,
                                u"jumps"_qs, u"\n"_qs, u"over"_qs, u" "_qs};
    // Only customizable words are read ("brown" is ignored, "fox" short); "jumps" draws nothing.
    ScriptedRandomSource title;
    QCOMPARE(SpinTitle(tokens, Settings(0), source, title), u"Fast brown fox jumps\nabove"_qs);
    QCOMPARE(title.Taken(), 4);
    QCOMPARE(source.Asked, (QStringList{u"Quick"_qs, u"jumps"_qs, u"over"_qs}));
    ScriptedRandomSource contents;
    QCOMPARE(SpinContents(tokens, Settings(0), source, contents), u"Fast brown fox jumps\r\nabove "_qs);
    QCOMPARE(SpinTitle({}, Settings(0), source, contents), QString());
}

void TestSpin::sameFirstVersionAfterFreshStart()
{
    // The process source is never seeded: its draws are those of the default Mersenne Twister.
    // Nothing else in this test program draws from it.
    for (const double expected : {0.8147236863931789, 0.9057919370756192, 0.12698681629350606})
        QCOMPARE(ProcessRandom().NextUniform(), expected);

    const ArticleTokens article = SplitArticle(u"Quick "_qs, u"A quick fox jumps over\r\nthe lazy dog. "_qs);
    TableAlternatives source({{u"quick"_qs, u"fast, rapid, swift"_qs}, {u"jumps"_qs, u"leaps, hops"_qs},
                              {u"over"_qs, u"above, across"_qs}, {u"lazy"_qs, u"idle, slack"_qs}});
    const auto firstVersion = [&] {
        MersenneRandomSource fresh;
        return SpinContents(article.ContentsTokens, Settings(0), source, fresh);
    };
    QCOMPARE(firstVersion(), firstVersion());
}

void TestSpin::spinnerMatchesSpinFunctions_data()
{
    QTest::addColumn<int>("level");
    QTest::addColumn<bool>("cached");
    for (int level = 0; level <= 4; ++level) {
        QTest::addRow("level %d, run", level) << level << true;
        QTest::addRow("level %d, afresh", level) << level << false;
    }
}

void TestSpin::spinnerMatchesSpinFunctions()
{
    QFETCH(int, level);
    QFETCH(bool, cached);

    QTemporaryDir home;
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
    MersenneRandomSource spinnerRandom(1234);
    WordFileAlternatives plainSource(store);
    CachedWordFileAlternatives cachedSource(store);
    WordFileAlternatives afreshSource(store);
    AlternativesSource &spinnerSource = cached ? static_cast<AlternativesSource &>(cachedSource) : afreshSource;
    Spinner spinner(article, settings, spinnerSource, spinnerRandom);
    for (int version = 0; version < 40; ++version) {
        QCOMPARE(spinner.SpinTitle(), SpinTitle(article.TitleTokens, settings, plainSource, plainRandom));
        QCOMPARE(spinner.SpinContents(),
                 SpinContents(article.ContentsTokens, settings, plainSource, plainRandom));
    }
    QCOMPARE(spinnerRandom.NextUniform(), plainRandom.NextUniform()); // the same number of draws
    // One read per file, whatever the capitals: quick, jumps, over, wall, lazy, sleeps, gardens, garden.
    if (cached)
        QCOMPARE(cachedSource.FileReads(), 8);
}

void TestSpin::runReadsFilesOnceSeparateSpinsAfresh()
{
    QTemporaryDir home;
    const WordStore store(home.path());
    QVERIFY(store.WriteAlternatives(u"quick"_qs, u"fast"_qs));
    const ArticleTokens article = SplitArticle(u"Quick "_qs, u"quick QUICK "_qs);
    ScriptedRandomSource random; // every draw 0: the first alternative; not a Mersenne source either
    CachedWordFileAlternatives run(store);
    WordFileAlternatives afresh(store);
    Spinner inRun(article, Settings(0), run, random);
    Spinner separate(article, Settings(0), afresh, random);
    QCOMPARE(inRun.SpinContents(), u"fast Fast "_qs);
    QCOMPARE(separate.SpinContents(), u"fast Fast "_qs);

    // An edit saved between spins reaches the next separate spin, not the running export.
    QVERIFY(store.WriteAlternatives(u"Quick"_qs, u"rapid"_qs));
    QCOMPARE(inRun.SpinTitle(), u"Fast"_qs);
    QCOMPARE(inRun.SpinContents(), u"fast Fast "_qs);
    QCOMPARE(separate.SpinContents(), u"rapid Rapid "_qs);
    QCOMPARE(run.FileReads(), 1);
}

QTEST_GUILESS_MAIN(TestSpin)
#include "tst_spin.moc"