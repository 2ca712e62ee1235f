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

QStringList Items(const QString &text)
{
    return text.isEmpty() ? QStringList() : text.split(u'|');
}

/// A word store in a fresh program folder and the hooks of a scripted suggestions window.
struct Harness
{
    void Add(const QStringList &words, int list)
    {
        AddItemsHooks hooks;
        hooks.SetCaption = [this](const QString &caption) { captions.append(caption); };
        hooks.ProcessEvents = [this] { ++events; };
        hooks.Manual = [this] { return manual; };
        hooks.Lookup = [this](const QString &w, int l, qsizetype row) {
            lookups.append(w + u' ' + QString::number(l) + u' ' + QString::number(row));
            if (!manual) { // the confirm window writes the user's choice into the row it was told
                lists.SetAlternatives(l, row - 1, u"chosen"_qs);
                manual = tickManualInConfirm;
            }
            return u"looked up"_qs;
        };
        hooks.SetTotal = [this](const QString &text) { totals.append(text); };
        for (const QString &word : words)
            AddItems(lists, word, list, settings, store, hooks);
    }

    /// "name=content" of every word file.
    QStringList Files() const
    {
        QStringList files;
        for (const QString &name : QDir(store.DataFolder()).entryList(QDir::Files, QDir::Name))
            files.append(name + u'=' + ReadTextFile(store.DataFolder() + u'/' + name));
        return files;
    }

    QTemporaryDir home;
    WordStore store{home.path()};
    WordLists lists;
    WordTestSettings settings{.MinimumWordLength = 3, .IgnoredWords = {u"brown"_qs}};
    bool manual = true;
    bool tickManualInConfirm = false; ///< "Do not prompt again." ticked in the confirm window
    QStringList lookups;
    QStringList captions;
    QStringList totals;
    int events = 0;
};

} // namespace

class TestWordLists final : public QObject
{
    Q_OBJECT

private slots:
    void init() { StopProcessing = false; }
    void cleanup() { StopProcessing = true; }

    void wordFileNames_data();
    void wordFileNames();
    void wordFileExistsCreatesDataFolder();
    void unchangedWordFileIsLeftAlone();
    void addItemsAndSave_data();
    void addItemsAndSave();
    void captionTotalAndStop();
    void saveDataCountsFailures();
    void repeatIndexMatchesRowByRowSearch();
};

void TestWordLists::wordFileNames_data()
{
    QTest::addColumn<QString>("word");
    QTest::addColumn<QString>("fileName"); // empty: the word cannot have a file
    QTest::newRow("lower case") << u"Quick"_qs << u"quick.dat"_qs;
    QTest::newRow("slash") << u"and/or"_qs << QString();
    QTest::newRow("NUL") << u"qu\0ick"_qs << QString();
    // An atomic save needs seven more bytes for its temporary name.
    QTest::newRow("248 bytes") << QString(244, u'x') << QString(244, u'x') + u".dat"_qs;
    QTest::newRow("249 bytes") << QString(245, u'x') << QString();
    QTest::newRow("250 bytes of UTF-8") << QString(123, u'\u00C9') << QString();
}

void TestWordLists::wordFileNames()
{
    QFETCH(QString, word);
    QFETCH(QString, fileName);
    Harness h;
    const bool named = !fileName.isEmpty();
    QCOMPARE(h.store.GetWordFilePath(word), named ? h.store.DataFolder() + u'/' + fileName : QString());
    QCOMPARE(h.store.WriteAlternatives(word.toUpper(), u"fast"_qs), named);
    QCOMPARE(h.store.ReadAlternatives(word), named ? u"fast"_qs : QString());
    QCOMPARE(h.store.WriteAlternatives(word, u"rapid"_qs), named); // a second save replaces the file
    QCOMPARE(h.store.WriteAlternatives(word, u"fast"_qs), named);
    QCOMPARE(h.store.WordFileExists(word, h.settings), named);
    // A row of a word without a file name is not saved, and that is no failure.
    h.Add({word}, 0);
    QCOMPARE(SaveData(h.lists, h.settings, h.store), 0);
    QCOMPARE(h.Files(), named ? QStringList{fileName + u"=fast"_qs} : QStringList());
}

