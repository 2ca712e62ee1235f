#include "common/TextFile.h"
#include "engine/WordLists.h"
#include "engine/WordStore.h"
#include "shell/ArticleModel.h"

#include <QDir>
#include <QFileInfo>
#include <QRandomGenerator>
#include <QTemporaryDir>
#include <QtTest>

#include <sys/stat.h>

using namespace verbloom;

namespace {

/// A word store in a fresh program folder and the hooks of a scripted suggestions window.
struct Harness
{
    Harness()
    {
        settings.MinimumWordLength = 3;
        settings.IgnoredWords = {u"brown"_qs};
    }

    void Add(const QString &word, int list)
    {
        AddItemsHooks hooks;
        hooks.SetCaption = [this](const QString &caption) { captions.append(caption); };
        hooks.ProcessEvents = [this] { ++events; };
        hooks.Manual = [this] { return manual; };
        hooks.Lookup = [this](const QString &w, int l, qsizetype row) {
            lookups.append(w + u' ' + QString::number(l) + u' ' + QString::number(row));
            if (onLookup)
                onLookup(w, l, row);
            return answers.value(w.toLower());
        };
        hooks.SetTotal = [this](const QString &text) { totals.append(text); };
        AddItems(lists, word, list, settings, store, hooks);
    }

    void AddAll(const QStringList &words, int list)
    {
        for (const QString &word : words)
            Add(word, list);
    }

    QStringList Files() const
    {
        return QDir(store.DataFolder()).entryList(QDir::Files | QDir::Hidden, QDir::Name);
    }

    QString File(const QString &name) const { return ReadTextFile(store.DataFolder() + u'/' + name); }

    QTemporaryDir home;
    WordStore store{home.path()};
    WordLists lists;
    WordTestSettings settings;
    bool manual = true;
    QHash<QString, QString> answers; ///< lookup results by lowered word
    std::function<void(const QString &, int, qsizetype)> onLookup;
    QStringList lookups;
    QStringList captions;
    QStringList totals;
    int events = 0;
};

// The repeat search as a plain walk over the rows, for comparison with the index.
std::optional<QString> SearchRowByRow(const WordLists &lists, const QString &word)
{
    std::optional<QString> found;
    for (int list = 0; list < 2; ++list) {
        for (const WordRow &row : lists.Rows(list)) {
            if (row.Text.toLower() == word.toLower())
                found = row.Alternatives;
        }
    }
    return found;
}

} // namespace

class TestWordLists final : public QObject
{
    Q_OBJECT

private slots:
    void init() { StopProcessing = false; }
    void cleanup() { StopProcessing = true; }
    void unchangedWordFileIsLeftAlone();

    void wordFileNames_data();
    void wordFileNames();
    void wordFileExistsCreatesDataFolder();
    void fileBeatsEarlierRow();
    void lastMatchingRowWins();
    void titleAndContentsShareOneFile();
    void emptyWordFileMeansNoLookup();
    void nonCustomizableTokens_data();
    void nonCustomizableTokens();
    void lookupResultStoredOnlyWhenManual_data();
    void lookupResultStoredOnlyWhenManual();
    void stopProcessingAddsNothing();
    void captionTotalAndEvents();
    void saveDataSkipsCheckedRowsAndCountsFailures();
    void repeatIndexMatchesRowByRowSearch();
};

void TestWordLists::wordFileNames_data()
{
    QTest::addColumn<QString>("word");
    QTest::addColumn<QString>("fileName"); // empty: the word cannot have a file
    QTest::newRow("lower case") << u"Quick"_qs << u"quick.dat"_qs;
    QTest::newRow("backslash is a name character") << u"ab\\cd"_qs << u"ab\\cd.dat"_qs;
    QTest::newRow("slash") << u"and/or"_qs << QString();
    QTest::newRow("NUL") << u"qu\0ick"_qs << QString();
    QTest::newRow("255 bytes") << QString(251, u'x') << QString(251, u'x') + u".dat"_qs;
    QTest::newRow("256 bytes") << QString(252, u'x') << QString();
    QTest::newRow("254 bytes of UTF-8") << QString(125, u'\u00E9') << QString(125, u'\u00E9') + u".dat"_qs;
    QTest::newRow("256 bytes of UTF-8") << QString(126, u'\u00C9') << QString();
}

