#include "BrowserPageSource.h"

#include "Browser.h"
#include "shell/ArticleModel.h"

#include <QEventLoop>
#include <QTimer>

namespace verbloom {

namespace {

// How often a waiting lookup looks at StopProcessing, so Cancel ends it quickly.
constexpr int StopPollMs = 100;

} // namespace

BrowserPageSource::BrowserPageSource(Browser &browser)
    : m_browser(browser)
{
}

void BrowserPageSource::Stop()
{
    m_browser.Stop();
}

void BrowserPageSource::Navigate(const QString &url)
{
    m_browser.Navigate(url);
}

bool BrowserPageSource::IsComplete() const
{
    return m_browser.ReadyState() == Browser::ReadyStateComplete
        && m_browser.DocumentReadyState() == u"complete";
}

bool BrowserPageSource::WaitUntilComplete(int timeoutMs)
{
    if (IsComplete())
        return true;
    QEventLoop loop;
    QTimer deadline;
    deadline.setSingleShot(true);
    QTimer stopPoll;
    QObject::connect(&m_browser, &Browser::documentComplete, &loop, &QEventLoop::quit);
    QObject::connect(&deadline, &QTimer::timeout, &loop, &QEventLoop::quit);
    QObject::connect(&stopPoll, &QTimer::timeout, &loop, [&loop] {
        if (StopProcessing)
            loop.quit();
    });
    deadline.start(timeoutMs);
    stopPoll.start(StopPollMs);
    while (!IsComplete() && deadline.isActive() && !StopProcessing) {
        if (loop.exec() != 0)
            break; // the application is quitting
    }
    return IsComplete();
}

QString BrowserPageSource::PageText()
{
    return m_browser.RootInnerText();
}

} // namespace verbloom
