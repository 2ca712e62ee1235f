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
    QString Text;
    QStringList Lines() const { return Text.split(u"\r\n"_qs); }
};

/// The page as the lookup reads it: fetched over HTTP and rendered to CR LF lines.
Page Fetch(const QString &url)
{
    HttpPageSource source;
    source.Navigate(url);
    if (!source.WaitUntilComplete(20000))
        return {};
    return {source.HttpStatus(), source.PageText()};
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
    QNetworkReply *reply = method == "HEAD" ? network.head(request) : network.sendCustomRequest(request, method);
    QSignalSpy finished(reply, &QNetworkReply::finished);
    if (!finished.wait(20000))
        return {};
    RawReply result{reply->attribute(QNetworkRequest::HttpStatusCodeAttribute).toInt(), reply->readAll(),
                    reply->rawHeader("Allow")};
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
    void survivesHostileMarkup();
    void buildsMeanings_data();
    void buildsMeanings();

    void happyHasSeveralMeanings();
    void pagesHoldBlocksTheParserReads_data();
    void pagesHoldBlocksTheParserReads();
    void lookupThroughTheService_data();
    void lookupThroughTheService();
    void answersWithoutMeaning_data();
    void answersWithoutMeaning();
    void answersSeveralClientsAtOnce();
    void refusesMissingDataAndBusyPort();

    void settingsChooseTheHost_data();
    void settingsChooseTheHost();
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
    QVERIFY2(QFile::exists(kData + u".idx"_qs), "The thesaurus data of the package mythes-en-us is needed for these tests");
    QVERIFY2(m_service.Start(kData), qPrintable(m_service.ErrorString()));
    QVERIFY(m_service.Port() != 0);
    QCOMPARE(m_service.BaseUrl(), u"http://127.0.0.1:%1"_qs.arg(m_service.Port()));
}

