#include "EngineFakes.h"

#include "engine/ThesaurusLookup.h"
#include "engine/ThesaurusParser.h"
#include "shell/ArticleModel.h"

#include <QtTest>

using namespace verbloom;
using namespace verbloom::test;

namespace {

const QString kHost = u"http://127.0.0.1:8080"_qs;

// "entry|synonyms" per meaning, for compact expectations.
QStringList Flatten(const QList<MeaningEntry> &meanings)
{
    QStringList flat;
    for (const MeaningEntry &meaning : meanings)
        flat.append(meaning.EntryWord + u'|' + meaning.Synonyms);
    return flat;
}

QString Meaning(const QString &entry, const QString &synonyms)
{
    return PageLines({u"Main Entry: "_qs + entry, u"Part of Speech: adjective"_qs,
                      u"Definition: something"_qs, u"Synonyms: "_qs + synonyms});
}

const QString kQuickPage = PageLines({u"quick - Thesaurus"_qs,
                                      Meaning(u"quick"_qs, u"fast, rapid, speedy"_qs),
                                      Meaning(u"quick 2"_qs, u"core, heart "_qs),
                                      u"Antonyms: slow"_qs});

QStringList Tokens(const QString &prefix, int count)
{
    QStringList tokens;
    for (int i = 0; i < count; ++i)
        tokens.append(prefix + QString::number(i));
    return tokens;
}

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
    void manualTakesLastMeaning();
    void offersMeanings();
    void retriesWithStem_data();
    void retriesWithStem();
    void stopFlagRequestsNothing();
    void stopDuringWaitSkipsOfferAndRetry();
    void expiredWaitGivesNothing();
    void noHostNoRequest();
};

void TestThesaurus::parsesPage_data()
{
    QTest::addColumn<QString>("page");
    QTest::addColumn<QString>("suffix");
    QTest::addColumn<QStringList>("meanings");
    QTest::addColumn<QString>("last");

    QTest::newRow("two meanings") << kQuickPage << QString()
                                  << QStringList{u"quick| fast, rapid, speedy"_qs, u"quick| core, heart "_qs}
                                  << u"core, heart"_qs;
    QTest::newRow("synonyms at distance two")
        << PageLines({u"Main Entry: quick"_qs, u"x"_qs, u"Synonyms: fast"_qs, u"y"_qs, u"z"_qs})
        << QString() << QStringList() << QString();
    QTest::newRow("synonyms at distance four")
        << PageLines({u"Main Entry: quick"_qs, u"x"_qs, u"y"_qs, u"z"_qs, u"Synonyms: fast"_qs})
        << QString() << QStringList() << QString();
    QTest::newRow("second colon cuts") << Meaning(u"quick"_qs, u"fast: rapid, speedy"_qs) << QString()
                                       << QStringList{u"quick| fast"_qs} << u"fast"_qs;
    QTest::newRow("entry second field") << Meaning(u"run: verb"_qs, u"dash"_qs) << QString()
                                        << QStringList{u"run| dash"_qs} << u"dash"_qs;
    QTest::newRow("homograph number") << Meaning(u"bank 2"_qs, u"shore"_qs) << QString()
                                      << QStringList{u"bank| shore"_qs} << u"shore"_qs;
    QTest::newRow("two words stay") << Meaning(u"ice cream"_qs, u"sorbet"_qs) << QString()
                                    << QStringList{u"ice cream| sorbet"_qs} << u"sorbet"_qs;
    QTest::newRow("entry in last three lines")
        << PageLines({u"Synonyms: x"_qs, u"Main Entry: quick"_qs, u"a"_qs, u"Synonyms: fast"_qs})
        << QString() << QStringList() << QString();
    QTest::newRow("entry last line") << u"Main Entry: quick"_qs << QString() << QStringList()
                                     << QString();
    QTest::newRow("no colon blank after label")
        << PageLines({u"Main Entry:quick"_qs, u"a"_qs, u"b"_qs, u"Synonyms: fast"_qs})
        << QString() << QStringList() << QString();
    QTest::newRow("labels are case exact")
        << PageLines({u"main entry: quick"_qs, u"a"_qs, u"b"_qs, u"Synonyms: fast"_qs,
                      u"Main Entry: quick"_qs, u"a"_qs, u"b"_qs, u"synonyms: fast"_qs})
        << QString() << QStringList() << QString();
    QTest::newRow("empty synonyms still a meaning") << Meaning(u"quick"_qs, QString()) << QString()
                                                    << QStringList{u"quick| "_qs} << QString();
    QTest::newRow("only LF breaks are one line")
        << u"Main Entry: quick\nx\ny\nSynonyms: fast"_qs << QString() << QStringList() << QString();
    QTest::newRow("suffix inflects entry and synonyms")
        << Meaning(u"walk"_qs, u"stroll, go on foot, March"_qs) << u"ed"_qs
        << QStringList{u"walked|strolled, marched"_qs} << u"stroll, go on foot, March"_qs;
    QTest::newRow("empty page") << QString() << QString() << QStringList() << QString();
}

