#include "thesaurus/HtmlInnerText.h"
#include "thesaurus/HttpPageSource.h"
#include "thesaurus/ThesaurusData.h"
#include "thesaurus/ThesaurusService.h"

#include "engine/ThesaurusLookup.h"
#include "engine/ThesaurusParser.h"
#include "shell/ArticleModel.h"

#include <QFile>
#include <QHttpServer>
#include <QHttpServerRequest>
#include <QHttpServerResponder>
#include <QNetworkAccessManager>
#include <QNetworkReply>
#include <QProcess>
#include <QRegularExpression>
#include <QSet>
#include <QTcpServer>
#include <QTcpSocket>
#include <QTemporaryDir>
#include <QtTest>

#include <csignal>
#include <memory>

using namespace verbloom;

namespace {

const QString kData = ThesaurusService::DefaultDataPath();

struct Page
{
    int Status = 0;
    QStringList Lines;
};

Page Fetch(const QString &url)
{
    HttpPageSource source;
    source.Navigate(url);
    if (!source.WaitUntilComplete(20000))
        return {};
    return {source.HttpStatus(), source.PageText().split(u"\r\n"_qs)};
}

struct RawReply
{
    int Status = 0;
    QByteArray Body;
    QByteArray Allow;
};

RawReply Send(const QByteArray &method, const QString &url)
{
    QNetworkAccessManager network;
    const QNetworkRequest request{QUrl(url)};
    QNetworkReply *reply = method == "HEAD" ? network.head(request)
                                            : network.sendCustomRequest(request, method);
    QSignalSpy finished(reply, &QNetworkReply::finished);
    if (!finished.wait(20000))
        return {};
    RawReply result{reply->attribute(QNetworkRequest::HttpStatusCodeAttribute).toInt(),
                    reply->readAll(), reply->rawHeader("Allow")};
    delete reply;
    return result;
}

/// The meaning blocks of a rendered page: four lines from each "Main Entry:" line.
QList<QStringList> Blocks(const QStringList &lines)
{
    QList<QStringList> blocks;
    for (qsizetype i = 0; i < lines.size(); ++i) {
        if (lines[i].startsWith(u"Main Entry:"_qs))
            blocks.append(lines.mid(i, 4));
    }
    return blocks;
}

QString SynonymsOf(const QStringList &block)
{
    return block.value(3).mid(QStringLiteral("Synonyms: ").size());
}

} // namespace

class TestThesaurus final : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();

    void rendersLikeABrowser_data();
    void rendersLikeABrowser();
    void decodesLikeABrowser_data();
    void decodesLikeABrowser();
    void survivesHostileMarkup();

    void buildsMeanings_data();
    void buildsMeanings();

    void happyHasSeveralMeanings();
    void everyBlockHasFourLines_data();
    void everyBlockHasFourLines();
    void blocksParseWithTheLookupParser();
    void lookupThroughTheService_data();
    void lookupThroughTheService();
    void wordsWithoutEntryGiveNoMeaning_data();
    void wordsWithoutEntryGiveNoMeaning();
    void answersBadRequests_data();
    void answersBadRequests();
    void answersSeveralClientsAtOnce();
    void refusesMissingDataAndBusyPort();

    void readsThesaurusUrl_data();
    void readsThesaurusUrl();
    void startsEmbeddedServiceOrUsesAddress();
    void missingDataGivesMessageAndEmptyPages();

    void pageSourceFollowsServerAnswers();
    void pageSourceTimesOutAndStops();

    void standaloneProgram_data();
    void standaloneProgram();
    void standaloneProgramRefusesBadStart_data();
    void standaloneProgramRefusesBadStart();

private:
    ThesaurusService m_service;
};

void TestThesaurus::initTestCase()
{
    QVERIFY2(QFile::exists(kData + u".idx"_qs),
             "The thesaurus data of the package mythes-en-us is needed for these tests");
    QVERIFY2(m_service.Start(kData), qPrintable(m_service.ErrorString()));
    QVERIFY(m_service.Port() != 0);
    QCOMPARE(m_service.BaseUrl(), u"http://127.0.0.1:%1"_qs.arg(m_service.Port()));
}

