#include "RecordingMessageSink.h"
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

using Kinds = QList<int>;

const QString kCr = QStringLiteral("\r");
const QString kLf = QStringLiteral("\n");
const QString kCrLf = QStringLiteral("\r\n");

void Register(clsSplitExtra &splitter, const QStringList &delimiters, const Kinds &kinds)
{
    for (qsizetype j = 0; j < delimiters.size(); ++j)
        splitter.AddDelimiter(delimiters.at(j), kinds.at(j));
}

QStringList Split(const QStringList &delimiters, const Kinds &kinds, const QString &text)
{
    clsSplitExtra splitter;
    Register(splitter, delimiters, kinds);
    splitter.SplitString(text);
    return splitter.Tokens();
}

// The split rules followed step by step, choosing the next match by scanning every delimiter:
// the reference for the queued search of the splitter.
QStringList ReferenceSplit(const QStringList &delimiters, const Kinds &kinds, const QString &text)
{
    const qsizetype count = delimiters.size();
    QList<qsizetype> next(count);
    for (qsizetype j = 0; j < count; ++j)
        next[j] = text.indexOf(delimiters.at(j));
    QStringList tokens;
    qsizetype start = 0;
    qsizetype pending = -1;
    auto flushPending = [&] {
        if (pending >= 0 && kinds.at(pending) == clsSplitExtra::DELIM_TOKEN)
            tokens.append(delimiters.at(pending));
    };
    for (;;) {
        qsizetype d = -1;
        for (qsizetype j = 0; j < count; ++j) {
            if (next.at(j) >= 0 && (d < 0 || next.at(j) < next.at(d)))
                d = j;
        }
        if (d < 0)
            break;
        const qsizetype p = next.at(d);
        const qsizetype len = delimiters.at(d).size();
        const int kind = kinds.at(d);
        flushPending();
        const qsizetype end = (kind == 1 || kind == 3) ? p + len - 1 : p - 1;
        if (start <= end && text.mid(start, end - start + 1) != delimiters.at(d))
            tokens.append(text.mid(start, end - start + 1));
        start = (kind == 2 || kind == 3) ? p : p + len;
        pending = d;
        if (p + len == text.size())
            break;
        next[d] = text.indexOf(delimiters.at(d), p + len);
    }
    flushPending();
    if (start < text.size())
        tokens.append(text.mid(start));
    return tokens;
}

} // namespace

class TestSplitExtra final : public QObject
{
    Q_OBJECT

private slots:
    void split_data();
    void split();
    void matchesStepByStepRules();
    void addDelimiterDerivesOffsets_data();
    void addDelimiterDerivesOffsets();
    void readdingKeepsRankInTies();
    void splitsAppend();
    void splitArray_data();
    void splitArray();
    void splitFileDecodesWholeFile_data();
    void splitFileDecodesWholeFile();
    void splitFilePieceRule();
    void errors_data();
    void errors();
    void errorBoxForms();
    void designModeYesEndsProgram();
    void clearTokensAllowsCompareMethod();
};

