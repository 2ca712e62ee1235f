#pragma once

#include "engine/ThesaurusParser.h"
#include "shell/ArticleModel.h"

#include <QString>

namespace verbloom {

/// A browser-like page loader: the main window's browser in the program, HTTP in the batch tool,
/// a scripted fake in tests.
class PageSource
{
public:
    virtual ~PageSource() = default;
    virtual void Stop() = 0;
    virtual void Navigate(const QString &url) = 0;
    /// Waits, processing pending events, until the page is complete; false after timeoutMs.
    virtual bool WaitUntilComplete(int timeoutMs) = 0;
    /// The inner text of the document's root element, lines joined with CR LF.
    virtual QString PageText() = 0;
};

/// Everything the confirm-meaning window shows for one offer.
struct ConfirmOffer
{
    QString Word;         ///< the looked-up word (lblActiveWord of the suggestions window)
    QString Suffix;
    QString Question;     ///< "Suggest the word closest in meaning to \"" + word + suffix + "\""
    QString Caption;      ///< word + ": confirm suggestions"
    QString Sentence;     ///< the context: tokens s .. s + 40 joined
    int List = 0;         ///< 0 title, 1 contents
    qsizetype Row = 0;    ///< the word row to fill, from 1
    QList<MeaningEntry> Meanings; ///< texts trimmed
};

/// Shows the confirm-meaning window modally; it writes the user's choice into the word row.
class ConfirmMeaningPresenter
{
public:
    virtual ~ConfirmMeaningPresenter() = default;
    virtual void Offer(const ConfirmOffer &offer) = 0;
};

/// What one lookup needs.
struct LookupContext
{
    QString Host;                          ///< such as "http://127.0.0.1:8080" (no trailing "/")
    bool Manual = false;                   ///< chkDontPrompt: take the last meaning without asking
    const ArticleTokens *Article = nullptr;///< for the context sentence
    PageSource *Page = nullptr;
    ConfirmMeaningPresenter *Confirm = nullptr;
    int TimeoutMs = 20000;                 ///< each wait; an expired wait gives an empty result
};

/// The context sentence of the confirm window for the word at `row` (from 1) of `list`.
QString ContextSentence(const ArticleTokens &article, int list, qsizetype row);

/// Looks the word up (stop, navigate to Host + "/search?q=" + word, wait, parse), retries with the
/// stem when nothing was found, and offers the meanings when not Manual. Empty when nothing found,
/// StopProcessing is set, a wait expired (no stem retry then), or there is no host or page source
/// (no request is made).
QString FetchAlternatives(const QString &word, const QString &suffix, int list, qsizetype row,
                          const LookupContext &context);

} // namespace verbloom
