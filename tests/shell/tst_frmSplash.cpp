// Start-up: the splash window's labels from SETTINGS.INI, its timer, the banner address, and the
// splitter's error box.
#include "LocalHttpServer.h"
#include "ShellRig.h"
#include "ShellTestMain.h"

#include "shell/ArticleModel.h"
#include "shell/SplitterMessageBox.h"
#include "shell/WebEngineBrowser.h"
#include "shell/frmSplash.h"

#include <QPointer>
#include <QTimer>

using namespace verbloom;
using namespace verbloom::test;

class tst_frmSplash final : public QObject
{
    Q_OBJECT

private slots:
    void labels_data();
    void labels();
    void showsMainWindowAfterTimer();
    void bannerFromSettings();
    void splitterMessageBox_data();
    void splitterMessageBox();
};

void tst_frmSplash::labels_data()
{
    QTest::addColumn<QByteArray>("ini");
    QTest::addColumn<QString>("company");
    QTest::addColumn<QString>("website");
    QTest::addColumn<QString>("support");
    const QString noSupport = u"Please contact  in case of any problems."_qs;
    const QString longName = u"C"_qs.repeated(100);
    QTest::newRow("no SETTINGS.INI") << QByteArray() << QString() << QString() << noSupport;
    QTest::newRow("all keys") << QByteArray("[URL]\r\nSupportUrl = help@example.com\r\nWebSiteUrl=www.example.com\r\n"
                                            "[COMPANY]\r\nCompanyName=Example Ltd.\r\n")
                              << u"Example Ltd."_qs << u"www.example.com"_qs
                              << u"Please contact help@example.com in case of any problems."_qs;
    QTest::newRow("100 characters shown whole") << "[COMPANY]\nCompanyName=" + longName.toLatin1() + '\n'
                                                << longName << QString() << noSupport;
}

void tst_frmSplash::labels()
{
    QFETCH(QByteArray, ini);
    QTemporaryDir home;
    SetProgramFolder(home.path());
    if (!ini.isEmpty())
        QVERIFY(WriteBinaryFile(home.filePath(u"SETTINGS.INI"_qs), ini));
    StopProcessing = false;
    int loads = 0;
    QWidget mainWindow;
    frmSplash splash([&]() -> QWidget * {
        ++loads;
        return &mainWindow;
    });
    QVERIFY(StopProcessing);
    QCOMPARE(loads, 1);
    QVERIFY(!mainWindow.isVisible());
    const auto text = [&](const QString &name) { return splash.findChild<QLabel *>(name)->text(); };
    QTEST(text(u"lblCompanyNM"_qs), "company");
    QTEST(text(u"lblWebSiteURL"_qs), "website");
    QTEST(text(u"lblSupport"_qs), "support");
    QCOMPARE(text(u"lblInternet"_qs), u"Please make sure that you are connected to the internet."_qs);
    QCOMPARE(text(u"lblLoading"_qs), u"Please wait, loading Verbloom ..."_qs);
    QCOMPARE(text(u"lblLogo"_qs), u"Verbloom"_qs);
    QCOMPARE(text(u"lblLogoShadow"_qs), u"Verbloom"_qs);
    QCOMPARE(splash.findChild<QLabel *>(u"lblLogoShadow"_qs)->palette().color(QPalette::WindowText),
             QColor(0xC0, 0xC0, 0xC0));
}

void tst_frmSplash::showsMainWindowAfterTimer()
{
    QTemporaryDir home;
    SetProgramFolder(home.path()); // no SETTINGS.INI: the program still starts
    QWidget mainWindow;
    auto *splash = new frmSplash([&]() -> QWidget * { return &mainWindow; });
    QPointer<frmSplash> alive(splash);
    auto *timer = splash->findChild<QTimer *>(u"Timer1"_qs);
    QCOMPARE(timer->interval(), 3000);
    QVERIFY(timer->isActive());
    splash->show();
    QVERIFY(!mainWindow.isVisible());
    QTRY_VERIFY_WITH_TIMEOUT(mainWindow.isVisible(), frmSplash::SplashMs + 5000);
    QTRY_VERIFY(alive.isNull());
}

void tst_frmSplash::bannerFromSettings()
{
    LocalHttpServer server;
    server.AddPage("/banner.html", "<html><head><title>Banner Page</title></head><body>Ad</body></html>");
    MainRig rig(QString(), "[URL]\nBANNER_URL=" + server.Url("/banner.html").toLatin1() + "\n");
    QTRY_COMPARE_WITH_TIMEOUT(rig.Main->WebBrowser1().ReadyState(), 4, 20000);
    QCOMPARE(rig.Main->WebBrowser1().LocationName(), u"Banner Page"_qs);
    QCOMPARE(rig.Main->WebBrowser1().View()->parentWidget()->objectName(), u"Picture3"_qs);
}

void tst_frmSplash::splitterMessageBox_data()
{
    QTest::addColumn<bool>("designMode");
    QTest::addColumn<UiServices::Answer>("answer");
    QTest::addColumn<SplitterAnswer>("expected");
    QTest::newRow("design mode, No") << true << UiServices::Answer::No << SplitterAnswer::No;
    QTest::newRow("design mode, Yes") << true << UiServices::Answer::Yes << SplitterAnswer::Yes;
    QTest::newRow("OK only") << false << UiServices::Answer::Ok << SplitterAnswer::Ok;
}

void tst_frmSplash::splitterMessageBox()
{
    QFETCH(bool, designMode);
    QFETCH(UiServices::Answer, answer);
    ScriptedUiServices ui;
    ui.NextAnswers = {answer};
    SplitterMessageBox box(ui);
    const QString prompt = u"Accessing Routine: 'Token'\r\nIndex Out Of Range: -1\r\n"_qs;
    QTEST(box.ShowSplitterMessage(prompt, designMode), "expected");
    const auto buttons = designMode ? UiServices::Buttons::YesNo : UiServices::Buttons::Ok;
    QCOMPARE(Boxes(ui), QStringList{Box(prompt, buttons, UiServices::Icon::Exclamation, u"clsSplitExtra Message"_qs)});
    QCOMPARE(ui.Messages[0].DefaultButton, designMode ? UiServices::Answer::No : UiServices::Answer::Ok);
}

VERBLOOM_SHELL_TEST_MAIN(tst_frmSplash)
#include "tst_frmSplash.moc"
