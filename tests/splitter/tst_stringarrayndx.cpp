#include "RecordingMessageSink.h"
#include "splitter/basStringArrayNdx.h"
#include "splitter/clsSplitExtra.h"

#include <QFile>
#include <QTemporaryDir>
#include <QtTest>

#include <functional>
#include <random>

using namespace verbloom;

using SplitterCall = std::function<void(clsSplitExtra &)>;
Q_DECLARE_METATYPE(SplitterCall)

namespace {

using Positions = QList<qsizetype>;

// A splitter holding the blank-separated words of `text`.
void Load(clsSplitExtra &splitter, const QString &text, int compareMethod = 0)
{
    splitter.TokenCompareMethod(compareMethod);
    splitter.AddDelimiter(u" "_qs, clsSplitExtra::DELIM_EXCLUDE);
    splitter.SplitString(text);
}

QStringList RandomTokens(std::mt19937 &random, int count)
{
    const QStringList words{u"a"_qs, u"A"_qs, u"b"_qs, u"B"_qs, u"ab"_qs, u"Ab"_qs,
                            u"\u00E9"_qs, u"\u00C9"_qs, u"z"_qs, u"_"_qs};
    QStringList tokens;
    for (int i = 0; i < count; ++i)
        tokens.append(words.at(qsizetype(random() % words.size())));
    return tokens;
}

QByteArray ReadBytes(const QString &path)
{
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray("<unreadable>");
}

} // namespace

class TestStringArrayNdx final : public QObject
{
    Q_OBJECT

private slots:
    void sortOrder_data();
    void sortOrder();
    void indexIsStableSort_data();
    void indexIsStableSort();
    void findFirstAndNext_data();
    void findFirstAndNext();
    void findWalksEveryEqualTokenInTextOrder_data();
    void findWalksEveryEqualTokenInTextOrder();
    void findResumesAndRebuilds();
    void searchWithoutTokens_data();
    void searchWithoutTokens();
    void sequences_data();
    void sequences();
    void sequenceSharesFindPosition();
    void listingFiles_data();
    void listingFiles();
    void emptyListings();
    void unwritableListing_data();
    void unwritableListing();
    void transfer();
};

void TestStringArrayNdx::sortOrder_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<int>("method");
    QTest::addColumn<Positions>("expected");
    QTest::newRow("binary") << u"b a B a"_qs << 0 << Positions{2, 1, 3, 0};
    QTest::newRow("text") << u"b a B a"_qs << 1 << Positions{1, 3, 0, 2};
    QTest::newRow("binary runs") << u"x X x y X x"_qs << 0 << Positions{1, 4, 0, 2, 5, 3};
    QTest::newRow("text runs") << u"x X x y X x"_qs << 1 << Positions{0, 1, 2, 4, 5, 3};
    QTest::newRow("prefix first") << u"ab a abc"_qs << 0 << Positions{1, 0, 2};
    QTest::newRow("one token") << u"z"_qs << 0 << Positions{0};
}

void TestStringArrayNdx::sortOrder()
{
    QFETCH(QString, text);
    QFETCH(int, method);
    QFETCH(Positions, expected);
    clsSplitExtra splitter;
    Load(splitter, text, method);
    QVERIFY(!splitter.IndexBuilt());
    splitter.TokenNdxCreate();
    QVERIFY(splitter.IndexBuilt());
    QCOMPARE(splitter.SortIndex(), expected);
}

void TestStringArrayNdx::indexIsStableSort_data()
{
    QTest::addColumn<int>("method");
    QTest::newRow("binary") << 0;
    QTest::newRow("text") << 1;
}

void TestStringArrayNdx::indexIsStableSort()
{
    QFETCH(int, method);
    std::mt19937 random(3);
    const QStringList tokens = RandomTokens(random, 3000);
    Positions index;
    BuildSortIndex(tokens, index, method);
    QCOMPARE(index.size(), tokens.size());
    QList<bool> seen(tokens.size(), false);
    for (qsizetype k = 0; k < index.size(); ++k) {
        QVERIFY(!seen.at(index.at(k)));
        seen[index.at(k)] = true;
        if (k == 0)
            continue;
        const int c = CompareByMethod(tokens.at(index.at(k - 1)), tokens.at(index.at(k)), method);
        QVERIFY(c < 0 || (c == 0 && index.at(k - 1) < index.at(k)));
    }
}

