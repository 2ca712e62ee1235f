#include "RecordingMessageSink.h"
#include "common/TextFile.h"
#include "splitter/clsSplitExtra.h"

#include <QTemporaryDir>
#include <QtTest>

#include <functional>

using namespace verbloom;

using SplitterCall = std::function<void(clsSplitExtra &)>;
Q_DECLARE_METATYPE(SplitterCall)

namespace {

using Kinds = QList<int>;

const QString kTooLarge = QStringLiteral("Delimiter is larger than array.");

void Register(clsSplitExtra &splitter, const QStringList &delimiters, const Kinds &kinds)
{
    for (qsizetype j = 0; j < delimiters.size(); ++j)
        splitter.AddDelimiter(delimiters.at(j), kinds.at(j));
}

// A list written as one text, separated by "|"; "" is none.
QStringList Bars(const QString &text)
{
    return text.isEmpty() ? QStringList() : text.split(u'|');
}

} // namespace

class TestSplitExtra final : public QObject
{
    Q_OBJECT

private slots:
    void split_data();
    void split();
    void splitsAppendUntilCleared();
    void splitFile_data();
    void splitFile();
    void errors_data();
    void errors();
    void errorBoxForms();
};

void TestSplitExtra::split_data()
{
    // "|" separates the delimiters, the elements given to SplitArray and the expected tokens.
    QTest::addColumn<QString>("delimiters");
    QTest::addColumn<Kinds>("kinds");
    QTest::addColumn<QString>("text");
    QTest::addColumn<QString>("expected");

    QTest::newRow("empty text") << u","_qs << Kinds{4} << QString() << QString();
    QTest::newRow("no match") << u","_qs << Kinds{4} << u"abc"_qs << u"abc"_qs;
    QTest::newRow("only delimiter") << u","_qs << Kinds{4} << u","_qs << u","_qs;
    // Single and adjacent matches; a piece that is just the delimiter is dropped.
    QTest::newRow("exclude") << u","_qs << Kinds{0} << u"a,b,,c"_qs << u"a|b|c"_qs;
    QTest::newRow("trail") << u","_qs << Kinds{1} << u"a,b,,c"_qs << u"a,|b,|c"_qs;
    QTest::newRow("lead") << u","_qs << Kinds{2} << u"a,b,,c"_qs << u"a|,b|,c"_qs;
    QTest::newRow("both") << u","_qs << Kinds{3} << u"a,b,,c"_qs << u"a,|,b,|,,|,c"_qs;
    QTest::newRow("token") << u","_qs << Kinds{4} << u"a,b,,c"_qs << u"a|,|b|,|,|c"_qs;
    QTest::newRow("mixed kinds") << u" |.|\r\n|--"_qs << Kinds{0, 4, 1, 2}
                                 << u"Hello world. Bye--now\r\nend"_qs
                                 << u"Hello|world|.|Bye|--now\r\n|end"_qs;
    QTest::newRow("comma and blank") << u",| "_qs << Kinds{4, 4} << u"a, b"_qs << u"a|,| |b"_qs;
    QTest::newRow("token first") << u","_qs << Kinds{4} << u",a"_qs << u",|a"_qs;
    QTest::newRow("token last") << u","_qs << Kinds{4} << u"a,"_qs << u"a|,"_qs;
    QTest::newRow("lead last") << u","_qs << Kinds{2} << u"a,"_qs << u"a|,"_qs;
    QTest::newRow("trail first") << u","_qs << Kinds{1} << u",a"_qs << u"a"_qs;
    QTest::newRow("whole multi-character match") << u"--"_qs << Kinds{0} << u"a--b-c"_qs
                                                 << u"a|b-c"_qs;
    QTest::newRow("blank at the very end") << u" |."_qs << Kinds{4, 4} << u"Hello world. "_qs
                                           << u"Hello| |world|.| "_qs;
    QTest::newRow("exact case") << u"X"_qs << Kinds{4} << u"axbXc"_qs << u"axb|X|c"_qs;
    // Matches 16 characters after the search start and far beyond it.
    const QString x = QString(16, u'x'), y = QString(16, u'y'), z = QString(40, u'z');
    QTest::newRow("distant matches") << u" "_qs << Kinds{0}
                                     << x + u" "_qs + y + u" "_qs + z + u" w"_qs
                                     << x + u"|"_qs + y + u"|"_qs + z + u"|w"_qs;

    // At one position the delimiter registered first wins; overlapping matches of others stay.
    QTest::newRow("tie: CR first") << u"\r|\r\n"_qs << Kinds{4, 4} << u"a\r\nb"_qs
                                   << u"a|\r|\r\n|b"_qs;
    QTest::newRow("tie: CR LF first") << u"\r\n|\r"_qs << Kinds{4, 4} << u"a\r\nb"_qs
                                      << u"a|\r\n|\r|\nb"_qs;
    QTest::newRow("re-added delimiter keeps its place, takes the new kind")
        << u"ab|a|ab"_qs << Kinds{4, 4, 0} << u"abc"_qs << u"a|bc"_qs;
    QTest::newRow("overlap: CR LF and LF") << u"\r\n|\n"_qs << Kinds{4, 4} << u"a\r\nb"_qs
                                          << u"a|\r\n|\n|b"_qs;
    QTest::newRow("match at the end stops the search")
        << u"\r\n|\n"_qs << Kinds{4, 4} << u"a\r\n"_qs << u"a|\r\n"_qs;

    // Arrays: every element but the last is longer than any delimiter (else see errors()).
    QTest::newRow("token spans the join") << u" "_qs << Kinds{4} << u"ab|c d"_qs << u"abc| |d"_qs;
    QTest::newRow("delimiter spans the join") << u"--"_qs << Kinds{1} << u"xa-|-b-c"_qs
                                              << u"xa--|b-c"_qs;
    QTest::newRow("short last element") << u" "_qs << Kinds{4} << u"ab|c"_qs << u"abc"_qs;
    QTest::newRow("one short element") << u"abc"_qs << Kinds{4} << u"a"_qs << u"a"_qs;
}