// Expected texts are what Qt WebEngine gives as document.documentElement.innerText.
void TestThesaurus::rendersLikeABrowser_data()
{
    QTest::addColumn<QString>("html");
    QTest::addColumn<QString>("expected");
    QTest::newRow("divs") << u"<div>one</div><div>two</div>"_qs << u"one\ntwo"_qs;
    QTest::newRow("nested blocks") << u"<div><div>a</div>  <div><div>b</div></div>c</div>"_qs
                                   << u"a\nb\nc"_qs;
    QTest::newRow("empty blocks") << u"<div></div><div>a</div><div></div><div></div><div>b</div>"_qs
                                  << u"a\nb"_qs;
    QTest::newRow("paragraphs") << u"<div>x</div><p>y</p><div>z</div>"_qs << u"x\n\ny\n\nz"_qs;
    QTest::newRow("paragraph in div") << u"<div>x<p>y</p>z</div>"_qs << u"x\n\ny\n\nz"_qs;
    QTest::newRow("br") << u"a<br>b<br><br>c"_qs << u"a\nb\n\nc"_qs;
    QTest::newRow("br ends block") << u"<div>a<br></div><div>b</div>"_qs << u"a\n\nb"_qs;
    QTest::newRow("leading br") << u"<br>text"_qs << u"\ntext"_qs;
    QTest::newRow("blanks") << u"  a   b \n\t c  <span> d </span> e "_qs << u"a b c d e"_qs;
    QTest::newRow("blanks at block edges") << u"<div>  a  </div>  <div>  b  </div>"_qs
                                           << u"a\nb"_qs;
    QTest::newRow("blank before br") << u"a <br> b"_qs << u"a\nb"_qs;
    QTest::newRow("script and style")
        << u"<div>a</div><script>var x='<div>no</div>';</script><style>div{color:red}</style>"
           "<div>b</div>"_qs
        << u"a\nb"_qs;
    QTest::newRow("entities")
        << u"<div>&amp; &lt;tag&gt; &quot;q&quot; &eacute; &#233; &#x41; &nbsp;x&nbsp;&nbsp;y "
           "&unknown;</div>"_qs
        << u"& <tag> \"q\" \u00e9 \u00e9 A \u00a0x\u00a0\u00a0y &unknown;"_qs;
    QTest::newRow("nbsp around br") << u"a&nbsp;<br>&nbsp;b"_qs << u"a\u00a0\n\u00a0b"_qs;
    QTest::newRow("head and title") << u"<html><head><title>T</title></head><body><div>body</div>"
                                       "</body></html>"_qs
                                    << u"body"_qs;
    QTest::newRow("hidden") << u"<div hidden>no</div><div style='display: none'>no2</div>"
                               "<div STYLE='DISPLAY:NONE'>no3</div><div>yes</div>"
                               "<noscript>ns</noscript><template>tp</template>"_qs
                            << u"yes"_qs;
    QTest::newRow("table") << u"<table><tr><td>a</td><td>b</td></tr><tr><td>c</td><td>d</td></tr>"
                              "</table>after"_qs
                           << u"a\tb\nc\td\nafter"_qs;
    QTest::newRow("table sections") << u"<table><thead><tr><th>h1</th><th>h2</th></tr></thead>"
                                       "<tbody><tr><td>a</td><td> b </td></tr></tbody></table>"_qs
                                    << u"h1\th2\na\tb"_qs;
    QTest::newRow("table blanks") << u"<table>\n <tr>\n  <td> a </td>\n  <td> b </td>\n </tr>\n"
                                     " <tr><td>c</td></tr>\n</table>"_qs
                                  << u"a\tb\nc"_qs;
    QTest::newRow("blocks in cell") << u"<table><tr><td><div>a</div><div>b</div></td><td>c</td>"
                                       "</tr></table>"_qs
                                    << u"a\nb\n\tc"_qs;
    QTest::newRow("lists") << u"<ul><li>a<ul><li>b</li></ul></li><li>c <b>bold</b></li></ul>x"_qs
                           << u"a\nb\nc bold\nx"_qs;
    QTest::newRow("pre") << u"<pre>\n  keep   this\n  and this</pre>after"_qs
                         << u"  keep   this\n  and this\nafter"_qs;
    QTest::newRow("pre with CR LF") << u"<pre>a\r\nb\r\n</pre>c"_qs << u"a\nb\n\nc"_qs;
    QTest::newRow("form controls")
        << u"<div>a<input value=v><select><option>o1</option><option>o2</option></select>"
           "<textarea>ta</textarea><button>btn</button>b</div>"_qs
        << u"a\no1\no2\nbtnb"_qs;
    QTest::newRow("closed details and dialog")
        << u"<details><summary>s</summary>d</details><dialog>dlg</dialog>x"_qs << u"s\nx"_qs;
    QTest::newRow("headings and rule") << u"<h1>Title</h1><div>x</div><h2>Sub</h2>a<hr>b"_qs
                                       << u"Title\nx\nSub\na\nb"_qs;
    QTest::newRow("text around a block") << u"text<div>block</div>more text"_qs
                                         << u"text\nblock\nmore text"_qs;
    QTest::newRow("unclosed tags") << u"<div>a<p>b<div>c"_qs << u"a\n\nb\n\nc"_qs;
    QTest::newRow("comments and images") << u"a<!-- <div>c</div> -->b<img alt='pic'>c"_qs
                                         << u"abc"_qs;
    QTest::newRow("line feed in text") << u"<div>a\r\nb</div>"_qs << u"a b"_qs;
    QTest::newRow("empty") << QString() << QString();
}

