#include "EngineFakes.h"

#include "engine/ThesaurusLookup.h"
#include "engine/ThesaurusParser.h"
#include "shell/ArticleModel.h"

#include <QtTest>

using namespace verbloom;
using namespace verbloom::test;

namespace {

const QString kHost = u"http://127.0.0.1:8080"_qs;

// "entry=synonyms" per meaning, for compact expectations.
QStringList Flatten(const QList<MeaningEntry> &meanings)
{
    QStringList flat;
    for (const MeaningEntry &meaning : meanings)
        flat.append(meaning.EntryWord + u'=' + meaning.Synonyms);
    return flat;
}

QString Meaning(const QString &entry, const QString &synonyms)
{
    return PageLines({u"Main Entry: "_qs + entry, u"Part of Speech: adjective"_qs,
                      u"Definition: something"_qs, u"Synonyms: "_qs + synonyms});
}

const QString kQuickPage = PageLines({u"quick - Thesaurus"_qs, Meaning(u"quick"_qs, u"fast, rapid, speedy"_qs),
                                      Meaning(u"quick 2"_qs, u"core, heart "_qs), u"Antonyms: slow"_qs});

} // namespace

class TestThesaurus final : public QObject
{
    Q_OBJECT

private slots:
    void init() { StopProcessing = false; }
    void cleanup() { StopProcessing = true; }

    void parsesPage_data();
    void parsesPage();
    void contextSentence_data();
    void contextSentence();
    void lookup_data();
    void lookup();
};

void TestThesaurus::parsesPage_data()
{
    QTest::addColumn<QString>("page");
    QTest::addColumn<QString>("suffix");
    QTest::addColumn<QString>("meanings"); // "entry=synonyms", "|" between
    QTest::addColumn<QString>("last");

    QTest::newRow("two meanings")
        << kQuickPage << QString() << u"quick= fast, rapid, speedy|quick= core, heart "_qs << u"core, heart"_qs;
    QTest::newRow("synonyms at distance two and four")
        << PageLines({u"Main Entry: quick"_qs, u"x"_qs, u"Synonyms: fast"_qs, u"y"_qs, u"Synonyms: slow"_qs})
        << QString() << QString() << QString();
    QTest::newRow("second colon cuts") << Meaning(u"quick"_qs, u"fast: rapid, speedy"_qs) << QString()
                                       << u"quick= fast"_qs << u"fast"_qs;
    // The homograph number goes, a second word stays, a second ": " ends the entry word.
    QTest::newRow("entry words")
        << PageLines({Meaning(u"bank 2"_qs, u"shore"_qs), Meaning(u"ice cream"_qs, u"sorbet"_qs),
                      Meaning(u"run: verb"_qs, QString())})
        << QString() << u"bank= shore|ice cream= sorbet|run= "_qs << QString();
    QTest::newRow("entry in last three lines")
        << PageLines({u"Synonyms: x"_qs, u"Main Entry: quick"_qs, u"a"_qs, u"Synonyms: fast"_qs})
        << QString() << QString() << QString();
    QTest::newRow("labels case exact, blank after the entry label")
        << PageLines({u"main entry: quick"_qs, u"a"_qs, u"b"_qs, u"Synonyms: fast"_qs, u"Main Entry: quick"_qs,
                      u"a"_qs, u"b"_qs, u"synonyms: fast"_qs, u"Main Entry:quick"_qs, u"a"_qs, u"b"_qs,
                      u"Synonyms: fast"_qs})
        << QString() << QString() << QString();
    QTest::newRow("only LF breaks are one line")
        << u"Main Entry: quick\nx\ny\nSynonyms: fast"_qs << QString() << QString() << QString();
    QTest::newRow("suffix inflects the meanings, not the result")
        << Meaning(u"walk"_qs, u"stroll, go on foot, March"_qs) << u"ed"_qs << u"walked=strolled, marched"_qs
        << u"stroll, go on foot, March"_qs;
}

void TestThesaurus::parsesPage()
{
    QFETCH(QString, page);
    QFETCH(QString, suffix);
    QFETCH(QString, meanings);
    QFETCH(QString, last);
    const ParsedPage parsed = ParseThesaurusPage(page, suffix);
    QCOMPARE(Flatten(parsed.Meanings).join(u'|'), meanings);
    QCOMPARE(parsed.LastSynonyms, last);
}

void TestThesaurus::contextSentence_data()
{
    QTest::addColumn<int>("list");
    QTest::addColumn<int>("row");
    QTest::addColumn<int>("from");
    QTest::addColumn<int>("to"); // last token index; -1: empty
    QTest::newRow("title row 5 starts at token 1") << 0 << 5 << 1 << 41;
    QTest::newRow("title row 21 starts at token 1") << 0 << 21 << 1 << 41;
    QTest::newRow("title row 22 starts at token 2") << 0 << 22 << 2 << 42;
    QTest::newRow("contents row 30 stops at the end") << 1 << 30 << 10 << 44;
    QTest::newRow("other list reads the title") << 7 << 5 << 1 << 41;
    QTest::newRow("row past the end") << 1 << 100 << 0 << -1;
}

void TestThesaurus::contextSentence()
{
    QFETCH(int, list);
    QFETCH(int, row);
    QFETCH(int, from);
    QFETCH(int, to);
    ArticleTokens article;
    QString expected;
    for (int i = 0; i < 50; ++i) {
        article.TitleTokens.append(u't' + QString::number(i));
        if (i < 45)
            article.ContentsTokens.append(u'c' + QString::number(i));
        if (i >= from && i <= to)
            expected += (list == 1 ? u'c' : u't') + QString::number(i);
    }
    QCOMPARE(ContextSentence(article, list, row), expected);
}