void TestSplitExtra::split_data()
{
    QTest::addColumn<QStringList>("delimiters");
    QTest::addColumn<Kinds>("kinds");
    QTest::addColumn<QString>("text");
    QTest::addColumn<QStringList>("expected");

    const QStringList comma{u","_qs};
    const QStringList commaBlank{u","_qs, u" "_qs};
    QTest::newRow("empty text") << comma << Kinds{4} << QString() << QStringList();
    QTest::newRow("no delimiter in text") << comma << Kinds{4} << u"abc"_qs << QStringList{u"abc"_qs};
    QTest::newRow("comma blank") << commaBlank << Kinds{4, 4} << u"a, b"_qs
                                 << QStringList{u"a"_qs, u","_qs, u" "_qs, u"b"_qs};
    QTest::newRow("leading") << commaBlank << Kinds{4, 4} << u",a"_qs
                             << QStringList{u","_qs, u"a"_qs};
    QTest::newRow("trailing") << commaBlank << Kinds{4, 4} << u"a,"_qs
                              << QStringList{u"a"_qs, u","_qs};
    QTest::newRow("only delimiter") << comma << Kinds{4} << u","_qs << QStringList{u","_qs};

    QTest::newRow("exclude") << comma << Kinds{0} << u"a,b"_qs << QStringList{u"a"_qs, u"b"_qs};
    QTest::newRow("trail") << comma << Kinds{1} << u"a,b"_qs << QStringList{u"a,"_qs, u"b"_qs};
    QTest::newRow("lead") << comma << Kinds{2} << u"a,b"_qs << QStringList{u"a"_qs, u",b"_qs};
    QTest::newRow("both") << comma << Kinds{3} << u"a,b"_qs << QStringList{u"a,"_qs, u",b"_qs};
    QTest::newRow("token") << comma << Kinds{4} << u"a,b"_qs
                           << QStringList{u"a"_qs, u","_qs, u"b"_qs};

    QTest::newRow("adjacent exclude") << comma << Kinds{0} << u"a,,b"_qs
                                      << QStringList{u"a"_qs, u"b"_qs};
    QTest::newRow("adjacent trail drops lone delimiter")
        << comma << Kinds{1} << u"a,,b"_qs << QStringList{u"a,"_qs, u"b"_qs};
    QTest::newRow("adjacent lead drops lone delimiter")
        << comma << Kinds{2} << u"a,,b"_qs << QStringList{u"a"_qs, u",b"_qs};
    QTest::newRow("adjacent both") << comma << Kinds{3} << u"a,,b"_qs
                                   << QStringList{u"a,"_qs, u",,"_qs, u",b"_qs};
    QTest::newRow("adjacent token") << comma << Kinds{4} << u"a,,b"_qs
                                    << QStringList{u"a"_qs, u","_qs, u","_qs, u"b"_qs};

    QTest::newRow("multi-character delimiter")
        << QStringList{u"--"_qs} << Kinds{0} << u"a--b-c"_qs << QStringList{u"a"_qs, u"b-c"_qs};
    QTest::newRow("multi-character trail")
        << QStringList{u"--"_qs} << Kinds{1} << u"a--b"_qs << QStringList{u"a--"_qs, u"b"_qs};

    QTest::newRow("tie: CR registered first")
        << QStringList{kCr, kCrLf} << Kinds{4, 4} << u"a\r\nb"_qs
        << QStringList{u"a"_qs, kCr, kCrLf, u"b"_qs};
    QTest::newRow("tie: CR LF registered first")
        << QStringList{kCrLf, kCr} << Kinds{4, 4} << u"a\r\nb"_qs
        << QStringList{u"a"_qs, kCrLf, kCr, u"\nb"_qs};
    QTest::newRow("overlap: CR LF and LF") << QStringList{kCrLf, kLf} << Kinds{4, 4}
                                          << u"a\r\nb"_qs
                                          << QStringList{u"a"_qs, kCrLf, kLf, u"b"_qs};
    QTest::newRow("match at the end stops the search")
        << QStringList{kCrLf, kLf} << Kinds{4, 4} << u"a\r\n"_qs
        << QStringList{u"a"_qs, kCrLf};
    QTest::newRow("match at the end stops the search, either order")
        << QStringList{kLf, kCrLf} << Kinds{4, 4} << u"a\r\n"_qs
        << QStringList{u"a"_qs, kCrLf};
    QTest::newRow("delimiter at the last character")
        << QStringList{u"."_qs, u" "_qs} << Kinds{4, 4} << u"Hello world. "_qs
        << QStringList{u"Hello"_qs, u" "_qs, u"world"_qs, u"."_qs, u" "_qs};
    QTest::newRow("exact case") << QStringList{u"X"_qs} << Kinds{4} << u"axbXc"_qs
                                << QStringList{u"axb"_qs, u"X"_qs, u"c"_qs};
    QTest::newRow("non-BMP text") << QStringList{u" "_qs} << Kinds{0} << u"\U0001F600 b"_qs
                                  << QStringList{u"\U0001F600"_qs, u"b"_qs};
}

