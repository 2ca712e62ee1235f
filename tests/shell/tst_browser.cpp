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

/// A browser on a window that is never shown, as webData is, and the page loader over it.
struct BrowserRig
{
    QWidget Host;
    WebEngineBrowser Browser{&Host};
    BrowserPageSource Page{Browser};
};

} // namespace

class tst_browser final : public QObject
{
    Q_OBJECT

private slots:
    void init() { StopProcessing = false; }
    void cleanup() { StopProcessing = false; }
    void pageTextAsCrLfLines();
    void sequenceOfPages();
    void neverCompletingPage();
    void unreachablePageCompletes();
};

void tst_browser::pageTextAsCrLfLines()
{
    LocalHttpServer server;
    server.AddPage("/lines.html", "<html><head><title>Lines</title></head><body><div>first line</div><div>second "
                                  "line</div><div style='display:none'>hidden</div><pre>a\nb</pre></body></html>");
    BrowserRig rig;
    rig.Browser.View()->hide();
    QSignalSpy complete(&rig.Browser, &Browser::documentComplete);
    rig.Page.Stop();
    rig.Page.Navigate(server.Url("/lines.html"));
    QCOMPARE(rig.Browser.ReadyState(), 1);
    QCOMPARE(rig.Browser.DocumentReadyState(), u"loading"_qs);
    QVERIFY(rig.Page.WaitUntilComplete(PageTimeoutMs));
    QCOMPARE(complete.count(), 1);
    QCOMPARE(rig.Browser.DocumentReadyState(), u"complete"_qs);
    QCOMPARE(rig.Page.PageText(), u"first line\r\nsecond line\r\na\r\nb"_qs);
    QCOMPARE(rig.Browser.BodyInnerText(), rig.Page.PageText());
    QCOMPARE(rig.Browser.LocationName(), u"Lines"_qs);
    QVERIFY(rig.Browser.HasBody());
}

void tst_browser::sequenceOfPages()
{
    // Each wait ends with the page asked for, never with the text of the one before.
    LocalHttpServer server;
    BrowserRig rig;
    for (int i = 0; i < 3; ++i) {
        const QByteArray path = "/word" + QByteArray::number(i);
        server.AddPage(path, "<html><body>page " + QByteArray::number(i) + "</body></html>");
        rig.Page.Stop();
        rig.Page.Navigate(server.Url(path));
        QVERIFY(rig.Page.WaitUntilComplete(PageTimeoutMs));
        QCOMPARE(rig.Page.PageText(), u"page "_qs + QString::number(i));
    }
    // A page abandoned while it loads does not complete the next one.
    server.AddHangingPath("/slow");
    rig.Page.Stop();
    rig.Page.Navigate(server.Url("/slow"));
    QTRY_COMPARE_WITH_TIMEOUT(server.RequestsByPath.value("/slow"), 1, PageTimeoutMs);
    rig.Page.Stop();
    rig.Page.Navigate(server.Url("/word1"));
    QVERIFY(rig.Page.WaitUntilComplete(PageTimeoutMs));
    QCOMPARE(rig.Page.PageText(), u"page 1"_qs);
}

void tst_browser::neverCompletingPage()
{
    // The wait gives up at its limit, and at once when StopProcessing is set.
    LocalHttpServer server;
    server.AddHangingPath("/never");
    BrowserRig rig;
    rig.Page.Navigate(server.Url("/never"));
    QVERIFY(!rig.Page.WaitUntilComplete(300));
    QVERIFY(rig.Browser.ReadyState() != Browser::ReadyStateComplete);

    QTimer::singleShot(50, this, [] { StopProcessing = true; });
    QElapsedTimer waited;
    waited.start();
    QVERIFY(!rig.Page.WaitUntilComplete(PageTimeoutMs));
    QVERIFY(waited.elapsed() < PageTimeoutMs / 4);
}

void tst_browser::unreachablePageCompletes()
{
    // Nothing listens on the port: the browser's error page completes in its place.
    quint16 port = 0;
    {
        LocalHttpServer closed;
        port = closed.serverPort();
    }
    BrowserRig rig;
    rig.Page.Navigate(u"http://127.0.0.1:"_qs + QString::number(port) + u"/gone"_qs);
    QVERIFY(rig.Page.WaitUntilComplete(PageTimeoutMs));
    QVERIFY(!rig.Browser.LocationName().isEmpty());
}

VERBLOOM_SHELL_TEST_MAIN(tst_browser)
#include "tst_browser.moc"
