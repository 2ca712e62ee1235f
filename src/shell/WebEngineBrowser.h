#pragma once

#include "Browser.h"

#include <QPointer>

class QWebEngineView;

namespace verbloom {

class SilentWebPage;

/// The browser on Qt WebEngine. All instances share one off-the-record profile, so nothing is
/// written to the user's disk. When loading ends (also with an error page), the root and body
/// texts and the title are fetched from the page; the browser reports complete after that.
class WebEngineBrowser final : public Browser
{
    Q_OBJECT

public:
    /// The view becomes a child of parentWidget.
    explicit WebEngineBrowser(QWidget *parentWidget);
    ~WebEngineBrowser() override;

    QWidget *View() const override;
    void Navigate(const QString &address) override;
    void Stop() override;
    void SetSilent(bool silent) override;
    int ReadyState() const override { return m_readyState; }
    QString DocumentReadyState() const override;
    QString RootInnerText() const override { return m_rootText; }
    QString BodyInnerText() const override { return m_bodyText; }
    bool HasBody() const override { return m_hasBody; }
    QString LocationName() const override;

    /// Shows a page made of the given markup (the banner when no address is set).
    void ShowHtml(const QString &html);

private:
    void OnLoadStarted();
    void OnLoadFinished(bool ok);
    void OnTextsCollected(quint64 generation, const QVariant &result);
    void Reset(int readyState);

    QPointer<QWebEngineView> m_view;
    SilentWebPage *m_page = nullptr;
    int m_readyState = 0;
    quint64 m_generation = 0; ///< raised by every Navigate and Stop; stale results are dropped
    QString m_rootText;
    QString m_bodyText;
    QString m_title;
    bool m_hasBody = false;
    bool m_awaitingStart = false; ///< Navigate was called and its load has not started yet
};

} // namespace verbloom