void TestSplitExtra::split()
{
    QFETCH(QStringList, delimiters);
    QFETCH(Kinds, kinds);
    QFETCH(QString, text);
    QFETCH(QStringList, expected);
    RecordingMessageSink sink;
    clsSplitExtra splitter;
    Register(splitter, delimiters, kinds);
    splitter.SplitString(text);
    QCOMPARE(splitter.Tokens(), expected);
    QCOMPARE(splitter.TokenCount(), expected.size());
    for (qsizetype i = 0; i < expected.size(); ++i)
        QCOMPARE(splitter.Token(i), expected.at(i));
    QVERIFY(sink.ShownBoxes().isEmpty());
}

void TestSplitExtra::matchesStepByStepRules()
{
    std::mt19937 random(7);
    const QString alphabet = u"ab,-\r\n x"_qs;
    const QStringList pool{u","_qs, u"-"_qs, u"--"_qs, u"\r\n"_qs, u"\n"_qs, u"\r"_qs,
                           u"ab"_qs, u"ba"_qs, u"a"_qs, u" "_qs, u"x x"_qs};
    for (int round = 0; round < 400; ++round) {
        QStringList delimiters;
        Kinds kinds;
        for (const QString &candidate : pool) {
            if (random() % 2) {
                delimiters.append(candidate);
                kinds.append(int(random() % 5));
            }
        }
        if (delimiters.isEmpty())
            continue;
        std::shuffle(delimiters.begin(), delimiters.end(), random);
        QString text;
        const int length = int(random() % 40);
        for (int i = 0; i < length; ++i)
            text += alphabet.at(qsizetype(random() % alphabet.size()));
        QCOMPARE(Split(delimiters, kinds, text), ReferenceSplit(delimiters, kinds, text));
    }
}

void TestSplitExtra::addDelimiterDerivesOffsets_data()
{
    QTest::addColumn<int>("kind");
    QTest::addColumn<qsizetype>("pieceEnd");
    QTest::addColumn<qsizetype>("nextStart");
    QTest::newRow("DELIM_EXCLUDE") << 0 << qsizetype(-1) << qsizetype(3);
    QTest::newRow("DELIM_TRAIL") << 1 << qsizetype(2) << qsizetype(3);
    QTest::newRow("DELIM_LEAD") << 2 << qsizetype(-1) << qsizetype(0);
    QTest::newRow("DELIM_BOTH") << 3 << qsizetype(2) << qsizetype(0);
    QTest::newRow("DELIM_TOKEN") << 4 << qsizetype(-1) << qsizetype(3);
}

void TestSplitExtra::addDelimiterDerivesOffsets()
{
    QFETCH(int, kind);
    QFETCH(qsizetype, pieceEnd);
    QFETCH(qsizetype, nextStart);
    clsSplitExtra splitter;
    QCOMPARE(splitter.MaxDelimiterLen(), qsizetype(-1));
    splitter.AddDelimiter(u","_qs, 4);
    splitter.AddDelimiter(u"abc"_qs, kind);
    QCOMPARE(splitter.Delimiters().size(), 2);
    const DelimiterEntry &entry = splitter.Delimiters().at(1);
    QCOMPARE(entry.Delimiter, u"abc"_qs);
    QCOMPARE(entry.DelimKind, kind);
    QCOMPARE(entry.DelimLen, qsizetype(3));
    QCOMPARE(entry.PieceEndOffset, pieceEnd);
    QCOMPARE(entry.NextStartOffset, nextStart);
    QCOMPARE(splitter.MaxDelimiterLen(), qsizetype(3));
    splitter.AddDelimiter(u";"_qs, 0);
    QCOMPARE(splitter.MaxDelimiterLen(), qsizetype(3));
    splitter.ClearDelimiters();
    QVERIFY(splitter.Delimiters().isEmpty());
    QCOMPARE(splitter.MaxDelimiterLen(), qsizetype(-1));
}

void TestSplitExtra::readdingKeepsRankInTies()
{
    // "ab" and "a" match at the same place; the one registered first is taken first.
    clsSplitExtra splitter;
    splitter.AddDelimiter(u"ab"_qs, 4);
    splitter.AddDelimiter(u"a"_qs, 4);
    splitter.AddDelimiter(u"ab"_qs, 0);
    QCOMPARE(splitter.Delimiters().size(), 2);
    QCOMPARE(splitter.Delimiters().at(0).Delimiter, u"ab"_qs);
    QCOMPARE(splitter.Delimiters().at(0).DelimKind, 0);
    splitter.SplitString(u"abc"_qs);
    QCOMPARE(splitter.Tokens(), (QStringList{u"a"_qs, u"bc"_qs}));
}

