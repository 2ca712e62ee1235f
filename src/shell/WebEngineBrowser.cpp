#include "WebEngineBrowser.h"

#include "common/LineEnds.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QUrl>
#include <QVariantMap>
#include <QWebEnginePage>
#include <QWebEngineProfile>
#include <QWebEngineScript>
#include <QWebEngineSettings>
#include <QWebEngineView>

namespace verbloom {

namespace {

// Collected in the isolated world, so page scripts cannot interfere.
constexpr QStringView CollectTextsScript = u"(function () {"
    "var d = document, r = d.documentElement, b = d.body;"
    "return { root: r ? r.innerText : '', hasBody: !!b && b.tagName !== 'FRAMESET',"
    "         body: b ? b.innerText : '', title: d.title };"
    "})()";

QWebEngineProfile *SharedProfile()
{
    // No storage name: off the record, nothing lands on disk. Parented to the application so it
    // outlives every page.
    static QWebEngineProfile *profile = new QWebEngineProfile(QCoreApplication::instance());
    return profile;
}

QUrl AddressToUrl(const QString &address)
{
    if (address.trimmed().isEmpty())
        return QUrl(u"about:blank"_qs);
    if (QDir::isAbsolutePath(address) && QFileInfo::exists(address))
        return QUrl::fromLocalFile(address);
    return QUrl::fromUserInput(address);
}

} // namespace

/// A page that shows no dialogs while silent and keeps page console output out of the log.
class SilentWebPage final : public QWebEnginePage
{
public:
    using QWebEnginePage::QWebEnginePage;
    bool Silent = false;

protected:
    void javaScriptAlert(const QUrl &origin, const QString &message) override
    {
        if (!Silent)
            QWebEnginePage::javaScriptAlert(origin, message);
    }
    bool javaScriptConfirm(const QUrl &origin, const QString &message) override
    {
        return Silent ? false : QWebEnginePage::javaScriptConfirm(origin, message);
    }
    bool javaScriptPrompt(const QUrl &origin, const QString &message, const QString &defaultValue,
                          QString *result) override
    {
        return Silent ? false : QWebEnginePage::javaScriptPrompt(origin, message, defaultValue, result);
    }
    void javaScriptConsoleMessage(JavaScriptConsoleMessageLevel, const QString &, int,
                                  const QString &) override
    {
    }
};

WebEngineBrowser::WebEngineBrowser(QWidget *parentWidget)
    : Browser(parentWidget)
    , m_view(new QWebEngineView(parentWidget))
    , m_page(new SilentWebPage(SharedProfile(), m_view))
{
    m_view->setPage(m_page);
    m_view->setContextMenuPolicy(Qt::NoContextMenu);
    m_page->settings()->setAttribute(QWebEngineSettings::JavascriptCanOpenWindows, false);
    m_page->settings()->setAttribute(QWebEngineSettings::PluginsEnabled, false);
    connect(m_page, &QWebEnginePage::loadStarted, this, &WebEngineBrowser::OnLoadStarted);
    connect(m_page, &QWebEnginePage::loadFinished, this, &WebEngineBrowser::OnLoadFinished);
    connect(m_page, &QWebEnginePage::loadProgress, this,
            [this](int progress) { emit progressChanged(progress, 100); });
    connect(m_page, &QWebEnginePage::titleChanged, this, &WebEngineBrowser::titleChanged);
    connect(m_page, &QWebEnginePage::linkHovered, this, &WebEngineBrowser::statusTextChanged);
}

WebEngineBrowser::~WebEngineBrowser()
{
    // The page must go before the shared profile; the view may already be gone with its parent.
    if (m_view)
        delete m_view;
}

QWidget *WebEngineBrowser::View() const
{
    return m_view;
}

void WebEngineBrowser::Navigate(const QString &address)
{
    ++m_generation;
    Reset(1);
    const QUrl url = AddressToUrl(address);
    if (!url.isValid()) {
        m_page->setHtml(u"<html><head><title>Cannot open the page</title></head><body>"
                        "The address could not be understood.</body></html>"_qs);
        return;
    }
    m_page->load(url);
}

void WebEngineBrowser::Stop()
{
    ++m_generation;
    Reset(0);
    m_page->triggerAction(QWebEnginePage::Stop);
}

void WebEngineBrowser::SetSilent(bool silent)
{
    m_page->Silent = silent;
}

QString WebEngineBrowser::DocumentReadyState() const
{
    switch (m_readyState) {
    case 0: return u"uninitialized"_qs;
    case ReadyStateComplete: return u"complete"_qs;
    default: return u"loading"_qs;
    }
}

QString WebEngineBrowser::LocationName() const
{
    return m_title.isEmpty() ? m_page->url().toString() : m_title;
}

void WebEngineBrowser::ShowHtml(const QString &html)
{
    ++m_generation;
    Reset(1);
    m_page->setHtml(html);
}

void WebEngineBrowser::Reset(int readyState)
{
    m_readyState = readyState;
    m_awaitingStart = readyState != 0;
    m_rootText.clear();
    m_bodyText.clear();
    m_title.clear();
    m_hasBody = false;
}

void WebEngineBrowser::OnLoadStarted()
{
    if (m_readyState == 0)
        return; // a load nobody asked for after Stop
    m_awaitingStart = false;
    emit statusTextChanged(u"Opening page "_qs + m_page->requestedUrl().toString() + u"..."_qs);
}

void WebEngineBrowser::OnLoadFinished(bool)
{
    // The end of a load that a later Navigate or Stop replaced is not this page's end.
    if (m_readyState == 0 || m_readyState == ReadyStateComplete || m_awaitingStart || m_page->isLoading())
        return;
    const quint64 generation = m_generation;
    QPointer<WebEngineBrowser> self(this);
    m_page->runJavaScript(CollectTextsScript.toString(), QWebEngineScript::ApplicationWorld,
                          [self, generation](const QVariant &result) {
                              if (self)
                                  self->OnTextsCollected(generation, result);
                          });
}

void WebEngineBrowser::OnTextsCollected(quint64 generation, const QVariant &result)
{
    if (generation != m_generation || m_readyState != 1 || m_page->isLoading())
        return;
    const QVariantMap texts = result.toMap();
    m_rootText = NormalizeToCrLf(texts.value(u"root"_qs).toString());
    m_bodyText = NormalizeToCrLf(texts.value(u"body"_qs).toString());
    m_hasBody = texts.value(u"hasBody"_qs).toBool();
    m_title = texts.value(u"title"_qs).toString();
    m_readyState = ReadyStateComplete;
    emit statusTextChanged(u"Done"_qs);
    emit documentComplete();
}

} // namespace verbloom
