#include "ThesaurusLookup.h"

#include "engine/AlternativesList.h"
#include "engine/WordForms.h"

#include <algorithm>

namespace verbloom {

namespace {

// The context window: tokens s to s + 40, where s = row - 20 for rows past 20 and 1 otherwise
// (rows count from 1, token indexes from 0).
constexpr qsizetype kContextBefore = 20;
constexpr qsizetype kContextLength = 41;

ConfirmOffer MakeOffer(const QString &word, const QString &suffix, int list, qsizetype row,
                       const ParsedPage &page, const LookupContext &context)
{
    ConfirmOffer offer;
    offer.Word = word;
    offer.Suffix = suffix;
    offer.Question = QLatin1String("Suggest the word closest in meaning to ") + QLatin1Char('"')
                     + word + suffix + QLatin1Char('"');
    offer.Caption = word + QLatin1String(": confirm suggestions");
    if (context.Article)
        offer.Sentence = ContextSentence(*context.Article, list, row);
    offer.List = list;
    offer.Row = row;
    for (const MeaningEntry &meaning : page.Meanings)
        offer.Meanings.append({TrimSpaces(meaning.EntryWord), TrimSpaces(meaning.Synonyms)});
    return offer;
}

} // namespace

QString ContextSentence(const ArticleTokens &article, int list, qsizetype row)
{
    const QStringList &tokens = list == 1 ? article.ContentsTokens : article.TitleTokens;
    const qsizetype start = row > kContextBefore ? row - kContextBefore : 1;
    const qsizetype end = std::min(start + kContextLength, tokens.size());
    QString sentence;
    for (qsizetype i = start; i < end; ++i)
        sentence += tokens.at(i);
    return sentence;
}

QString FetchAlternatives(const QString &word, const QString &suffix, int list, qsizetype row,
                          const LookupContext &context)
{
    // No thesaurus has entries this long; looking such a token up (and retrying it once per
    // trailing "s") would only keep the analysis waiting.
    constexpr qsizetype kMaxLookupLength = 64;
    if (StopProcessing || !context.Page || context.Host.isEmpty() || word.size() > kMaxLookupLength)
        return {};

    PageSource &page = *context.Page;
    page.Stop();
    page.Navigate(context.Host + QLatin1String("/search?q=") + word);
    if (!page.WaitUntilComplete(context.TimeoutMs))
        return {};

    const ParsedPage parsed = ParseThesaurusPage(page.PageText(), suffix);
    if (!context.Manual && !parsed.Meanings.isEmpty() && !StopProcessing && context.Confirm)
        context.Confirm->Offer(MakeOffer(word, suffix, list, row, parsed, context));

    QString result = parsed.LastSynonyms;
    if (result.isEmpty()) {
        const StemAndSuffix split = SplitSuffix(word);
        if (!split.Stem.isEmpty() && split.Stem != word) {
            result = FetchAlternatives(split.Stem, split.Suffix, list, row, context);
            if (!result.isEmpty())
                result = InflectAlternatives(result, split.Suffix);
        }
    }
    return result;
}

} // namespace verbloom