// Expected texts are what Qt WebEngine gives as document.documentElement.innerText, "\n" for CR LF.
void TestThesaurus::rendersLikeABrowser_data()
{
    QTest::addColumn<QByteArray>("html");
    QTest::addColumn<QByteArray>("charset"); // the server's
    QTest::addColumn<QString>("expected");
    const auto row = [](const char *name, const QByteArray &html, const QString &expected) {
        QTest::newRow(name) << html << QByteArray() << expected;
    };
    row("nested blocks", "<div><div>a</div>  <div><div>b</div></div>c</div>", u"a\nb\nc"_qs);
    row("empty blocks", "<div></div><div>a</div><div></div><div></div><div>b</div>", u"a\nb"_qs);
    row("paragraph in div", "<div>x<p>y</p>z</div>", u"x\n\ny\n\nz"_qs);
    row("br", "a <br> b<br><br>c", u"a\nb\n\nc"_qs);
    row("br ends block", "<div>a<br></div><div>b</div>", u"a\n\nb"_qs);
    row("leading br", "<br>text", u"\ntext"_qs);
    row("blanks", "  a   b \r\n\t c  <span> d </span> e ", u"a b c d e"_qs);
    row("blanks at block edges", "<div>  a  </div>  <div>  b  </div>", u"a\nb"_qs);
    row("script and style", "<div>a</div><script>var x='<div>no</div>';</script><style>div{color:red}</style><div>b</div>",
        u"a\nb"_qs);
    row("entities", "<div>&amp; &lt;tag&gt; &quot;q&quot; &eacute; &#233; &#x41; &nbsp;x&nbsp;&nbsp;y &unknown;</div>",
        u"& <tag> \"q\" \u00e9 \u00e9 A \u00a0x\u00a0\u00a0y &unknown;"_qs);
    row("nbsp around br", "a&nbsp;<br>&nbsp;b", u"a\u00a0\n\u00a0b"_qs);
    row("head and title", "<html><head><title>T</title></head><body><div>body</div></body></html>", u"body"_qs);
    row("hidden", "<div hidden>no</div><div style='display: none'>no2</div><div STYLE='DISPLAY:NONE'>no3</div>"
                  "<div>yes</div><noscript>ns</noscript><template>tp</template>",
        u"yes"_qs);
    row("table sections", "<table><thead><tr><th>h1</th><th>h2</th></tr></thead><tbody><tr><td>a</td><td> b </td>"
                          "</tr></tbody></table>after",
        u"h1\th2\na\tb\nafter"_qs);
    row("table blanks", "<table>\n <tr>\n  <td> a </td>\n  <td> b </td>\n </tr>\n <tr><td>c</td></tr>\n</table>",
        u"a\tb\nc"_qs);
    row("blocks in cell", "<table><tr><td><div>a</div><div>b</div></td><td>c</td></tr></table>", u"a\nb\n\tc"_qs);
    row("lists", "<ul><li>a<ul><li>b</li></ul></li><li>c <b>bold</b></li></ul>x", u"a\nb\nc bold\nx"_qs);
    row("pre", "<pre>\n  keep   this\n  and this</pre>after", u"  keep   this\n  and this\nafter"_qs);
    row("pre with CR LF", "<pre>a\r\nb\r\n</pre>c", u"a\nb\n\nc"_qs);
    row("form controls", "<div>a<input value=v><select><option>o1</option><option>o2</option></select>"
                         "<textarea>ta</textarea><button>btn</button>b</div>",
        u"a\no1\no2\nbtnb"_qs);
    row("closed details and dialog", "<details><summary>s</summary>d</details><dialog>dlg</dialog>x", u"s\nx"_qs);
    row("headings and rule", "<h1>Title</h1><div>x</div><h2>Sub</h2>a<hr>b", u"Title\nx\nSub\na\nb"_qs);
    row("unclosed tags", "<div>a<p>b<div>c", u"a\n\nb\n\nc"_qs);
    row("comments and images", "a<!-- <div>c</div> -->b<img alt='pic'>c", u"abc"_qs);
    row("empty", QByteArray(), QString());
    // Decoding: the server's charset, else a declared one, else UTF-8 or Windows-1252.
    row("utf-8", "<p>caf\xc3\xa9</p>", u"caf\u00e9"_qs);
    row("undeclared windows-1252", "<p>caf\xe9 \x93q\x94</p>", u"caf\u00e9 \u201cq\u201d"_qs);
    row("meta charset", "<html><head><meta charset=\"windows-1251\"></head><body>\xcf\xf0\xe8</body>",
        u"\u041f\u0440\u0438"_qs);
    row("utf-16 with bom", QByteArray("\xff\xfe<\0p\0>\0h\0i\0<\0/\0p\0>\0", 20), u"hi"_qs);
    row("NUL byte", QByteArray("<div>a\0b</div>", 14), u"a\ufffdb"_qs);
    QTest::newRow("server charset wins") << QByteArray("<html><head><meta charset=\"utf-8\"></head><body>caf\xe9</body>")
                                         << QByteArray("ISO-8859-15") << u"caf\u00e9"_qs;
    QTest::newRow("latin-1 label means windows-1252") << QByteArray("<p>\x93q\x94</p>") << QByteArray("iso-8859-1")
                                                      << u"\u201cq\u201d"_qs;
    QTest::newRow("unknown charset") << QByteArray("<p>ok</p>") << QByteArray("no-such-charset") << u"ok"_qs;
}

void TestThesaurus::rendersLikeABrowser()
{
    QFETCH(QByteArray, html);
    QFETCH(QByteArray, charset);
    QFETCH(QString, expected);
    QCOMPARE(HtmlInnerText(html, charset), expected.replace(u"\n"_qs, u"\r\n"_qs));
}

