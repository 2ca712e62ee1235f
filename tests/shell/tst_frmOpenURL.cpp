// The web-page loader: address check, loading a page served on 127.0.0.1, abandoning a page.
#include "LocalHttpServer.h"
#include "ShellTestMain.h"

#include "shell/Browser.h"
#include "shell/ImageCommand.h"
#include "shell/UiServices.h"
#include "shell/frmOpenURL.h"

#include <QLabel>
#include <QLineEdit>
#include <QMouseEvent>
#include <QPlainTextEdit>
#include <QProgressBar>
#include <QTest>

using namespace verbloom;
using namespace verbloom::test;

namespace {

constexpr int PageTimeoutMs = 20000;

const QByteArray SamplePage =
    "<!DOCTYPE html><html><head><title>Sample Page</title><style>p{margin:0}</style></head>"
    "<body><h1>Gardening Tips</h1><p>Water the plants early.</p><p>Mulch keeps the soil moist.</p>"
    "<script>document.write('')</script></body></html>";

const QByteArray FramesetPage =
    "<html><head><title>Frames</title></head>"
    "<frameset cols='50%,50%'><frame src='/a'><frame src='/b'></frameset></html>";

/// A loader over boxes of its own, as the main window's boxes would be.
struct LoaderRig
{
    QLineEdit Title;
    QPlainTextEdit Contents;
    ScriptedUiServices Ui;
    frmOpenURL Loader{Title, Contents, Ui};

    LoaderRig()
    {
        Title.setText(QStringLiteral("Old title"));
        Contents.setPlainText(QStringLiteral("Old contents"));
        Loader.show();
    }
    template<typename T> T *Find(const QString &name) { return Loader.findChild<T *>(name); }
    void Get(const QString &address)
    {
        Find<QLineEdit>(QStringLiteral("txturl"))->setText(address);
        QTest::mouseClick(Find<QLabel>(QStringLiteral("Label4")), Qt::LeftButton);
    }
};

void MoveOver(QWidget *widget)
{
    QMouseEvent move(QEvent::MouseMove, QPointF(2, 2), widget->mapToGlobal(QPointF(2, 2)), Qt::NoButton,
                     Qt::NoButton, Qt::NoModifier);
    QCoreApplication::sendEvent(widget, &move);
}

} // namespace

class tst_frmOpenURL final : public QObject
{
    Q_OBJECT

private slots:
    void opensWithItsTexts();
    void addressLength_data();
    void addressLength();
    void loadsTitleAndBody();
    void framesetLeavesArticle();
    void closeBoxAbandonsPage();
    void hoverSkins();
};

void tst_frmOpenURL::opensWithItsTexts()
{
    LoaderRig rig;
    QCOMPARE(rig.Loader.windowTitle(), QStringLiteral("Open URL to customize"));
    QCOMPARE(rig.Find<QLineEdit>(QStringLiteral("txturl"))->text(), QStringLiteral("http://"));
    QCOMPARE(rig.Find<QLabel>(QStringLiteral("lblPrompt"))->text(), QStringLiteral("Enter a URL to get contents from"));
    QCOMPARE(rig.Find<QLabel>(QStringLiteral("lblNote"))->text(),
             QStringLiteral("(Note:- Please make sure that the URL starts with \"http://\" or \"https://\" )"));
    QCOMPARE(rig.Find<QLabel>(QStringLiteral("Label4"))->text(), QStringLiteral("Get Contents"));
    QVERIFY(rig.Find<QLabel>(QStringLiteral("msg")));
    QVERIFY(rig.Find<QProgressBar>(QStringLiteral("ProgressBar1")));
    QCOMPARE(rig.Loader.WebBrowser1().ReadyState(), 0); // stopped when the window loads
}

void tst_frmOpenURL::addressLength_data()
{
    QTest::addColumn<QString>("address");
    QTest::addColumn<bool>("accepted");
    QTest::newRow("bare http://") << QStringLiteral("http://") << false;
    QTest::newRow("15 characters") << QStringLiteral("http://127.0.0.") << false;
    QTest::newRow("15 of anything") << QStringLiteral("abcdefghijklmno") << false;
    QTest::newRow("16 characters") << QStringLiteral("http://127.0.0.1") << true;
}

