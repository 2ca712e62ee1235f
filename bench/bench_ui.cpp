// verbloom-bench-ui: speed and responsiveness of the suggestions window filled with an article
// whose words all have word files. One line per measure.
#include "BenchVocabulary.h"
#include "common/ProgramFolder.h"
#include "engine/SuggestionsHost.h"
#include "engine/ThesaurusLookup.h"
#include "engine/WordStore.h"
#include "engine/frmSuggestions.h"
#include "shell/ArticleModel.h"
#include "shell/UiServices.h"

#include <QApplication>
#include <QElapsedTimer>
#include <QLabel>
#include <QLocale>
#include <QPlainTextEdit>
#include <QRandomGenerator>
#include <QSet>
#include <QTabWidget>
#include <QTableView>
#include <QTemporaryDir>
#include <QTest>
#include <QTextStream>
#include <QTimer>

#include <algorithm>
#include <ctime>
#include <iterator>
#include <memory>

using namespace verbloom;

namespace {

constexpr int kArticleWords = 5000;
constexpr int kTitleWords = 8;
constexpr int kVocabulary = 800;  // distinct words of four letters or more, each with a word file
constexpr double kShortWordShare = 0.45; // share of words of three letters or less, as in English prose

QTextStream &Out()
{
    static QTextStream out(stdout);
    return out;
}

QString Number(qsizetype value)
{
    return QLocale(QLocale::English).toString(value);
}

QString Milliseconds(qint64 nanoseconds)
{
    return QString::number(double(nanoseconds) / 1e6, 'f', 1) + u" ms"_qs;
}

// Processor time of this process: beside the wall time, as the machine may be shared.
qint64 ProcessCpuNanoseconds()
{
    return qint64(double(std::clock()) / CLOCKS_PER_SEC * 1e9);
}

/// No thesaurus: with every word in a word file no lookup should be asked for.
class NoPageSource final : public PageSource
{
public:
    void Stop() override {}
    void Navigate(const QString &) override {}
    bool WaitUntilComplete(int) override { return false; }
    QString PageText() override { return {}; }
};

/// The main window as the suggestions window sees it, doing nothing.
class BenchHost final : public SuggestionsHost
{
public:
    WordTestSettings Settings; ///< words of four letters or more are customizable
    bool Running = false;

    WordTestSettings CurrentWordTestSettings() const override { return Settings; }
    SpinSettings CurrentSpinSettings() const override { return {Settings, 0}; }
    PageSource &LookupPage() override { return m_page; }
    QString ThesaurusHost() const override { return {}; }
    void ShowWaitWindow() override {}
    void HideMainWindow() override {}
    void ShowVerifyPage() override {}
    void cmdVerifyTryAgain_Click() override {}
    bool AnalysisRunning() const override { return Running; }
    void cmdNext_Click() override {}
    void SetButton(bool) override {}
    void UnloadWaitWindow() override {}
    void ShowMainWindow() override {}

private:
    NoPageSource m_page;
};

// ---- The article

// A made-up word of four letters or more.
/// Picks ranks 0 .. n-1 with Zipf frequencies (the rank r word about 1/(r+1) as often as the first).
class ZipfPicker final
{
public:
    explicit ZipfPicker(qsizetype n)
    {
        double total = 0;
        for (qsizetype rank = 0; rank < n; ++rank)
            m_cumulative.append(total += 1.0 / double(rank + 1));
    }