void TestWordLists::wordFileNames()
{
    QFETCH(QString, word);
    QFETCH(QString, fileName);
    Harness h;
    if (fileName.isEmpty()) {
        QCOMPARE(h.store.GetWordFilePath(word), QString());
        QVERIFY(!h.store.WriteAlternatives(word, u"fast"_qs));
        QCOMPARE(h.store.ReadAlternatives(word), QString());
        QVERIFY(!h.store.WordFileExists(word, h.settings));
        // A row of such a word is not saved, and that is no failure.
        h.Add(word, 0);
        h.lists.SetAlternatives(0, 0, u"fast"_qs);
        QCOMPARE(SaveData(h.lists, h.settings, h.store), 0);
        QCOMPARE(h.Files(), QStringList());
        return;
    }
    QCOMPARE(h.store.GetWordFilePath(word), h.store.DataFolder() + u'/' + fileName);
    QVERIFY(h.store.WriteAlternatives(word.toUpper(), u"fast, rapid"_qs));
    QCOMPARE(h.Files(), QStringList{fileName});
    QCOMPARE(h.store.ReadAlternatives(word), u"fast, rapid"_qs);
    QVERIFY(h.store.WordFileExists(word, h.settings));
}

void TestWordLists::wordFileExistsCreatesDataFolder()
{
    Harness h;
    QVERIFY(!h.store.WordFileExists(u"the"_qs, h.settings));
    QVERIFY(!QFileInfo::exists(h.store.DataFolder())); // a short word returns at once
    QVERIFY(!h.store.WordFileExists(u"quick"_qs, h.settings));
    QVERIFY(QFileInfo(h.store.DataFolder()).isDir());
    QCOMPARE(h.store.DataFolder(), h.home.path() + u"/data"_qs);
}

void TestWordLists::fileBeatsEarlierRow()
{
    Harness h;
    QVERIFY(h.store.WriteAlternatives(u"quick"_qs, u"rapid"_qs));
    h.Add(u"Quick"_qs, 0);
    h.lists.SetAlternatives(0, 0, u"edited"_qs);
    h.Add(u"QUICK"_qs, 1);
    const WordRow &repeat = h.lists.Row(1, 0);
    QCOMPARE(repeat.Alternatives, u"rapid"_qs);
    QVERIFY(repeat.Blue);
    QVERIFY(repeat.Bold); // bold also when the file existed
    const WordRow &first = h.lists.Row(0, 0);
    QVERIFY(first.Blue);
    QVERIFY(!first.Bold);
    QCOMPARE(h.lookups, QStringList());
}

void TestWordLists::lastMatchingRowWins()
{
    Harness h;
    h.answers.insert(u"slow"_qs, u"calm"_qs);
    h.Add(u"slow"_qs, 0);
    QCOMPARE(h.lists.Row(0, 0).Alternatives, u"calm"_qs);
    h.lists.SetAlternatives(0, 0, u"t0"_qs);
    h.Add(u"Slow"_qs, 1);
    QCOMPARE(h.lists.Row(1, 0).Alternatives, u"t0"_qs); // the current text of the earlier row
    QVERIFY(h.lists.Row(1, 0).Bold);
    QVERIFY(!h.lists.Row(1, 0).Blue);
    h.lists.SetAlternatives(1, 0, u"c1"_qs);
    // A title row added now still comes before every contents row in the search.
    h.Add(u"SLOW"_qs, 0);
    QCOMPARE(h.lists.Row(0, 1).Alternatives, u"c1"_qs);
    h.lists.SetAlternatives(0, 1, u"t2"_qs);
    h.Add(u"slow"_qs, 1);
    QCOMPARE(h.lists.Row(1, 1).Alternatives, u"c1"_qs);
    QCOMPARE(h.lookups, QStringList{u"slow 0 1"_qs});
}