void tst_frmOpenURL::addressLength()
{
    QFETCH(QString, address);
    QFETCH(bool, accepted);
    LoaderRig rig;
    rig.Get(address);
    if (accepted) {
        QVERIFY(rig.Ui.Messages.isEmpty());
        QCOMPARE(rig.Loader.WebBrowser1().ReadyState(), 1); // loading started
        return;
    }
    QCOMPARE(rig.Ui.Messages.size(), 1);
    QCOMPARE(rig.Ui.Messages[0].Text, QStringLiteral("Please enter valid URL!!!"));
    QCOMPARE(rig.Ui.Messages[0].Title, QStringLiteral("Verbloom"));
    QCOMPARE(rig.Ui.Messages[0].IconKind, UiServices::Icon::Critical);
    QCOMPARE(rig.Ui.Messages[0].ButtonSet, UiServices::Buttons::Ok);
    QVERIFY(rig.Loader.isVisible());
    QCOMPARE(rig.Find<QLineEdit>(QStringLiteral("txturl"))->text(), address);
    QCOMPARE(rig.Loader.WebBrowser1().ReadyState(), 0);
}

void tst_frmOpenURL::loadsTitleAndBody()
{
    LocalHttpServer server;
    server.AddPage("/article.html", SamplePage);
    LoaderRig rig;
    rig.Get(server.Url("/article.html"));
    QTRY_VERIFY_WITH_TIMEOUT(!rig.Loader.isVisible(), PageTimeoutMs);
    QCOMPARE(rig.Loader.result(), int(QDialog::Accepted));
    QCOMPARE(rig.Title.text(), QStringLiteral("Sample Page"));
    const QString body = rig.Loader.WebBrowser1().BodyInnerText();
    QVERIFY2(body.contains(QStringLiteral("Gardening Tips\r\n")), qPrintable(body));
    QVERIFY(!body.contains(QStringLiteral("<p>")));
    QVERIFY(!body.contains(QRegularExpression(QStringLiteral("[^\r]\n"))));
    QCOMPARE(rig.Contents.toPlainText(), QString(body).replace(QStringLiteral("\r\n"), QStringLiteral("\n")));
    QVERIFY2(rig.Contents.toPlainText().contains(QStringLiteral("Water the plants early.\n\nMulch keeps the soil moist.")), qPrintable(rig.Contents.toPlainText()));
    QVERIFY(!rig.Find<QLabel>(QStringLiteral("msg"))->text().isEmpty());
    QVERIFY(rig.Ui.Messages.isEmpty());
}

void tst_frmOpenURL::framesetLeavesArticle()
{
    LocalHttpServer server;
    server.AddPage("/frames.html", FramesetPage);
    LoaderRig rig;
    rig.Get(server.Url("/frames.html"));
    QTRY_COMPARE_WITH_TIMEOUT(rig.Loader.WebBrowser1().ReadyState(), int(Browser::ReadyStateComplete), PageTimeoutMs);
    QVERIFY(!rig.Loader.WebBrowser1().HasBody());
    QVERIFY(rig.Loader.isVisible());
    QCOMPARE(rig.Title.text(), QStringLiteral("Old title"));
    QCOMPARE(rig.Contents.toPlainText(), QStringLiteral("Old contents"));
}

void tst_frmOpenURL::closeBoxAbandonsPage()
{
    LocalHttpServer server;
    server.AddHangingPath("/never.html");
    LoaderRig rig;
    rig.Get(server.Url("/never.html"));
    QTRY_COMPARE_WITH_TIMEOUT(server.RequestsByPath.value("/never.html"), 1, PageTimeoutMs);
    QVERIFY(rig.Loader.close());
    QVERIFY(!rig.Loader.isVisible());
    QCOMPARE(rig.Loader.result(), int(QDialog::Rejected));
    QCOMPARE(rig.Title.text(), QStringLiteral("Old title"));
    QCOMPARE(rig.Contents.toPlainText(), QStringLiteral("Old contents"));
}

void tst_frmOpenURL::hoverSkins()
{
    LoaderRig rig;
    auto *command = qobject_cast<ImageCommand *>(rig.Find<QLabel>(QStringLiteral("cmdGet"))->parentWidget());
    QVERIFY(command);
    QCOMPARE(command->Skin(), QStringLiteral("pic1"));
    MoveOver(rig.Find<QLabel>(QStringLiteral("Label4")));
    QCOMPARE(command->Skin(), QStringLiteral("pic2"));
    MoveOver(rig.Find<QWidget>(QStringLiteral("Picture1")));
    QCOMPARE(command->Skin(), QStringLiteral("pic1"));
    MoveOver(rig.Find<QLabel>(QStringLiteral("cmdGet")));
    QCOMPARE(command->Skin(), QStringLiteral("pic2"));
}

VERBLOOM_SHELL_TEST_MAIN(tst_frmOpenURL)
#include "tst_frmOpenURL.moc"