void TestThesaurus::rendersLikeABrowser()
{
    QFETCH(QString, html);
    QFETCH(QString, expected);
    QCOMPARE(HtmlInnerText(html.toUtf8()), expected.replace(u"\n"_qs, u"\r\n"_qs));
}

void TestThesaurus::decodesLikeABrowser_data()
{
    QTest::addColumn<QByteArray>("bytes");
    QTest::addColumn<QByteArray>("charset");
    QTest::addColumn<QString>("expected");
    QTest::newRow("utf-8") << QByteArray("<p>caf\xc3\xa9</p>") << QByteArray() << u"caf\u00e9"_qs;
    QTest::newRow("undeclared windows-1252")
        << QByteArray("<p>caf\xe9 \x93q\x94</p>") << QByteArray() << u"caf\u00e9 \u201cq\u201d"_qs;
    QTest::newRow("meta charset")
        << QByteArray("<html><head><meta charset=\"windows-1251\"></head><body>\xcf\xf0\xe8</body>")
        << QByteArray() << u"\u041f\u0440\u0438"_qs;
    QTest::newRow("server charset wins")
        << QByteArray("<html><head><meta charset=\"utf-8\"></head><body>caf\xe9</body>")
        << QByteArray("ISO-8859-15") << u"caf\u00e9"_qs;
    QTest::newRow("utf-16 with bom") << QByteArray("\xff\xfe<\0p\0>\0h\0i\0<\0/\0p\0>\0", 20)
                                     << QByteArray() << u"hi"_qs;
    QTest::newRow("NUL byte") << QByteArray("<div>a\0b</div>", 14) << QByteArray()
                              << u"a\ufffdb"_qs;
    QTest::newRow("latin-1 label means windows-1252")
        << QByteArray("<p>\x93q\x94</p>") << QByteArray("iso-8859-1") << u"\u201cq\u201d"_qs;
    QTest::newRow("unknown charset") << QByteArray("<p>ok</p>") << QByteArray("no-such-charset")
                                     << u"ok"_qs;
}

void TestThesaurus::decodesLikeABrowser()
{
    QFETCH(QByteArray, bytes);
    QFETCH(QByteArray, charset);
    QFETCH(QString, expected);
    QCOMPARE(HtmlInnerText(bytes, charset), expected);
}

void TestThesaurus::survivesHostileMarkup()
{
    const int depth = 200000;
    const QByteArray nested = "<p>before</p>" + QByteArray("<div>").repeated(depth) + "x"
        + QByteArray("</div>").repeated(depth) + "<p>after</p>";
    QCOMPARE(HtmlInnerText(nested), u"before\r\n\r\nx\r\n\r\nafter"_qs);
    const QByteArray broken = "<div <p></ta<<ble><td>&#xffffffff;&#0;<!--<script>";
    const QString text = HtmlInnerText(broken);
    QVERIFY(!text.contains(u"script"_qs));
}

void TestThesaurus::buildsMeanings_data()
{
    QTest::addColumn<QString>("word");
    QTest::addColumn<QString>("pos");
    QTest::addColumn<QStringList>("terms");
    QTest::addColumn<QString>("head");
    QTest::addColumn<QString>("partOfSpeech");
    QTest::addColumn<QStringList>("synonyms");
    QTest::newRow("marks") << u"happy"_qs << u"(adj)"_qs
                           << QStringList{u"blessed (similar term)"_qs, u"glad (related term)"_qs,
                                          u"feeling (generic term)"_qs, u"unhappy (antonym)"_qs}
                           << u"happy"_qs << u"adjective"_qs
                           << QStringList{u"blessed"_qs, u"glad"_qs};
    QTest::newRow("head is the first plain term")
        << u"happy"_qs << u"(adj)"_qs << QStringList{u"felicitous"_qs, u"fortunate (similar term)"_qs}
        << u"felicitous"_qs << u"adjective"_qs << QStringList{u"felicitous"_qs, u"fortunate"_qs};
    QTest::newRow("word itself and repeats")
        << u"bank"_qs << u"(noun)"_qs
        << QStringList{u"Bank"_qs, u"depository"_qs, u"Depository (similar term)"_qs, u"bank"_qs}
        << u"Bank"_qs << u"noun"_qs << QStringList{u"depository"_qs};
    QTest::newRow("colon and comma") << u"x"_qs << u"(adv)"_qs
                                     << QStringList{u"a: b"_qs, u"c, d"_qs, u"e"_qs, u" f "_qs}
                                     << u"x"_qs << u"adverb"_qs << QStringList{u"e"_qs, u"f"_qs};
    QTest::newRow("phrases stay") << u"walk"_qs << u"(verb)"_qs
                                  << QStringList{u"take the air"_qs, u"walk about (related term)"_qs}
                                  << u"take the air"_qs << u"verb"_qs
                                  << QStringList{u"take the air"_qs, u"walk about"_qs};
    QTest::newRow("unknown mark dropped, own parenthesis kept")
        << u"w"_qs << u"(noun)"_qs
        << QStringList{u"x (derived term)"_qs, u"Bach (composer)"_qs, u""_qs}
        << u"w"_qs << u"noun"_qs << QStringList{u"Bach (composer)"_qs};
}