void TestThesaurus::survivesHostileMarkup()
{
    const int depth = 200000;
    const QByteArray nested = "<p>before</p>" + QByteArray("<div>").repeated(depth) + "x"
        + QByteArray("</div>").repeated(depth) + "<p>after</p>";
    QCOMPARE(HtmlInnerText(nested), u"before\r\n\r\nx\r\n\r\nafter"_qs);
    QVERIFY(!HtmlInnerText("<div <p></ta<<ble><td>&#xffffffff;&#0;<!--<script>").contains(u"script"_qs));
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
                           << u"happy"_qs << u"adjective"_qs << QStringList{u"blessed"_qs, u"glad"_qs};
    QTest::newRow("head is the first plain term")
        << u"happy"_qs << u"(adj)"_qs << QStringList{u"felicitous"_qs, u"fortunate (similar term)"_qs}
        << u"felicitous"_qs << u"adjective"_qs << QStringList{u"felicitous"_qs, u"fortunate"_qs};
    QTest::newRow("word itself and repeats")
        << u"bank"_qs << u"(noun)"_qs
        << QStringList{u"Bank"_qs, u"depository"_qs, u"Depository (similar term)"_qs, u"bank"_qs}
        << u"Bank"_qs << u"noun"_qs << QStringList{u"depository"_qs};
    QTest::newRow("colon and comma") << u"x"_qs << u"(adv)"_qs << QStringList{u"a: b"_qs, u"c, d"_qs, u"e"_qs, u" f "_qs}
                                     << u"x"_qs << u"adverb"_qs << QStringList{u"e"_qs, u"f"_qs};
    QTest::newRow("verb, unknown mark dropped, own parenthesis kept")
        << u"w"_qs << u"(verb)"_qs << QStringList{u"x (derived term)"_qs, u"Bach (composer)"_qs, u""_qs}
        << u"w"_qs << u"verb"_qs << QStringList{u"Bach (composer)"_qs};
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
    QCOMPARE(page.Lines().value(0), u"Thesaurus: happy"_qs);
    const QList<QStringList> blocks = Blocks(page.Lines());
    QVERIFY2(blocks.size() >= 3, qPrintable(page.Text));
    QCOMPARE(blocks.first(), (QStringList{u"Main Entry: happy"_qs, u"Part of Speech: adjective"_qs,
                                          u"Definition: happy (adjective)"_qs, blocks.first().value(3)}));
    QStringList all;
    for (const QStringList &block : blocks)
        all += SynonymsOf(block).split(u", "_qs);
    QVERIFY(all.contains(u"glad"_qs));
    QVERIFY(!all.contains(u"unhappy"_qs));
    QVERIFY(!all.contains(u"happy"_qs));
    QVERIFY(!page.Text.contains(u"term)"_qs));
    QVERIFY(!page.Text.contains(u"(antonym)"_qs));

    // The lookup sends the word as it stands: capitals and blanks around it do not matter.
    QCOMPARE(Fetch(m_service.BaseUrl() + u"/search?q=%20HAPPY%20"_qs).Lines().mid(1), page.Lines().mid(1));
}

void TestThesaurus::pagesHoldBlocksTheParserReads_data()
{
    QTest::addColumn<QString>("word");
    for (const char *word : {"happy", "walk", "bank", "set", "ice cream"})
        QTest::newRow(word) << QString::fromLatin1(word);
}

void TestThesaurus::pagesHoldBlocksTheParserReads()
{
    QFETCH(QString, word);
    const Page page = Fetch(m_service.BaseUrl() + u"/search?q="_qs + QString::fromLatin1(QUrl::toPercentEncoding(word)));
    QCOMPARE(page.Status, 200);
    // Heading, then blocks of four lines and nothing else.
    const QStringList lines = page.Lines();
    const QList<QStringList> blocks = Blocks(lines);
    QVERIFY(!blocks.isEmpty());
    QCOMPARE(lines.size(), 1 + 4 * blocks.size());
    static const QRegularExpression entry(u"^Main Entry: [^:,]+$"_qs);
    static const QRegularExpression pos(u"^Part of Speech: (noun|verb|adjective|adverb)$"_qs);
    static const QRegularExpression definition(u"^Definition: [^:]+ \\((noun|verb|adjective|adverb)\\)$"_qs);
    for (const QStringList &block : blocks) {
        QVERIFY2(entry.match(block.value(0)).hasMatch(), qPrintable(block.value(0)));
        QVERIFY2(pos.match(block.value(1)).hasMatch(), qPrintable(block.value(1)));
        QVERIFY2(definition.match(block.value(2)).hasMatch(), qPrintable(block.value(2)));
        QVERIFY(block.value(3).startsWith(u"Synonyms: "_qs));
        QSet<QString> seen;
        for (const QString &synonym : SynonymsOf(block).split(u", "_qs)) {
            QVERIFY2(!synonym.isEmpty() && synonym.trimmed() == synonym, qPrintable(block.value(3)));
            QVERIFY(!synonym.contains(u':') && !synonym.contains(u','));
            QVERIFY(synonym.compare(word, Qt::CaseInsensitive) != 0);
            QVERIFY2(!seen.contains(synonym.toLower()), qPrintable(synonym));
            seen.insert(synonym.toLower());
        }
    }

    // The lookup's own parser reads the same meanings.
    const ParsedPage parsed = ParseThesaurusPage(page.Text, QString());
    QCOMPARE(parsed.Meanings.size(), blocks.size());
    for (qsizetype i = 0; i < blocks.size(); ++i) {
        QCOMPARE(parsed.Meanings[i].EntryWord.trimmed(), blocks[i].value(0).mid(QStringLiteral("Main Entry: ").size()));
        QCOMPARE(parsed.Meanings[i].Synonyms.trimmed(), SynonymsOf(blocks[i]));
    }
    QCOMPARE(parsed.LastSynonyms, SynonymsOf(blocks.last()));
}

