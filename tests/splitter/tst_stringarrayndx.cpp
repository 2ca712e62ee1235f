#include "RecordingMessageSink.h"
#include "splitter/basStringArrayNdx.h"
#include "splitter/clsSplitExtra.h"

#include <QFile>
#include <QTemporaryDir>
#include <QtTest>

#include <random>

using namespace verbloom;

namespace {

using Positions = QList<qsizetype>;

// A splitter holding the blank-separated words of `text`.
void Load(clsSplitExtra &splitter, const QString &text, int compareMethod = 0)
{
    splitter.TokenCompareMethod(compareMethod);
    splitter.AddDelimiter(u" "_qs, clsSplitExtra::DELIM_EXCLUDE);
    splitter.SplitString(text);
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
    void findWalksEqualTokensInTextOrder_data();
    void findWalksEqualTokensInTextOrder();
    void findStateAcrossCalls();
    void sequences_data();
    void sequences();
    void listingFiles_data();
    void listingFiles();
    void transfer();
};

void TestStringArrayNdx::sortOrder_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<int>("method");
    QTest::addColumn<Positions>("expected");
    QTest::newRow("binary") << u"x X x y X x"_qs << 0 << Positions{1, 4, 0, 2, 5, 3};
    QTest::newRow("text") << u"x X x y X x"_qs << 1 << Positions{0, 1, 2, 4, 5, 3};
    QTest::newRow("prefix first") << u"ab a abc"_qs << 0 << Positions{1, 0, 2};
    QTest::newRow("b a B a, binary") << u"b a B a"_qs << 0 << Positions{2, 1, 3, 0};
    QTest::newRow("b a B a, text") << u"b a B a"_qs << 1 << Positions{1, 3, 0, 2};
}

void TestStringArrayNdx::sortOrder()
{
    QFETCH(QString, text);
    QFETCH(int, method);
    QFETCH(Positions, expected);
    clsSplitExtra splitter;
    Load(splitter, text, method);
    splitter.TokenNdxCreate();
    QVERIFY(splitter.IndexBuilt());
    QCOMPARE(splitter.SortIndex(), expected);
}

void TestStringArrayNdx::findWalksEqualTokensInTextOrder_data()
{
    QTest::addColumn<int>("method");
    QTest::newRow("binary") << 0;
    QTest::newRow("text") << 1;
}

// Every equal token is found, in text order (the sort is stable), in small and large indexes.
void TestStringArrayNdx::findWalksEqualTokensInTextOrder()
{
    QFETCH(int, method);
    std::mt19937 random(5);
    const QStringList words{u"a"_qs, u"A"_qs, u"b"_qs, u"B"_qs, u"ab"_qs,
                            u"Ab"_qs, u"\u00E9"_qs, u"\u00C9"_qs, u"z"_qs, u"_"_qs};
    const auto randomWords = [&](int count) {
        QStringList tokens;
        for (int i = 0; i < count; ++i)
            tokens.append(words.at(qsizetype(random() % words.size())));
        return tokens;
    };
    for (int size : {1, 2, 3, 7, 64, 501, 3000}) {
        const QStringList tokens = randomWords(size);
        clsSplitExtra splitter;
        Load(splitter, tokens.join(QLatin1Char(' ')), method);
        for (const QString &value : words + QStringList{u"0"_qs, u"q"_qs, u"zz"_qs}) {
            Positions expected;
            for (qsizetype i = 0; i < tokens.size(); ++i) {
                if (CompareByMethod(tokens.at(i), value, method) == 0)
                    expected.append(i);
            }
            Positions found;
            for (qsizetype p = splitter.TokenFindFirst(value); p >= 0; p = splitter.TokenFindNext())
                found.append(p);
            QCOMPARE(found, expected);
            QCOMPARE(splitter.TokenFindNext(), -1);
        }
    }
}

void TestStringArrayNdx::findStateAcrossCalls()
{
    clsSplitExtra splitter;
    Load(splitter, u"b a B a"_qs);
    QCOMPARE(splitter.TokenFindFirst(u"a"_qs), 1);
    QCOMPARE(splitter.TokenFindNext(), 3);
    QCOMPARE(splitter.TokenFindFirst(u"a"_qs), 1); // resumes inside the run, steps back
    QCOMPARE(splitter.TokenSequenceCount({u"b"_qs}, 0), 1); // runs its candidates out
    QCOMPARE(splitter.TokenFindNext(), -1);
    QCOMPARE(splitter.TokenFindNthSequence(1, {u"a"_qs}, 0), 1); // stops on its match
    QCOMPARE(splitter.TokenFindNext(), 3); // continues after it, with the value of FindFirst
    splitter.SplitString(u"c a"_qs); // the index is rebuilt on the next search
    QCOMPARE(splitter.TokenFindFirst(u"c"_qs), 4);
    QCOMPARE(splitter.TokenFindFirst(u"a"_qs), 1);
    QCOMPARE(splitter.TokenFindNext(), 3);
    QCOMPARE(splitter.TokenFindNext(), 5);
    QCOMPARE(splitter.TokenFindNext(), -1);
    QCOMPARE(splitter.TokenFindFirst(u"a"_qs), 1);
    QCOMPARE(splitter.TokenFindFirst(u"A"_qs), -1); // no resume on a token equal but for case
}