void TestThesaurus::lookup_data()
{
    QTest::addColumn<QString>("word");
    QTest::addColumn<bool>("manual");
    QTest::addColumn<int>("list");
    QTest::addColumn<int>("row");
    QTest::addColumn<QString>("disturbance"); // "stop", "no host", "expire" or "stop in wait"
    QTest::addColumn<QString>("expected");
    QTest::addColumn<QString>("requests");    // the words requested, "|" between
    QTest::addColumn<QString>("offer");       // what the confirm window shows, "|" between; "": none

    QTest::newRow("manual takes the last meaning")
        << u"Quick"_qs << true << 0 << 1 << QString() << u"core, heart"_qs << u"Quick"_qs << QString();
    // Row 5 of the title: the context runs from token index 1 to the end of the title.
    QTest::newRow("offer") << u"quick"_qs << false << 0 << 5 << QString() << u"core, heart"_qs << u"quick"_qs
                           << u"quick||Suggest the word closest in meaning to \"quick\"|quick: confirm suggestions"
                              "| very quick brown fox jumps |0|5|quick=fast, rapid, speedy|quick=core, heart"_qs;
    // A word with no meaning is retried with its stem; the result gets the suffix back.
    QTest::newRow("manual stem retry") << u"Walked"_qs << true << 1 << 3 << QString() << u"strolled, marched"_qs
                                       << u"Walked|Walk"_qs << QString();
    QTest::newRow("stem retry offer")
        << u"Walked"_qs << false << 1 << 3 << QString() << u"strolled, marched"_qs << u"Walked|Walk"_qs
        << u"Walk|ed|Suggest the word closest in meaning to \"Walked\"|Walk: confirm suggestions| Walked home. "
           "|1|3|walked=strolled, marched"_qs;
    QTest::newRow("stop flag") << u"quick"_qs << true << 0 << 1 << u"stop"_qs << QString() << QString()
                               << QString();
    QTest::newRow("no host") << u"quick"_qs << false << 0 << 1 << u"no host"_qs << QString() << QString()
                             << QString();
    QTest::newRow("expired wait")
        << u"quick"_qs << false << 0 << 1 << u"expire"_qs << QString() << u"quick"_qs << QString();
    // Cancel during the wait: the loaded page is still read, but nothing is offered or retried.
    QTest::newRow("stop in wait")
        << u"quick"_qs << false << 0 << 1 << u"stop in wait"_qs << u"core, heart"_qs << u"quick"_qs << QString();
    QTest::newRow("64 characters are looked up")
        << QString(64, u'x') << true << 0 << 1 << QString() << QString() << QString(64, u'x') << QString();
    QTest::newRow("65 characters are not") << QString(64, u'x') + u's' << true << 0 << 1 << QString() << QString()
                                           << QString() << QString();
    QTest::newRow("stop in wait, no retry")
        << u"Walked"_qs << true << 1 << 3 << u"stop in wait"_qs << QString() << u"Walked"_qs << QString();
}

void TestThesaurus::lookup()
{
    QFETCH(QString, word);
    QFETCH(bool, manual);
    QFETCH(int, list);
    QFETCH(int, row);
    QFETCH(QString, disturbance);
    QFETCH(QString, expected);
    QFETCH(QString, requests);
    QFETCH(QString, offer);

    const ArticleTokens article = SplitArticle(u"A very quick brown fox jumps "_qs, u"He Walked home. "_qs);
    FakePageSource page;
    page.Pages.insert(kHost + u"/search?q=Quick"_qs, kQuickPage);
    page.Pages.insert(kHost + u"/search?q=quick"_qs, kQuickPage);
    page.Pages.insert(kHost + u"/search?q=Walked"_qs, u"No results for Walked"_qs);
    page.Pages.insert(kHost + u"/search?q=Walk"_qs, Meaning(u"walk"_qs, u"stroll, go on foot, March"_qs));
    page.Completes = disturbance != u"expire"_qs;
    if (disturbance == u"stop in wait"_qs)
        page.OnWait = [] { StopProcessing = true; };
    StopProcessing = disturbance == u"stop"_qs;
    const int timeoutMs = page.Completes ? 20000 : 150;
    RecordingPresenter confirm;
    const LookupContext context{disturbance == u"no host"_qs ? QString() : kHost, manual, &article, &page,
                                &confirm, timeoutMs};

    QCOMPARE(FetchAlternatives(word, QString(), list, row, context), expected);
    QStringList log;
    for (const QString &request : requests.split(u'|', Qt::SkipEmptyParts))
        log << u"stop"_qs << u"navigate "_qs + kHost + u"/search?q="_qs + request
            << u"wait "_qs + QString::number(timeoutMs);
    QCOMPARE(page.Log, log);
    QStringList shown;
    for (const ConfirmOffer &o : confirm.Offers)
        shown << o.Word << o.Suffix << o.Question << o.Caption << o.Sentence << QString::number(o.List)
              << QString::number(o.Row) << Flatten(o.Meanings);
    QCOMPARE(shown.join(u'|'), offer);
}

QTEST_GUILESS_MAIN(TestThesaurus)
#include "tst_thesauruslookup.moc"