void TestThesaurus::lookupThroughTheService_data()
{
    QTest::addColumn<QString>("word");
    QTest::addColumn<QString>("expected");
    QTest::newRow("last meaning") << u"happy"_qs << u"well-chosen, felicitous"_qs;
    QTest::newRow("stem retry") << u"jumped"_qs << u"alternated"_qs;
    QTest::newRow("stem retry drops phrases") << u"walked"_qs << QString();
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

void TestThesaurus::answersWithoutMeaning_data()
{
    QTest::addColumn<QByteArray>("method");
    QTest::addColumn<QString>("path");
    QTest::addColumn<int>("status");
    QTest::addColumn<QByteArray>("allow");
    const auto get = [](const char *name, const QString &path, int status) {
        QTest::newRow(name) << QByteArray("GET") << path << status << QByteArray();
    };
    // A page without any meaning, so the lookup's stem retry applies.
    get("unknown word", u"/search?q=xyzzyq"_qs, 200);
    get("inflected form", u"/search?q=walked"_qs, 200);
    get("empty q", u"/search?q="_qs, 200);
    get("missing q", u"/search"_qs, 200);
    get("10,000 characters", u"/search?q="_qs + QString(10000, u'a'), 200);
    get("broken percent sign, taken as it stands", u"/search?q=ab%zz"_qs, 200);
    get("markup", u"/search?q=%3Cb%3EMain%20Entry:%20x%3C/b%3E"_qs, 200);
    // Bad requests.
    get("invalid UTF-8", u"/search?q=%FFhappy"_qs, 400);
    get("cut UTF-8", u"/search?q=caf%C3"_qs, 400);
    get("control character", u"/search?q=a%0D%0AMain"_qs, 400);
    get("NUL", u"/search?q=a%00"_qs, 400);
    get("unknown path", u"/find?q=happy"_qs, 404);
    get("trailing slash", u"/search/?q=happy"_qs, 404);
    QTest::newRow("POST") << QByteArray("POST") << u"/search?q=happy"_qs << 405 << QByteArray("GET, HEAD");
    QTest::newRow("unknown method") << QByteArray("BREW") << u"/search?q=happy"_qs << 405 << QByteArray("GET, HEAD");
    QTest::newRow("HEAD") << QByteArray("HEAD") << u"/search?q=happy"_qs << 200 << QByteArray();
}

void TestThesaurus::answersWithoutMeaning()
{
    QFETCH(QByteArray, method);
    QFETCH(QString, path);
    QFETCH(int, status);
    const RawReply reply = Send(method, m_service.BaseUrl() + path);
    QCOMPARE(reply.Status, status);
    QTEST(reply.Allow, "allow");
    QCOMPARE(reply.Body.isEmpty(), method == "HEAD");
    if (method == "HEAD")
        return;
    QVERIFY(reply.Body.startsWith("<!DOCTYPE html>"));
    const QStringList lines = HtmlInnerText(reply.Body).split(u"\r\n"_qs);
    QVERIFY(Blocks(lines).isEmpty());
    if (status == 200) {
        QCOMPARE(lines.size(), 2);
        QVERIFY(lines[0].startsWith(u"Thesaurus:"_qs));
        QCOMPARE(lines[1], u"No entry was found."_qs);
    }
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
        for (const QString &word : words)
            replies.append(clients.back()->get(QNetworkRequest(QUrl(m_service.BaseUrl() + u"/search?q="_qs + word))));
    }
    QTRY_VERIFY_WITH_TIMEOUT(std::all_of(replies.begin(), replies.end(), [](QNetworkReply *r) { return r->isFinished(); }),
                             20000);
    for (qsizetype i = 0; i < replies.size(); ++i) {
        QCOMPARE(replies[i]->attribute(QNetworkRequest::HttpStatusCodeAttribute).toInt(), 200);
        const QString text = HtmlInnerText(replies[i]->readAll());
        QVERIFY(text.startsWith(u"Thesaurus: "_qs + words[i % words.size()] + u"\r\nMain Entry: "_qs));
    }
    qDeleteAll(replies);

    stalled.write("ppy HTTP/1.1\r\nHost: 127.0.0.1\r\n\r\n");
    QTRY_VERIFY_WITH_TIMEOUT(stalled.bytesAvailable() > 0 && stalled.peek(20).startsWith("HTTP/1.1 200"), 10000);
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
    QVERIFY2(busy.ErrorString().contains(u"127.0.0.1:%1"_qs.arg(m_service.Port())), qPrintable(busy.ErrorString()));
    QVERIFY(!busy.IsListening());

    QVERIFY(!m_service.Start(kData));
    QVERIFY(m_service.ErrorString().contains(u"already running"_qs));
}

