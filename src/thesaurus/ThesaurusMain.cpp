// verbloom-thesaurus: the thesaurus service as a program of its own.
#include "ThesaurusService.h"

#include <QCommandLineParser>
#include <QCoreApplication>
#include <QSocketNotifier>
#include <QTextStream>

#include <csignal>
#include <sys/socket.h>
#include <unistd.h>

namespace {

int g_signalPipe[2] = {-1, -1};

void OnSignal(int)
{
    const char byte = 1;
    [[maybe_unused]] const ssize_t written = ::write(g_signalPipe[1], &byte, 1);
}

/// SIGINT and SIGTERM end the event loop, so the server closes cleanly.
bool QuitOnSignals(QCoreApplication &app)
{
    if (::socketpair(AF_UNIX, SOCK_STREAM, 0, g_signalPipe) != 0)
        return false;
    auto *notifier = new QSocketNotifier(g_signalPipe[0], QSocketNotifier::Read, &app);
    QObject::connect(notifier, &QSocketNotifier::activated, &app, [notifier] {
        notifier->setEnabled(false);
        char byte = 0;
        [[maybe_unused]] const ssize_t read = ::read(g_signalPipe[0], &byte, 1);
        QCoreApplication::quit();
    });
    struct sigaction action = {};
    action.sa_handler = OnSignal;
    sigemptyset(&action.sa_mask);
    action.sa_flags = SA_RESTART;
    return ::sigaction(SIGINT, &action, nullptr) == 0 && ::sigaction(SIGTERM, &action, nullptr) == 0;
}

} // namespace

int main(int argc, char *argv[])
{
    QCoreApplication app(argc, argv);
    QCoreApplication::setApplicationName(u"verbloom-thesaurus"_qs);
    QTextStream out(stdout);
    QTextStream err(stderr);

    QCommandLineParser parser;
    parser.setApplicationDescription(
        u"Serves the thesaurus pages of the Verbloom lookup on 127.0.0.1: GET /search?q=WORD.\n"
        "Prints the address it serves on the first line of its output; "
        "Ctrl+C (SIGINT) or SIGTERM stops it."_qs);
    parser.addHelpOption();
    const QCommandLineOption portOption(u"port"_qs,
                                        u"Port to listen on (default 0: any free port)."_qs,
                                        u"N"_qs, u"0"_qs);
    const QCommandLineOption dataOption(
        u"data"_qs, u"Thesaurus data, path without .idx/.dat (default %1)."_qs.arg(
                        verbloom::ThesaurusService::DefaultDataPath()),
        u"PATH-WITHOUT-EXTENSION"_qs, verbloom::ThesaurusService::DefaultDataPath());
    parser.addOption(portOption);
    parser.addOption(dataOption);
    if (!parser.parse(QCoreApplication::arguments())) {
        err << parser.errorText() << "\n\n" << parser.helpText();
        return 2;
    }
    if (parser.isSet(u"help"_qs)) {
        out << parser.helpText();
        return 0;
    }
    if (!parser.positionalArguments().isEmpty()) {
        err << "Unexpected argument: " << parser.positionalArguments().first() << "\n\n"
            << parser.helpText();
        return 2;
    }
    bool ok = false;
    const uint port = parser.value(portOption).toUInt(&ok);
    if (!ok || port > 65535) {
        err << "The port must be a number from 0 to 65535: " << parser.value(portOption) << '\n';
        return 2;
    }

    verbloom::ThesaurusService service;
    if (!service.Start(parser.value(dataOption), quint16(port))) {
        err << service.ErrorString() << '\n';
        return 1;
    }
    if (!QuitOnSignals(app)) {
        err << "Cannot install the signal handlers.\n";
        return 1;
    }
    out << service.BaseUrl() << Qt::endl;
    return QCoreApplication::exec();
}