    qsizetype Pick(QRandomGenerator &random) const
    {
        const double u = random.generateDouble() * m_cumulative.constLast();
        const auto it = std::upper_bound(m_cumulative.cbegin(), m_cumulative.cend(), u);
        return std::min<qsizetype>(it - m_cumulative.cbegin(), m_cumulative.size() - 1);
    }

private:
    QList<double> m_cumulative;
};

struct BenchArticle
{
    QString Title;
    QString Contents;
    qsizetype Tokens = 0;
    qsizetype CustomizableTokens = 0;
    qsizetype DistinctCustomizable = 0;
};

/// Words of the vocabulary in Zipf frequencies with short words between them, in sentences of 6
/// to 20 words with commas, paragraphs joined by CR LF. Every vocabulary word gets a word file of
/// 2 to 5 alternatives, some of them phrases.
BenchArticle MakeArticle(const WordStore &store, const WordTestSettings &wordTest)
{
    static const char *const kShortWords[] = {"the", "of", "and", "to", "a", "in", "is", "it", "for",
                                              "on", "as", "by", "at", "an", "be", "or", "was", "are",
                                              "we", "you", "can", "our", "not", "but", "all", "its"};
    QRandomGenerator random(5000);
    const QStringList vocabulary = bench::MakeVocabulary(random, kVocabulary);
    bench::WriteWordFiles(store, vocabulary, random, 2, 5, true);

    const ZipfPicker longWords(vocabulary.size());
    const ZipfPicker shortWords(qsizetype(std::size(kShortWords)));
    const auto nextWord = [&] {
        return random.generateDouble() < kShortWordShare
            ? QString(QLatin1String(kShortWords[shortWords.Pick(random)]))
            : vocabulary.at(longWords.Pick(random));
    };
    const auto capitalized = [](QString word) {
        word[0] = word[0].toUpper();
        return word;
    };

    BenchArticle article;
    for (int i = 0; i < kTitleWords; ++i)
        article.Title += capitalized(vocabulary.at(longWords.Pick(random))) + u' ';

    int sentenceLeft = 0;
    int sentencesInParagraph = 0;
    bool sentenceStart = true;
    for (int i = 0; i < kArticleWords; ++i) {
        if (sentenceLeft == 0)
            sentenceLeft = 6 + random.bounded(15);
        const QString word = nextWord();
        article.Contents += sentenceStart ? capitalized(word) : word;
        sentenceStart = --sentenceLeft == 0;
        if (!sentenceStart) {
            article.Contents += random.bounded(8) == 0 ? QLatin1String(", ") : QLatin1String(" ");
        } else if (++sentencesInParagraph == 5 && i + 1 < kArticleWords) {
            article.Contents += QLatin1String(".\r\n");
            sentencesInParagraph = 0;
        } else {
            article.Contents += QLatin1String(". ");
        }
    }

    const ArticleTokens tokens = SplitArticle(article.Title, article.Contents);
    QSet<QString> distinct;
    for (const QStringList *list : {&tokens.TitleTokens, &tokens.ContentsTokens}) {
        article.Tokens += list->size();
        for (const QString &token : *list) {
            if (IsCustomizableWord(token, wordTest)) {
                ++article.CustomizableTokens;
                distinct.insert(token.toLower());
            }
        }
    }
    article.DistinctCustomizable = distinct.size();
    return article;
}

// ---- The measures

/// One suggestions window over the program folder, with a main window that does nothing.
struct Bench
{
    BenchHost Host;
    ScriptedUiServices Ui;
    std::unique_ptr<frmSuggestions> Window;