void TestStringArrayNdx::sequences_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<int>("method");
    QTest::addColumn<QString>("sequence"); // blank-separated
    QTest::addColumn<int>("lastIndex");
    QTest::addColumn<int>("count");
    QTest::addColumn<Positions>("nth"); // TokenFindNthSequence for n = 0, 1, 2, ...

    const QString story = u"the cat and the dog and the cat"_qs;
    QTest::newRow("overlapping places") << u"a a a"_qs << 0 << u"a a"_qs << 1 << 2
                                        << Positions{-1, 0, 1, -1};
    QTest::newRow("one element, text compare") << u"x y x X"_qs << 1 << u"X"_qs << 0 << 3
                                               << Positions{-1, 0, 2, 3, -1};
    QTest::newRow("no match past the last token") << u"x y x"_qs << 0 << u"x y"_qs << 1 << 1
                                                  << Positions{-1, 0, -1};
    QTest::newRow("last index 0 uses the first element only")
        << story << 0 << u"the dog"_qs << 0 << 3 << Positions{-1, 0, 3, 6, -1};
    QTest::newRow("last index beyond the sequence")
        << story << 0 << u"the cat"_qs << 5 << 2 << Positions{-1, 0, 6, -1};
    QTest::newRow("three elements") << story << 0 << u"and the cat"_qs << 2 << 1
                                    << Positions{-1, 5, -1};
    QTest::newRow("binary case") << u"The CAT the cat"_qs << 0 << u"the cat"_qs << 1 << 1
                                 << Positions{-1, 2, -1};
    QTest::newRow("text case") << u"The CAT the cat"_qs << 1 << u"the cat"_qs << 1 << 2
                               << Positions{-1, 0, 2, -1};
    QTest::newRow("empty sequence") << story << 0 << QString() << 0 << 0 << Positions{-1, -1};
}

void TestStringArrayNdx::sequences()
{
    QFETCH(QString, text);
    QFETCH(int, method);
    QFETCH(QString, sequence);
    QFETCH(int, lastIndex);
    QFETCH(int, count);
    QFETCH(Positions, nth);
    const QStringList words = sequence.split(u' ', Qt::SkipEmptyParts);
    RecordingMessageSink sink;
    clsSplitExtra splitter;
    Load(splitter, text, method);
    QCOMPARE(splitter.TokenSequenceCount(words, lastIndex), count);
    Positions found;
    for (qsizetype n = 0; n < nth.size(); ++n)
        found.append(splitter.TokenFindNthSequence(n, words, lastIndex));
    QCOMPARE(found, nth);
    QCOMPARE(splitter.TokenFindNthSequence(-1, words, lastIndex), -1);
    QVERIFY(sink.Prompts().isEmpty());
}

void TestStringArrayNdx::listingFiles_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<bool>("sorted");
    QTest::addColumn<int>("method");
    QTest::addColumn<QByteArray>("expected");
    const QString text = u"b a\nc B a caf\u00E9 \u201Cq\u201D"_qs;
    const QString data = QStringLiteral(VERBLOOM_TEST_DATA "/");
    QTest::newRow("text order") << text << false << 0
                                << ReadBytes(data + u"token_listing.txt"_qs);
    QTest::newRow("sorted, binary") << text << true << 0
                                    << ReadBytes(data + u"sorted_listing_binary.txt"_qs);
    QTest::newRow("sorted, text") << text << true << 1
                                  << ReadBytes(data + u"sorted_listing_text.txt"_qs);
    QTest::newRow("no tokens") << QString() << false << 0
                               << QByteArray("Token Listing - Total Tokens: 0\r\n");
    QTest::newRow("no tokens, sorted") << QString() << true << 0
                                       << QByteArray("Sorted Index - Total Tokens: 0\r\n");
}

void TestStringArrayNdx::listingFiles()
{
    QFETCH(QString, text);
    QFETCH(bool, sorted);
    QFETCH(int, method);
    QFETCH(QByteArray, expected);
    RecordingMessageSink sink;
    QTemporaryDir dir;
    const QString path = dir.filePath(u"listing.txt"_qs);
    clsSplitExtra splitter;
    Load(splitter, text, method);
    QVERIFY(sorted ? splitter.SaveSortedTokenArrayToFile(path)
                   : splitter.SaveTokenArrayToFile(path));
    QCOMPARE(ReadBytes(path), expected);
    QCOMPARE(splitter.IndexBuilt(), sorted && !text.isEmpty());
    // The sorted listing builds the index first, which reports a missing token.
    const QStringList prompts = sorted && text.isEmpty()
        ? QStringList{RecordingMessageSink::DesignPrompt(u"TokenNdxCreate"_qs,
                                                         u"No tokens to index."_qs)}
        : QStringList();
    QCOMPARE(sink.Prompts(), prompts);
}

void TestStringArrayNdx::transfer()
{
    clsSplitExtra splitter;
    Load(splitter, u"x y z"_qs);
    QStringList target{u"old"_qs, u"old"_qs, u"old"_qs, u"old"_qs, u"old"_qs};
    splitter.TransferTokenArray(target);
    QCOMPARE(target, (QStringList{u"x"_qs, u"y"_qs, u"z"_qs}));
}

QTEST_GUILESS_MAIN(TestStringArrayNdx)
#include "tst_stringarrayndx.moc"