void TestWordLists::wordFileExistsCreatesDataFolder()
{
    Harness h;
    QCOMPARE(h.store.DataFolder(), h.home.path() + u"/data"_qs);
    QVERIFY(!h.store.WordFileExists(u"the"_qs, h.settings));
    QVERIFY(!QFileInfo::exists(h.store.DataFolder())); // a short word returns at once
    QVERIFY(!h.store.WordFileExists(u"quick"_qs, h.settings));
    QVERIFY(QFileInfo(h.store.DataFolder()).isDir());
}

void TestWordLists::unchangedWordFileIsLeftAlone()
{
    Harness h;
    QVERIFY(h.store.WriteAlternatives(u"quick"_qs, u"fast, rapid"_qs));
    const QByteArray path = QFile::encodeName(h.store.GetWordFilePath(u"quick"_qs));
    const auto inode = [&path] {
        struct stat info {};
        ::stat(path.constData(), &info);
        return info.st_ino;
    };
    const auto before = inode();
    QVERIFY(h.store.WriteAlternatives(u"Quick"_qs, u"fast, rapid"_qs));
    QCOMPARE(inode(), before);
    QVERIFY(h.store.WriteAlternatives(u"quick"_qs, u"fast"_qs));
    QCOMPARE(h.Files(), QStringList{u"quick.dat=fast"_qs});
    QVERIFY(h.store.WriteAlternatives(u"quick"_qs, QString()));
    QCOMPARE(h.Files(), QStringList{u"quick.dat="_qs});
}

void TestWordLists::addItemsAndSave_data()
{
    // Items separated by "|". files: "word=alternatives" before the rows are added. steps: "L word"
    // adds a row to list L, "L:R text" edits row R (from 0) of list L, "L:R!" checks it, "prompt"
    // and "prompt once" clear "Manual" (once: "Do not prompt again." is then ticked in the confirm
    // window). rows: "L text=alternatives" and the marks. The lookup finds "looked up"; the confirm
    // window writes "chosen" into the row it was given.
    QTest::addColumn<QString>("files");
    QTest::addColumn<QString>("steps");
    QTest::addColumn<QString>("rows");
    QTest::addColumn<QString>("lookups");
    QTest::addColumn<QString>("saved");

    QTest::newRow("file beats earlier row, bold also with a file")
        << u"quick=rapid"_qs << u"0 Quick|0:0 edited|1 QUICK"_qs
        << u"0 Quick=edited blue|1 QUICK=rapid blue bold"_qs << QString() << u"quick.dat=edited"_qs;
    // The current text of the last match, title rows before contents rows however late they came;
    // a word's file is written from its first row only.
    QTest::newRow("last matching row wins")
        << QString() << u"0 slow|1 Slow|0:0 t0|1:0 c1|0 SLOW|1 calm|1:1 c2|0 CALM|0:2 t3|1 Calm"_qs
        << u"0 slow=t0|0 SLOW=c1 bold|0 CALM=t3 bold|1 Slow=c1 bold|1 calm=c2|1 Calm=c2 bold"_qs
        << u"slow 0 1|calm 1 2"_qs << u"calm.dat=c2|slow.dat=t0"_qs;
    QTest::newRow("empty word file: no lookup")
        << u"quick="_qs << u"1 quick"_qs << u"1 quick= blue"_qs << QString() << u"quick.dat="_qs;
    // Blank, punctuation, line break, short word, number, ignored word.
    QTest::newRow("non-customizable tokens")
        << u"brown=tan"_qs << u"0  |0 ,|0 \n|0 the|0 1999|0 BROWN|1 brown|0:5 typed"_qs
        << u"0  =|0 ,=|0 \n=|0 the=|0 1999=|0 BROWN=typed|1 brown="_qs << QString() << u"brown.dat=tan"_qs;
    QTest::newRow("checked row not saved")
        << QString() << u"0 quick|0 slow|0:1!"_qs << u"0 quick=looked up|0 slow=looked up"_qs
        << u"quick 0 1|slow 0 2"_qs << u"quick.dat=looked up"_qs;
    QTest::newRow("prompting keeps the confirmed choice")
        << QString() << u"prompt|1 A|1  |1 quick"_qs << u"1 A=|1  =|1 quick=chosen"_qs << u"quick 1 3"_qs
        << u"quick.dat=chosen"_qs;
    QTest::newRow("do not prompt again keeps the confirmed choice")
        << QString() << u"prompt once|1 quick|1 slow"_qs << u"1 quick=chosen|1 slow=looked up"_qs
        << u"quick 1 1|slow 1 2"_qs << u"quick.dat=chosen|slow.dat=looked up"_qs;
}

