// The embedded browser and the lookup's page loader over it, against pages served on 127.0.0.1.
#include "LocalHttpServer.h"
#include "ShellTestMain.h"

#include "shell/ArticleModel.h"
#include "shell/BrowserPageSource.h"
#include "shell/WebEngineBrowser.h"

#include <QElapsedTimer>
#include <QSignalSpy>
#include <QTimer>
#include <QWidget>

using namespace verbloom;
using namespace verbloom::test;

namespace {

constexpr int PageTimeoutMs = 20000;

const QByteArray LinesPage =
    "<html><head><title>Lines</title></head><body><div>first line</div><div>second line</div>"
    "<div style='display:none'>hidden</div><pre>a\nb</pre></body></html>";

} // namespace

class tst_browser final : public QObject
{
    Q_OBJECT

private slots:
    void init() { StopProcessing = false; }
    void cleanup() { StopProcessing = false; }
    void pageTextAsCrLfLines();
    void hiddenBrowserLoads();
    void sequenceOfPages();
    void neverCompletingPageTimesOut();
    void stopProcessingEndsWait();
    void unreachablePageCompletes();
};

void tst_browser::pageTextAsCrLfLines()
{
    LocalHttpServer server;
    server.AddPage("/lines.html", LinesPage);
    QWidget host;
    host.show();
    WebEngineBrowser browser(&host);
    QSignalSpy complete(&browser, &Browser::documentComplete);
    BrowserPageSource page(browser);
    page.Stop();
    page.Navigate(server.Url("/lines.html"));
    QCOMPARE(browser.ReadyState(), 1);
    QCOMPARE(browser.DocumentReadyState(), QStringLiteral("loading"));
    QVERIFY(page.WaitUntilComplete(PageTimeoutMs));
    QCOMPARE(complete.count(), 1);
    QCOMPARE(browser.DocumentReadyState(), QStringLiteral("complete"));
    QCOMPARE(page.PageText(), QStringLiteral("first line\r\nsecond line\r\na\r\nb"));
    QCOMPARE(browser.BodyInnerText(), page.PageText());
    QCOMPARE(browser.LocationName(), QStringLiteral("Lines"));
    QVERIFY(browser.HasBody());
}

void tst_browser::hiddenBrowserLoads()
{
    // webData is never shown; its pages still load and give their text.
    LocalHttpServer server;
    server.AddPage("/lines.html", LinesPage);
    QWidget host;
    WebEngineBrowser browser(&host);
    browser.View()->hide();
    BrowserPageSource page(browser);
    page.Navigate(server.Url("/lines.html"));
    QVERIFY(page.WaitUntilComplete(PageTimeoutMs));
    QVERIFY(page.PageText().startsWith(QStringLiteral("first line\r\nsecond line")));
}

void tst_browser::sequenceOfPages()
{
    // Each wait ends with the page asked for, never with the text of the one before.
    LocalHttpServer server;
    QWidget host;
    WebEngineBrowser browser(&host);
    BrowserPageSource page(browser);
    for (int i = 0; i < 5; ++i) {
        const QByteArray path = "/word" + QByteArray::number(i);
        server.AddPage(path, "<html><body>page " + QByteArray::number(i) + "</body></html>");
        page.Stop();
        page.Navigate(server.Url(path));
        QVERIFY(page.WaitUntilComplete(PageTimeoutMs));
        QCOMPARE(page.PageText(), QStringLiteral("page ") + QString::number(i));
    }
    // A page abandoned while it loads does not complete the next one.
    server.AddHangingPath("/slow");
    page.Stop();
    page.Navigate(server.Url("/slow"));
    QTRY_COMPARE_WITH_TIMEOUT(server.RequestsByPath.value("/slow"), 1, PageTimeoutMs);
    page.Stop();
    page.Navigate(server.Url("/word1"));
    QVERIFY(page.WaitUntilComplete(PageTimeoutMs));
    QCOMPARE(page.PageText(), QStringLiteral("page 1"));
}

void tst_browser::neverCompletingPageTimesOut()
{
    LocalHttpServer server;
    server.AddHangingPath("/never");
    QWidget host;
    WebEngineBrowser browser(&host);
    BrowserPageSource page(browser);
    page.Navigate(server.Url("/never"));
    QVERIFY(!page.WaitUntilComplete(300));
    QVERIFY(browser.ReadyState() != Browser::ReadyStateComplete);
}

void tst_browser::stopProcessingEndsWait()
{
    LocalHttpServer server;
    server.AddHangingPath("/never");
    QWidget host;
    WebEngineBrowser browser(&host);
    BrowserPageSource page(browser);
    page.Navigate(server.Url("/never"));
    QTimer::singleShot(50, this, [] { StopProcessing = true; });
    QElapsedTimer waited;
    waited.start();
    QVERIFY(!page.WaitUntilComplete(PageTimeoutMs));
    QVERIFY(waited.elapsed() < PageTimeoutMs);
}

void tst_browser::unreachablePageCompletes()
{
    // Nothing listens on the port: the browser's error page completes in its place.
    quint16 port = 0;
    {
        LocalHttpServer closed;
        port = closed.serverPort();
    }
    QWidget host;
    WebEngineBrowser browser(&host);
    BrowserPageSource page(browser);
    page.Navigate(QStringLiteral("http://127.0.0.1:") + QString::number(port) + QStringLiteral("/gone"));
    QVERIFY(page.WaitUntilComplete(PageTimeoutMs));
    QVERIFY(!browser.LocationName().isEmpty());
}

VERBLOOM_SHELL_TEST_MAIN(tst_browser)
#include "tst_browser.moc"