void TestThesaurus::buildsMeanings()
{
    QFETCH(QString, word);
    QFETCH(QString, pos);
    QFETCH(QStringList, terms);
    const ThesaurusMeaning meaning = ThesaurusData::BuildMeaning(word, pos, terms);
    QTEST(meaning.HeadTerm, "head");
    QTEST(meaning.PartOfSpeech, "partOfSpeech");
    QTEST(meaning.Synonyms, "synonyms");
}

void TestThesaurus::happyHasSeveralMeanings()
{
    const Page page = Fetch(m_service.BaseUrl() + u"/search?q=happy"_qs);
    QCOMPARE(page.Status, 200);
    QCOMPARE(page.Lines.value(0), u"Thesaurus: happy"_qs);
    const QList<QStringList> blocks = Blocks(page.Lines);
    QVERIFY2(blocks.size() >= 3, qPrintable(page.Lines.join(u'\n')));
    QCOMPARE(blocks.first(), (QStringList{u"Main Entry: happy"_qs, u"Part of Speech: adjective"_qs,
                                          u"Definition: happy (adjective)"_qs,
                                          blocks.first().value(3)}));
    QStringList all;
    for (const QStringList &block : blocks)
        all += SynonymsOf(block).split(u", "_qs);
    QVERIFY(all.contains(u"glad"_qs));
    QVERIFY(!all.contains(u"unhappy"_qs));
    QVERIFY(!all.contains(u"happy"_qs));
    QVERIFY(!page.Lines.join(u'\n').contains(u"term)"_qs));
    QVERIFY(!page.Lines.join(u'\n').contains(u"(antonym)"_qs));

    // The lookup sends the word as it stands: capitals and blanks around it do not matter.
    QCOMPARE(Fetch(m_service.BaseUrl() + u"/search?q=%20HAPPY%20"_qs).Lines.mid(1), page.Lines.mid(1));
}

void TestThesaurus::everyBlockHasFourLines_data()
{
    QTest::addColumn<QString>("word");
    for (const char *word : {"happy", "walk", "bank", "run", "good", "fast", "ice cream", "set"})
        QTest::newRow(word) << QString::fromLatin1(word);
}

void TestThesaurus::everyBlockHasFourLines()
{
    QFETCH(QString, word);
    const Page page = Fetch(m_service.BaseUrl() + u"/search?q="_qs
                            + QString::fromLatin1(QUrl::toPercentEncoding(word)));
    QCOMPARE(page.Status, 200);
    // Heading, then blocks of four lines and nothing else.
    QCOMPARE((page.Lines.size() - 1) % 4, 0);
    const QList<QStringList> blocks = Blocks(page.Lines);
    QVERIFY(!blocks.isEmpty());
    QCOMPARE(blocks.size(), (page.Lines.size() - 1) / 4);
    static const QRegularExpression entry(u"^Main Entry: [^:,]+$"_qs);
    static const QRegularExpression pos(u"^Part of Speech: (noun|verb|adjective|adverb)$"_qs);
    static const QRegularExpression definition(u"^Definition: [^:]+ \\((noun|verb|adjective|adverb)\\)$"_qs);
    for (const QStringList &block : blocks) {
        QVERIFY2(entry.match(block.value(0)).hasMatch(), qPrintable(block.value(0)));
        QVERIFY2(pos.match(block.value(1)).hasMatch(), qPrintable(block.value(1)));
        QVERIFY2(definition.match(block.value(2)).hasMatch(), qPrintable(block.value(2)));
        QVERIFY(block.value(3).startsWith(u"Synonyms: "_qs));
        const QStringList synonyms = SynonymsOf(block).split(u", "_qs);
        QSet<QString> seen;
        for (const QString &synonym : synonyms) {
            QVERIFY2(!synonym.isEmpty() && synonym.trimmed() == synonym, qPrintable(block.value(3)));
            QVERIFY(!synonym.contains(u':') && !synonym.contains(u','));
            QVERIFY(synonym.compare(word, Qt::CaseInsensitive) != 0);
            QVERIFY2(!seen.contains(synonym.toLower()), qPrintable(synonym));
            seen.insert(synonym.toLower());
        }
    }
}

