#include "HttpPageSource.h"

#include "HtmlInnerText.h"

#include <QEventLoop>
#include <QNetworkReply>
#include <QNetworkRequest>
#include <QTimer>
#include <QUrl>

namespace verbloom {

namespace {

/// Splits "text/html; charset=UTF-8" into the lower-case type and the charset.
void ParseContentType(const QByteArray &header, QByteArray &type, QByteArray &charset)
{
    const QList<QByteArray> parts = header.split(';');
    type = parts.value(0).trimmed().toLower();
    charset.clear();
    for (qsizetype i = 1; i < parts.size(); ++i) {
        const QByteArray part = parts[i].trimmed();
        if (part.toLower().startsWith("charset=")) {
            charset = part.mid(8).trimmed();
            if (charset.size() >= 2 && charset.startsWith('"') && charset.endsWith('"'))
                charset = charset.mid(1, charset.size() - 2);
        }
    }
}

QString PlainText(const QByteArray &body, const QByteArray &charset)
{
    QString text = DecodePage(body, charset, false);
    text.replace(u"\r\n"_qs, u"\n"_qs).replace(QLatin1Char('\r'), QLatin1Char('\n'));
    while (text.endsWith(QLatin1Char('\n')))
        text.chop(1);
    return text.replace(QLatin1Char('\n'), u"\r\n"_qs);
}

} // namespace

HttpPageSource::HttpPageSource(QObject *parent)
    : QObject(parent)
{
}

HttpPageSource::~HttpPageSource()
{
    AbortReply();
}

void HttpPageSource::Stop()
{
    if (AbortReply())
        Complete(QString(), 0);
}

bool HttpPageSource::AbortReply()
{
    QNetworkReply *reply = m_reply;
    if (!reply)
        return false;
    m_reply = nullptr;
    reply->disconnect(this);
    reply->abort();
    reply->deleteLater();
    return true;
}

void HttpPageSource::Navigate(const QString &url)
{
    Stop();
    m_complete = false;
    m_text.clear();
    m_status = 0;
    const QUrl target(url);
    if (!target.isValid()
        || (target.scheme() != QLatin1String("http") && target.scheme() != QLatin1String("https"))) {
        Complete(QString(), 0);
        return;
    }
    QNetworkRequest request(target);
    request.setAttribute(QNetworkRequest::RedirectPolicyAttribute,
                         QNetworkRequest::NoLessSafeRedirectPolicy);
    request.setHeader(QNetworkRequest::UserAgentHeader, QByteArrayLiteral("Verbloom/1.0"));
    QNetworkReply *reply = m_network.get(request);
    m_reply = reply;
    connect(reply, &QNetworkReply::finished, this, [this, reply] { Finish(reply); });
    connect(reply, &QNetworkReply::downloadProgress, this, [reply](qint64 received, qint64) {
        if (received > MaxPageBytes)
            reply->abort();
    });
}

bool HttpPageSource::WaitUntilComplete(int timeoutMs)
{
    if (m_complete)
        return true;
    QEventLoop loop;
    QTimer timer;
    timer.setSingleShot(true);
    connect(&timer, &QTimer::timeout, &loop, &QEventLoop::quit);
    connect(this, &HttpPageSource::Completed, &loop, &QEventLoop::quit);
    if (timeoutMs >= 0)
        timer.start(timeoutMs);
    loop.exec();
    return m_complete;
}

QString HttpPageSource::PageText()
{
    return m_text;
}

bool HttpPageSource::IsComplete() const
{
    return m_complete;
}

int HttpPageSource::HttpStatus() const
{
    return m_status;
}

void HttpPageSource::Finish(QNetworkReply *reply)
{
    reply->deleteLater();
    if (reply != m_reply)
        return;
    m_reply = nullptr;
    const int status = reply->attribute(QNetworkRequest::HttpStatusCodeAttribute).toInt();
    if (reply->error() == QNetworkReply::OperationCanceledError) {
        Complete(QString(), status);
        return;
    }
    const QByteArray body = reply->readAll();
    QByteArray type;
    QByteArray charset;
    ParseContentType(reply->rawHeader("Content-Type"), type, charset);
    Complete(type == "text/plain" ? PlainText(body, charset) : HtmlInnerText(body, charset), status);
}

void HttpPageSource::Complete(const QString &text, int status)
{
    m_text = text;
    m_status = status;
    m_complete = true;
    emit Completed();
}

} // namespace verbloom