void TestStringArrayNdx::findFirstAndNext_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<int>("method");
    QTest::addColumn<QString>("value");
    QTest::addColumn<Positions>("expected"); // FindFirst, then FindNext until and after -1
    QTest::newRow("binary a") << u"b a B a"_qs << 0 << u"a"_qs << Positions{1, 3, -1, -1};
    QTest::newRow("binary b") << u"b a B a"_qs << 0 << u"b"_qs << Positions{0, -1, -1};
    QTest::newRow("binary A") << u"b a B a"_qs << 0 << u"A"_qs << Positions{-1, -1};
    QTest::newRow("text A") << u"b a B a"_qs << 1 << u"A"_qs << Positions{1, 3, -1, -1};
    QTest::newRow("text b") << u"b a B a"_qs << 1 << u"b"_qs << Positions{0, 2, -1};
    QTest::newRow("no such token") << u"b a B a"_qs << 0 << u"zz"_qs << Positions{-1, -1};
    QTest::newRow("below all") << u"b a B a"_qs << 0 << u"0"_qs << Positions{-1, -1};
    QTest::newRow("long run")
        << u"c c c c c c c a b d"_qs << 0 << u"c"_qs << Positions{0, 1, 2, 3, 4, 5, 6, -1};
    QTest::newRow("run at the end") << u"b b a b"_qs << 0 << u"b"_qs << Positions{0, 1, 3, -1};
}

void TestStringArrayNdx::findFirstAndNext()
{
    QFETCH(QString, text);
    QFETCH(int, method);
    QFETCH(QString, value);
    QFETCH(Positions, expected);
    RecordingMessageSink sink;
    clsSplitExtra splitter;
    Load(splitter, text, method);
    Positions found{splitter.TokenFindFirst(value)};
    while (found.size() < expected.size())
        found.append(splitter.TokenFindNext());
    QCOMPARE(found, expected);
    QVERIFY(splitter.IndexBuilt());
    QVERIFY(sink.ShownBoxes().isEmpty());
}

void TestStringArrayNdx::findWalksEveryEqualTokenInTextOrder_data()
{
    indexIsStableSort_data();
}

void TestStringArrayNdx::findWalksEveryEqualTokenInTextOrder()
{
    QFETCH(int, method);
    std::mt19937 random(5);
    for (int size : {1, 2, 3, 7, 64, 501}) {
        const QStringList tokens = RandomTokens(random, size);
        clsSplitExtra splitter;
        Load(splitter, tokens.join(QLatin1Char(' ')), method);
        for (const QString &value : RandomTokens(random, 10) + QStringList{u"q"_qs}) {
            Positions expected;
            for (qsizetype i = 0; i < tokens.size(); ++i) {
                if (CompareByMethod(tokens.at(i), value, method) == 0)
                    expected.append(i);
            }
            Positions found;
            for (qsizetype p = splitter.TokenFindFirst(value); p != -1; p = splitter.TokenFindNext())
                found.append(p);
            QCOMPARE(found, expected);
        }
    }
}

void TestStringArrayNdx::findResumesAndRebuilds()
{
    clsSplitExtra splitter;
    Load(splitter, u"b a B a"_qs);
    QCOMPARE(splitter.TokenFindFirst(u"a"_qs), 1);
    QCOMPARE(splitter.TokenFindNext(), 3);
    QCOMPARE(splitter.TokenFindFirst(u"a"_qs), 1); // resumes inside the run, steps back
    QCOMPARE(splitter.TokenFindFirst(u"c"_qs), -1);
    splitter.SplitString(u"c a"_qs);
    QVERIFY(!splitter.IndexBuilt());
    QCOMPARE(splitter.TokenFindFirst(u"c"_qs), 4);
    QCOMPARE(splitter.TokenFindFirst(u"a"_qs), 1);
    QCOMPARE(splitter.TokenFindNext(), 3);
    QCOMPARE(splitter.TokenFindNext(), 5);
    QCOMPARE(splitter.TokenFindNext(), -1);
}

void TestStringArrayNdx::searchWithoutTokens_data()
{
    QTest::addColumn<SplitterCall>("call");
    QTest::newRow("find first")
        << SplitterCall([](clsSplitExtra &s) { QCOMPARE(s.TokenFindFirst(u"a"_qs), -1); });
    QTest::newRow("find next")
        << SplitterCall([](clsSplitExtra &s) { QCOMPARE(s.TokenFindNext(), -1); });
    QTest::newRow("sequence count") << SplitterCall([](clsSplitExtra &s) {
        QCOMPARE(s.TokenSequenceCount({u"a"_qs}, 0), 0);
    });
    QTest::newRow("nth sequence") << SplitterCall([](clsSplitExtra &s) {
        QCOMPARE(s.TokenFindNthSequence(1, {u"a"_qs}, 0), -1);
    });
}