void TestThesaurus::blocksParseWithTheLookupParser()
{
    for (const QString &word : {u"happy"_qs, u"walk"_qs, u"bank"_qs, u"run"_qs}) {
        HttpPageSource source;
        source.Navigate(m_service.BaseUrl() + u"/search?q="_qs + word);
        QVERIFY(source.WaitUntilComplete(20000));
        const QString text = source.PageText();
        const QList<QStringList> blocks = Blocks(text.split(u"\r\n"_qs));
        const ParsedPage parsed = ParseThesaurusPage(text, QString());
        QCOMPARE(parsed.Meanings.size(), blocks.size());
        for (qsizetype i = 0; i < blocks.size(); ++i) {
            QCOMPARE(parsed.Meanings[i].EntryWord.trimmed(),
                     blocks[i].value(0).mid(QStringLiteral("Main Entry: ").size()));
            QCOMPARE(parsed.Meanings[i].Synonyms.trimmed(), SynonymsOf(blocks[i]));
        }
        QCOMPARE(parsed.LastSynonyms, SynonymsOf(blocks.last()));
    }
}

void TestThesaurus::lookupThroughTheService_data()
{
    QTest::addColumn<QString>("word");
    QTest::addColumn<QString>("expected");
    QTest::newRow("last meaning") << u"happy"_qs << u"well-chosen, felicitous"_qs;
    QTest::newRow("stem retry") << u"jumped"_qs << u"alternated"_qs;
    QTest::newRow("stem retry, s") << u"jumps"_qs << u"alternates"_qs;
    QTest::newRow("stem retry drops phrases") << u"walked"_qs << QString();
    QTest::newRow("unknown") << u"xyzzyq"_qs << QString();
}

void TestThesaurus::lookupThroughTheService()
{
    QFETCH(QString, word);
    const bool stopped = StopProcessing;
    StopProcessing = false;
    HttpPageSource source;
    LookupContext context;
    context.Host = m_service.BaseUrl();
    context.Manual = true;
    context.Page = &source;
    const QString result = FetchAlternatives(word, QString(), 1, 1, context);
    StopProcessing = stopped;
    QTEST(result, "expected");
}

void TestThesaurus::wordsWithoutEntryGiveNoMeaning_data()
{
    QTest::addColumn<QString>("query");
    QTest::newRow("unknown word") << u"xyzzyq"_qs;
    QTest::newRow("inflected form") << u"walked"_qs;
    QTest::newRow("empty") << QString();
    QTest::newRow("blank") << u"%20"_qs;
    QTest::newRow("10,000 characters") << QString(10000, u'a');
    QTest::newRow("broken percent sign, taken as it stands") << u"ab%zz"_qs;
    QTest::newRow("markup") << u"%3Cb%3EMain%20Entry:%20x%3C/b%3E"_qs;
}

void TestThesaurus::wordsWithoutEntryGiveNoMeaning()
{
    QFETCH(QString, query);
    const Page page = Fetch(m_service.BaseUrl() + u"/search?q="_qs + query);
    QCOMPARE(page.Status, 200);
    QCOMPARE(page.Lines.size(), 2);
    QVERIFY(page.Lines[0].startsWith(u"Thesaurus:"_qs));
    QCOMPARE(page.Lines[1], u"No entry was found."_qs);
}

void TestThesaurus::answersBadRequests_data()
{
    QTest::addColumn<QByteArray>("method");
    QTest::addColumn<QString>("path");
    QTest::addColumn<int>("status");
    QTest::addColumn<QByteArray>("allow");
    QTest::newRow("missing q") << QByteArray("GET") << u"/search"_qs << 200 << QByteArray();
    QTest::newRow("invalid UTF-8") << QByteArray("GET") << u"/search?q=%FFhappy"_qs << 400
                                   << QByteArray();
    QTest::newRow("cut UTF-8") << QByteArray("GET") << u"/search?q=caf%C3"_qs << 400 << QByteArray();
    QTest::newRow("control character") << QByteArray("GET") << u"/search?q=a%0D%0AMain"_qs << 400
                                       << QByteArray();
    QTest::newRow("NUL") << QByteArray("GET") << u"/search?q=a%00"_qs << 400 << QByteArray();
    QTest::newRow("unknown path") << QByteArray("GET") << u"/find?q=happy"_qs << 404 << QByteArray();
    QTest::newRow("root") << QByteArray("GET") << u"/"_qs << 404 << QByteArray();
    QTest::newRow("trailing slash") << QByteArray("GET") << u"/search/?q=happy"_qs << 404
                                    << QByteArray();
    QTest::newRow("POST") << QByteArray("POST") << u"/search?q=happy"_qs << 405
                          << QByteArray("GET, HEAD");
    QTest::newRow("DELETE") << QByteArray("DELETE") << u"/search?q=happy"_qs << 405
                            << QByteArray("GET, HEAD");
    QTest::newRow("unknown method") << QByteArray("BREW") << u"/search?q=happy"_qs << 405
                                    << QByteArray("GET, HEAD");
    QTest::newRow("HEAD") << QByteArray("HEAD") << u"/search?q=happy"_qs << 200 << QByteArray();
}

