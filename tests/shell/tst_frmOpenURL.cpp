// The web-page loader: address check, loading a page served on 127.0.0.1, abandoning a page.
#include "LocalHttpServer.h"
#include "ShellRig.h"
#include "ShellTestMain.h"

#include "shell/Browser.h"
#include "shell/frmOpenURL.h"

#include <QProgressBar>

using namespace verbloom;
using namespace verbloom::test;

namespace {

constexpr int PageTimeoutMs = 20000;

/// A loader over boxes of its own, as the main window's boxes would be.
struct LoaderRig
{
    QLineEdit Title;
    QPlainTextEdit Contents;
    ScriptedUiServices Ui;
    frmOpenURL Loader{Title, Contents, Ui};

    LoaderRig()
    {
        Title.setText(u"Old title"_qs);
        Contents.setPlainText(u"Old contents"_qs);
        Loader.show();
    }
    template<typename T = QWidget> T *Find(const QString &name) { return Loader.findChild<T *>(name); }
    void Get(const QString &address)
    {
        Find<QLineEdit>(u"txturl"_qs)->setText(address);
        QTest::mouseClick(Find<QLabel>(u"Label4"_qs), Qt::LeftButton);
    }
    void CheckArticleKept()
    {
        QCOMPARE(Title.text(), u"Old title"_qs);
        QCOMPARE(Contents.toPlainText(), u"Old contents"_qs);
    }
};

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
    QCOMPARE(rig.Loader.windowTitle(), u"Open URL to customize"_qs);
    QCOMPARE(rig.Find<QLineEdit>(u"txturl"_qs)->text(), u"http://"_qs);
    QCOMPARE(rig.Find<QLabel>(u"lblPrompt"_qs)->text(), u"Enter a URL to get contents from"_qs);
    QCOMPARE(rig.Find<QLabel>(u"lblNote"_qs)->text(),
             u"(Note:- Please make sure that the URL starts with \"http://\" or \"https://\" )"_qs);
    QCOMPARE(rig.Find<QLabel>(u"Label4"_qs)->text(), u"Get Contents"_qs);
    QVERIFY(rig.Find<QLabel>(u"msg"_qs));
    QVERIFY(rig.Find<QProgressBar>(u"ProgressBar1"_qs));
    QCOMPARE(rig.Loader.WebBrowser1().ReadyState(), 0); // stopped when the window loads
}

void tst_frmOpenURL::addressLength_data()
{
    QTest::addColumn<QString>("address");
    QTest::addColumn<bool>("accepted");
    QTest::newRow("15 characters") << u"http://127.0.0."_qs << false;
    QTest::newRow("16 characters") << u"http://127.0.0.1"_qs << true;
}

void tst_frmOpenURL::addressLength()
{
    QFETCH(QString, address);
    QFETCH(bool, accepted);
    LoaderRig rig;
    rig.Get(address);
    QCOMPARE(rig.Loader.WebBrowser1().ReadyState(), accepted ? 1 : 0); // loading started or not
    if (accepted) {
        QVERIFY(rig.Ui.Messages.isEmpty());
        return;
    }
    QVERIFY(rig.Loader.isVisible());
    QCOMPARE(Boxes(rig.Ui), QStringList{Box(u"Please enter valid URL!!!"_qs, UiServices::Buttons::Ok,
                                            UiServices::Icon::Critical)});
    QCOMPARE(rig.Find<QLineEdit>(u"txturl"_qs)->text(), address);
}

void tst_frmOpenURL::loadsTitleAndBody()
{
    LocalHttpServer server;
    server.AddPage("/article.html",
                   "<!DOCTYPE html><html><head><title>Sample Page</title><style>p{margin:0}</style></head>"
                   "<body><h1>Gardening Tips</h1><p>Water the plants early.</p><p>Mulch keeps the soil moist.</p>"
                   "<script>document.write('')</script></body></html>");
    LoaderRig rig;
    rig.Get(server.Url("/article.html"));
    QTRY_VERIFY_WITH_TIMEOUT(!rig.Loader.isVisible(), PageTimeoutMs);
    QCOMPARE(rig.Loader.result(), int(QDialog::Accepted));
    QCOMPARE(rig.Title.text(), u"Sample Page"_qs);
    const QString body = rig.Loader.WebBrowser1().BodyInnerText();
    QVERIFY2(body.contains(u"Gardening Tips\r\n"_qs), qPrintable(body));
    QVERIFY(!body.contains(u"<p>"_qs));
    QVERIFY(!body.contains(QRegularExpression(u"[^\r]\n"_qs)));
    QCOMPARE(rig.Contents.toPlainText(), QString(body).replace(u"\r\n"_qs, u"\n"_qs));
    QVERIFY2(rig.Contents.toPlainText().contains(u"Water the plants early.\n\nMulch keeps the soil moist."_qs),
             qPrintable(rig.Contents.toPlainText()));
    QVERIFY(!rig.Find<QLabel>(u"msg"_qs)->text().isEmpty());
    QVERIFY(rig.Ui.Messages.isEmpty());
}

void tst_frmOpenURL::framesetLeavesArticle()
{
    LocalHttpServer server;
    server.AddPage("/frames.html", "<html><head><title>Frames</title></head>"
                                   "<frameset cols='50%,50%'><frame src='/a'><frame src='/b'></frameset></html>");
    LoaderRig rig;
    rig.Get(server.Url("/frames.html"));
    QTRY_COMPARE_WITH_TIMEOUT(rig.Loader.WebBrowser1().ReadyState(), int(Browser::ReadyStateComplete), PageTimeoutMs);
    QVERIFY(!rig.Loader.WebBrowser1().HasBody());
    QVERIFY(rig.Loader.isVisible());
    rig.CheckArticleKept();
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
    rig.CheckArticleKept();
}

void tst_frmOpenURL::hoverSkins()
{
    LoaderRig rig;
    auto *command = qobject_cast<ImageCommand *>(rig.Find<QLabel>(u"cmdGet"_qs)->parentWidget());
    QVERIFY(command);
    QCOMPARE(command->Skin(), u"pic1"_qs);
    MoveMouseOver(rig.Find(u"Label4"_qs));
    QCOMPARE(command->Skin(), u"pic2"_qs);
    MoveMouseOver(rig.Find(u"Picture1"_qs));
    QCOMPARE(command->Skin(), u"pic1"_qs);
    MoveMouseOver(rig.Find(u"cmdGet"_qs));
    QCOMPARE(command->Skin(), u"pic2"_qs);
}

VERBLOOM_SHELL_TEST_MAIN(tst_frmOpenURL)
#include "tst_frmOpenURL.moc"
