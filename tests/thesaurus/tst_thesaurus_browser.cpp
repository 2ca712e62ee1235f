// The thesaurus pages read the same in the program's browser and without one.
#include "thesaurus/HtmlInnerText.h"
#include "thesaurus/ThesaurusService.h"

#include <QGuiApplication>
#include <QNetworkAccessManager>
#include <QNetworkReply>
#include <QWebEnginePage>
#include <QtTest>

#include <unistd.h>

using namespace verbloom;

class TestThesaurusBrowser final : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();
    void browserAndRendererAgree_data();
    void browserAndRendererAgree();

private:
    QString BrowserText(const QString &url);
    QByteArray Download(const QString &url);

    ThesaurusService m_service;
    QWebEnginePage m_page;
};

void TestThesaurusBrowser::initTestCase()
{
    QVERIFY2(m_service.Start(ThesaurusService::DefaultDataPath()), qPrintable(m_service.ErrorString()));
}

QString TestThesaurusBrowser::BrowserText(const QString &url)
{
    QSignalSpy loaded(&m_page, &QWebEnginePage::loadFinished);
    m_page.load(QUrl(url));
    if (!loaded.wait(30000) || !loaded.first().first().toBool())
        return u"(not loaded)"_qs;
    QString text;
    bool done = false;
    m_page.runJavaScript(u"document.documentElement.innerText"_qs, [&](const QVariant &value) {
        text = value.toString();
        done = true;
    });
    if (!QTest::qWaitFor([&done] { return done; }, 30000))
        return u"(no text)"_qs;
    return text.replace(u"\n"_qs, u"\r\n"_qs);
}

QByteArray TestThesaurusBrowser::Download(const QString &url)
{
    QNetworkAccessManager network;
    QNetworkReply *reply = network.get(QNetworkRequest(QUrl(url)));
    QSignalSpy finished(reply, &QNetworkReply::finished);
    finished.wait(30000);
    const QByteArray body = reply->readAll();
    delete reply;
    return body;
}

void TestThesaurusBrowser::browserAndRendererAgree_data()
{
    QTest::addColumn<QString>("query");
    for (const char *word : {"happy", "walk", "bank", "set", "good", "xyzzyq", "AT%26T%3Cb%3E", ""})
        QTest::newRow(*word ? word : "empty") << QString::fromLatin1(word);
}

void TestThesaurusBrowser::browserAndRendererAgree()
{
    QFETCH(QString, query);
    const QString url = m_service.BaseUrl() + u"/search?q="_qs + query;
    const QString browser = BrowserText(url);
    QCOMPARE(HtmlInnerText(Download(url), "utf-8"), browser);
    QVERIFY(browser.startsWith(u"Thesaurus:"_qs));
}

int main(int argc, char *argv[])
{
    if (geteuid() == 0)
        qputenv("QTWEBENGINE_DISABLE_SANDBOX", "1");
    QCoreApplication::setAttribute(Qt::AA_ShareOpenGLContexts);
    QGuiApplication app(argc, argv);
    TestThesaurusBrowser test;
    return QTest::qExec(&test, argc, argv);
}

#include "tst_thesaurus_browser.moc"