    QTableView *List(int list) const
    {
        return Window->findChild<QTableView *>(u"lstSuggestions"_qs + QString::number(list));
    }
};

/// Runs the pending events until none is left; the time it took.
qint64 UntilIdle()
{
    QElapsedTimer timer;
    timer.start();
    QCoreApplication::processEvents();
    QCoreApplication::sendPostedEvents();
    QCoreApplication::processEvents();
    return timer.nsecsElapsed();
}

/// Customizable rows that did not get their alternatives from a word file.
qsizetype RowsWithoutFile(const Bench &bench)
{
    qsizetype rows = 0;
    for (int list = 0; list < 2; ++list) {
        for (const WordRow &row : bench.Window->Lists().Rows(list))
            rows += IsCustomizableWord(row.Text, bench.Host.Settings) && !row.Blue ? 1 : 0;
    }
    return rows;
}

/// Fills the lists as "Next" does, timing the fill and the gaps between event-loop turns.
void MeasureFill(Bench &bench, const BenchArticle &article, const QString &name)
{
    QElapsedTimer clock;
    qint64 lastTurn = 0;
    qint64 longestGap = 0;
    qsizetype turns = 0;
    // A zero timer runs once per turn of the event loop, i.e. whenever input could be handled.
    QTimer probe;
    probe.setInterval(0);
    QObject::connect(&probe, &QTimer::timeout, &probe, [&] {
        const qint64 now = clock.nsecsElapsed();
        longestGap = std::max(longestGap, now - lastTurn);
        lastTurn = now;
        ++turns;
    });

    StopProcessing = false;
    bench.Host.Running = true;
    const qint64 cpuStart = ProcessCpuNanoseconds();
    clock.start();
    probe.start();
    const bool completed = FillWordLists(article.Title, article.Contents, CurrentArticle(), *bench.Window,
                                         bench.Host);
    const qint64 elapsed = clock.nsecsElapsed();
    const qint64 cpu = ProcessCpuNanoseconds() - cpuStart;
    probe.stop();
    bench.Host.Running = false;
    longestGap = std::max(longestGap, elapsed - lastTurn); // the last stretch until the fill returns
    const qint64 idle = UntilIdle();

    const qsizetype rows = bench.Window->Lists().Count(0) + bench.Window->Lists().Count(1);
    Out() << "fill suggestions window, " << name << ": " << QString::number(double(elapsed) / 1e9, 'f', 3)
          << " s (CPU " << QString::number(double(cpu) / 1e9, 'f', 3) << " s), " << Number(rows)
          << " rows, " << RowsWithoutFile(bench) << " customizable rows without word file, then "
          << Milliseconds(idle) << " until idle" << (completed ? "" : " (CANCELLED)") << Qt::endl;
    Out() << "responsiveness during fill, " << name << ": longest gap between event-loop turns "
          << Milliseconds(longestGap) << " (" << Number(turns) << " turns, mean "
          << Milliseconds(turns > 0 ? elapsed / turns : elapsed) << ")" << Qt::endl;
}

/// The first row (from 1) at or after `from` of the contents list that holds a customizable word.
int CustomizableRow(const Bench &bench, int from)
{
    const QList<WordRow> &rows = bench.Window->Lists().Rows(1);
    for (int row = std::max(from, 1); row <= rows.size(); ++row) {
        if (IsCustomizableWord(rows.at(row - 1).Text, bench.Host.Settings))
            return row;
    }
    return 1;
}

/// A mouse click on a row (from 1) of the contents list: saves every row and shows a new sample.
void MeasureClick(Bench &bench, int row, const QString &name)
{
    QTableView *view = bench.List(1);
    auto *tabs = bench.Window->findChild<QTabWidget *>(u"SSTab1"_qs);
    if (tabs->currentIndex() != 1)
        tabs->setCurrentIndex(1);
    const QModelIndex index = view->model()->index(row - 1, 0);
    view->scrollTo(index);
    UntilIdle();
    auto *sample = bench.Window->findChild<QPlainTextEdit *>(u"txtSample"_qs);
    sample->clear();

    const qint64 cpuStart = ProcessCpuNanoseconds();
    QElapsedTimer clock;
    clock.start();
    QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, view->visualRect(index).center());
    const qint64 elapsed = clock.nsecsElapsed();
    const qint64 cpu = ProcessCpuNanoseconds() - cpuStart;
    const qint64 idle = UntilIdle();

    const QString word = bench.Window->Lists().Row(1, row - 1).Text;
    const bool taken = bench.Window->findChild<QLabel *>(u"lblActiveWord"_qs)->text() == word
        && !sample->toPlainText().isEmpty();
    Out() << name << " (row " << row << ", \"" << word << "\"; saves every row, makes a sample): "
          << Milliseconds(elapsed) << " (CPU " << Milliseconds(cpu) << "), then " << Milliseconds(idle)
          << " until idle" << (taken ? "" : " (CLICK NOT TAKEN)") << Qt::endl;
}

int Run()
{
    QTemporaryDir home;
    if (!home.isValid()) {
        Out() << "suggestions window: no temporary folder" << Qt::endl;
        return 1;
    }
    SetProgramFolder(home.path());
    Bench bench;
    bench.Host.Settings.MinimumWordLength = 3;
    const BenchArticle article = MakeArticle(WordStore(ProgramFolder()), bench.Host.Settings);
    Out() << "suggestions window article (" << QGuiApplication::platformName() << "): "
          << Number(kArticleWords) << " words + " << kTitleWords << " in the title, " << Number(article.Tokens)
          << " tokens, " << Number(article.CustomizableTokens) << " customizable tokens of "
          << Number(article.DistinctCustomizable) << " distinct words, " << kVocabulary
          << " word files of 2-5 alternatives" << Qt::endl;

    StopProcessing = true;
    bench.Window = std::make_unique<frmSuggestions>(bench.Host, bench.Ui);
    MeasureFill(bench, article, u"first"_qs);
    MeasureClick(bench, CustomizableRow(bench, 1), u"first row click"_qs);
    MeasureClick(bench, CustomizableRow(bench, int(bench.Window->Lists().Count(1) / 2)), u"second row click"_qs);

    // "Ok" hides the window with its rows; "Next" fills it again.
    bench.Window->hide();
    UntilIdle();
    MeasureFill(bench, article, u"again"_qs);

    if (!bench.Ui.Messages.isEmpty())
        Out() << "(messages shown: " << bench.Ui.Messages.constFirst().Text << ")" << Qt::endl;
    bench.Window.reset();
    return 0;
}

} // namespace

int main(int argc, char *argv[])
{
    QApplication app(argc, argv);
    return Run();
}
