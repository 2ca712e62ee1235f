#include "bench_export.h"

#include "BenchVocabulary.h"

#include "common/TextFile.h"
#include "engine/RandomSource.h"
#include "engine/SpinGenerator.h"
#include "engine/WordStore.h"
#include "export/SpinnerVersionSource.h"
#include "export/SqlExport.h"
#include "shell/ArticleModel.h"
#include "site/modGenerateWebPages.h"

#include <QDir>
#include <QElapsedTimer>
#include <QFile>
#include <QFileInfo>
#include <QRandomGenerator>
#include <QTemporaryDir>
#include <QTextStream>

#include <functional>

namespace verbloom::bench {

namespace {

constexpr int kWords = 1000;
constexpr int kVocabulary = 300;

// A kilobyte figure of /proc/self/status ("VmHWM", "VmRSS"); -1 when unknown.
qint64 StatusKiB(const char *field)
{
    QFile status(QStringLiteral("/proc/self/status"));
    if (!status.open(QIODevice::ReadOnly))
        return -1;
    const QByteArray prefix = QByteArray(field) + ':';
    for (const QByteArray &line : status.readAll().split('\n')) {
        if (line.startsWith(prefix))
            return line.mid(prefix.size()).trimmed().split(' ').value(0).toLongLong();
    }
    return -1;
}

// Starts a new peak: the high-water mark falls back to the memory in use now (Linux).
bool ResetPeak()
{
    QFile clearRefs(QStringLiteral("/proc/self/clear_refs"));
    return clearRefs.open(QIODevice::WriteOnly) && clearRefs.write("5") == 1;
}

// A 1,000-word article whose every word has a word file of three alternatives.
ArticleBoxes MakeArticle(const WordStore &store)
{
    QRandomGenerator random(7);
    const QStringList vocabulary = MakeVocabulary(random, kVocabulary);
    WriteWordFiles(store, vocabulary, random, 3, 3, false);
    ArticleBoxes article;
    for (int i = 0; i < 8; ++i)
        article.Title += vocabulary.at(random.bounded(kVocabulary)) + u' ';
    for (int i = 1; i <= kWords; ++i) {
        article.Contents += vocabulary.at(random.bounded(kVocabulary));
        article.Contents += i % 50 == 0 ? u".\r\n"_qs : (i % 10 == 0 ? u". "_qs : u" "_qs);
    }
    if (!article.Contents.endsWith(u' '))
        article.Contents += u' ';
    return article;
}

// Runs one measure with the spin generator over the article and prints seconds and memory.
void Measure(QTextStream &out, const QString &name, const QString &home, const ArticleBoxes &article,
             const std::function<QString(ArticleBoxes &, VersionSource &)> &work)
{
    const WordStore store(home);
    const ArticleTokens tokens = SplitArticle(article.Title, article.Contents);
    SpinSettings settings;
    settings.CustomizationLevel = 0; // "Maximum": every word is replaced
    MersenneRandomSource random;

    const bool reset = ResetPeak();
    const qint64 before = StatusKiB("VmRSS");
    QElapsedTimer timer;
    timer.start();
    CachedWordFileAlternatives alternatives(store);
    Spinner spinner(tokens, settings, alternatives, random);
    SpinnerVersionSource source(spinner);
    ArticleBoxes boxes = article;
    const QString outcome = work(boxes, source);
    const double seconds = double(timer.nsecsElapsed()) / 1e9;
    const qint64 peak = StatusKiB("VmHWM");
    out << name << ": " << QString::number(seconds, 'f', 3) << " s, peak memory "
        << QString::number(double(peak) / 1024.0, 'f', 1) << " MiB ("
        << (reset ? u"+"_qs + QString::number(double(peak - before) / 1024.0, 'f', 1) + u" MiB during the run"_qs
                  : u"peak since start"_qs)
        << "), " << outcome << "\n";
    out.flush();
}

} // namespace

void RunExportBenchmarks(QTextStream &out)
{
    QTemporaryDir home;
    if (!home.isValid()) {
        out << "export: no temporary folder\n";
        return;
    }
    const ArticleBoxes article = MakeArticle(WordStore(home.path()));

    Measure(out, u"SQL export, 10,000 versions of a 1,000-word article"_qs, home.path(), article,
            [&](ArticleBoxes &boxes, VersionSource &source) -> QString {
                SqlExportOptions options;
                options.FileName = home.filePath(u"export.sql"_qs);
                options.TableName = u"articles"_qs;
                options.TitleFieldName = u"title"_qs;
                options.ArticleFieldName = u"body"_qs;
                options.Count = u"10000"_qs;
                const SqlExportResult result = ExportSql(options, boxes, source);
                return QString::number(result.Versions) + u" statements, "_qs
                    + QString::number(QFileInfo(options.FileName).size() / (1024 * 1024)) + u" MiB file"_qs;
            });

    const QString templates = home.filePath(u"templates"_qs);
    const QString output = home.filePath(u"site"_qs);
    QDir().mkpath(templates);
    QDir().mkpath(output);
    WriteTextFile(templates + u"/bench.htm"_qs,
                  u"<html><head><title>#TITLE#</title></head><body>#TOPADCODE#<div>#LEFTADCODE#</div>"
                  "<div>#NAV_LINK#</div><div>#CONTENT#</div><div>#RIGHTADCODE#</div>#BOTTOMADCODE#</body></html>"_qs);
    Measure(out, u"Site, 1,000 pages x 10 links of a 1,000-word article"_qs, home.path(), article,
            [&](ArticleBoxes &boxes, VersionSource &source) -> QString {
                SiteOptions options = DefaultSiteOptions({u"bench.htm"_qs});
                options.OutputFolder = output;
                options.NoOfPages = u"1000"_qs;
                options.LinkCount = u"10"_qs;
                options.TopCode = u"<div class='ad'>top</div>"_qs;
                const SiteRunResult result = GenerateWebSite(home.path(), options, boxes, source);
                return QString::number(result.FilesWritten) + u" files written, "_qs
                    + QString::number(result.FailedFiles.size()) + u" failed"_qs;
            });
}

} // namespace verbloom::bench
