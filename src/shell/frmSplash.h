#pragma once

#include <QWidget>

#include <functional>

class QLabel;
class QTimer;

namespace verbloom {

/// The start window: logo and the maker's contact data from SETTINGS.INI. Loading it loads the
/// main window hidden (through the function given); three seconds later its timer shows the
/// main window and the splash window goes away.
class frmSplash final : public QWidget
{
    Q_OBJECT

public:
    /// Interval of Timer1.
    static constexpr int SplashMs = 3000;

    /// Runs the load steps at once: StopProcessing, the three labels, loading the main window.
    explicit frmSplash(std::function<QWidget *()> loadMainWindow, QWidget *parent = nullptr);

private:
    void Form_Load();
    void Timer1_Timer();
    void BuildWindow();

    std::function<QWidget *()> m_loadMainWindow;
    QWidget *m_mainWindow = nullptr;

    QLabel *lblCompanyNM = nullptr;
    QLabel *lblWebSiteURL = nullptr;
    QLabel *lblSupport = nullptr;
    QTimer *Timer1 = nullptr;
};

} // namespace verbloom
