#include "bench_thesaurus.h"

#include "thesaurus/HttpPageSource.h"
#include "thesaurus/ThesaurusService.h"

#include <QElapsedTimer>
#include <QEventLoop>
#include <QFile>
#include <QNetworkAccessManager>
#include <QNetworkReply>
#include <QRegularExpression>

#include <algorithm>

namespace verbloom::bench {

namespace {

/// Common words: the 1,000 single words with the most meanings in the thesaurus data.
QStringList CommonWords(const QString &dataPath, int count)
{
    QFile file(dataPath + u".dat"_qs);
    if (!file.open(QIODevice::ReadOnly))
        return {};
    static const QRegularExpression plainWord(u"^[a-z]+$"_qs);
    QList<std::pair<int, QString>> entries;
    while (!file.atEnd()) {
        const QByteArray line = file.readLine();
        if (line.startsWith('('))
            continue;
        const qsizetype bar = line.indexOf('|');
        const QString word = QString::fromUtf8(line.left(bar));
        if (bar > 0 && plainWord.match(word).hasMatch())
            entries.append({line.mid(bar + 1).trimmed().toInt(), word});
    }
    std::stable_sort(entries.begin(), entries.end(),
                     [](const auto &a, const auto &b) { return a.first > b.first; });
    QStringList words;
    for (qsizetype i = 0; i < entries.size() && words.size() < count; ++i)
        words.append(entries[i].second);
    return words;
}

double PerSecond(qsizetype count, qint64 nanoseconds)
{
    return double(count) / (double(nanoseconds) / 1e9);
}

} // namespace

void RunThesaurusBenchmarks(QTextStream &out)
{
    ThesaurusService service;
    if (!service.Start(ThesaurusService::DefaultDataPath())) {
        out << "thesaurus: " << service.ErrorString() << Qt::endl;
        return;
    }
    const QStringList words = CommonWords(ThesaurusService::DefaultDataPath(), 1000);
    const QString search = service.BaseUrl() + u"/search?q="_qs;

    // One lookup at a time, as the batch tool makes them: fetch over one kept-alive connection
    // and render the page to lines.
    HttpPageSource source;
    qsizetype meanings = 0;
    qint64 best = std::numeric_limits<qint64>::max();
    for (int run = 0; run < 3; ++run) {
        QElapsedTimer timer;
        timer.start();
        for (const QString &word : words) {
            source.Navigate(search + word);
            if (source.WaitUntilComplete(20000))
                meanings += source.PageText().count(u"\r\nMain Entry: "_qs);
        }
        best = std::min(best, timer.nsecsElapsed());
    }
    out << "thesaurus, " << words.size() << " common words one at a time (fetch + render): "
        << qRound(PerSecond(words.size(), best)) << " lookups/s, "
        << QString::number(double(meanings) / 3.0 / double(words.size()), 'f', 1)
        << " meanings per word" << Qt::endl;

    // All requests at once over the client's kept-alive connections (six per host).
    QNetworkAccessManager network;
    best = std::numeric_limits<qint64>::max();
    for (int run = 0; run < 3; ++run) {
        QElapsedTimer timer;
        timer.start();
        qsizetype pending = words.size();
        QEventLoop loop;
        for (const QString &word : words) {
            QNetworkReply *reply = network.get(QNetworkRequest(QUrl(search + word)));
            QObject::connect(reply, &QNetworkReply::finished, &loop, [&pending, &loop, reply] {
                reply->deleteLater();
                if (--pending == 0)
                    loop.quit();
            });
        }
        loop.exec();
        best = std::min(best, timer.nsecsElapsed());
    }
    out << "thesaurus, " << words.size() << " common words, all at once: "
        << qRound(PerSecond(words.size(), best)) << " lookups/s" << Qt::endl;
}

} // namespace verbloom::bench