void TestSplitExtra::split()
{
    QFETCH(QString, delimiters);
    QFETCH(Kinds, kinds);
    QFETCH(QString, text);
    QFETCH(QString, expected);
    const QStringList tokens = Bars(expected);
    RecordingMessageSink sink;
    clsSplitExtra whole;
    clsSplitExtra array;
    Register(whole, Bars(delimiters), kinds);
    Register(array, Bars(delimiters), kinds);
    whole.SplitString(QString(text).remove(u'|'));
    array.SplitArray(text.split(u'|'));
    QCOMPARE(whole.Tokens(), tokens);
    QCOMPARE(array.Tokens(), tokens);
    QCOMPARE(whole.TokenCount(), tokens.size());
    for (qsizetype i = 0; i < tokens.size(); ++i)
        QCOMPARE(whole.Token(i), tokens.at(i));
    QVERIFY(sink.Prompts().isEmpty());
}

void TestSplitExtra::splitsAppendUntilCleared()
{
    RecordingMessageSink sink;
    clsSplitExtra splitter;
    splitter.AddDelimiter(u"---"_qs, clsSplitExtra::DELIM_TOKEN);
    splitter.ClearDelimiters(); // forgets the longest delimiter too
    splitter.AddDelimiter(u" "_qs, clsSplitExtra::DELIM_TOKEN);
    splitter.SplitArray({u"a "_qs, u"b"_qs});
    splitter.TokenNdxCreate();
    splitter.SplitString(u"c "_qs);
    QCOMPARE(splitter.Tokens(), (QStringList{u"a"_qs, u" "_qs, u"b"_qs, u"c"_qs, u" "_qs}));
    QVERIFY(!splitter.IndexBuilt());
    splitter.TokenNdxCreate();
    splitter.SplitString(QString());
    QVERIFY(!splitter.IndexBuilt()); // even a split that yields nothing
    splitter.ClearTokens();
    QCOMPARE(splitter.TokenCount(), 0);
    splitter.TokenCompareMethod(1); // allowed again once cleared
    QCOMPARE(splitter.CompareMethod(), 1);
    splitter.SplitString(u"d"_qs);
    QCOMPARE(splitter.Tokens(), QStringList{u"d"_qs});
    QVERIFY(sink.Prompts().isEmpty());
}

void TestSplitExtra::splitFile_data()
{
    QTest::addColumn<QByteArray>("bytes");
    QTest::addColumn<qsizetype>("extraDelimiterLength"); // an excluded "---..." when > 0
    QTest::addColumn<QString>("expected"); // the tokens, separated by "|"; none: refused

    const qsizetype piece = clsSplitExtra::kFilePieceBytes;
    // "é" (two bytes in UTF-8) straddles the first piece boundary.
    QTest::newRow("UTF-8 across the piece boundary")
        << QByteArray(piece - 1, 'x') + "\xC3\xA9z y" << qsizetype(0)
        << QString(piece - 1, u'x') + u"\u00E9z| |y"_qs;
    QTest::newRow("Windows-1252") << QByteArray("say \x93hi\x94 caf\xE9") << qsizetype(0)
                                  << u"say| |\u201Chi\u201D| |caf\u00E9"_qs;
    QTest::newRow("one piece, delimiter as long as a piece")
        << QByteArray(piece - 2, 'a') + " b" << piece << QString(piece - 2, u'a') + u"| |b"_qs;
    QTest::newRow("two pieces, delimiter as long as a piece")
        << QByteArray(piece - 2, 'a') + " bc" << piece << QString();
}

