#include "bench_spin.h"

#include "BenchVocabulary.h"

#include "engine/RandomSource.h"
#include "engine/SpinGenerator.h"
#include "engine/WordStore.h"
#include "shell/ArticleModel.h"

#include <QElapsedTimer>
#include <QRandomGenerator>
#include <QStringList>
#include <QTemporaryDir>
#include <QTextStream>

#include <ctime>

namespace verbloom::bench {

namespace {

constexpr int kArticleWords = 1000;
constexpr int kVocabulary = 400;

// A made-up word of 2 to 4 syllables: at least 4 letters, so every one is customizable.
struct BenchArticle
{
    ArticleTokens Tokens;
    qsizetype CustomizableTokens = 0;
};

// 1,000 words in sentences of 12 with commas and paragraphs; every word has a word file of
// 2 to 5 alternatives, some of them phrases.
BenchArticle MakeArticle(const WordStore &store, const WordTestSettings &wordTest)
{
    QRandomGenerator random(2024);
    const QStringList vocabulary = bench::MakeVocabulary(random, kVocabulary);
    bench::WriteWordFiles(store, vocabulary, random, 2, 5, true);

    QString title;
    for (int i = 0; i < 8; ++i)
        title += vocabulary.at(random.bounded(kVocabulary)) + u' ';
    QString contents;
    for (int i = 1; i <= kArticleWords; ++i) {
        QString word = vocabulary.at(random.bounded(kVocabulary));
        if (i % 12 == 1)
            word[0] = word[0].toUpper();
        contents += word;
        if (i % 60 == 0)
            contents += QLatin1String(".\r\n");
        else if (i % 12 == 0)
            contents += QLatin1String(". ");
        else if (i % 7 == 0)
            contents += QLatin1String(", ");
        else
            contents += u' ';
    }
    if (!contents.endsWith(u' '))
        contents += u' ';

    BenchArticle article;
    article.Tokens = SplitArticle(title, contents);
    for (const QStringList *tokens : {&article.Tokens.TitleTokens, &article.Tokens.ContentsTokens}) {
        for (const QString &token : *tokens)
            article.CustomizableTokens += IsCustomizableWord(token, wordTest) ? 1 : 0;
    }
    return article;
}

// Processor time of this process: beside the wall time, as the machine may be shared.
double ProcessCpuSeconds()
{
    return static_cast<double>(std::clock()) / CLOCKS_PER_SEC;
}

struct Measure
{
    double Seconds = 0;
    double CpuSeconds = 0;
    qsizetype FileReads = 0;
    qsizetype Characters = 0; // keeps the work observable
};

// Versions made by one Spinner over word files read once.
Measure OneRun(const BenchArticle &article, const WordStore &store, const SpinSettings &settings,
               int versions)
{
    MersenneRandomSource random;
    Measure measure;
    QElapsedTimer timer;
    timer.start();
    const double cpuStart = ProcessCpuSeconds();
    CachedWordFileAlternatives source(store);
    Spinner spinner(article.Tokens, settings, source, random);
    for (int i = 0; i < versions; ++i)
        measure.Characters += spinner.SpinTitle().size() + spinner.SpinContents().size();
    measure.Seconds = timer.nsecsElapsed() / 1e9;
    measure.CpuSeconds = ProcessCpuSeconds() - cpuStart;
    measure.FileReads = source.FileReads();
    return measure;
}

// Versions made one by one, every word file read afresh (the verify page, the sample).
Measure SeparateSpins(const BenchArticle &article, const WordStore &store,
                      const SpinSettings &settings, int versions)
{
    MersenneRandomSource random;
    WordFileAlternatives source(store);
    Measure measure;
    QElapsedTimer timer;
    timer.start();
    const double cpuStart = ProcessCpuSeconds();
    for (int i = 0; i < versions; ++i) {
        measure.Characters += SpinTitle(article.Tokens.TitleTokens, settings, source, random).size()
                              + SpinContents(article.Tokens.ContentsTokens, settings, source, random).size();
    }
    measure.Seconds = timer.nsecsElapsed() / 1e9;
    measure.CpuSeconds = ProcessCpuSeconds() - cpuStart;
    measure.FileReads = article.CustomizableTokens * versions;
    return measure;
}

void Print(QTextStream &out, const QString &name, int versions, const Measure &measure)
{
    out << name << ": " << versions << " versions in " << QString::number(measure.Seconds, 'f', 3)
        << " s (CPU " << QString::number(measure.CpuSeconds, 'f', 3) << " s) = "
        << QString::number(versions / measure.Seconds, 'f', 0) << " versions/s, "
        << measure.FileReads << " file reads (" << measure.Characters << " characters)\n";
}

} // namespace

void RunSpinBenchmarks(QTextStream &out)
{
    QTemporaryDir home;
    if (!home.isValid()) {
        out << "spin: no temporary folder\n";
        return;
    }
    const WordStore store(home.path());
    SpinSettings settings;
    const BenchArticle article = MakeArticle(store, settings.WordTest);
    out << "spin article: " << kArticleWords << " words, " << article.CustomizableTokens
        << " customizable tokens, " << kVocabulary << " word files of 2-5 alternatives\n";

    const struct
    {
        int Level;
        const char *Name;
    } levels[] = {{0, "Maximum"}, {2, "Level 2"}};
    for (const auto &level : levels) {
        settings.CustomizationLevel = level.Level;
        const QString name = QLatin1String(level.Name);
        Print(out, u"spin "_qs + name + u", one run (files read once)"_qs, 2000,
              OneRun(article, store, settings, 2000));
        Print(out, u"spin "_qs + name + u", separate spins (files read afresh)"_qs, 200,
              SeparateSpins(article, store, settings, 200));
    }
    settings.CustomizationLevel = 0;
    Print(out, u"spin Maximum, 10,000 versions in one run"_qs, 10000,
          OneRun(article, store, settings, 10000));
    out.flush();
}

} // namespace verbloom::bench