void TestWordLists::titleAndContentsShareOneFile()
{
    Harness h;
    h.answers.insert(u"quick"_qs, u"fast, rapid"_qs);
    h.AddAll({u"Quick"_qs, u" "_qs}, 0);
    h.AddAll({u"A"_qs, u" "_qs, u"quick"_qs, u" "_qs, u"QUICK"_qs, u" "_qs}, 1);
    h.lists.SetAlternatives(1, 2, u"changed in the repeat"_qs);
    h.lists.SetAlternatives(1, 4, u"changed again"_qs);
    QCOMPARE(SaveData(h.lists, h.settings, h.store), 0);
    QCOMPARE(h.Files(), QStringList{u"quick.dat"_qs});
    QCOMPARE(h.File(u"quick.dat"_qs), u"fast, rapid"_qs);
    QCOMPARE(h.lookups, QStringList{u"Quick 0 1"_qs});
}

void TestWordLists::emptyWordFileMeansNoLookup()
{
    Harness h;
    QVERIFY(h.store.WriteAlternatives(u"quick"_qs, QString()));
    h.answers.insert(u"quick"_qs, u"fast"_qs);
    h.Add(u"quick"_qs, 1);
    QCOMPARE(h.lists.Row(1, 0).Alternatives, QString());
    QVERIFY(h.lists.Row(1, 0).Blue);
    QCOMPARE(h.lookups, QStringList());
    QCOMPARE(SaveData(h.lists, h.settings, h.store), 0);
    QCOMPARE(h.File(u"quick.dat"_qs), QString());
}

void TestWordLists::nonCustomizableTokens_data()
{
    QTest::addColumn<QString>("token");
    QTest::newRow("blank") << u" "_qs;
    QTest::newRow("comma") << u","_qs;
    QTest::newRow("line break") << u"\n"_qs;
    QTest::newRow("short word") << u"the"_qs;
    QTest::newRow("number") << u"1999"_qs;
    QTest::newRow("digit") << u"mp3s"_qs;
    QTest::newRow("ampersand") << u"AT&T"_qs;
    QTest::newRow("ignored word") << u"BROWN"_qs;
}

void TestWordLists::nonCustomizableTokens()
{
    QFETCH(QString, token);
    Harness h;
    h.answers.insert(token.toLower(), u"something"_qs);
    h.Add(token, 0);
    h.Add(token, 1);
    QCOMPARE(h.lists.Count(0), 1);
    QCOMPARE(h.lists.Count(1), 1);
    for (int list = 0; list < 2; ++list) {
        const WordRow &row = h.lists.Row(list, 0);
        QCOMPARE(row.Text, token);
        QCOMPARE(row.Alternatives, QString());
        QVERIFY(!row.Blue && !row.Bold);
    }
    h.lists.SetAlternatives(0, 0, u"typed"_qs);
    QCOMPARE(SaveData(h.lists, h.settings, h.store), 0);
    QCOMPARE(h.lookups, QStringList());
    QCOMPARE(h.Files(), QStringList());
}

void TestWordLists::lookupResultStoredOnlyWhenManual_data()
{
    QTest::addColumn<bool>("manual");
    QTest::addColumn<bool>("tickManualDuringLookup");
    QTest::addColumn<QString>("expected");
    QTest::newRow("manual stores the result") << true << false << u"last meaning"_qs;
    QTest::newRow("prompting keeps the confirmed choice") << false << false << u"chosen"_qs;
    QTest::newRow("do not prompt again keeps the confirmed choice") << false << true << u"chosen"_qs;
}

void TestWordLists::lookupResultStoredOnlyWhenManual()
{
    QFETCH(bool, manual);
    QFETCH(bool, tickManualDuringLookup);
    QFETCH(QString, expected);
    Harness h;
    h.manual = manual;
    h.answers.insert(u"quick"_qs, u"last meaning"_qs);
    h.onLookup = [&h, tickManualDuringLookup](const QString &, int list, qsizetype row) {
        if (!h.manual) // the confirm window writes into the row it was told
            h.lists.SetAlternatives(list, row - 1, u"chosen"_qs);
        if (tickManualDuringLookup)
            h.manual = true;
    };
    h.AddAll({u"A"_qs, u" "_qs}, 1);
    h.Add(u"quick"_qs, 1);
    QCOMPARE(h.lookups, QStringList{u"quick 1 3"_qs});
    QCOMPARE(h.lists.Row(1, 2).Alternatives, expected);
}