void TestThesaurus::answersBadRequests()
{
    QFETCH(QByteArray, method);
    QFETCH(QString, path);
    QFETCH(int, status);
    const RawReply reply = Send(method, m_service.BaseUrl() + path);
    QCOMPARE(reply.Status, status);
    QTEST(reply.Allow, "allow");
    if (method == "HEAD") {
        QVERIFY(reply.Body.isEmpty());
        return;
    }
    QVERIFY(reply.Body.startsWith("<!DOCTYPE html>"));
    QVERIFY(!HtmlInnerText(reply.Body).contains(u"Main Entry:"_qs));
    // The service still answers afterwards.
    QCOMPARE(Blocks(Fetch(m_service.BaseUrl() + u"/search?q=glad"_qs).Lines).size(), 5);
}

void TestThesaurus::answersSeveralClientsAtOnce()
{
    // A client that stalls in the middle of its request holds no one up.
    QTcpSocket stalled;
    stalled.connectToHost(QHostAddress::LocalHost, m_service.Port());
    QVERIFY(stalled.waitForConnected(5000));
    stalled.write("GET /search?q=ha");
    QVERIFY(stalled.waitForBytesWritten(5000));

    const QStringList words{u"happy"_qs, u"sad"_qs, u"big"_qs, u"small"_qs, u"quick"_qs,
                            u"slow"_qs, u"house"_qs, u"car"_qs, u"run"_qs, u"walk"_qs};
    std::vector<std::unique_ptr<QNetworkAccessManager>> clients;
    QList<QNetworkReply *> replies;
    for (int client = 0; client < 5; ++client) {
        clients.push_back(std::make_unique<QNetworkAccessManager>());
        for (const QString &word : words) {
            replies.append(clients.back()->get(
                QNetworkRequest(QUrl(m_service.BaseUrl() + u"/search?q="_qs + word))));
        }
    }
    const auto allFinished = [&replies] {
        return std::all_of(replies.begin(), replies.end(),
                           [](QNetworkReply *reply) { return reply->isFinished(); });
    };
    QTRY_VERIFY_WITH_TIMEOUT(allFinished(), 20000);
    for (qsizetype i = 0; i < replies.size(); ++i) {
        QNetworkReply *reply = replies[i];
        QCOMPARE(reply->attribute(QNetworkRequest::HttpStatusCodeAttribute).toInt(), 200);
        const QString text = HtmlInnerText(reply->readAll());
        QVERIFY(text.startsWith(u"Thesaurus: "_qs + words[i % words.size()] + u"\r\nMain Entry: "_qs));
    }
    qDeleteAll(replies);

    stalled.write("ppy HTTP/1.1\r\nHost: 127.0.0.1\r\n\r\n");
    QTRY_VERIFY_WITH_TIMEOUT(stalled.bytesAvailable() > 0 && stalled.peek(20).startsWith("HTTP/1.1 200"),
                             10000);
}

void TestThesaurus::refusesMissingDataAndBusyPort()
{
    ThesaurusService missing;
    QVERIFY(!missing.Start(u"/nonexistent/th_en_US_v2"_qs));
    QVERIFY(missing.ErrorString().contains(u"/nonexistent/th_en_US_v2.idx"_qs));
    QVERIFY(!missing.IsListening());
    QCOMPARE(missing.BaseUrl(), QString());

    ThesaurusService busy;
    QVERIFY(!busy.Start(kData, m_service.Port()));
    QVERIFY2(busy.ErrorString().contains(u"127.0.0.1:%1"_qs.arg(m_service.Port())),
             qPrintable(busy.ErrorString()));
    QVERIFY(!busy.IsListening());

    QVERIFY(!m_service.Start(kData));
    QVERIFY(m_service.ErrorString().contains(u"already running"_qs));
}

void TestThesaurus::readsThesaurusUrl_data()
{
    QTest::addColumn<QByteArray>("ini"); // "-" for no file
    QTest::addColumn<QString>("expected");
    QTest::newRow("no file") << QByteArray("-") << QString();
    QTest::newRow("no key") << QByteArray("[URL]\r\nBANNER_URL=http://b/\r\n") << QString();
    QTest::newRow("empty value") << QByteArray("[URL]\r\nThesaurusUrl=\r\n") << QString();
    QTest::newRow("address") << QByteArray("[URL]\r\nThesaurusUrl=http://127.0.0.1:8080\r\n")
                             << u"http://127.0.0.1:8080"_qs;
    QTest::newRow("trailing slashes and blanks")
        << QByteArray("[url]\r\n thesaurusurl = http://thesaurus.example.org/th// \r\n")
        << u"http://thesaurus.example.org/th"_qs;
    QTest::newRow("other section") << QByteArray("[COMPANY]\r\nThesaurusUrl=http://x\r\n")
                                   << QString();
}

