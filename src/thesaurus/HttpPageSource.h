#pragma once

#include "engine/ThesaurusLookup.h"

#include <QNetworkAccessManager>
#include <QObject>
#include <QPointer>
#include <QString>

class QNetworkReply;

namespace verbloom {

/// Loads pages over HTTP(S) without a browser and renders them with HtmlInnerText.
/// Redirects are followed as a browser would (never from https to http). A page that cannot be
/// loaded completes with the text of the server's error document, or with no text at all when
/// there is none (refused connection, bad address). Bodies larger than MaxPageBytes are cut off
/// and give no text. A text/plain page gives its text as it stands.
class HttpPageSource final : public QObject, public PageSource
{
    Q_OBJECT

public:
    explicit HttpPageSource(QObject *parent = nullptr);
    ~HttpPageSource() override;

    static constexpr qint64 MaxPageBytes = 32 * 1024 * 1024;

    /// Ends a load in progress; the page is then complete and empty.
    void Stop() override;
    /// Starts loading the address and returns at once.
    void Navigate(const QString &url) override;
    /// Runs a local event loop until the page is complete; false after timeoutMs (the load goes on).
    bool WaitUntilComplete(int timeoutMs) override;
    /// The rendered text of the last complete page, lines joined with CR LF.
    QString PageText() override;

    bool IsComplete() const;
    /// The HTTP status of the last page (0 when none was received).
    int HttpStatus() const;

signals:
    void Completed();

private:
    /// Ends the load in progress without completing the page; false when there was none.
    bool AbortReply();
    void Finish(QNetworkReply *reply);
    void Complete(const QString &text, int status);

    QNetworkAccessManager m_network;
    QPointer<QNetworkReply> m_reply;
    QString m_text;
    int m_status = 0;
    bool m_complete = true;
};

} // namespace verbloom