void TestSplitExtra::splitFile()
{
    QFETCH(QByteArray, bytes);
    QFETCH(qsizetype, extraDelimiterLength);
    QFETCH(QString, expected);
    RecordingMessageSink sink;
    QTemporaryDir dir;
    const QString path = dir.filePath(u"article.txt"_qs);
    QVERIFY(WriteBinaryFile(path, bytes));
    clsSplitExtra splitter;
    splitter.AddDelimiter(u" "_qs, clsSplitExtra::DELIM_TOKEN);
    if (extraDelimiterLength > 0)
        splitter.AddDelimiter(QString(extraDelimiterLength, u'-'), clsSplitExtra::DELIM_EXCLUDE);
    splitter.SplitFile(path);
    QCOMPARE(splitter.Tokens(), Bars(expected));
    const QStringList prompts = expected.isEmpty()
        ? QStringList{RecordingMessageSink::DesignPrompt(u"iSbTokenSplit"_qs, kTooLarge)}
        : QStringList();
    QCOMPARE(sink.Prompts(), prompts);
}

// A row of errors(): statements run on the splitter `s`.
#define CALL(...) SplitterCall([](clsSplitExtra &s) { __VA_ARGS__; })

void TestSplitExtra::errors_data()
{
    QTest::addColumn<SplitterCall>("call");
    QTest::addColumn<QString>("routine");
    QTest::addColumn<QString>("message");

    // Every row starts from a splitter holding "a", "b" (indexed) with "," and " " of kind 0;
    // only the rows that need no tokens clear them.
    const QString add = u"AddDelimiter"_qs;
    const QString split = u"iSbTokenSplit"_qs;
    const QString read = u"ReadFileChunks"_qs;
    const QString index = u"TokenNdxCreate"_qs;
    const QString noIndex = u"No tokens to index."_qs;
    const QString badKind = u"DELIM_ Constant not recognized."_qs;
    QTest::newRow("empty delimiter, checked before kind")
        << CALL(s.AddDelimiter(QString(), 9)) << add << u"Delimiter length cannot be 0."_qs;
    QTest::newRow("kind 5") << CALL(s.AddDelimiter(u","_qs, 5)) << add << badKind;
    QTest::newRow("kind -1") << CALL(s.AddDelimiter(u";"_qs, -1)) << add << badKind;
    QTest::newRow("token -1") << CALL(QCOMPARE(s.Token(-1), QString())) << u"Token"_qs
                              << u"Index Out Of Range: -1"_qs;
    QTest::newRow("token count") << CALL(QCOMPARE(s.Token(2), QString())) << u"Token"_qs
                                 << u"Index Out Of Range: 2"_qs;
    // Tokens are held: the method itself is checked first.
    QTest::newRow("compare method 2") << CALL(s.TokenCompareMethod(2)) << u"TokenCompareMethod"_qs
                                      << u"Invalid CompareMethod: 2"_qs;
    QTest::newRow("compare method -1") << CALL(s.TokenCompareMethod(-1)) << u"TokenCompareMethod"_qs
                                       << u"Invalid CompareMethod: -1"_qs;
    QTest::newRow("compare method after split")
        << CALL(s.TokenCompareMethod(1)) << u"TokenCompareMethod"_qs
        << u"Document 'CompareMethod' Must Be Set Proir to Split"_qs;
    QTest::newRow("no delimiters, checked before the sizes")
        << CALL(s.ClearDelimiters(); s.SplitArray({u"a"_qs, u"b"_qs})) << split
        << u"No current delimiters."_qs;
    QTest::newRow("element as short as the delimiter")
        << CALL(s.SplitArray({u"c"_qs, u"d e"_qs})) << split << kTooLarge;
    QTest::newRow("middle element too short")
        << CALL(s.SplitArray({u"cd"_qs, u"e"_qs, u"f"_qs})) << split << kTooLarge;
    QTest::newRow("longest delimiter counts")
        << CALL(s.AddDelimiter(u"---"_qs, 0); s.AddDelimiter(u","_qs, 0);
                s.SplitArray({u"cde"_qs, u"f g"_qs}))
        << split << kTooLarge;
    QTest::newRow("file read before delimiter check")
        << CALL(s.ClearDelimiters(); s.SplitFile(u"/nonexistent/article.txt"_qs)) << read
        << u"Unable to read file: /nonexistent/article.txt"_qs;
    QTest::newRow("directory as file") << CALL(s.SplitFile(u"/"_qs)) << read
                                       << u"Unable to read file: /"_qs;
    QTest::newRow("unwritable listing")
        << CALL(QVERIFY(!s.SaveTokenArrayToFile(u"/nonexistent/listing.txt"_qs)))
        << u"SaveTokenArrayToFile"_qs << u"Unable to write file: /nonexistent/listing.txt"_qs;
    QTest::newRow("unwritable sorted listing")
        << CALL(QVERIFY(!s.SaveSortedTokenArrayToFile(u"/nonexistent/sorted.txt"_qs)))
        << u"SaveSortedTokenArrayToFile"_qs << u"Unable to write file: /nonexistent/sorted.txt"_qs;
    QTest::newRow("index without tokens") << CALL(s.ClearTokens(); s.TokenNdxCreate()) << index
                                          << noIndex;
    QTest::newRow("find first without tokens")
        << CALL(s.ClearTokens(); QCOMPARE(s.TokenFindFirst(u"a"_qs), -1)) << index << noIndex;
    QTest::newRow("find next without tokens")
        << CALL(s.ClearTokens(); QCOMPARE(s.TokenFindNext(), -1)) << index << noIndex;
    QTest::newRow("sequence count without tokens")
        << CALL(s.ClearTokens(); QCOMPARE(s.TokenSequenceCount({u"a"_qs}, 0), 0)) << index
        << noIndex;
    QTest::newRow("nth sequence without tokens")
        << CALL(s.ClearTokens(); QCOMPARE(s.TokenFindNthSequence(1, {u"a"_qs}, 0), -1)) << index
        << noIndex;
    QTest::newRow("transfer without tokens")
        << CALL(s.ClearTokens(); QStringList target{u"keep"_qs}; s.TransferTokenArray(target);
                QCOMPARE(target, QStringList{u"keep"_qs}))
        << u"TransferTokenArray"_qs << u"No tokens available for transfer."_qs;
}