void TestThesaurus::readsThesaurusUrl()
{
    QFETCH(QByteArray, ini);
    QTemporaryDir dir;
    const QString path = dir.filePath(u"SETTINGS.INI"_qs);
    if (ini != "-") {
        QFile file(path);
        QVERIFY(file.open(QIODevice::WriteOnly));
        file.write(ini);
    }
    QTEST(ConfiguredThesaurusUrl(path), "expected");
}

void TestThesaurus::startsEmbeddedServiceOrUsesAddress()
{
    QTemporaryDir dir;
    const QString ini = dir.filePath(u"SETTINGS.INI"_qs);
    QObject owner;

    const ThesaurusHost embedded = StartThesaurusHost(ini, &owner, kData);
    QVERIFY2(embedded.Message.isEmpty(), qPrintable(embedded.Message));
    QVERIFY(embedded.Service);
    QCOMPARE(embedded.Service->parent(), &owner);
    QCOMPARE(embedded.Url, embedded.Service->BaseUrl());
    QVERIFY(Blocks(Fetch(embedded.Url + u"/search?q=happy"_qs).Lines).size() >= 3);

    QFile file(ini);
    QVERIFY(file.open(QIODevice::WriteOnly));
    file.write("[URL]\r\nThesaurusUrl=" + m_service.BaseUrl().toLatin1() + "/\r\n");
    file.close();
    const int services = owner.findChildren<ThesaurusService *>().size();
    const ThesaurusHost configured = StartThesaurusHost(ini, &owner, kData);
    QCOMPARE(configured.Url, m_service.BaseUrl());
    QVERIFY(!configured.Service);
    QVERIFY(configured.Message.isEmpty());
    QCOMPARE(owner.findChildren<ThesaurusService *>().size(), services);

    QVERIFY(file.open(QIODevice::WriteOnly));
    file.write("[URL]\r\nThesaurusUrl=localhost:8080\r\n");
    file.close();
    const ThesaurusHost bad = StartThesaurusHost(ini, &owner, kData);
    QCOMPARE(bad.Url, u"localhost:8080"_qs);
    QVERIFY(bad.Message.contains(u"ThesaurusUrl"_qs));
    QVERIFY(!bad.Service);
}

void TestThesaurus::missingDataGivesMessageAndEmptyPages()
{
    QTemporaryDir dir;
    QObject owner;
    const ThesaurusHost host = StartThesaurusHost(dir.filePath(u"SETTINGS.INI"_qs), &owner,
                                                  dir.filePath(u"missing"_qs));
    QVERIFY(host.Message.contains(dir.filePath(u"missing.idx"_qs)));
    QVERIFY(host.Message.contains(u"mythes-en-us"_qs));
    QVERIFY(host.Service);
    QVERIFY(!host.Service->HasData());
    const Page page = Fetch(host.Url + u"/search?q=happy"_qs);
    QCOMPARE(page.Status, 200);
    QCOMPARE(page.Lines, (QStringList{u"Thesaurus: happy"_qs, u"No entry was found."_qs}));
}

void TestThesaurus::pageSourceFollowsServerAnswers()
{
    QHttpServer server;
    server.route(u"/plain"_qs, [] {
        return QHttpServerResponse("text/plain; charset=utf-8", "caf\xc3\xa9\r\nsecond line\n");
    });
    server.route(u"/latin"_qs, [] {
        return QHttpServerResponse("text/html", "<div>caf\xe9</div><div>two</div>");
    });
    server.route(u"/moved"_qs, [](const QHttpServerRequest &, QHttpServerResponder &&responder) {
        responder.write({{"Location", "/latin"}}, QHttpServerResponder::StatusCode::Found);
    });
    server.setMissingHandler([](const QHttpServerRequest &, QHttpServerResponder &&responder) {
        responder.write("<h1>Gone</h1><p>Nothing here</p>", "text/html",
                        QHttpServerResponder::StatusCode::NotFound);
    });
    const quint16 port = server.listen(QHostAddress::LocalHost);
    QVERIFY(port != 0);
    const QString base = u"http://127.0.0.1:%1"_qs.arg(port);

    const struct { QString Path; int Status; QString Text; } cases[] = {
        {u"/plain"_qs, 200, u"caf\u00e9\r\nsecond line"_qs},
        {u"/latin"_qs, 200, u"caf\u00e9\r\ntwo"_qs},
        {u"/moved"_qs, 200, u"caf\u00e9\r\ntwo"_qs},
        {u"/missing"_qs, 404, u"Gone\r\n\r\nNothing here"_qs},
    };
    HttpPageSource source;
    for (const auto &c : cases) {
        source.Navigate(base + c.Path);
        QVERIFY(source.WaitUntilComplete(20000));
        QCOMPARE(source.HttpStatus(), c.Status);
        QCOMPARE(source.PageText(), c.Text);
    }

    // Nothing listens there: the page completes without text, as a browser's error page has no
    // thesaurus lines.
    QTcpServer closed;
    QVERIFY(closed.listen(QHostAddress::LocalHost));
    const quint16 closedPort = closed.serverPort();
    closed.close();
    for (const QString &url : {u"http://127.0.0.1:%1/search?q=x"_qs.arg(closedPort),
                               u"not a url"_qs, u"ftp://127.0.0.1/x"_qs, QString()}) {
        source.Navigate(url);
        QVERIFY(source.WaitUntilComplete(20000));
        QCOMPARE(source.PageText(), QString());
    }
}