void TestThesaurus::parsesPage()
{
    QFETCH(QString, page);
    QFETCH(QString, suffix);
    QFETCH(QStringList, meanings);
    QFETCH(QString, last);
    const ParsedPage parsed = ParseThesaurusPage(page, suffix);
    QCOMPARE(Flatten(parsed.Meanings), meanings);
    QCOMPARE(parsed.LastSynonyms, last);
}

void TestThesaurus::contextSentence_data()
{
    QTest::addColumn<int>("list");
    QTest::addColumn<int>("row");
    QTest::addColumn<QString>("expected");
    const QStringList title = Tokens(u"t"_qs, 50);
    const QStringList contents = Tokens(u"c"_qs, 45);
    QTest::newRow("title row 5 starts at token 1") << 0 << 5 << title.mid(1, 41).join(QString());
    QTest::newRow("title row 20") << 0 << 20 << title.mid(1, 41).join(QString());
    QTest::newRow("title row 21 starts at token 1") << 0 << 21 << title.mid(1, 41).join(QString());
    QTest::newRow("title row 22 starts at token 2") << 0 << 22 << title.mid(2, 41).join(QString());
    QTest::newRow("contents row 30 stops at the end") << 1 << 30 << contents.mid(10).join(QString());
    QTest::newRow("other list reads the title") << 7 << 5 << title.mid(1, 41).join(QString());
    QTest::newRow("row past the end") << 1 << 100 << QString();
}

void TestThesaurus::contextSentence()
{
    QFETCH(int, list);
    QFETCH(int, row);
    QFETCH(QString, expected);
    ArticleTokens article;
    article.TitleTokens = Tokens(u"t"_qs, 50);
    article.ContentsTokens = Tokens(u"c"_qs, 45);
    QCOMPARE(ContextSentence(article, list, row), expected);
}

void TestThesaurus::manualTakesLastMeaning()
{
    FakePageSource page;
    page.Pages.insert(kHost + u"/search?q=Quick"_qs, kQuickPage);
    RecordingPresenter confirm;
    LookupContext context{kHost, true, nullptr, &page, &confirm, 20000};
    QCOMPARE(FetchAlternatives(u"Quick"_qs, QString(), 0, 1, context), u"core, heart"_qs);
    QCOMPARE(page.Log, (QStringList{u"stop"_qs, u"navigate http://127.0.0.1:8080/search?q=Quick"_qs,
                                    u"wait 20000"_qs}));
    QVERIFY(confirm.Offers.isEmpty());
}

void TestThesaurus::offersMeanings()
{
    ArticleTokens article = SplitArticle(u"A very quick brown fox jumps "_qs, u"Body text "_qs);
    FakePageSource page;
    page.Pages.insert(kHost + u"/search?q=quick"_qs, kQuickPage);
    RecordingPresenter confirm;
    LookupContext context{kHost, false, &article, &page, &confirm, 20000};

    QCOMPARE(FetchAlternatives(u"quick"_qs, QString(), 0, 5, context), u"core, heart"_qs);
    QCOMPARE(confirm.Offers.size(), 1);
    const ConfirmOffer &offer = confirm.Offers.first();
    QCOMPARE(offer.Word, u"quick"_qs);
    QCOMPARE(offer.Suffix, QString());
    QCOMPARE(offer.Question, u"Suggest the word closest in meaning to \"quick\""_qs);
    QCOMPARE(offer.Caption, u"quick: confirm suggestions"_qs);
    // Row 5 of the title: from token index 1 to the end of the title.
    QCOMPARE(offer.Sentence, u" very quick brown fox jumps "_qs);
    QCOMPARE(offer.List, 0);
    QCOMPARE(offer.Row, 5);
    QCOMPARE(Flatten(offer.Meanings),
             (QStringList{u"quick|fast, rapid, speedy"_qs, u"quick|core, heart"_qs}));
}

