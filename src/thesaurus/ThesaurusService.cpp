#include "ThesaurusService.h"

#include "ThesaurusData.h"
#include "ThesaurusPage.h"

#include "common/IniFile.h"

#include <QHostAddress>
#include <QHttpServer>
#include <QHttpServerRequest>
#include <QHttpServerResponder>
#include <QStringDecoder>
#include <QTcpServer>
#include <QUrl>

#include <optional>

namespace verbloom {

namespace {

using Status = QHttpServerResponder::StatusCode;

int HexValue(char c)
{
    if (c >= '0' && c <= '9')
        return c - '0';
    if (c >= 'a' && c <= 'f')
        return c - 'a' + 10;
    if (c >= 'A' && c <= 'F')
        return c - 'A' + 10;
    return -1;
}

/// Decodes "%XX" sequences and "+" (a blank); nullopt for a broken "%" sequence.
std::optional<QByteArray> PercentDecode(QByteArrayView text)
{
    QByteArray bytes;
    bytes.reserve(text.size());
    for (qsizetype i = 0; i < text.size(); ++i) {
        const char c = text[i];
        if (c == '+') {
            bytes.append(' ');
        } else if (c != '%') {
            bytes.append(c);
        } else {
            if (i + 2 >= text.size())
                return std::nullopt;
            const int high = HexValue(text[i + 1]);
            const int low = HexValue(text[i + 2]);
            if (high < 0 || low < 0)
                return std::nullopt;
            bytes.append(char(high * 16 + low));
            i += 2;
        }
    }
    return bytes;
}

/// The word of the query "q=WORD": percent-decoded UTF-8 without control characters.
/// "" when the key is missing; nullopt when the value is not valid.
std::optional<QString> QueryWord(QByteArrayView query)
{
    for (QByteArrayView pair : query.toByteArray().split('&')) {
        const qsizetype eq = pair.indexOf('=');
        const QByteArrayView key = eq < 0 ? pair : pair.first(eq);
        if (key != "q")
            continue;
        const std::optional<QByteArray> bytes
            = PercentDecode(eq < 0 ? QByteArrayView() : pair.sliced(eq + 1));
        if (!bytes)
            return std::nullopt;
        QStringDecoder decode(QStringConverter::Utf8, QStringConverter::Flag::Stateless);
        const QString word = decode(*bytes);
        if (decode.hasError())
            return std::nullopt;
        for (const QChar c : word) {
            if (c.unicode() < 0x20 || c.unicode() == 0x7f)
                return std::nullopt;
        }
        return word;
    }
    return QString();
}

void WriteHtml(QHttpServerResponder &responder, const QHttpServerRequest &request,
               const QByteArray &html, Status status,
               const QByteArray &allow = QByteArray())
{
    responder.writeStatusLine(status);
    responder.writeHeader("Content-Type", "text/html; charset=utf-8");
    responder.writeHeader("Content-Length", QByteArray::number(html.size()));
    responder.writeHeader("Cache-Control", "no-store");
    if (!allow.isEmpty())
        responder.writeHeader("Allow", allow);
    responder.writeBody(request.method() == QHttpServerRequest::Method::Head ? QByteArray() : html);
}

} // namespace

ThesaurusService::ThesaurusService(QObject *parent)
    : QObject(parent)
{
}

ThesaurusService::~ThesaurusService() = default;

QString ThesaurusService::DefaultDataPath()
{
    return u"/usr/share/mythes/th_en_US_v2"_qs;
}

bool ThesaurusService::Start(const QString &dataPathWithoutExtension, quint16 port)
{
    auto data = std::make_unique<ThesaurusData>();
    if (!data->Open(dataPathWithoutExtension, &m_error))
        return false;
    if (!Listen(port))
        return false;
    m_data = std::move(data);
    return true;
}

bool ThesaurusService::StartWithoutData(quint16 port)
{
    return Listen(port);
}

bool ThesaurusService::Listen(quint16 port)
{
    if (m_server) {
        m_error = u"The thesaurus service is already running."_qs;
        return false;
    }
    auto *tcp = new QTcpServer(this);
    if (!tcp->listen(QHostAddress::LocalHost, port)) {
        m_error = u"The thesaurus service cannot listen on 127.0.0.1:%1: %2"_qs.arg(port).arg(
            tcp->errorString());
        delete tcp;
        return false;
    }
    m_server = new QHttpServer(this);
    m_server->route(u"/search"_qs,
                    [this](const QHttpServerRequest &request, QHttpServerResponder &&responder) {
                        Answer(request, std::move(responder));
                    });
    // Other paths, and methods the router does not know, end here.
    m_server->setMissingHandler([this](const QHttpServerRequest &request,
                                       QHttpServerResponder &&responder) {
        Answer(request, std::move(responder));
    });
    m_server->bind(tcp);
    m_port = tcp->serverPort();
    m_error.clear();
    return true;
}

void ThesaurusService::Answer(const QHttpServerRequest &request, QHttpServerResponder &&responder)
{
    if (request.url().path() != QLatin1String("/search")) {
        WriteHtml(responder, request,
                  MessagePageHtml(u"Not found"_qs, u"This server answers /search?q=WORD only."_qs),
                  Status::NotFound);
        return;
    }
    const auto method = request.method();
    if (method != QHttpServerRequest::Method::Get && method != QHttpServerRequest::Method::Head) {
        WriteHtml(responder, request,
                  MessagePageHtml(u"Method not allowed"_qs, u"Use GET /search?q=WORD."_qs),
                  Status::MethodNotAllowed, "GET, HEAD");
        return;
    }
    const std::optional<QString> word = QueryWord(request.url().query(QUrl::FullyEncoded).toLatin1());
    if (!word) {
        WriteHtml(responder, request,
                  MessagePageHtml(u"Bad request"_qs,
                                  u"The word must be percent-encoded UTF-8 text."_qs),
                  Status::BadRequest);
        return;
    }
    const QString trimmed = word->trimmed();
    const QList<ThesaurusMeaning> meanings = m_data ? m_data->Lookup(trimmed)
                                                    : QList<ThesaurusMeaning>();
    WriteHtml(responder, request, ThesaurusPageHtml(trimmed, meanings), Status::Ok);
}

QString ThesaurusService::ErrorString() const
{
    return m_error;
}

bool ThesaurusService::IsListening() const
{
    return m_server != nullptr;
}

bool ThesaurusService::HasData() const
{
    return m_data != nullptr;
}

quint16 ThesaurusService::Port() const
{
    return m_port;
}

QString ThesaurusService::BaseUrl() const
{
    return m_server ? u"http://127.0.0.1:%1"_qs.arg(m_port) : QString();
}

QString ConfiguredThesaurusUrl(const QString &settingsIniPath)
{
    QString url = ReadIniValue(u"URL"_qs, u"ThesaurusUrl"_qs, settingsIniPath).trimmed();
    while (url.endsWith(QLatin1Char('/')))
        url.chop(1);
    return url;
}

ThesaurusHost StartThesaurusHost(const QString &settingsIniPath, QObject *parent,
                                 const QString &dataPathWithoutExtension)
{
    ThesaurusHost host;
    host.Url = ConfiguredThesaurusUrl(settingsIniPath);
    if (!host.Url.isEmpty()) {
        const QUrl url(host.Url, QUrl::StrictMode);
        if (!url.isValid() || url.host().isEmpty()
            || (url.scheme() != QLatin1String("http") && url.scheme() != QLatin1String("https")))
            host.Message = u"ThesaurusUrl in SETTINGS.INI is not an http address: %1"_qs.arg(host.Url);
        return host;
    }
    auto *service = new ThesaurusService(parent);
    if (!service->Start(dataPathWithoutExtension)) {
        host.Message = service->ErrorString()
            + u" Words will not be looked up. Install the package mythes-en-us, or set ThesaurusUrl "
              "in the [URL] section of SETTINGS.INI to the address of another thesaurus."_qs;
        if (!service->StartWithoutData()) {
            host.Message = service->ErrorString() + u" Words will not be looked up."_qs;
            delete service;
            return host;
        }
    }
    host.Service = service;
    host.Url = service->BaseUrl();
    return host;
}

} // namespace verbloom