void TestThesaurus::pageSourceTimesOutAndStops()
{
    QTcpServer silent; // accepts and never answers
    QVERIFY(silent.listen(QHostAddress::LocalHost));
    HttpPageSource source;
    source.Navigate(u"http://127.0.0.1:%1/search?q=happy"_qs.arg(silent.serverPort()));
    QVERIFY(!source.IsComplete());
    QVERIFY(!source.WaitUntilComplete(300));
    QVERIFY(!source.IsComplete());
    source.Stop();
    QVERIFY(source.IsComplete());
    QCOMPARE(source.PageText(), QString());

    // A new navigation after a timeout starts cleanly.
    source.Navigate(m_service.BaseUrl() + u"/search?q=glad"_qs);
    QVERIFY(source.WaitUntilComplete(20000));
    QVERIFY(source.PageText().startsWith(u"Thesaurus: glad\r\nMain Entry: glad\r\n"_qs));
}

void TestThesaurus::standaloneProgram_data()
{
    QTest::addColumn<int>("signal");
    QTest::newRow("SIGTERM") << int(SIGTERM);
    QTest::newRow("SIGINT") << int(SIGINT);
}

void TestThesaurus::standaloneProgram()
{
    QFETCH(int, signal);
    QProcess process;
    process.start(QStringLiteral(VERBLOOM_THESAURUS_PROGRAM), {u"--data"_qs, kData});
    QVERIFY(process.waitForStarted());
    QTRY_VERIFY_WITH_TIMEOUT(process.canReadLine(), 20000);
    const QString url = QString::fromUtf8(process.readLine()).trimmed();
    static const QRegularExpression address(u"^http://127\\.0\\.0\\.1:[0-9]+$"_qs);
    QVERIFY2(address.match(url).hasMatch(), qPrintable(url));
    QVERIFY(Blocks(Fetch(url + u"/search?q=happy"_qs).Lines).size() >= 3);

    ::kill(pid_t(process.processId()), signal);
    QVERIFY(process.waitForFinished(20000));
    QCOMPARE(process.exitStatus(), QProcess::NormalExit);
    QCOMPARE(process.exitCode(), 0);
    QCOMPARE(Fetch(url + u"/search?q=happy"_qs).Status, 0);
}

void TestThesaurus::standaloneProgramRefusesBadStart_data()
{
    QTest::addColumn<QStringList>("arguments");
    QTest::addColumn<int>("exitCode");
    QTest::addColumn<QString>("message");
    QTest::newRow("missing data") << QStringList{u"--data"_qs, u"/nonexistent/th"_qs} << 1
                                  << u"/nonexistent/th.idx"_qs;
    QTest::newRow("busy port") << QStringList{u"--port"_qs, u"BUSY"_qs} << 1 << u"127.0.0.1:"_qs;
    QTest::newRow("bad port") << QStringList{u"--port"_qs, u"70000"_qs} << 2 << u"70000"_qs;
    QTest::newRow("stray argument") << QStringList{u"happy"_qs} << 2 << u"happy"_qs;
}

void TestThesaurus::standaloneProgramRefusesBadStart()
{
    QFETCH(QStringList, arguments);
    arguments.replaceInStrings(u"BUSY"_qs, QString::number(m_service.Port()));
    QProcess process;
    process.start(QStringLiteral(VERBLOOM_THESAURUS_PROGRAM), arguments);
    QVERIFY(process.waitForFinished(20000));
    QCOMPARE(process.exitStatus(), QProcess::NormalExit);
    QTEST(process.exitCode(), "exitCode");
    QFETCH(QString, message);
    const QString errors = QString::fromUtf8(process.readAllStandardError());
    QVERIFY2(errors.contains(message), qPrintable(errors));
    QVERIFY(process.readAllStandardOutput().isEmpty());
}

QTEST_GUILESS_MAIN(TestThesaurus)
#include "tst_thesaurus.moc"