void TestThesaurus::retriesWithStem_data()
{
    QTest::addColumn<bool>("manual");
    QTest::newRow("manual") << true;
    QTest::newRow("prompting") << false;
}

void TestThesaurus::retriesWithStem()
{
    QFETCH(bool, manual);
    ArticleTokens article = SplitArticle(u"Walked "_qs, u"He Walked home. "_qs);
    FakePageSource page;
    page.Pages.insert(kHost + u"/search?q=Walked"_qs, u"No results for Walked"_qs);
    page.Pages.insert(kHost + u"/search?q=Walk"_qs,
                      Meaning(u"walk"_qs, u"stroll, go on foot, March"_qs));
    RecordingPresenter confirm;
    LookupContext context{kHost, manual, &article, &page, &confirm, 20000};

    QCOMPARE(FetchAlternatives(u"Walked"_qs, QString(), 1, 3, context), u"strolled, marched"_qs);
    QCOMPARE(page.Log, (QStringList{u"stop"_qs, u"navigate http://127.0.0.1:8080/search?q=Walked"_qs,
                                    u"wait 20000"_qs, u"stop"_qs,
                                    u"navigate http://127.0.0.1:8080/search?q=Walk"_qs,
                                    u"wait 20000"_qs}));
    if (manual) {
        QVERIFY(confirm.Offers.isEmpty());
        return;
    }
    QCOMPARE(confirm.Offers.size(), 1);
    const ConfirmOffer &offer = confirm.Offers.first();
    QCOMPARE(offer.Word, u"Walk"_qs);
    QCOMPARE(offer.Suffix, u"ed"_qs);
    QCOMPARE(offer.Question, u"Suggest the word closest in meaning to \"Walked\""_qs);
    QCOMPARE(offer.Caption, u"Walk: confirm suggestions"_qs);
    QCOMPARE(offer.Sentence, u" Walked home. "_qs);
    QCOMPARE(offer.List, 1);
    QCOMPARE(offer.Row, 3);
    QCOMPARE(Flatten(offer.Meanings), (QStringList{u"walked|strolled, marched"_qs}));
}

void TestThesaurus::stopFlagRequestsNothing()
{
    StopProcessing = true;
    FakePageSource page;
    page.Pages.insert(kHost + u"/search?q=quick"_qs, kQuickPage);
    RecordingPresenter confirm;
    LookupContext context{kHost, true, nullptr, &page, &confirm, 20000};
    QCOMPARE(FetchAlternatives(u"quick"_qs, QString(), 1, 1, context), QString());
    QVERIFY(page.Log.isEmpty());
}

void TestThesaurus::stopDuringWaitSkipsOfferAndRetry()
{
    FakePageSource page;
    page.Pages.insert(kHost + u"/search?q=quick"_qs, kQuickPage);
    page.OnWait = [] { StopProcessing = true; };
    RecordingPresenter confirm;
    LookupContext context{kHost, false, nullptr, &page, &confirm, 20000};
    // The page that finished loading is still read, but no window is offered.
    QCOMPARE(FetchAlternatives(u"quick"_qs, QString(), 1, 1, context), u"core, heart"_qs);
    QVERIFY(confirm.Offers.isEmpty());

    StopProcessing = false;
    page.Log.clear();
    QCOMPARE(FetchAlternatives(u"walked"_qs, QString(), 1, 1, context), QString());
    QCOMPARE(page.Log.size(), 3); // no request for the stem
}

void TestThesaurus::expiredWaitGivesNothing()
{
    FakePageSource page;
    page.Completes = false;
    page.Pages.insert(kHost + u"/search?q=walked"_qs, kQuickPage);
    RecordingPresenter confirm;
    LookupContext context{kHost, false, nullptr, &page, &confirm, 150};
    QCOMPARE(FetchAlternatives(u"walked"_qs, QString(), 1, 1, context), QString());
    QCOMPARE(page.Log, (QStringList{u"stop"_qs, u"navigate http://127.0.0.1:8080/search?q=walked"_qs,
                                    u"wait 150"_qs}));
    QVERIFY(confirm.Offers.isEmpty());
}

void TestThesaurus::noHostNoRequest()
{
    FakePageSource page;
    RecordingPresenter confirm;
    LookupContext context{QString(), false, nullptr, &page, &confirm, 20000};
    QCOMPARE(FetchAlternatives(u"quick"_qs, QString(), 1, 1, context), QString());
    QVERIFY(page.Log.isEmpty());
}

QTEST_GUILESS_MAIN(TestThesaurus)
#include "tst_thesauruslookup.moc"