void TestSplitExtra::splitsAppend()
{
    clsSplitExtra splitter;
    splitter.AddDelimiter(u" "_qs, 4);
    splitter.SplitString(u"a b"_qs);
    splitter.TokenNdxCreate();
    QVERIFY(splitter.IndexBuilt());
    splitter.SplitString(u"c "_qs);
    QVERIFY(!splitter.IndexBuilt());
    QCOMPARE(splitter.TokenCount(), 5);
    QCOMPARE(splitter.Tokens(), (QStringList{u"a"_qs, u" "_qs, u"b"_qs, u"c"_qs, u" "_qs}));
    splitter.TokenNdxCreate();
    splitter.SplitString(QString());
    QVERIFY(!splitter.IndexBuilt()); // even a split that yields nothing
    splitter.ClearTokens();
    QCOMPARE(splitter.TokenCount(), 0);
    splitter.SplitString(u"d"_qs);
    QCOMPARE(splitter.Tokens(), QStringList{u"d"_qs});
}

void TestSplitExtra::splitArray_data()
{
    QTest::addColumn<QStringList>("delimiters");
    QTest::addColumn<Kinds>("kinds");
    QTest::addColumn<QStringList>("pieces");
    QTest::addColumn<QStringList>("expected");
    QTest::addColumn<QString>("error");

    const QStringList blank{u" "_qs};
    QTest::newRow("token spans the join")
        << blank << Kinds{4} << QStringList{u"ab"_qs, u"c d"_qs}
        << QStringList{u"abc"_qs, u" "_qs, u"d"_qs} << QString();
    QTest::newRow("delimiter spans the join")
        << QStringList{u"--"_qs} << Kinds{0} << QStringList{u"xa-"_qs, u"-by"_qs}
        << QStringList{u"xa"_qs, u"by"_qs} << QString();
    QTest::newRow("short last element is fine")
        << blank << Kinds{4} << QStringList{u"ab"_qs, u"c"_qs} << QStringList{u"abc"_qs}
        << QString();
    QTest::newRow("one short element is fine")
        << QStringList{u"abc"_qs} << Kinds{4} << QStringList{u"a"_qs} << QStringList{u"a"_qs}
        << QString();
    QTest::newRow("no elements") << blank << Kinds{4} << QStringList() << QStringList()
                                 << QString();
    QTest::newRow("element as short as the delimiter")
        << blank << Kinds{4} << QStringList{u"a"_qs, u"bcd"_qs} << QStringList()
        << u"Delimiter is larger than array."_qs;
    QTest::newRow("middle element too short")
        << QStringList{u"--"_qs} << Kinds{4} << QStringList{u"abc"_qs, u"de"_qs, u"f"_qs}
        << QStringList() << u"Delimiter is larger than array."_qs;
    QTest::newRow("longest delimiter counts")
        << QStringList{u"---"_qs, u" "_qs} << Kinds{4, 4}
        << QStringList{u"abc"_qs, u"d e"_qs} << QStringList()
        << u"Delimiter is larger than array."_qs;
    QTest::newRow("no delimiters checked first")
        << QStringList() << Kinds{} << QStringList{u"a"_qs, u"b"_qs} << QStringList()
        << u"No current delimiters."_qs;
}