void TestWordLists::addItemsAndSave()
{
    QFETCH(QString, files);
    QFETCH(QString, steps);
    QFETCH(QString, rows);
    QFETCH(QString, lookups);
    QFETCH(QString, saved);
    Harness h;
    for (const QString &file : Items(files))
        QVERIFY(h.store.WriteAlternatives(file.section(u'=', 0, 0), file.section(u'=', 1)));
    for (const QString &step : Items(steps)) {
        if (step.startsWith(u"prompt"_qs)) {
            h.manual = false;
            h.tickManualInConfirm = step == u"prompt once"_qs;
            continue;
        }
        const int list = step.at(0).digitValue();
        const qsizetype blank = step.indexOf(u' ');
        if (step.endsWith(u'!'))
            h.lists.SetChecked(list, step.mid(2).chopped(1).toInt(), true);
        else if (step.at(1) == u':')
            h.lists.SetAlternatives(list, step.mid(2, blank - 2).toInt(), step.mid(blank + 1));
        else
            h.Add({step.mid(2)}, list);
    }
    QStringList shown;
    for (int list = 0; list < 2; ++list) {
        for (const WordRow &row : h.lists.Rows(list))
            shown.append(QString::number(list) + u' ' + row.Text + u'=' + row.Alternatives
                         + (row.Blue ? u" blue"_qs : QString()) + (row.Bold ? u" bold"_qs : QString()));
    }
    QCOMPARE(shown, Items(rows));
    QCOMPARE(h.lookups, Items(lookups));
    QCOMPARE(SaveData(h.lists, h.settings, h.store), 0);
    QCOMPARE(h.Files(), Items(saved));
}

void TestWordLists::captionTotalAndStop()
{
    Harness h;
    h.Add({u"Quick"_qs, u" "_qs}, 0);
    h.Add({u"fox"_qs}, 1);
    QCOMPARE(h.captions, (QStringList{u"Getting alternatives for Quick"_qs, u"Getting alternatives for  "_qs,
                                      u"Getting alternatives for fox"_qs}));
    QCOMPARE(h.totals, (QStringList{u"Working with 1 Words"_qs, u"Working with 2 Words"_qs,
                                    u"Working with 1 Words"_qs}));
    QVERIFY(h.events >= 3);

    // While StopProcessing is set, nothing at all happens.
    StopProcessing = true;
    h.Add({u"slow"_qs}, 0);
    QCOMPARE(h.lists.Count(0), 2);
    QCOMPARE(h.captions.size(), 3);
    QCOMPARE(h.totals.size(), 3);
    QCOMPARE(h.lookups.size(), 1);
}

void TestWordLists::saveDataCountsFailures()
{
    // A data folder that cannot hold files: both rows fail, nothing is lost or thrown.
    Harness h;
    QVERIFY(WriteTextFile(h.store.DataFolder(), u"in the way"_qs));
    h.Add({u"quick"_qs, u"slow"_qs}, 0);
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
        if (action < 60)
            lists.Append(list, words.at(random.bounded(words.size())));
        else if (action < 98 && lists.Count(list) > 0)
            lists.SetAlternatives(list, random.bounded(lists.Count(list)), QString::number(step));
        else if (action >= 98)
            lists.Clear();
        // The last row of either list (title first) whose text matches, ignoring case.
        for (const QString &word : words) {
            std::optional<QString> found;
            for (const WordRow &row : lists.Rows(0) + lists.Rows(1)) {
                if (row.Text.toLower() == word.toLower())
                    found = row.Alternatives;
            }
            QCOMPARE(lists.FindRepeat(word), found);
        }
    }
}

QTEST_GUILESS_MAIN(TestWordLists)
#include "tst_wordlists.moc"