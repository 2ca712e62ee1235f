#include "batch/BatchRun.h"

#include "batch/BatchActions.h"
#include "batch/BatchAnalysis.h"
#include "batch/BatchConsole.h"
#include "common/LineEnds.h"
#include "common/ProgramFolder.h"
#include "common/TextFile.h"
#include "engine/RandomSource.h"
#include "engine/SpinGenerator.h"
#include "engine/WordStore.h"
#include "thesaurus/HttpPageSource.h"
#include "thesaurus/ThesaurusService.h"

#include <QCoreApplication>
#include <QLocale>

#include <memory>

namespace verbloom {

namespace {

/// The decimal point of the user's locale, with which the windows read typed numbers.
QChar DecimalPoint()
{
    const QString point = QLocale::system().decimalPoint();
    return point.size() == 1 ? point.at(0) : QLatin1Char('.');
}

void SetUpProgramFolder(const QString &home)
{
    QStringList arguments{QCoreApplication::applicationFilePath()};
    if (!home.isEmpty())
        arguments << u"--home"_qs << home;
    InitProgramFolder(arguments);
}

} // namespace

int RunBatch(const BatchArguments &arguments, BatchConsole &console)
{
    SetUpProgramFolder(arguments.Home);
    const QString programFolder = ProgramFolder();

    QString contents = arguments.ContentsText;
    if (arguments.ContentsFromFile && !TryReadTextFile(arguments.ContentsFile, contents)) {
        console.Error(u"The contents file could not be read: "_qs + arguments.ContentsFile);
        return kExitFailed;
    }
    WordTestSettings settings;
    settings.MinimumWordLength = arguments.MinimumWordLength;
    for (const QString &word : arguments.IgnoredWords) {
        if (const std::optional<QString> refusal = CheckIgnoredWord(word, arguments.MinimumWordLength)) {
            console.Error(*refusal);
            return kExitFailed;
        }
        settings.IgnoredWords.append(word.trimmed());
    }
    if (const std::optional<ArticleRefusal> refusal = VerifyArticleTexts(arguments.Title, contents)) {
        console.Error(refusal->Message);
        return kExitFailed;
    }
    BatchActions actions(arguments, programFolder, DecimalPoint(), console);
    if (const std::optional<QString> refusal = actions.Check()) {
        console.Error(*refusal);
        return kExitFailed;
    }

    LookupContext lookup;
    QObject thesaurusOwner;
    std::unique_ptr<HttpPageSource> page;
    if (arguments.Lookup) {
        const ThesaurusHost host = StartThesaurusHost(SettingsIniPath(), &thesaurusOwner);
        if (!host.Message.isEmpty())
            console.Error(host.Message);
        page = std::make_unique<HttpPageSource>();
        lookup.Host = host.Url;
        lookup.Page = page.get();
    }

    // "Next": the closing blanks, then the analysis.
    // The contents box of the window holds CR LF line breaks; so does the first version.
    const ArticleBoxes article{WithClosingBlank(arguments.Title), WithClosingBlank(NormalizeToCrLf(contents))};
    const WordStore store(programFolder);
    BatchAnalysis analysis(settings, store, lookup, console);
    analysis.Run(article.Title, article.Contents);
    const QStringList newWords = analysis.NewWords();
    if (arguments.Lookup) {
        if (const qsizetype failures = analysis.SaveWordFiles(); failures > 0) {
            console.Error(u"The alternatives of "_qs + QString::number(failures)
                          + u" word(s) could not be saved in the folder \""_qs + store.DataFolder() + u"\"."_qs);
            return kExitFailed;
        }
    }

    const SpinSettings spinSettings{settings, arguments.CustomizationLevel};
    CachedWordFileAlternatives alternatives(store);
    std::optional<MersenneRandomSource> seeded;
    RandomSource &random = arguments.Seed ? seeded.emplace(*arguments.Seed) : ProcessRandom();
    Spinner spinner(analysis.Article(), spinSettings, alternatives, random);
    if (const std::optional<QString> failure = actions.Run(article, spinner, newWords)) {
        console.Error(*failure);
        return kExitFailed;
    }
    return kExitSuccess;
}

} // namespace verbloom
