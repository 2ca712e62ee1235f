#include "frmSplash.h"

#include "common/IniFile.h"
#include "common/ProgramFolder.h"
#include "shell/ArticleModel.h"

#include <QCoreApplication>
#include <QFrame>
#include <QGridLayout>
#include <QGuiApplication>
#include <QLabel>
#include <QPalette>
#include <QScreen>
#include <QTimer>
#include <QVBoxLayout>

namespace verbloom {

namespace {

QLabel *MakeLabel(const QString &name, const QString &text, QWidget *parent)
{
    auto *label = new QLabel(text, parent);
    label->setObjectName(name);
    label->setWordWrap(true);
    return label;
}

} // namespace

frmSplash::frmSplash(std::function<QWidget *()> loadMainWindow, QWidget *parent)
    : QWidget(parent, Qt::SplashScreen | Qt::FramelessWindowHint)
    , m_loadMainWindow(std::move(loadMainWindow))
{
    setObjectName(u"frmSplash"_qs);
    setWindowTitle(u"Verbloom"_qs);
    BuildWindow();
    Timer1 = new QTimer(this);
    Timer1->setObjectName(u"Timer1"_qs);
    Timer1->setInterval(SplashMs);
    Timer1->setSingleShot(true); // the window unloads when it fires
    connect(Timer1, &QTimer::timeout, this, &frmSplash::Timer1_Timer);
    Timer1->start();
    Form_Load();
}

void frmSplash::BuildWindow()
{
    auto *background = new QFrame(this);
    background->setObjectName(u"Picture1"_qs);

    // The logo: the product name twice, the light grey copy a little lower right as its shadow.
    auto *logo = new QWidget(background);
    auto *logoLayout = new QGridLayout(logo);
    logoLayout->setContentsMargins(0, 0, 0, 0);
    auto *shadow = MakeLabel(u"lblLogoShadow"_qs, u"Verbloom"_qs, logo);
    auto *front = MakeLabel(u"lblLogo"_qs, u"Verbloom"_qs, logo);
    QPalette shadowPalette = shadow->palette();
    shadowPalette.setColor(QPalette::WindowText, QColor(0xC0, 0xC0, 0xC0));
    shadow->setPalette(shadowPalette);
    shadow->setContentsMargins(4, 4, 0, 0);
    front->setContentsMargins(0, 0, 4, 4);
    logoLayout->addWidget(shadow, 0, 0);
    logoLayout->addWidget(front, 0, 0);

    auto *tagline = MakeLabel(u"lblTagline"_qs, u"One article, many unique versions"_qs, background);
    lblCompanyNM = MakeLabel(u"lblCompanyNM"_qs, QString(), background);
    lblWebSiteURL = MakeLabel(u"lblWebSiteURL"_qs, QString(), background);
    lblSupport = MakeLabel(u"lblSupport"_qs, QString(), background);
    auto *legal = MakeLabel(u"lblLegal"_qs,
                            u"This program is protected by copyright law. Copying or passing on "
                            "this program, or any part of it, without permission is not allowed."_qs,
                            background);
    auto *internet = MakeLabel(u"lblInternet"_qs,
                               u"Please make sure that you are connected to the internet."_qs, background);
    auto *loading = MakeLabel(u"lblLoading"_qs, u"Please wait, loading Verbloom ..."_qs, background);

    auto *layout = new QVBoxLayout(background);
    layout->setContentsMargins(36, 28, 36, 24);
    layout->setSpacing(6);
    layout->addWidget(logo, 0, Qt::AlignLeft);
    layout->addWidget(tagline);
    layout->addSpacing(18);
    layout->addWidget(lblCompanyNM);
    layout->addWidget(lblWebSiteURL);
    layout->addWidget(lblSupport);
    layout->addStretch(1);
    layout->addWidget(internet);
    layout->addWidget(loading);
    layout->addSpacing(8);
    layout->addWidget(legal);

    auto *outer = new QVBoxLayout(this);
    outer->setContentsMargins(0, 0, 0, 0);
    outer->addWidget(background);
    resize(560, 340);
    if (const QScreen *screen = QGuiApplication::primaryScreen())
        move(screen->availableGeometry().center() - rect().center());
}

void frmSplash::Form_Load()
{
    StopProcessing = true;
    const QString ini = SettingsIniPath();
    lblSupport->setText(u"Please contact "_qs + ReadIniValue(u"URL"_qs, u"SupportUrl"_qs, ini)
                        + u" in case of any problems."_qs);
    lblCompanyNM->setText(ReadIniValue(u"COMPANY"_qs, u"CompanyName"_qs, ini));
    lblWebSiteURL->setText(ReadIniValue(u"URL"_qs, u"WebSiteUrl"_qs, ini));
    if (m_loadMainWindow)
        m_mainWindow = m_loadMainWindow();
    QCoreApplication::processEvents();
}

void frmSplash::Timer1_Timer()
{
    if (m_mainWindow)
        m_mainWindow->show();
    close();
    deleteLater();
}

} // namespace verbloom