void TestSplitExtra::errors()
{
    QFETCH(SplitterCall, call);
    QFETCH(QString, routine);
    QFETCH(QString, message);
    const bool keepsTokens = routine != u"TokenNdxCreate"_qs && routine != u"TransferTokenArray"_qs;
    RecordingMessageSink sink;
    clsSplitExtra splitter;
    splitter.AddDelimiter(u","_qs, 0);
    splitter.AddDelimiter(u" "_qs, 0);
    splitter.SplitString(u"a,b"_qs);
    splitter.TokenNdxCreate();
    call(splitter);
    QCOMPARE(sink.Prompts(), QStringList{RecordingMessageSink::DesignPrompt(routine, message)});
    QCOMPARE(sink.EndRequests(), 0); // No answered
    QCOMPARE(splitter.Tokens(), keepsTokens ? (QStringList{u"a"_qs, u"b"_qs}) : QStringList());
    QCOMPARE(splitter.IndexBuilt(), keepsTokens);
    QCOMPARE(splitter.CompareMethod(), 0);
    if (routine == u"AddDelimiter"_qs) { // refused delimiters change nothing
        QCOMPARE(splitter.Delimiters().size(), 2);
        QCOMPARE(splitter.Delimiters().at(0).DelimKind, 0);
    }
}

void TestSplitExtra::errorBoxForms()
{
    RecordingMessageSink sink;
    sink.SetAnswer(SplitterAnswer::Yes);
    clsSplitExtra splitter; // design mode is on at creation
    splitter.SplitString(u"x"_qs);
    splitter.DesignMode(false);
    splitter.AddDelimiter(QString(), 4);
    QCOMPARE(sink.Prompts(), (QStringList{u"Accessing Routine: 'iSbTokenSplit'\r\n"
                                          u"No current delimiters.\r\n"
                                          u"\r\nBreak to Examine Call Stack?"_qs,
                                          u"Accessing Routine: 'AddDelimiter'\r\n"
                                          u"Delimiter length cannot be 0.\r\n"_qs}));
    QCOMPARE(sink.DesignModes(), (QList<bool>{true, false}));
    QCOMPARE(sink.EndRequests(), 1); // only the design-mode Yes ends the program
    QCOMPARE(kSplitterMessageTitle, u"clsSplitExtra Message");
}

QTEST_GUILESS_MAIN(TestSplitExtra)
#include "tst_splitextra.moc"
