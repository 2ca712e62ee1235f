#pragma once

#include "engine/RandomSource.h"
#include "shell/ArticleModel.h"

#include <QHash>
#include <QString>
#include <QStringList>

namespace verbloom {

class WordStore;

/// Settings the spin reads at the moment of the call.
struct SpinSettings
{
    WordTestSettings WordTest;
    int CustomizationLevel = 2; ///< index of cmbCustomizationLevel: 0 "Maximum" .. 4 "Minimum"
};

/// Where the spin reads a word's alternatives.
class AlternativesSource
{
public:
    virtual ~AlternativesSource() = default;
    virtual QString Alternatives(const QString &token) = 0;
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
/// the exports and the site generator call.
class Spinner final
{
public:
    Spinner(const ArticleTokens &article, const SpinSettings &settings, AlternativesSource &source,
            RandomSource &random);
    QString SpinTitle();
    QString SpinContents();

private:
    const ArticleTokens &m_article;
    SpinSettings m_settings;
    AlternativesSource &m_source;
    RandomSource &m_random;
};

} // namespace verbloom