void TestWordLists::stopProcessingAddsNothing()
{
    Harness h;
    StopProcessing = true;
    h.AddAll({u"quick"_qs, u" "_qs}, 0);
    QCOMPARE(h.lists.Count(0), 0);
    QCOMPARE(h.captions, QStringList());
    QCOMPARE(h.totals, QStringList());
    QCOMPARE(h.lookups, QStringList());
}

void TestWordLists::captionTotalAndEvents()
{
    Harness h;
    h.AddAll({u"Quick"_qs, u" "_qs}, 0);
    h.Add(u"fox"_qs, 1);
    QCOMPARE(h.captions, (QStringList{u"Getting alternatives for Quick"_qs,
                                      u"Getting alternatives for  "_qs,
                                      u"Getting alternatives for fox"_qs}));
    QCOMPARE(h.totals, (QStringList{u"Working with 1 Words"_qs, u"Working with 2 Words"_qs,
                                    u"Working with 1 Words"_qs}));
    QVERIFY(h.events >= 3);
}

void TestWordLists::saveDataSkipsCheckedRowsAndCountsFailures()
{
    Harness h;
    h.answers.insert(u"quick"_qs, u"fast"_qs);
    h.answers.insert(u"slow"_qs, u"calm"_qs);
    h.AddAll({u"quick"_qs, u" "_qs, u"slow"_qs}, 0);
    h.lists.SetChecked(0, 2, true);
    QCOMPARE(SaveData(h.lists, h.settings, h.store), 0);
    QCOMPARE(h.Files(), QStringList{u"quick.dat"_qs});

    // A data folder that cannot hold files: both rows fail, nothing is lost or thrown.
    QVERIFY(QDir(h.store.DataFolder()).removeRecursively());
    QVERIFY(WriteTextFile(h.store.DataFolder(), u"in the way"_qs));
    h.lists.SetChecked(0, 2, false);
    QCOMPARE(SaveData(h.lists, h.settings, h.store), 2);
    QCOMPARE(ReadTextFile(h.store.DataFolder()), u"in the way"_qs);
}

void TestWordLists::repeatIndexMatchesRowByRowSearch()
{
    const QStringList words = {u"quick"_qs, u"Quick"_qs, u"QUICK"_qs, u"slow"_qs, u"Slow"_qs,
                               u" "_qs, u","_qs, u"fox"_qs, u"\u00C9lan"_qs, u"\u00E9lan"_qs};
    QRandomGenerator random(7);
    WordLists lists;
    for (int step = 0; step < 3000; ++step) {
        const int action = random.bounded(100);
        const int list = random.bounded(2);
        if (action < 60) {
            lists.Append(list, words.at(random.bounded(words.size())));
        } else if (action < 98) {
            if (lists.Count(list) > 0)
                lists.SetAlternatives(list, random.bounded(lists.Count(list)),
                                      QString::number(step));
        } else {
            lists.Clear();
        }
        for (const QString &word : words)
            QCOMPARE(lists.FindRepeat(word), SearchRowByRow(lists, word));
    }
}

void TestWordLists::unchangedWordFileIsLeftAlone()
{
    Harness h;
    QVERIFY(h.store.WriteAlternatives(u"quick"_qs, u"fast, rapid"_qs));
    const QString path = h.store.GetWordFilePath(u"quick"_qs);
    const auto inode = [&path] {
        struct stat info {};
        ::stat(QFile::encodeName(path).constData(), &info);
        return info.st_ino;
    };
    const auto before = inode();
    QVERIFY(h.store.WriteAlternatives(u"Quick"_qs, u"fast, rapid"_qs));
    QCOMPARE(inode(), before);
    QVERIFY(h.store.WriteAlternatives(u"quick"_qs, u"fast"_qs));
    QCOMPARE(h.File(u"quick.dat"_qs), u"fast"_qs);
    QVERIFY(h.store.WriteAlternatives(u"quick"_qs, QString()));
    QCOMPARE(QFileInfo(path).size(), 0);
}

QTEST_GUILESS_MAIN(TestWordLists)
#include "tst_wordlists.moc"
