#pragma once

#include "engine/RandomSource.h"
#include "shell/ArticleModel.h"

#include <QHash>
#include <QString>
#include <QStringList>

#include <optional>

namespace verbloom {

class WordStore;

/// The customization levels by index: "Maximum", "Level 3", "Level 2" (the default), "Level 1",
/// "Minimum".
const QStringList &CustomizationLevelNames();
inline constexpr int DefaultCustomizationLevel = 2;

/// Settings the spin reads at the moment of the call.
struct SpinSettings
{
    WordTestSettings WordTest;
    int CustomizationLevel = DefaultCustomizationLevel; ///< index of cmbCustomizationLevel: 0 "Maximum" .. 4 "Minimum"
};

/// Where the spin reads a word's alternatives.
class AlternativesSource
{
public:
    virtual ~AlternativesSource() = default;
    virtual QString Alternatives(const QString &token) = 0;
    /// True when a token's text cannot change while this source lives (one export or site run),
    /// so a Spinner may prepare each token's candidates once.
    virtual bool KeepsTextsForRun() const { return false; }
};

/// Reads the word file afresh on every call (ReGenerate, the sample of the suggestions window).
class WordFileAlternatives final : public AlternativesSource
{
public:
    explicit WordFileAlternatives(const WordStore &store);
    QString Alternatives(const QString &token) override;

private:
    const WordStore &m_store;
};

/// Reads each word file once and keeps its text for the rest of one export or site run.
class CachedWordFileAlternatives final : public AlternativesSource
{
public:
    explicit CachedWordFileAlternatives(const WordStore &store);
    QString Alternatives(const QString &token) override;
    bool KeepsTextsForRun() const override { return true; }
    /// Word files read so far (words differing only in capitals share one read).
    qsizetype FileReads() const { return m_fileReads; }

private:
    const WordStore &m_store;
    QHash<QString, QString> m_cache;
    qsizetype m_fileReads = 0;
};

/// The text that stands for one token (see the replacement rules: level skip, candidates with the
/// token itself as the last one, trimming, empty-piece fallback, capital rule).
QString ReplaceWord(const QString &token, const QString &alternatives, const SpinSettings &settings,
                    RandomSource &random);

/// A customized title: all title tokens but the last (the closing blank).
QString SpinTitle(const QStringList &titleTokens, const SpinSettings &settings,
                  AlternativesSource &source, RandomSource &random);

/// A customized contents: all tokens, then every LF turned into CR LF.
QString SpinContents(const QStringList &contentsTokens, const SpinSettings &settings,
                     AlternativesSource &source, RandomSource &random);

/// Makes one customized version after another from one analysed article; what the verify page,
/// the exports and the site generator call. Gives exactly the texts and draws of the functions
/// SpinTitle and SpinContents, but decides the word test once per token, and with a source that
/// keeps its texts for the run, prepares each token's candidates once. The article must not
/// change while the Spinner lives.
class Spinner final
{
public:
    Spinner(const ArticleTokens &article, const SpinSettings &settings, AlternativesSource &source,
            RandomSource &random);
    QString SpinTitle();
    QString SpinContents();

private:
    struct TextSpan
    {
        qsizetype Offset = 0;
        qsizetype Length = 0;
    };
    /// A customizable token with the unchanged tokens after it, or unchanged tokens alone.
    struct Segment
    {
        TextSpan Output;          ///< the token(s) unchanged
        qsizetype FirstChoice = 0;
        qsizetype Candidates = 0; ///< n + 1 prepared candidates; 0: no draw from the plan
        qsizetype ReadAtSpin = -1;///< a customizable token whose file is read at every spin
    };
    /// What stays the same for every version of one text: the word test of each token and,
    /// with a source that keeps its texts, the final text of each candidate.
    struct SpinPlan
    {
        QStringList Source;
        QString Pool;             ///< all texts of the plan, CR LF already in for the contents
        QList<TextSpan> Choices;
        QList<Segment> Segments;
        bool CrLf = false;
    };

    SpinPlan Plan(const QStringList &tokens, qsizetype count, bool crLf);
    QString Spin(const SpinPlan &plan, qsizetype &sizeHint);
    template<typename Random>
    QString Spin(const SpinPlan &plan, qsizetype &sizeHint, Random &random);

    const ArticleTokens &m_article;
    SpinSettings m_settings;
    AlternativesSource &m_source;
    RandomSource &m_random;
    MersenneRandomSource *m_mersenne; ///< m_random when it is one: its draws can be inlined
    std::optional<SpinPlan> m_titlePlan;
    std::optional<SpinPlan> m_contentsPlan;
    qsizetype m_titleSizeHint = 0;
    qsizetype m_contentsSizeHint = 0;
};

} // namespace verbloom