void TestSplitExtra::splitArray()
{
    QFETCH(QStringList, delimiters);
    QFETCH(Kinds, kinds);
    QFETCH(QStringList, pieces);
    QFETCH(QStringList, expected);
    QFETCH(QString, error);
    RecordingMessageSink sink;
    clsSplitExtra splitter;
    Register(splitter, delimiters, kinds);
    splitter.SplitString(u"first"_qs);
    splitter.TokenNdxCreate();
    sink.Clear();
    splitter.SplitArray(pieces);
    if (error.isEmpty()) {
        QVERIFY(sink.ShownBoxes().isEmpty());
        QCOMPARE(splitter.Tokens(), QStringList{u"first"_qs} + expected);
        QCOMPARE(splitter.Tokens(),
                 QStringList{u"first"_qs} + Split(delimiters, kinds, pieces.join(QString())));
        QVERIFY(!splitter.IndexBuilt());
    } else {
        QCOMPARE(sink.Prompts(),
                 QStringList{RecordingMessageSink::DesignPrompt(u"iSbTokenSplit"_qs, error)});
        const QStringList before = delimiters.isEmpty() ? QStringList() : QStringList{u"first"_qs};
        QCOMPARE(splitter.Tokens(), before);
        QCOMPARE(splitter.IndexBuilt(), !before.isEmpty()); // the failed split changed nothing
    }
}

void TestSplitExtra::splitFileDecodesWholeFile_data()
{
    QTest::addColumn<QByteArray>("bytes");
    QTest::addColumn<QStringList>("expected");

    // "é" (two bytes in UTF-8) straddles the first 64000-byte piece boundary.
    QByteArray straddling(63999, 'x');
    straddling += "\xC3\xA9z y";
    QTest::newRow("UTF-8 across the piece boundary")
        << straddling
        << QStringList{QString(63999, QLatin1Char('x')) + u"\u00E9z"_qs, u" "_qs, u"y"_qs};
    QTest::newRow("Windows-1252")
        << QByteArray("say \x93hi\x94 caf\xE9")
        << QStringList{u"say"_qs, u" "_qs, u"\u201Chi\u201D"_qs, u" "_qs, u"caf\u00E9"_qs};
    QTest::newRow("UTF-8 with BOM") << QByteArray("\xEF\xBB\xBFon off")
                                    << QStringList{u"on"_qs, u" "_qs, u"off"_qs};
    QTest::newRow("CR LF kept") << QByteArray("a\r\nb c")
                                << QStringList{u"a\r\nb"_qs, u" "_qs, u"c"_qs};
    QTest::newRow("empty file") << QByteArray() << QStringList();
}

void TestSplitExtra::splitFileDecodesWholeFile()
{
    QFETCH(QByteArray, bytes);
    QFETCH(QStringList, expected);
    RecordingMessageSink sink;
    QTemporaryDir dir;
    const QString path = dir.filePath(u"article.txt"_qs);
    QFile file(path);
    QVERIFY(file.open(QIODevice::WriteOnly));
    file.write(bytes);
    file.close();
    clsSplitExtra splitter;
    splitter.AddDelimiter(u" "_qs, 4);
    splitter.SplitFile(path);
    QCOMPARE(splitter.Tokens(), expected);
    QVERIFY(sink.ShownBoxes().isEmpty());
}

void TestSplitExtra::splitFilePieceRule()
{
    RecordingMessageSink sink;
    QTemporaryDir dir;
    const QString path = dir.filePath(u"big.txt"_qs);
    const QString longDelimiter(clsSplitExtra::kFilePieceBytes, QLatin1Char('-'));
    const QString error = RecordingMessageSink::DesignPrompt(
        u"iSbTokenSplit"_qs, u"Delimiter is larger than array."_qs);

    // One piece: any delimiter is fine.
    {
        QFile file(path);
        QVERIFY(file.open(QIODevice::WriteOnly));
        file.write(QByteArray(clsSplitExtra::kFilePieceBytes - 2, 'a') + " b");
    }
    clsSplitExtra splitter;
    splitter.AddDelimiter(u" "_qs, 4);
    splitter.AddDelimiter(longDelimiter, 0);
    splitter.SplitFile(path);
    QCOMPARE(splitter.TokenCount(), 3);
    QVERIFY(sink.ShownBoxes().isEmpty());

    // Two pieces: the first is not longer than the longest delimiter.
    {
        QFile file(path);
        QVERIFY(file.open(QIODevice::Append));
        file.write("c");
    }
    splitter.SplitFile(path);
    QCOMPARE(splitter.TokenCount(), 3);
    QCOMPARE(sink.Prompts(), QStringList{error});
}

