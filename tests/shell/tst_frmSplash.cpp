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

namespace {

constexpr int SplashWaitMs = frmSplash::SplashMs + 5000;

QString LabelText(QWidget *window, const QString &name)
{
    return window->findChild<QLabel *>(name)->text();
}

} // namespace

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
    const QString longName = QStringLiteral("C").repeated(100);
    QTest::newRow("no SETTINGS.INI") << QByteArray() << QString() << QString()
                                     << QStringLiteral("Please contact  in case of any problems.");
    QTest::newRow("all keys") << QByteArray("[URL]\r\nSupportUrl = help@example.com\r\nWebSiteUrl=www.example.com\r\n"
                                            "[COMPANY]\r\nCompanyName=Example Ltd.\r\n")
                              << QStringLiteral("Example Ltd.") << QStringLiteral("www.example.com")
                              << QStringLiteral("Please contact help@example.com in case of any problems.");
    QTest::newRow("sections and keys ignore case")
        << QByteArray("[url]\nwebsiteurl=site\n[company]\ncompanyname=Name\n") << QStringLiteral("Name")
        << QStringLiteral("site") << QStringLiteral("Please contact  in case of any problems.");
    QTest::newRow("100 characters cut to 79") << (QByteArray("[COMPANY]\nCompanyName=") + longName.toLatin1() + '\n')
                                              << longName.left(79) << QString()
                                              << QStringLiteral("Please contact  in case of any problems.");
}

void tst_frmSplash::labels()
{
    QFETCH(QByteArray, ini);
    QFETCH(QString, company);
    QFETCH(QString, website);
    QFETCH(QString, support);
    QTemporaryDir home;
    SetProgramFolder(home.path());
    if (!ini.isEmpty())
        QVERIFY(WriteBinaryFile(home.filePath(QStringLiteral("SETTINGS.INI")), ini));
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
    QCOMPARE(LabelText(&splash, QStringLiteral("lblCompanyNM")), company);
    QCOMPARE(LabelText(&splash, QStringLiteral("lblWebSiteURL")), website);
    QCOMPARE(LabelText(&splash, QStringLiteral("lblSupport")), support);
    QCOMPARE(LabelText(&splash, QStringLiteral("lblInternet")),
             QStringLiteral("Please make sure that you are connected to the internet."));
    QCOMPARE(LabelText(&splash, QStringLiteral("lblLoading")), QStringLiteral("Please wait, loading Verbloom ..."));
    QCOMPARE(LabelText(&splash, QStringLiteral("lblLogo")), QStringLiteral("Verbloom"));
    QCOMPARE(LabelText(&splash, QStringLiteral("lblLogoShadow")), QStringLiteral("Verbloom"));
    QCOMPARE(splash.findChild<QLabel *>(QStringLiteral("lblLogoShadow"))->palette().color(QPalette::WindowText),
             QColor(0xC0, 0xC0, 0xC0));
}

void tst_frmSplash::showsMainWindowAfterTimer()
{
    QTemporaryDir home;
    SetProgramFolder(home.path()); // no SETTINGS.INI: the program still starts
    QWidget mainWindow;
    auto *splash = new frmSplash([&]() -> QWidget * { return &mainWindow; });
    QPointer<frmSplash> alive(splash);
    auto *timer = splash->findChild<QTimer *>(QStringLiteral("Timer1"));
    QCOMPARE(timer->interval(), 3000);
    QVERIFY(timer->isActive());
    splash->show();
    QVERIFY(!mainWindow.isVisible());
    QTRY_VERIFY_WITH_TIMEOUT(mainWindow.isVisible(), SplashWaitMs);
    QTRY_VERIFY(alive.isNull());
}

void tst_frmSplash::bannerFromSettings()
{
    LocalHttpServer server;
    server.AddPage("/banner.html", "<html><head><title>Banner Page</title></head><body>Ad</body></html>");
    MainRig rig(QString(), "[URL]\nBANNER_URL=" + server.Url("/banner.html").toLatin1() + "\n");
    QTRY_COMPARE_WITH_TIMEOUT(rig.Main->WebBrowser1().ReadyState(), 4, 20000);
    QCOMPARE(rig.Main->WebBrowser1().LocationName(), QStringLiteral("Banner Page"));
    QCOMPARE(rig.Main->WebBrowser1().View()->parentWidget()->objectName(), QStringLiteral("Picture3"));
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
    QFETCH(SplitterAnswer, expected);
    ScriptedUiServices ui;
    ui.NextAnswers = {answer};
    SplitterMessageBox box(ui);
    const QString prompt = QStringLiteral("Accessing Routine: 'Token'\r\nIndex Out Of Range: -1\r\n");
    QCOMPARE(box.ShowSplitterMessage(prompt, designMode), expected);
    QCOMPARE(ui.Messages.size(), 1);
    QCOMPARE(ui.Messages[0].Text, prompt);
    QCOMPARE(ui.Messages[0].Title, QStringLiteral("clsSplitExtra Message"));
    QCOMPARE(ui.Messages[0].IconKind, UiServices::Icon::Exclamation);
    QCOMPARE(ui.Messages[0].ButtonSet, designMode ? UiServices::Buttons::YesNo : UiServices::Buttons::Ok);
    QCOMPARE(ui.Messages[0].DefaultButton, designMode ? UiServices::Answer::No : UiServices::Answer::Ok);
}

VERBLOOM_SHELL_TEST_MAIN(tst_frmSplash)
#include "tst_frmSplash.moc"
