#pragma once

#include <QObject>
#include <QString>

#include <memory>

class QHttpServer;
class QHttpServerRequest;
class QHttpServerResponder;

namespace verbloom {

class ThesaurusData;

/// The thesaurus behind a small HTTP server on 127.0.0.1: GET /search?q=WORD answers the word's
/// thesaurus page (see ThesaurusPageHtml). The word is percent-decoded UTF-8, looked up in lower
/// case; a bad encoding gives 400, another path 404, another method than GET or HEAD 405.
/// Requests are answered on the thread that owns the service, through its event loop.
class ThesaurusService final : public QObject
{
    Q_OBJECT

public:
    explicit ThesaurusService(QObject *parent = nullptr);
    ~ThesaurusService() override;

    /// "/usr/share/mythes/th_en_US_v2": Debian's English thesaurus, without extension.
    static QString DefaultDataPath();

    /// Opens PATH.idx/PATH.dat and listens on 127.0.0.1:port (0 picks a free port).
    /// False when the data cannot be read or the port is busy; see ErrorString().
    bool Start(const QString &dataPathWithoutExtension, quint16 port = 0);
    /// Listens without data: every word gets a page without meanings.
    bool StartWithoutData(quint16 port = 0);

    /// Why Start failed, in words for the user.
    QString ErrorString() const;
    bool IsListening() const;
    bool HasData() const;
    quint16 Port() const;
    /// "http://127.0.0.1:<port>", or "" when not listening.
    QString BaseUrl() const;

private:
    bool Listen(quint16 port);
    void Answer(const QHttpServerRequest &request, QHttpServerResponder &&responder);

    std::unique_ptr<ThesaurusData> m_data;
    QHttpServer *m_server = nullptr;
    quint16 m_port = 0;
    QString m_error;
};

/// SETTINGS.INI [URL] ThesaurusUrl without trailing "/", or "" when the embedded service is to
/// be used (key empty or missing).
QString ConfiguredThesaurusUrl(const QString &settingsIniPath);

/// Where the lookups of this run go.
struct ThesaurusHost
{
    QString Url;       ///< such as "http://127.0.0.1:41234"; "" only when nothing could be started
    QString Message;   ///< a problem to show the user once; "" when all is well
    ThesaurusService *Service = nullptr; ///< the embedded service, owned by the parent given
};

/// Start-up of the program and the batch tool: the configured ThesaurusUrl when SETTINGS.INI
/// names one, else the embedded service on a free loopback port. When the data is missing the
/// service still runs without it (lookups find nothing at once) and Message says why.
ThesaurusHost StartThesaurusHost(const QString &settingsIniPath, QObject *parent,
                                 const QString &dataPathWithoutExtension
                                 = ThesaurusService::DefaultDataPath());

} // namespace verbloom