void TestSplitExtra::errors_data()
{
    QTest::addColumn<SplitterCall>("call");
    QTest::addColumn<QString>("routine");
    QTest::addColumn<QString>("message");
    QTest::addColumn<QStringList>("tokensAfter");

    // Every row starts from a splitter holding "a", "b" with "," and " " of kind 0.
    const QStringList held{u"a"_qs, u"b"_qs};
    const auto add = [](QString delimiter, int kind) {
        return SplitterCall([=](clsSplitExtra &s) { s.AddDelimiter(delimiter, kind); });
    };
    QTest::newRow("empty delimiter") << add(QString(), 4) << u"AddDelimiter"_qs
                                     << u"Delimiter length cannot be 0."_qs << held;
    QTest::newRow("empty delimiter checked before kind")
        << add(QString(), 9) << u"AddDelimiter"_qs << u"Delimiter length cannot be 0."_qs << held;
    QTest::newRow("kind 5") << add(u","_qs, 5) << u"AddDelimiter"_qs
                            << u"DELIM_ Constant not recognized."_qs << held;
    QTest::newRow("kind -1") << add(u";"_qs, -1) << u"AddDelimiter"_qs
                             << u"DELIM_ Constant not recognized."_qs << held;
    QTest::newRow("kind 255") << add(u";"_qs, 255) << u"AddDelimiter"_qs
                              << u"DELIM_ Constant not recognized."_qs << held;
    QTest::newRow("token -1")
        << SplitterCall([](clsSplitExtra &s) { QCOMPARE(s.Token(-1), QString()); })
        << u"Token"_qs << u"Index Out Of Range: -1"_qs << held;
    QTest::newRow("token count")
        << SplitterCall([](clsSplitExtra &s) { QCOMPARE(s.Token(2), QString()); })
        << u"Token"_qs << u"Index Out Of Range: 2"_qs << held;
    QTest::newRow("compare method 2")
        << SplitterCall([](clsSplitExtra &s) { s.TokenCompareMethod(2); })
        << u"TokenCompareMethod"_qs << u"Invalid CompareMethod: 2"_qs << held;
    QTest::newRow("compare method -3")
        << SplitterCall([](clsSplitExtra &s) { s.TokenCompareMethod(-3); })
        << u"TokenCompareMethod"_qs << u"Invalid CompareMethod: -3"_qs << held;
    QTest::newRow("compare method after split")
        << SplitterCall([](clsSplitExtra &s) { s.TokenCompareMethod(1); })
        << u"TokenCompareMethod"_qs << u"Document 'CompareMethod' Must Be Set Proir to Split"_qs
        << held;
    QTest::newRow("no delimiters")
        << SplitterCall([](clsSplitExtra &s) {
               s.ClearDelimiters();
               s.SplitString(u"c d"_qs);
           })
        << u"iSbTokenSplit"_qs << u"No current delimiters."_qs << held;
    QTest::newRow("no delimiters, array")
        << SplitterCall([](clsSplitExtra &s) {
               s.ClearDelimiters();
               s.SplitArray({u"c d"_qs});
           })
        << u"iSbTokenSplit"_qs << u"No current delimiters."_qs << held;
    QTest::newRow("index without tokens")
        << SplitterCall([](clsSplitExtra &s) {
               s.ClearTokens();
               s.TokenNdxCreate();
               QVERIFY(!s.IndexBuilt());
           })
        << u"TokenNdxCreate"_qs << u"No tokens to index."_qs << QStringList();
    QTest::newRow("transfer without tokens")
        << SplitterCall([](clsSplitExtra &s) {
               s.ClearTokens();
               QStringList target{u"keep"_qs};
               s.TransferTokenArray(target);
               QCOMPARE(target, QStringList{u"keep"_qs});
           })
        << u"TransferTokenArray"_qs << u"No tokens available for transfer."_qs << QStringList();
    QTest::newRow("missing file")
        << SplitterCall([](clsSplitExtra &s) { s.SplitFile(u"/nonexistent/article.txt"_qs); })
        << u"ReadFileChunks"_qs << u"Unable to read file: /nonexistent/article.txt"_qs << held;
    QTest::newRow("file read before delimiter check")
        << SplitterCall([](clsSplitExtra &s) {
               s.ClearDelimiters();
               s.SplitFile(u"/nonexistent/article.txt"_qs);
           })
        << u"ReadFileChunks"_qs << u"Unable to read file: /nonexistent/article.txt"_qs << held;
    QTest::newRow("directory as file")
        << SplitterCall([](clsSplitExtra &s) { s.SplitFile(u"/"_qs); }) << u"ReadFileChunks"_qs
        << u"Unable to read file: /"_qs << held;
}