void TestStringArrayNdx::searchWithoutTokens()
{
    QFETCH(SplitterCall, call);
    RecordingMessageSink sink;
    clsSplitExtra splitter;
    call(splitter);
    QCOMPARE(sink.Prompts(), QStringList{RecordingMessageSink::DesignPrompt(
                                 u"TokenNdxCreate"_qs, u"No tokens to index."_qs)});
    QVERIFY(!splitter.IndexBuilt());
}

void TestStringArrayNdx::sequences_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<int>("method");
    QTest::addColumn<QStringList>("sequence");
    QTest::addColumn<qsizetype>("lastIndex");
    QTest::addColumn<qsizetype>("count");
    QTest::addColumn<Positions>("nth"); // TokenFindNthSequence for n = 0, 1, 2, ...

    const QStringList aa{u"a"_qs, u"a"_qs};
    const QStringList theCat{u"the"_qs, u"cat"_qs};
    const QString story = u"the cat and the dog and the cat"_qs;
    QTest::newRow("overlapping places") << u"a a a"_qs << 0 << aa << qsizetype(1) << qsizetype(2)
                                        << Positions{-1, 0, 1, -1};
    QTest::newRow("one element counts equal tokens")
        << u"x y x X"_qs << 0 << QStringList{u"x"_qs} << qsizetype(0) << qsizetype(2)
        << Positions{-1, 0, 2, -1};
    QTest::newRow("one element, text compare")
        << u"x y x X"_qs << 1 << QStringList{u"X"_qs} << qsizetype(0) << qsizetype(3)
        << Positions{-1, 0, 2, 3, -1};
    QTest::newRow("no match past the last token")
        << u"x y x"_qs << 0 << QStringList{u"x"_qs, u"y"_qs} << qsizetype(1) << qsizetype(1)
        << Positions{-1, 0, -1};
    QTest::newRow("story") << story << 0 << theCat << qsizetype(1) << qsizetype(2)
                           << Positions{-1, 0, 6, -1};
    QTest::newRow("last index 0 uses the first element only")
        << story << 0 << QStringList{u"the"_qs, u"dog"_qs} << qsizetype(0) << qsizetype(3)
        << Positions{-1, 0, 3, 6, -1};
    QTest::newRow("last index beyond the sequence")
        << story << 0 << theCat << qsizetype(5) << qsizetype(2) << Positions{-1, 0, 6, -1};
    QTest::newRow("three elements") << story << 0
                                    << QStringList{u"and"_qs, u"the"_qs, u"cat"_qs}
                                    << qsizetype(2) << qsizetype(1) << Positions{-1, 5, -1};
    QTest::newRow("binary case") << u"The CAT the cat"_qs << 0 << theCat << qsizetype(1)
                                 << qsizetype(1) << Positions{-1, 2, -1};
    QTest::newRow("text case") << u"The CAT the cat"_qs << 1 << theCat << qsizetype(1)
                               << qsizetype(2) << Positions{-1, 0, 2, -1};
    QTest::newRow("first element absent") << story << 0 << QStringList{u"zz"_qs} << qsizetype(0)
                                          << qsizetype(0) << Positions{-1, -1};
    QTest::newRow("empty sequence") << story << 0 << QStringList() << qsizetype(0)
                                    << qsizetype(0) << Positions{-1, -1};
}

void TestStringArrayNdx::sequences()
{
    QFETCH(QString, text);
    QFETCH(int, method);
    QFETCH(QStringList, sequence);
    QFETCH(qsizetype, lastIndex);
    QFETCH(qsizetype, count);
    QFETCH(Positions, nth);
    RecordingMessageSink sink;
    clsSplitExtra splitter;
    Load(splitter, text, method);
    QCOMPARE(splitter.TokenSequenceCount(sequence, lastIndex), count);
    Positions found;
    for (qsizetype n = 0; n < nth.size(); ++n)
        found.append(splitter.TokenFindNthSequence(n, sequence, lastIndex));
    QCOMPARE(found, nth);
    QCOMPARE(splitter.TokenFindNthSequence(-1, sequence, lastIndex), -1);
    QVERIFY(sink.ShownBoxes().isEmpty());
}