void TestThesaurus::settingsChooseTheHost_data()
{
    QTest::addColumn<QByteArray>("ini");        // "-" for no file; SERVICE: this test's service
    QTest::addColumn<QString>("configured");
    QTest::addColumn<bool>("embedded");         // the embedded service is started
    QTest::addColumn<bool>("message");
    QTest::newRow("no file") << QByteArray("-") << QString() << true << false;
    QTest::newRow("empty value") << QByteArray("[URL]\r\nThesaurusUrl=\r\n") << QString() << true << false;
    QTest::newRow("other section") << QByteArray("[COMPANY]\r\nThesaurusUrl=http://x\r\n") << QString() << true << false;
    QTest::newRow("address") << QByteArray("[URL]\r\nThesaurusUrl=SERVICE/\r\n") << u"SERVICE"_qs << false << false;
    QTest::newRow("trailing slashes and blanks")
        << QByteArray("[url]\r\n thesaurusurl = http://thesaurus.example.org/th// \r\n")
        << u"http://thesaurus.example.org/th"_qs << false << false;
    QTest::newRow("not an address") << QByteArray("[URL]\r\nThesaurusUrl=localhost:8080\r\n") << u"localhost:8080"_qs
                                    << false << true;
}

void TestThesaurus::settingsChooseTheHost()
{
    QFETCH(QByteArray, ini);
    QFETCH(QString, configured);
    QFETCH(bool, embedded);
    QFETCH(bool, message);
    QTemporaryDir dir;
    const QString path = dir.filePath(u"SETTINGS.INI"_qs);
    QFile file(path);
    if (ini != "-")
        QVERIFY(file.open(QIODevice::WriteOnly) && file.write(ini.replace("SERVICE", m_service.BaseUrl().toLatin1())));
    file.close();
    configured.replace(u"SERVICE"_qs, m_service.BaseUrl());
    QCOMPARE(ConfiguredThesaurusUrl(path), configured);

    QObject owner;
    const ThesaurusHost host = StartThesaurusHost(path, &owner, kData);
    QCOMPARE(owner.findChildren<ThesaurusService *>().size(), embedded ? 1 : 0);
    QCOMPARE(host.Service, owner.findChild<ThesaurusService *>());
    QVERIFY2(message ? host.Message.contains(u"ThesaurusUrl"_qs) : host.Message.isEmpty(), qPrintable(host.Message));
    QCOMPARE(host.Url, embedded ? host.Service->BaseUrl() : configured);
    if (embedded)
        QVERIFY(Blocks(Fetch(host.Url + u"/search?q=happy"_qs).Lines()).size() >= 3);
}

void TestThesaurus::missingDataGivesMessageAndEmptyPages()
{
    QTemporaryDir dir;
    QObject owner;
    const ThesaurusHost host = StartThesaurusHost(dir.filePath(u"SETTINGS.INI"_qs), &owner, dir.filePath(u"missing"_qs));
    QVERIFY(host.Message.contains(dir.filePath(u"missing.idx"_qs)));
    QVERIFY(host.Message.contains(u"mythes-en-us"_qs));
    QVERIFY(host.Service);
    QVERIFY(!host.Service->HasData());
    const Page page = Fetch(host.Url + u"/search?q=happy"_qs);
    QCOMPARE(page.Status, 200);
    QCOMPARE(page.Text, u"Thesaurus: happy\r\nNo entry was found."_qs);
}