void TestSplitExtra::errors()
{
    QFETCH(SplitterCall, call);
    QFETCH(QString, routine);
    QFETCH(QString, message);
    QFETCH(QStringList, tokensAfter);
    RecordingMessageSink sink;
    clsSplitExtra splitter;
    splitter.AddDelimiter(u","_qs, 0);
    splitter.AddDelimiter(u" "_qs, 0);
    splitter.SplitString(u"a,b"_qs);
    const QList<DelimiterEntry> delimiters = splitter.Delimiters();
    QVERIFY(sink.ShownBoxes().isEmpty());

    call(splitter);
    QCOMPARE(sink.Prompts(), QStringList{RecordingMessageSink::DesignPrompt(routine, message)});
    QVERIFY(sink.ShownBoxes().first().DesignMode);
    QCOMPARE(sink.EndRequests(), 0);
    QCOMPARE(splitter.Tokens(), tokensAfter);
    QCOMPARE(splitter.CompareMethod(), 0);
    if (routine == u"AddDelimiter"_qs) {
        QCOMPARE(splitter.Delimiters().size(), delimiters.size());
        for (qsizetype j = 0; j < delimiters.size(); ++j)
            QCOMPARE(splitter.Delimiters().at(j).DelimKind, delimiters.at(j).DelimKind);
    }
}

void TestSplitExtra::errorBoxForms()
{
    RecordingMessageSink sink;
    clsSplitExtra splitter;
    splitter.DesignMode(false);
    splitter.AddDelimiter(QString(), 4);
    QCOMPARE(sink.ShownBoxes().size(), 1);
    QCOMPARE(sink.ShownBoxes().first().Prompt,
             u"Accessing Routine: 'AddDelimiter'\r\nDelimiter length cannot be 0.\r\n"_qs);
    QVERIFY(!sink.ShownBoxes().first().DesignMode);
    splitter.DesignMode(true);
    splitter.SplitString(u"x"_qs);
    QCOMPARE(sink.ShownBoxes().at(1).Prompt,
             u"Accessing Routine: 'iSbTokenSplit'\r\nNo current delimiters.\r\n"
             u"\r\nBreak to Examine Call Stack?"_qs);
    QVERIFY(sink.ShownBoxes().at(1).DesignMode);
    QCOMPARE(kSplitterMessageTitle, u"clsSplitExtra Message");
}

void TestSplitExtra::designModeYesEndsProgram()
{
    RecordingMessageSink sink;
    sink.SetAnswer(SplitterAnswer::Yes);
    clsSplitExtra splitter;
    splitter.TokenNdxCreate();
    QCOMPARE(sink.EndRequests(), 1);
    splitter.DesignMode(false);
    splitter.TokenNdxCreate();
    QCOMPARE(sink.EndRequests(), 1);
    QCOMPARE(sink.ShownBoxes().size(), 2);
}

void TestSplitExtra::clearTokensAllowsCompareMethod()
{
    RecordingMessageSink sink;
    clsSplitExtra splitter;
    QCOMPARE(splitter.CompareMethod(), 0);
    splitter.AddDelimiter(u" "_qs, 0);
    splitter.SplitString(u"a b"_qs);
    splitter.TokenFindFirst(u"b"_qs);
    splitter.ClearTokens();
    QVERIFY(!splitter.IndexBuilt());
    QVERIFY(splitter.SortIndex().isEmpty());
    splitter.TokenCompareMethod(1);
    QCOMPARE(splitter.CompareMethod(), 1);
    splitter.TokenCompareMethod(0);
    QCOMPARE(splitter.CompareMethod(), 0);
    QVERIFY(sink.ShownBoxes().isEmpty());
}

QTEST_GUILESS_MAIN(TestSplitExtra)
#include "tst_splitextra.moc"