void TestStringArrayNdx::sequenceSharesFindPosition()
{
    clsSplitExtra splitter;
    Load(splitter, u"b a B a"_qs);
    QCOMPARE(splitter.TokenFindFirst(u"a"_qs), 1);
    QCOMPARE(splitter.TokenSequenceCount({u"b"_qs}, 0), 1); // runs its candidates out
    QCOMPARE(splitter.TokenFindNext(), -1);
    QCOMPARE(splitter.TokenFindFirst(u"a"_qs), 1);
    QCOMPARE(splitter.TokenFindNthSequence(1, {u"a"_qs}, 0), 1); // stops on its match
    QCOMPARE(splitter.TokenFindNext(), 3); // continues after it, with the value of FindFirst
}

void TestStringArrayNdx::listingFiles_data()
{
    QTest::addColumn<bool>("sorted");
    QTest::addColumn<int>("method");
    QTest::addColumn<QString>("expectedFile");
    QTest::newRow("text order") << false << 0 << u"token_listing.txt"_qs;
    QTest::newRow("sorted, binary") << true << 0 << u"sorted_listing_binary.txt"_qs;
    QTest::newRow("sorted, text") << true << 1 << u"sorted_listing_text.txt"_qs;
}

void TestStringArrayNdx::listingFiles()
{
    QFETCH(bool, sorted);
    QFETCH(int, method);
    QFETCH(QString, expectedFile);
    RecordingMessageSink sink;
    QTemporaryDir dir;
    const QString path = dir.filePath(u"listing.txt"_qs);
    QFile old(path);
    QVERIFY(old.open(QIODevice::WriteOnly));
    old.write(QByteArray(500, 'o')); // overwritten, not appended to
    old.close();
    clsSplitExtra splitter;
    Load(splitter, u"b a\nc B a caf\u00E9 \u201Cq\u201D"_qs, method);
    QVERIFY(sorted ? splitter.SaveSortedTokenArrayToFile(path)
                   : splitter.SaveTokenArrayToFile(path));
    QCOMPARE(ReadBytes(path), ReadBytes(QStringLiteral(VERBLOOM_TEST_DATA "/") + expectedFile));
    QCOMPARE(splitter.IndexBuilt(), sorted);
    QVERIFY(sink.ShownBoxes().isEmpty());
}

void TestStringArrayNdx::emptyListings()
{
    RecordingMessageSink sink;
    QTemporaryDir dir;
    clsSplitExtra splitter;
    QVERIFY(splitter.SaveTokenArrayToFile(dir.filePath(u"a.txt"_qs)));
    QVERIFY(splitter.SaveSortedTokenArrayToFile(dir.filePath(u"b.txt"_qs)));
    QCOMPARE(ReadBytes(dir.filePath(u"a.txt"_qs)), QByteArray("Token Listing - Total Tokens: 0\r\n"));
    QCOMPARE(ReadBytes(dir.filePath(u"b.txt"_qs)), QByteArray("Sorted Index - Total Tokens: 0\r\n"));
    QVERIFY(sink.ShownBoxes().isEmpty());
}

void TestStringArrayNdx::unwritableListing_data()
{
    listingFiles_data();
}

void TestStringArrayNdx::unwritableListing()
{
    QFETCH(bool, sorted);
    RecordingMessageSink sink;
    QTemporaryDir dir;
    const QString path = dir.filePath(u"missing/listing.txt"_qs);
    clsSplitExtra splitter;
    Load(splitter, u"a b"_qs);
    QVERIFY(!(sorted ? splitter.SaveSortedTokenArrayToFile(path)
                     : splitter.SaveTokenArrayToFile(path)));
    const QString routine = sorted ? u"SaveSortedTokenArrayToFile"_qs : u"SaveTokenArrayToFile"_qs;
    QCOMPARE(sink.Prompts(), QStringList{RecordingMessageSink::DesignPrompt(
                                 routine, u"Unable to write file: "_qs + path)});
    QVERIFY(!QFile::exists(path));
}

void TestStringArrayNdx::transfer()
{
    RecordingMessageSink sink;
    clsSplitExtra splitter;
    Load(splitter, u"x y z"_qs);
    QStringList target{u"old"_qs, u"old"_qs, u"old"_qs, u"old"_qs, u"old"_qs};
    splitter.TransferTokenArray(target);
    QCOMPARE(target, (QStringList{u"x"_qs, u"y"_qs, u"z"_qs}));
    target[0] = u"changed"_qs;
    QCOMPARE(splitter.Token(0), u"x"_qs); // a copy
    QVERIFY(sink.ShownBoxes().isEmpty());
}

QTEST_GUILESS_MAIN(TestStringArrayNdx)
#include "tst_stringarrayndx.moc"
