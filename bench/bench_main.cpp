// verbloom-bench: speed measurements. One function per measure, each printing one line.
#include "bench_export.h"
#include "bench_spin.h"
#include "bench_thesaurus.h"
#include "shell/ArticleModel.h"

#include <QCoreApplication>
#include <QElapsedTimer>
#include <QLocale>
#include <QTextStream>

#include <algorithm>
#include <limits>
#include <random>

using namespace verbloom;

namespace {

QTextStream &Out()
{
    static QTextStream out(stdout);
    return out;
}

/// The fastest of `runs` runs of `work`, in nanoseconds.
template<typename Work>
qint64 BestOf(int runs, Work work)
{
    qint64 best = std::numeric_limits<qint64>::max();
    for (int run = 0; run < runs; ++run) {
        QElapsedTimer timer;
        timer.start();
        work();
        best = std::min(best, timer.nsecsElapsed());
    }
    return best;
}

/// Article contents of words, blanks, punctuation and CR LF line breaks, ending with a blank.
/// Stops at `maxTokens` tokens (as the article splits) or at `maxChars` characters, whichever
/// comes first.
QString SampleContents(qsizetype maxTokens, qsizetype maxChars)
{
    static const QStringList words{
        u"the"_qs, u"Customers"_qs, u"article"_qs, u"wonderful"_qs, u"and"_qs, u"garden"_qs,
        u"quickly"_qs, u"marketing"_qs, u"was"_qs, u"Internet"_qs, u"improve"_qs, u"results"_qs,
        u"mp3"_qs, u"your"_qs, u"business"_qs, u"writing"_qs, u"simple"_qs, u"because"_qs,
        u"don"_qs, u"well"_qs, u"known"_qs, u"Everything"_qs, u"50%"_qs, u"publish"_qs};
    static const QStringList separators{u" "_qs, u" "_qs, u" "_qs, u" "_qs, u" "_qs,
                                        u", "_qs, u". "_qs, u"-"_qs, u"'"_qs, u"\r\n"_qs};
    std::mt19937 random(1);
    QString text;
    qsizetype tokens = 0;
    while (maxTokens - tokens >= 3 && text.size() < maxChars) {
        text += words.at(qsizetype(random() % words.size()));
        const QString &separator = separators.at(qsizetype(random() % separators.size()));
        text += separator;
        tokens += 1 + (separator.size() == 2 && separator != u"\r\n"_qs ? 2 : 1);
    }
    if (!text.endsWith(QLatin1Char(' '))) {
        text += QLatin1Char(' ');
        ++tokens;
    }
    while (tokens < maxTokens && text.size() < maxChars) { // pad to the exact count
        text += QLatin1Char(' ');
        ++tokens;
    }
    return text;
}

void BenchSplitArticle()
{
    const qsizetype size = 1024 * 1024;
    const QString contents = SampleContents(std::numeric_limits<qsizetype>::max(), size);
    const QString title = u"Sample article title "_qs;
    const qint64 nanoseconds = BestOf(7, [&] { SplitArticle(title, contents); });
    const double megabytes = double(contents.size() + title.size()) / (1024.0 * 1024.0);
    Out() << "split 1 MB article: " << qRound(megabytes / (double(nanoseconds) / 1e9))
          << " MB/s" << Qt::endl;
}

void BenchSplitAndWordTest(qsizetype tokenCount)
{
    const QString contents = SampleContents(tokenCount, std::numeric_limits<qsizetype>::max());
    const QString title = u"Sample article title "_qs;
    const WordTestSettings settings{3, {u"about"_qs, u"after"_qs, u"because"_qs, u"could"_qs,
                                        u"every"_qs, u"their"_qs, u"there"_qs, u"these"_qs,
                                        u"which"_qs, u"would"_qs}};
    if (SplitArticle(title, contents).ContentsTokens.size() != tokenCount)
        Out() << "(sample article has the wrong token count)" << Qt::endl;
    qsizetype customizable = 0;
    const qint64 nanoseconds = BestOf(5, [&] {
        const ArticleTokens article = SplitArticle(title, contents);
        for (const QStringList *tokens : {&article.TitleTokens, &article.ContentsTokens}) {
            customizable += std::count_if(tokens->begin(), tokens->end(), [&](const QString &t) {
                return IsCustomizableWord(t, settings);
            });
        }
    });
    if (customizable == 0)
        Out() << "(no customizable word)" << Qt::endl;
    Out() << "split + word test, " << QLocale(QLocale::English).toString(tokenCount)
          << " tokens: " << QString::number(double(nanoseconds) / 1e6, 'f', 2) << " ms"
          << Qt::endl;
}

} // namespace

int main(int argc, char *argv[])
{
    QCoreApplication app(argc, argv);
    BenchSplitArticle();
    BenchSplitAndWordTest(10000);
    BenchSplitAndWordTest(100000);
    verbloom::bench::RunSpinBenchmarks(Out());
    verbloom::bench::RunExportBenchmarks(Out());
    verbloom::bench::RunThesaurusBenchmarks(Out());
    return 0;
}