void TestThesaurus::pageSourceFollowsServerAnswers()
{
    QHttpServer server;
    server.route(u"/plain"_qs, [] { return QHttpServerResponse("text/plain; charset=utf-8", "caf\xc3\xa9\r\nsecond line\n"); });
    server.route(u"/latin"_qs, [] { return QHttpServerResponse("text/html", "<div>caf\xe9</div><div>two</div>"); });
    server.route(u"/moved"_qs, [](const QHttpServerRequest &, QHttpServerResponder &&responder) {
        responder.write({{"Location", "/latin"}}, QHttpServerResponder::StatusCode::Found);
    });
    server.setMissingHandler([](const QHttpServerRequest &, QHttpServerResponder &&responder) {
        responder.write("<h1>Gone</h1><p>Nothing here</p>", "text/html", QHttpServerResponder::StatusCode::NotFound);
    });
    const quint16 port = server.listen(QHostAddress::LocalHost);
    QVERIFY(port != 0);
    const QString base = u"http://127.0.0.1:%1"_qs.arg(port);
    QCOMPARE(Fetch(base + u"/plain"_qs).Text, u"caf\u00e9\r\nsecond line"_qs);
    QCOMPARE(Fetch(base + u"/latin"_qs).Text, u"caf\u00e9\r\ntwo"_qs);
    const Page moved = Fetch(base + u"/moved"_qs);
    QCOMPARE(moved.Status, 200);
    QCOMPARE(moved.Text, u"caf\u00e9\r\ntwo"_qs);
    const Page missing = Fetch(base + u"/missing"_qs);
    QCOMPARE(missing.Status, 404);
    QCOMPARE(missing.Text, u"Gone\r\n\r\nNothing here"_qs);

    // Nothing listens there: the page completes without text, as a browser's error page has no
    // thesaurus lines.
    QTcpServer closed;
    QVERIFY(closed.listen(QHostAddress::LocalHost));
    const quint16 closedPort = closed.serverPort();
    closed.close();
    HttpPageSource source;
    for (const QString &url : {u"http://127.0.0.1:%1/search?q=x"_qs.arg(closedPort), u"not a url"_qs,
                               u"ftp://127.0.0.1/x"_qs, QString()}) {
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
    QVERIFY2(QRegularExpression(u"^http://127\\.0\\.0\\.1:[0-9]+$"_qs).match(url).hasMatch(), qPrintable(url));
    QVERIFY(Blocks(Fetch(url + u"/search?q=happy"_qs).Lines()).size() >= 3);

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
    QTest::newRow("missing data") << QStringList{u"--data"_qs, u"/nonexistent/th"_qs} << 1 << u"/nonexistent/th.idx"_qs;
    QTest::newRow("busy port") << QStringList{u"--port"_qs, u"BUSY"_qs} << 1 << u"127.0.0.1:"_qs;
    QTest::newRow("bad port") << QStringList{u"--port"_qs, u"70000"_qs} << 2 << u"70000"_qs;
    QTest::newRow("stray argument") << QStringList{u"happy"_qs} << 2 << u"happy"_qs;
}

void TestThesaurus::standaloneProgramRefusesBadStart()
{
    QFETCH(QStringList, arguments);
    QFETCH(QString, message);
    QProcess process;
    process.start(QStringLiteral(VERBLOOM_THESAURUS_PROGRAM),
                  arguments.replaceInStrings(u"BUSY"_qs, QString::number(m_service.Port())));
    QVERIFY(process.waitForFinished(20000));
    QCOMPARE(process.exitStatus(), QProcess::NormalExit);
    QTEST(process.exitCode(), "exitCode");
    const QString errors = QString::fromUtf8(process.readAllStandardError());
    QVERIFY2(errors.contains(message), qPrintable(errors));
    QVERIFY(process.readAllStandardOutput().isEmpty());
}

QTEST_GUILESS_MAIN(TestThesaurus)
#include "tst_thesaurus.moc"
